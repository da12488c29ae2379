#include "RenderTypeFixture.h"

#include "OrlexGraphics/manipulator/RenderVolumeManipulator.h"

#include <algorithm>
#include <cmath>

using namespace OrlexGraphics;

namespace
{

constexpr int c_VolumeWidth = 400;
constexpr int c_VolumeHeight = 300;

const VVolume c_Volume{QVector3D(-1000, -2000, -100), QVector3D(1000, 2000, 3000)};

/// 20 mm a pixel, the world's origin in the middle.
CoreGraphics::VCameraController VolumeCamera(std::uint32_t i_Type, bool i_bYUp = false)
{
	CoreGraphics::VCameraController camera;
	camera.m_Type = i_Type;
	camera.m_bYUp = i_bYUp;
	camera.m_OrthographicScale = 20.0f;
	camera.SetSize(QSize(c_VolumeWidth, c_VolumeHeight));
	camera.Update();
	return camera;
}

class VolumeManipulator : public VRenderTypeTest
{
protected:
	VolumeManipulator() : VRenderTypeTest(QSize(c_VolumeWidth, c_VolumeHeight)) {}

	void SetUp() override
	{
		VRenderTypeTest::SetUp();
		m_Camera = VolumeCamera(CoreGraphics::ECameraTop);
		m_pManipulator = std::make_unique<VRenderVolumeManipulator>(
		    m_Library, m_pRegistry, m_pSelection, "Volume", QVector3D(1.0f, 0.0f, 1.0f), c_Volume);
	}

	std::unique_ptr<VRenderVolumeManipulator> m_pManipulator;
};
INSTANTIATE_IN_BOTH_DIALECTS(VolumeManipulator);

constexpr std::array<int, 3> c_Magenta{255, 0, 255};
constexpr std::array<int, 3> c_Nothing{40, 40, 40};

} // namespace

TEST(VolumeDrag, HandlesMoveTheirSides)
{
	struct VRow
	{
		const char* m_pName;
		std::uint32_t m_Type;
		bool m_bYUp;
		VVolumeHandle m_Handle;
		QPoint m_Move;
		VVolume m_Expected;
	};
	const QVector3D low = c_Volume.m_Minimum, high = c_Volume.m_Maximum;
	// From above X points to the left and Y down; from the front Z is up. With Y up, from above X points to the right
	// and Z down.
	const VRow rows[] = {
	    {"lower X", CoreGraphics::ECameraTop, false, {EVolumeFace, 0}, {10, 5}, {low - QVector3D(200, 0, 0), high}},
	    {"upper X", CoreGraphics::ECameraTop, false, {EVolumeFace, 1}, {-10, 0}, {low, high + QVector3D(200, 0, 0)}},
	    {"lower Y", CoreGraphics::ECameraTop, false, {EVolumeFace, 2}, {0, 10}, {low + QVector3D(0, 200, 0), high}},
	    {"upper Z", CoreGraphics::ECameraFront, false, {EVolumeFace, 5}, {3, -10}, {low, high + QVector3D(0, 0, 200)}},
	    {"through the other side", CoreGraphics::ECameraTop, false, {EVolumeFace, 1}, {300, 0},
	        {low, QVector3D(-990, 2000, 3000)}},
	    {"corner", CoreGraphics::ECameraTop, false, {EVolumeCorner, 1}, {-10, 20},
	        {low + QVector3D(0, 400, 0), high + QVector3D(200, 0, 0)}},
	    {"opposite corner", CoreGraphics::ECameraTop, false, {EVolumeCorner, 2}, {-10, 20},
	        {low + QVector3D(200, 0, 0), high + QVector3D(0, 400, 0)}},
	    {"centre", CoreGraphics::ECameraTop, false, {EVolumeCentre, 0}, {-10, 20},
	        {low + QVector3D(200, 400, 0), high + QVector3D(200, 400, 0)}},
	    {"centre, Y up", CoreGraphics::ECameraTop, true, {EVolumeCentre, 0}, {-10, 20},
	        {low + QVector3D(-200, 0, 400), high + QVector3D(-200, 0, 400)}},
	    {"corner, Y up", CoreGraphics::ECameraTop, true, {EVolumeCorner, 3}, {10, 10},
	        {low, high + QVector3D(200, 0, 200)}}};
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const CoreGraphics::VCameraController camera = VolumeCamera(rRow.m_Type, rRow.m_bYUp);
		const auto drag = VVolumeDrag::Press(camera, {123, 45}, rRow.m_Handle, c_Volume);
		ASSERT_TRUE(drag);
		const auto moved = drag->Drag(camera, QPoint(123, 45) + rRow.m_Move);
		ASSERT_TRUE(moved);
		EXPECT_LT((moved->m_Minimum - rRow.m_Expected.m_Minimum).length(), 0.1f);
		EXPECT_LT((moved->m_Maximum - rRow.m_Expected.m_Maximum).length(), 0.1f);
	}
	// Along the view there is no place for the mouse, and there are no other handles.
	const CoreGraphics::VCameraController top = VolumeCamera(CoreGraphics::ECameraTop);
	EXPECT_FALSE(VVolumeDrag::Press(top, {1, 1}, {EVolumeFace, 5}, c_Volume));
	EXPECT_FALSE(VVolumeDrag::Press(VolumeCamera(CoreGraphics::ECameraFront), {1, 1}, {EVolumeCentre, 0}, c_Volume));
	for (const VVolumeHandle& rHandle : {VVolumeHandle{EVolumeFace, 6}, {EVolumeCorner, 4}, {EVolumeCentre, 1}, {3, 0}})
		EXPECT_FALSE(VVolumeDrag::Press(top, {1, 1}, rHandle, c_Volume));
}

