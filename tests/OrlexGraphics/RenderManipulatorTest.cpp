#include "RenderTypeFixture.h"

#include "OrlexGraphics/manipulator/RenderManipulator.h"

#include <algorithm>
#include <cstdlib>

using namespace OrlexGraphics;

namespace
{

constexpr std::array<int, 3> c_Green{51, 255, 51};
constexpr std::array<int, 3> c_Blue{51, 51, 255};

class RenderManipulator : public VRenderTypeTest
{
protected:
	RenderManipulator() : VRenderTypeTest(QSize(400, 300)) {}

	void SetUp() override
	{
		VRenderTypeTest::SetUp();
		m_pManipulator = std::make_unique<VRenderManipulator>(m_Library, m_pRegistry, m_pSelection);
		m_pManipulator->SetVisible(true);
		// From +X, with Y to the right and Z up, the origin in the middle of the picture.
		m_Camera.m_Type = CoreGraphics::ECameraRight;
	}

	/// Pixels from the lower left corner that hold a colour, within one step of a byte.
	QRect ExtentOf(const VColour& i_rColour) const
	{
		return Extent(
		    [&](const VColour& i_rPixel)
		    {
			    return std::equal(i_rPixel.begin(), i_rPixel.end(), i_rColour.begin(),
			        [](int i_A, int i_B) { return std::abs(i_A - i_B) <= 1; });
		    });
	}

	void PointAt(const VManipulatorHandle& i_rHandle) { m_pSelection->PreSelection().Replace({HandleItem(i_rHandle)}); }

	std::unique_ptr<VRenderManipulator> m_pManipulator;
};
INSTANTIATE_IN_BOTH_DIALECTS(RenderManipulator);

} // namespace

TEST_P(RenderManipulator, HandlesKeepTheirSizeOnTheScreen)
{
	struct VRow
	{
		const char* m_pName;
		std::uint32_t m_Type;
		float m_Distance;
		float m_Scale;
		float m_PixelRatio;
		float m_Factor;
	};
	const VRow rows[] = {{"fixed", CoreGraphics::ECameraRight, 7000, 1, 1, 1},
	    {"near", CoreGraphics::ECameraPerspective, 1000, 1, 1, 1},
	    {"far", CoreGraphics::ECameraPerspective, 40000, 1, 1, 1},
	    {"half", CoreGraphics::ECameraRight, 7000, 0.5f, 1, 0.5f},
	    {"a fine display", CoreGraphics::ECameraRight, 7000, 0.5f, 2, 1}};
	// Level with the floor, along -X as the fixed view looks.
	m_Camera.m_Pitch = -90.0f;
	m_Camera.m_Yaw = -90.0f;
	m_pManipulator->SetModeMask(1);
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		m_Camera.m_Type = rRow.m_Type;
		m_Camera.m_Distance = rRow.m_Distance;
		m_Options.m_ManipulatorScale = rRow.m_Scale;
		m_Render.m_PixelRatio = rRow.m_PixelRatio;
		DrawFrame(*m_pManipulator);
		// A shaft from 10 to 90 and a head to 120 pixels, whose tip is thinner than a pixel; the head of X covers the
		// beginning.
		const QRect green = ExtentOf(c_Green), blue = ExtentOf(c_Blue);
		EXPECT_NEAR(green.right() - m_Size.width() / 2, 120 * rRow.m_Factor, 3.5);
		EXPECT_NEAR(green.left() - m_Size.width() / 2, 10 * rRow.m_Factor, 3.5);
		EXPECT_NEAR(green.height(), 20 * rRow.m_Factor, 2.5);
		EXPECT_NEAR(blue.bottom() - m_Size.height() / 2, 120 * rRow.m_Factor, 3.5);
		EXPECT_NEAR(blue.width(), 20 * rRow.m_Factor, 2.5);
	}
}

TEST_P(RenderManipulator, ModesChooseTheHandles)
{
	struct VRow
	{
		std::uint32_t m_Mask;
		/// Of the handles of Z, seen from +X.
		QRect m_Blue;
	};
	const VRow rows[] = {{0, {}}, {1, {QPoint(190, 160), QPoint(210, 270)}},
	    // Sides at 25 pixels along X, which points at the eye, and along Y.
	    {2, {QPoint(199, 149), QPoint(226, 151)}}, {4, {QPoint(149, 149), QPoint(251, 151)}}, {8, {}}};
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_Mask);
		m_pManipulator->SetModeMask(rRow.m_Mask);
		DrawFrame(*m_pManipulator);
		const QRect blue = ExtentOf(c_Blue);
		EXPECT_EQ(blue.isEmpty(), rRow.m_Blue.isEmpty());
		ExpectNear(blue, rRow.m_Blue, 3.0);
	}
}

TEST_P(RenderManipulator, DrawsOnlyWhereItMay)
{
	const auto drawn = [&]
	{
		Update(*m_pManipulator);
		return DrawnIn(*m_pManipulator);
	};
	EXPECT_EQ(drawn(), "overlay, overlay pick");
	m_Options.m_bManipulator = false;
	EXPECT_EQ(drawn(), "");
	m_Options.m_bManipulator = true;
	m_Options.m_OverlayCamera = "camera";
	EXPECT_EQ(drawn(), "");
	m_Options.m_OverlayCamera.clear();
	// Arrows, planes and rings are all there is.
	m_pManipulator->SetModeMask(8);
	EXPECT_EQ(drawn(), "");
	m_pManipulator->SetModeMask(7);
	m_pManipulator->SetVisible(false);
	EXPECT_EQ(drawn(), "");
}

