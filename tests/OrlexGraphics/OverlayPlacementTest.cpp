#include "OrlexGraphics/overlays/OverlayPlacement.h"

#include <gtest/gtest.h>

namespace
{

TEST(OverlayPlacement, KeepsLabelsInTheView)
{
	// The eye in the origin looks along -z; y is up. 1000 away half the view is 1000 wide.
	QMatrix4x4 viewProjection;
	viewProjection.perspective(90.0f, 1.0f, 1.0f, 100000.0f);
	const QSizeF size(200, 200);
	const struct
	{
		const char* m_pName;
		QVector3D m_Point;
		bool m_bYUp;
		QPointF m_Position;
		double m_RotationDegrees;
		bool m_bOffscreen;
	} rows[] = {
	    // 100 mm up are 10 pixels, and 20 more.
	    {"in the middle", {0, 0, -1000}, true, {0, -30}, 180.0, false},
	    {"to the right", {300, 0, -1000}, true, {30, -30}, 135.0, false},
	    {"below", {0, -600, -1000}, true, {0, 30}, 0.0, false},
	    // Raised towards the eye.
	    {"z up", {0, 0, -1000}, false, {0, -20}, 180.0, false},
	    {"beyond the right edge", {1400, -300, -1000}, true, {70, 0}, 90.0, true},
	    {"beyond the upper edge", {0, 2000, -1000}, true, {0, -70}, 180.0, true},
	    {"behind, to the left", {-1400, 100, 1000}, true, {-70, 0}, -90.0, true},
	    {"behind, above to the left", {-500, 500, 1000}, true, {-70, -56}, -128.6598, true},
	};
	for (const auto& rRow : rows)
	{
		const OrlexGraphics::VOverlayPlace place =
		    OrlexGraphics::PlaceOverlay(viewProjection, size, rRow.m_Point, rRow.m_bYUp);
		EXPECT_NEAR(place.m_Position.x(), rRow.m_Position.x(), 0.01) << rRow.m_pName;
		EXPECT_NEAR(place.m_Position.y(), rRow.m_Position.y(), 0.01) << rRow.m_pName;
		EXPECT_NEAR(place.m_RotationDegrees, rRow.m_RotationDegrees, 0.01) << rRow.m_pName;
		EXPECT_EQ(place.m_bOffscreen, rRow.m_bOffscreen) << rRow.m_pName;
		if (rRow.m_bOffscreen)
			EXPECT_EQ(place.m_Depth, 1.0) << rRow.m_pName;
		else
			EXPECT_NEAR(place.m_Depth, 0.99901, 1e-4) << rRow.m_pName;
	}
}

} // namespace