TEST(VolumeDrag, CornersStandOnTheFloor)
{
	EXPECT_EQ(VolumeHandlePlace(c_Volume, {EVolumeCorner, 0}, false), QVector3D(-1000, -2000, -100));
	EXPECT_EQ(VolumeHandlePlace(c_Volume, {EVolumeCorner, 3}, false), QVector3D(1000, 2000, -100));
	EXPECT_EQ(VolumeHandlePlace(c_Volume, {EVolumeCorner, 2}, true), QVector3D(-1000, -2000, 3000));
	EXPECT_EQ(VolumeHandlePlace(c_Volume, {EVolumeFace, 4}, false), QVector3D(0, 0, -100));
	EXPECT_EQ(VolumeHandlePlace(c_Volume, {EVolumeCentre, 0}, true), QVector3D(0, 0, 1450));
}

TEST(VolumeDrag, ArrowsFadeWhereTheyPointAtTheEye)
{
	for (const auto& [angle, opacity] :
	    {std::pair(0.0, 0.0f), {0.09, 0.0f}, {0.15, 0.25f}, {0.2, 0.5f}, {0.3, 1.0f}, {1.5, 1.0f}})
	{
		EXPECT_NEAR(VRenderVolumeManipulator::ArrowOpacity(static_cast<float>(std::cos(angle))), opacity, 1e-3f);
		EXPECT_NEAR(VRenderVolumeManipulator::ArrowOpacity(static_cast<float>(-std::cos(angle))), opacity, 1e-3f);
	}
	// Rounding may take a cosine beyond 1.
	EXPECT_EQ(VRenderVolumeManipulator::ArrowOpacity(1.0001f), 0.0f);
}

