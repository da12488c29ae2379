#include "DrawFixture.h"

#include "OrlexGraphics/CameraGrid.h"
#include "OrlexGraphics/RenderCameras.h"
#include "OrlexGraphics/RenderForcePlates.h"
#include "OrlexGraphics/RenderReconstructions.h"
#include "OrlexGraphics/SelectionKinds.h"
#include "OrlexGraphics/SelectionRegistry.h"

using namespace OrlexGraphics;

namespace
{

/// What a capture stage has beside its subjects.
class RenderCapture : public VDrawTest
{
protected:
	const std::shared_ptr<VSelectionRegistry> m_pRegistry = std::make_shared<VSelectionRegistry>();
};
INSTANTIATE_IN_BOTH_DIALECTS(RenderCapture);

} // namespace

TEST_P(RenderCapture, ReconstructionsAreCrossesOfTheirScale)
{
	struct VRow
	{
		float m_Scale;
		/// Pixels.
		int m_Arm;
	};
	VRenderReconstructions points(m_Library);
	Draw(points, EPassOpaque);
	EXPECT_TRUE(Extent().isEmpty());
	points.SetPoints({{0, 500, 300}, {0, -1000, -200}});
	m_Camera.m_OrthographicScale = 1.0f;
	m_Camera.m_Centre = QVector3D(0, 500, 300);
	for (const VRow& rRow : {VRow{1.0f, 7}, {10.0f, 70}, {3.0f, 21}})
	{
		m_Options.m_ReconstructionScale = rRow.m_Scale;
		Draw(points, EPassOpaque);
		ExpectNear(Extent(), QRect(200 - rRow.m_Arm, 150 - rRow.m_Arm, 2 * rRow.m_Arm, 2 * rRow.m_Arm));
	}
	EXPECT_EQ(std::max(Pixel(190, 150)[0], Pixel(190, 149)[0]), 230);

	const auto draws = [&](std::uint32_t i_Pass)
	{
		Draw(points, i_Pass);
		return !Extent().isEmpty();
	};
	EXPECT_FALSE(draws(EPassTransparent));
	EXPECT_FALSE(draws(EPassOverlay));
	for (const float scale : {0.0f, -1.0f})
	{
		m_Options.m_ReconstructionScale = scale;
		EXPECT_FALSE(draws(EPassOpaque)) << scale;
	}
	m_Options.m_ReconstructionScale = 1.0f;
	m_Options.m_bReconstructions = false;
	EXPECT_FALSE(draws(EPassOpaque));
	m_Options.m_bReconstructions = true;
	m_Render.m_Mode = CoreGraphics::ERenderPick;
	EXPECT_FALSE(draws(EPassOpaque));
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
		m_pRegistry->Reset();
		m_pRegistry->ClearExcluded();
		plates.AllocateIds();
	};
	update();
	Draw(plates, EPassOpaque);
	EXPECT_TRUE(Extent().isEmpty());
	plates.SetPlates(std::make_shared<std::vector<VForcePlate>>(std::vector{left, right}));
	update();

	// From above, with X to the left and Y down: 40 by 60 pixels each, a frame of white at the edge.
	m_Camera.m_Type = CoreGraphics::ECameraTop;
	Draw(plates, EPassOpaque);
	ExpectNear(Extent(), QRect(180, 70, 41, 161));
	EXPECT_GT(Pixel(200, 170)[0], Pixel(200, 190)[0] + 20);
	EXPECT_EQ(Pixel(200, 150)[0], c_Background);
	m_Render.m_Mode = CoreGraphics::ERenderPick;
	Draw(plates, EPassOpaque);
	for (const auto& [y, index, pName] : {std::tuple(200, 0u, "Left"), {100, 1u, "Right"}})
	{
		NVX::ISelectionItem item;
		ASSERT_TRUE(m_pRegistry->ResolveId(Id(190, y), item));
		EXPECT_EQ(item, (NVX::ISelectionItem{ESelectionForcePlate, 0, index, pName}));
		EXPECT_EQ(m_pRegistry->GetName(Id(190, y)), pName);
	}

	// From the right: the plates are lines, the arrow stands 100 mm beside the middle.
	m_Camera.m_Type = CoreGraphics::ECameraRight;
	m_Render.m_Mode = CoreGraphics::ERenderNormal;
	Draw(plates, EPassOpaque);
	// The tip is thinner than a pixel.
	EXPECT_NEAR(Extent().bottom(), 247, 3);
	EXPECT_GT(Pixel(260, 200)[0], 2 * Pixel(260, 200)[1]);
	EXPECT_EQ(Pixel(150, 200)[0], c_Background) << "nobody stands on the left one";
	m_Render.m_Mode = CoreGraphics::ERenderId;
	Draw(plates, EPassOpaque);
	EXPECT_TRUE(Extent().isEmpty()) << "nothing is selected";
	m_pRegistry->SetSelection({{ESelectionForcePlate, 0, 1, "Right"}}, {});
	update();
	Draw(plates, EPassOpaque);
	EXPECT_NE(Id(260, 200), 0u);
}

TEST_P(RenderCapture, ThereAreNoCameras)
{
	VRenderCameras cameras;
	EXPECT_TRUE(cameras.RenderOverlayCamera(m_Render, m_Options));
	for (const std::uint32_t pass : {EPassOpaque, EPassTransparent, EPassOverlay})
	{
		Draw(cameras, pass);
		EXPECT_TRUE(Extent().isEmpty());
	}
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
