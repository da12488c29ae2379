#include "RenderTypeFixture.h"

#include "OrlexGraphics/item/CameraGrid.h"
#include "OrlexGraphics/manipulator/RenderVolumeManipulator.h"
#include "OrlexGraphics/picking/SelectionKinds.h"
#include "OrlexGraphics/stage/RenderCameras.h"
#include "OrlexGraphics/stage/RenderForcePlates.h"
#include "OrlexGraphics/stage/RenderReconstructionVolume.h"
#include "OrlexGraphics/stage/RenderReconstructions.h"

using namespace OrlexGraphics;

namespace
{

/// From 50 to 350 and from 50 to 250 pixels.
const VVolume c_StageVolume{{-400, -1500, -1000}, {400, 1500, 1000}};
const QRect c_StageEdges(50, 50, 301, 201);

/// What a capture stage has beside its subjects, seen from +X, with Y to the right and Z up, 10 mm a pixel, the origin
/// in the middle.
class RenderCapture : public VRenderTypeTest
{
protected:
	RenderCapture() : VRenderTypeTest(QSize(400, 300))
	{
		m_Camera.m_Type = CoreGraphics::ECameraRight;
		m_Camera.m_OrthographicScale = 10.0f;
	}

	void SetUp() override
	{
		VRenderTypeTest::SetUp();
		m_pManipulator = std::make_unique<VRenderVolumeManipulator>(
		    m_Library, m_pRegistry, m_pSelection, "Volume", QVector3D(0.2f, 0.4f, 0.6f), VVolume());
	}

	/// An exchange, and then a frame update with the volume.
	void Update(const std::optional<VVolume>& i_rVolume)
	{
		m_pManipulator->Synchronise();
		BeginFrame();
		m_pManipulator->BringVolume(i_rVolume);
		m_pManipulator->AllocateIds();
	}

	std::unique_ptr<VRenderVolumeManipulator> m_pManipulator;
};
INSTANTIATE_IN_BOTH_DIALECTS(RenderCapture);

} // namespace

TEST_P(RenderCapture, VolumeHasEdgesAndInnerWalls)
{
	VRenderReconstructionVolume box(m_Library);
	EXPECT_EQ(DrawnIn(box), "") << "without a volume";
	box.SetVolume(c_StageVolume);
	EXPECT_TRUE(Draw(box, EPassOpaque));
	ExpectNear(Drawn(), c_StageEdges);
	EXPECT_EQ(Pixel(200, 150)[0], 40);
	EXPECT_TRUE(Draw(box, EPassTransparent));
	ExpectNear(Drawn(), c_StageEdges);
	// The far wall alone, lit from the eye and by the ambience, at an alpha of 0.08.
	EXPECT_NEAR(Pixel(200, 150)[0], 0.92 * 40 + 0.08 * 0.7 * (0.5 + 0.2) * 255, 1);
	EXPECT_EQ(DrawnIn(box), "opaque, transparent");
	m_Options.m_bReconstructionVolume = false;
	EXPECT_EQ(DrawnIn(box), "");
}

TEST_P(RenderCapture, HandlesOfAVolumeAreThereWhenAFrameBringsIt)
{
	EXPECT_FALSE(Draw(*m_pManipulator, EPassOverlay)) << "before";
	Update(c_StageVolume);
	EXPECT_TRUE(Draw(*m_pManipulator, EPassOverlay)) << "in the frame that brings it";
	Update(VVolume{{1, 0, 0}, {0, 1, 1}});
	EXPECT_FALSE(Draw(*m_pManipulator, EPassOverlay)) << "without an inside";
	Update(c_StageVolume);
	Update({});
	EXPECT_FALSE(Draw(*m_pManipulator, EPassOverlay)) << "when it is gone";
}

TEST_P(RenderCapture, AVolumeThatAFrameBringsWaitsForTheEndOfADrag)
{
	Update(c_StageVolume);
	EXPECT_FALSE(m_pManipulator->IsVisible()) << "before the exchange";
	Update(c_StageVolume);
	EXPECT_EQ(m_pManipulator->Volume(), c_StageVolume);
	m_Camera.Update();
	m_pSelection->PreSelection().Replace({m_pManipulator->HandleItem({EVolumeFace, 3})});
	m_pManipulator->Press(m_Camera, {380, 150});
	ASSERT_TRUE(m_pManipulator->IsDragging());
	m_pManipulator->Drag(m_Camera, {360, 150}, {});
	const VVolume dragged = m_pManipulator->Volume();
	EXPECT_NEAR(dragged.m_Maximum.y(), 1300.0f, 0.1f);

	const VVolume brought{{-400, -1500, -1000}, {400, 500, 1000}};
	Update(brought);
	Update(brought);
	EXPECT_EQ(m_pManipulator->Volume(), dragged);
	Draw(*m_pManipulator, EPassOverlay);
	EXPECT_EQ(std::max(Pixel(329, 200)[1], Pixel(330, 200)[1]), 102) << "the edge stays under the hand";
	m_pManipulator->Release();
	m_pManipulator->Synchronise();
	EXPECT_EQ(m_pManipulator->Volume(), brought);
	Update({});
	m_pManipulator->Synchronise();
	EXPECT_FALSE(m_pManipulator->IsVisible());
}