TEST_P(VolumeManipulator, DrawsItsBoxAndHandlesWhenShown)
{
	Update(*m_pManipulator);
	EXPECT_EQ(DrawnIn(*m_pManipulator), "");
	m_pManipulator->SetVisible(true);
	Update(*m_pManipulator);
	EXPECT_EQ(DrawnIn(*m_pManipulator), "overlay, overlay pick");
	// From above: X from 150 to 250 pixels, Y from 50 to 250; an arrow of 48 pixels out of each side, none at the eye.
	DrawFrame(*m_pManipulator);
	ExpectNear(Drawn(), QRect(QPoint(102, 2), QPoint(297, 297)), 4.0);
	EXPECT_EQ(Pixel(280, 149), c_Magenta);
	EXPECT_EQ(Pixel(120, 149), c_Magenta);
	EXPECT_EQ(Pixel(200, 279), c_Magenta);
	EXPECT_EQ(Pixel(200, 19), c_Magenta);
	EXPECT_EQ(Pixel(250, 249), c_Magenta);
	EXPECT_EQ(Pixel(200, 149), c_Magenta);
	EXPECT_EQ(Pixel(200, 129), c_Nothing);
	EXPECT_EQ(Pixel(300, 149), c_Nothing);

	DrawFrame(*m_pManipulator, CoreGraphics::ERenderPick);
	EXPECT_EQ(ItemAt(280, 149), m_pManipulator->HandleItem({EVolumeFace, 0}));
	EXPECT_EQ(ItemAt(200, 19), m_pManipulator->HandleItem({EVolumeFace, 3}));
	EXPECT_EQ(ItemAt(250, 249), m_pManipulator->HandleItem({EVolumeCorner, 0}));
	EXPECT_EQ(ItemAt(200, 149), m_pManipulator->HandleItem({EVolumeCentre, 0}));
	m_Options.m_bManipulator = false;
	EXPECT_EQ(DrawnIn(*m_pManipulator), "");
}

TEST_P(VolumeManipulator, APressDragsTheHandleThatIsPointedAt)
{
	std::vector<VVolume> changes;
	m_pManipulator->ChangedSignal().Connect(
	    [&](const QVector3D& i_rLow, const QVector3D& i_rHigh) {
		    changes.push_back({i_rLow, i_rHigh});
	    });
	const NVX::ISelectionItem handle = m_pManipulator->HandleItem({EVolumeFace, 0});
	m_pSelection->PreSelection().Replace({handle});
	EXPECT_FALSE(m_pManipulator->IsHovered());
	m_pManipulator->SetVisible(true);
	EXPECT_TRUE(m_pManipulator->IsHovered());
	DrawFrame(*m_pManipulator);
	EXPECT_EQ(Pixel(280, 149), c_Yellow);

	m_pManipulator->Press(m_Camera, {280, 150});
	EXPECT_TRUE(m_pManipulator->IsDragging());
	EXPECT_EQ(m_pSelection->Selection().Items(), std::vector<NVX::ISelectionItem>{handle});
	m_pManipulator->Drag(m_Camera, {290, 150}, {});
	ASSERT_EQ(changes.size(), 1u);
	EXPECT_NEAR(changes[0].m_Minimum.x(), -1200.0f, 0.1f);
	EXPECT_EQ(changes[0].m_Maximum, c_Volume.m_Maximum);
	EXPECT_EQ(m_pManipulator->Volume(), changes[0]);
	m_pManipulator->SetVolume(c_Volume);
	EXPECT_EQ(m_pManipulator->Volume(), changes[0]);
	DrawFrame(*m_pManipulator);
	EXPECT_EQ(Pixel(305, 149), c_Yellow) << "the handle stays under the hand";
	m_pManipulator->Release();
	EXPECT_TRUE(m_pSelection->Selection().Items().empty());
	m_pManipulator->SetVolume(c_Volume);
	EXPECT_EQ(m_pManipulator->Volume(), c_Volume);

	m_pManipulator->Press(m_Camera, {280, 150});
	m_pManipulator->Drag(m_Camera, {290, 150}, {});
	m_pManipulator->Cancel();
	EXPECT_FALSE(m_pManipulator->IsDragging());
	EXPECT_TRUE(m_pSelection->Selection().Items().empty());
	EXPECT_EQ(m_pManipulator->Volume(), c_Volume);
	EXPECT_EQ(changes.back(), c_Volume);

	// Another volume's handle is not this one's.
	NVX::ISelectionItem other = handle;
	other.m_Name = "Other";
	m_pSelection->PreSelection().Replace({other});
	EXPECT_FALSE(m_pManipulator->IsHovered());
}