TEST_P(RenderManipulator, PicksGiveTheHandle)
{
	DrawFrame(*m_pManipulator, CoreGraphics::ERenderPick);
	EXPECT_EQ(ItemAt(300, 150), HandleItem({EManipulatorArrow, 1}));
	EXPECT_EQ(ItemAt(200, 250), HandleItem({EManipulatorArrow, 2}));
	// The ring about X stands upright before the eye.
	// At a distance of 50 pixels, aslant.
	EXPECT_EQ(ItemAt(200 - 36, 150 - 36), HandleItem({EManipulatorRing, 0}));
	EXPECT_EQ(ItemAt(100, 250), NVX::ISelectionItem());

	// What was found is left out of the next layer.
	m_pRegistry->Exclude(m_pRegistry->Allocate(HandleItem({EManipulatorArrow, 1})));
	m_Render.ClearBuffers(true, true);
	m_pManipulator->Render(m_Render, m_Options, EPassOverlay);
	Read();
	EXPECT_EQ(ItemAt(300, 150), NVX::ISelectionItem());
}

TEST_P(RenderManipulator, APressDragsTheHandleThatIsPointedAt)
{
	int begun = 0, ended = 0;
	std::vector<QMatrix4x4> changes;
	m_pManipulator->BeginSignal().Connect([&] { ++begun; });
	m_pManipulator->ChangedSignal().Connect([&](const QMatrix4x4& i_rMatrix) { changes.push_back(i_rMatrix); });
	m_pManipulator->EndSignal().Connect([&] { ++ended; });
	const NVX::ISelectionItem segment{NVX::ESelectionTargetSegment, 0x0fffffff, 4, "arm"};
	m_pSelection->Selection().Replace({segment});
	m_Camera.Update();

	EXPECT_FALSE(m_pManipulator->IsHovered());
	m_pManipulator->Press(m_Camera, {300, 150});
	EXPECT_FALSE(m_pManipulator->IsDragging());

	PointAt({EManipulatorArrow, 1});
	EXPECT_TRUE(m_pManipulator->IsHovered());
	DrawFrame(*m_pManipulator);
	EXPECT_EQ(Pixel(300, 150), c_Yellow);

	m_pManipulator->Press(m_Camera, {300, 150});
	EXPECT_TRUE(m_pManipulator->IsDragging());
	EXPECT_EQ(begun, 1);
	// The segment stays selected beside the handle.
	EXPECT_EQ(m_pSelection->Selection().Items(),
	    (std::vector<NVX::ISelectionItem>{segment, HandleItem({EManipulatorArrow, 1})}));
	m_pSelection->PreSelection().Replace({});
	m_pManipulator->Drag(m_Camera, {310, 140}, {});
	ASSERT_EQ(changes.size(), 1u);
	// 4 mm a pixel.
	EXPECT_NEAR(changes[0](1, 3), 40.0f, 0.02f);
	EXPECT_NEAR(changes[0](2, 3), 0.0f, 0.02f);
	EXPECT_EQ(m_pManipulator->Transform(), changes[0]);
	EXPECT_TRUE(m_pManipulator->GivenTransform().isIdentity());

	// While it is dragged it takes no other transform.
	QMatrix4x4 other;
	other.translate(1, 2, 3);
	m_pManipulator->SetTransform(other);
	EXPECT_EQ(m_pManipulator->Transform(), changes[0]);
	DrawFrame(*m_pManipulator);
	EXPECT_EQ(Pixel(310, 150), c_Yellow);
	// The black marker stands on the other side, with its tip towards the middle.
	EXPECT_EQ(Pixel(210 - 45, 155), (VColour{0, 0, 0}));
	EXPECT_EQ(Pixel(210 - 25, 155), (VColour{40, 40, 40}));

	m_pManipulator->Release();
	EXPECT_FALSE(m_pManipulator->IsDragging());
	EXPECT_EQ(ended, 1);
	EXPECT_EQ(m_pSelection->Selection().Items(), std::vector<NVX::ISelectionItem>{segment});
	m_pManipulator->Drag(m_Camera, {350, 140}, {});
	m_pManipulator->Release();
	EXPECT_EQ(changes.size(), 1u);
	EXPECT_EQ(ended, 1);
	m_pManipulator->SetTransform(other);
	EXPECT_EQ(m_pManipulator->Transform(), other);

	// A refused press begins nothing: the arrow of X points at the eye.
	PointAt({EManipulatorArrow, 0});
	m_pManipulator->Press(m_Camera, {200, 150});
	EXPECT_FALSE(m_pManipulator->IsDragging());
	EXPECT_EQ(begun, 1);

	// Neither does one that the mode has taken away since, nor one that never was.
	m_pManipulator->SetModeMask(4);
	for (const VManipulatorHandle& rHandle :
	    {VManipulatorHandle{EManipulatorArrow, 1}, {EManipulatorMarker, 1}, {40, 0}})
	{
		PointAt(rHandle);
		EXPECT_FALSE(m_pManipulator->IsHovered()) << rHandle.m_Group;
	}

	// Hidden it takes no press, and hiding it ends a drag.
	PointAt({EManipulatorRing, 0});
	m_pManipulator->Press(m_Camera, {250, 150});
	EXPECT_TRUE(m_pManipulator->IsDragging());
	m_pManipulator->SetVisible(false);
	EXPECT_FALSE(m_pManipulator->IsDragging());
	EXPECT_FALSE(m_pManipulator->IsHovered());
	EXPECT_EQ(ended, 2);
	EXPECT_EQ(m_pSelection->Selection().Items(), std::vector<NVX::ISelectionItem>{segment});
}