TEST_P(RenderCapture, ReconstructionsAreCrossesOfTheirScale)
{
	VRenderReconstructions points(m_Library);
	EXPECT_EQ(DrawnIn(points), "");
	points.SetPoints({{0, 500, 300}, {0, -1000, -200}});
	m_Camera.m_OrthographicScale = 1.0f;
	m_Camera.m_Centre = QVector3D(0, 500, 300);
	// In pixels.
	for (const auto& [scale, arm] : {std::pair(1.0f, 7), {10.0f, 70}, {3.0f, 21}})
	{
		m_Options.m_ReconstructionScale = scale;
		Draw(points, EPassOpaque);
		ExpectNear(Drawn(), QRect(200 - arm, 150 - arm, 2 * arm, 2 * arm));
	}
	EXPECT_EQ(std::max(Pixel(190, 150)[0], Pixel(190, 149)[0]), 230);
	EXPECT_EQ(DrawnIn(points), "opaque");
	for (const float scale : {0.0f, -1.0f})
	{
		m_Options.m_ReconstructionScale = scale;
		EXPECT_EQ(DrawnIn(points), "") << scale;
	}
	m_Options.m_ReconstructionScale = 1.0f;
	m_Options.m_bReconstructions = false;
	EXPECT_EQ(DrawnIn(points), "");
}

TEST_P(RenderCapture, ForcePlatesShowTheirForceAndArePicked)
{
	VForcePlate left;
	left.m_Name = "Left";
	left.m_Transform.translate(0, -500, 0);
	VForcePlate right;
	right.m_Name = "Right";
	right.m_Transform.translate(0, 500, 0);
	right.m_Force = QVector3D(0, 0, 1000);
	right.m_CentreOfPressure = QVector3D(0, 100, 0);
	VRenderForcePlates plates(m_Library, m_pRegistry);
	const auto update = [&]
	{
		BeginFrame();
		plates.AllocateIds();
	};
	update();
	EXPECT_EQ(DrawnIn(plates), "");
	plates.SetPlates(std::make_shared<std::vector<VForcePlate>>(std::vector{left, right}));
	update();

	// From above, with X to the left and Y down: 40 by 60 pixels each, a frame of white at the edge.
	m_Camera.m_Type = CoreGraphics::ECameraTop;
	Draw(plates, EPassOpaque);
	ExpectNear(Drawn(), QRect(180, 70, 41, 161));
	EXPECT_GT(Pixel(200, 170)[0], Pixel(200, 190)[0] + 20);
	EXPECT_EQ(Pixel(200, 150)[0], 40);
	Draw(plates, EPassOpaque, CoreGraphics::ERenderPick);
	const NVX::ISelectionItem rightItem{ESelectionForcePlate, 0, 1, "Right"};
	EXPECT_EQ(ItemAt(190, 200), (NVX::ISelectionItem{ESelectionForcePlate, 0, 0, "Left"}));
	EXPECT_EQ(ItemAt(190, 100), rightItem);
	EXPECT_EQ(m_pRegistry->GetName(m_pRegistry->Allocate(rightItem)), "Right");

	// From the right: the plates are lines, the arrow stands 100 mm beside the middle. Its tip is thinner than a pixel.
	m_Camera.m_Type = CoreGraphics::ECameraRight;
	EXPECT_EQ(DrawnIn(plates), "opaque, opaque pick") << "nothing is selected";
	Draw(plates, EPassOpaque);
	EXPECT_NEAR(Extent([](const VColour& i_rColour) { return i_rColour[0] > 60; }).bottom(), 247, 3);
	EXPECT_GT(Pixel(260, 200)[0], 2 * Pixel(260, 200)[1]);
	EXPECT_EQ(Pixel(150, 200)[0], 40) << "nobody stands on the left one";
	m_pSelection->Selection().Replace({rightItem});
	update();
	Draw(plates, EPassOpaque, CoreGraphics::ERenderId);
	EXPECT_EQ(ItemAt(260, 200), rightItem);
}

TEST_P(RenderCapture, ThereAreNoCameras)
{
	VRenderCameras cameras;
	EXPECT_TRUE(cameras.RenderOverlayCamera(m_Render, m_Options));
	EXPECT_EQ(DrawnIn(cameras), "");
}

TEST(CameraGrid, TellsQmlOfItsTiles)
{
	VCameraGrid grid;
	EXPECT_EQ(grid.property("count").toInt(), 0);
	const QHash<int, QByteArray> names = grid.roleNames();
	int role = Qt::UserRole + 1;
	for (const char* const pName : {"tileUserId", "tileDisplayType", "tileDeviceURN", "tileRect", "tileVideo",
	         "tileVideoInput", "tileVideoFile", "tileSelectionItem", "tileAdditionalData"})
		EXPECT_EQ(names.value(role++), pName);
	EXPECT_EQ(names.size(), 9);
	int changes = 0;
	QObject::connect(&grid, &VCameraGrid::AspectRatioChanged, [&] { ++changes; });
	for (const double ratio : {1.5, 1.5, 1.0})
		EXPECT_TRUE(grid.setProperty("aspectRatio", ratio));
	EXPECT_EQ(changes, 2);
	for (const char* const pSignal : {"CountChanged()", "ResetViews()"})
		EXPECT_GE(grid.metaObject()->indexOfSignal(pSignal), 0) << pSignal;
}
