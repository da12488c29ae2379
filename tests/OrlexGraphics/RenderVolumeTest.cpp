#include "DrawFixture.h"

#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/RenderReconstructionVolume.h"
#include "OrlexGraphics/RenderVolumeManipulator.h"
#include "OrlexGraphics/SelectionRegistry.h"

using namespace OrlexGraphics;

namespace
{

/// From 50 to 350 and from 50 to 250 pixels.
const VVolume c_Volume{{-400, -1500, -1000}, {400, 1500, 1000}};
const QRect c_Edges(50, 50, 301, 201);

class RenderVolume : public VDrawTest
{
protected:
	void SetUp() override
	{
		VDrawTest::SetUp();
		m_pBox = std::make_unique<VRenderReconstructionVolume>(m_Library);
		m_pManipulator = std::make_unique<VRenderVolumeManipulator>(
		    m_Library, m_pRegistry, m_pSelection, "Volume", QVector3D(0.2f, 0.4f, 0.6f), VVolume());
	}

	/// A frame update with the volume, and the exchange before it.
	void Update(const std::optional<VVolume>& i_rVolume)
	{
		m_pRegistry->SetSelection(m_pSelection->Selection().Items(), m_pSelection->PreSelection().Items());
		m_pManipulator->Synchronise();
		m_pRegistry->Reset();
		m_pRegistry->ClearExcluded();
		m_pManipulator->BringVolume(i_rVolume);
		m_pManipulator->AllocateIds();
	}

	bool IsDrawn(IRenderType& io_rType, std::uint32_t i_Pass)
	{
		Draw(io_rType, i_Pass);
		return !Extent().isEmpty();
	}

	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	const std::shared_ptr<VSelectionRegistry> m_pRegistry = std::make_shared<VSelectionRegistry>();
	std::unique_ptr<VRenderReconstructionVolume> m_pBox;
	std::unique_ptr<VRenderVolumeManipulator> m_pManipulator;
};
INSTANTIATE_IN_BOTH_DIALECTS(RenderVolume);

} // namespace

TEST_P(RenderVolume, BoxHasEdgesAndInnerWalls)
{
	EXPECT_FALSE(IsDrawn(*m_pBox, EPassOpaque)) << "without a volume";
	m_pBox->SetVolume(c_Volume);
	Draw(*m_pBox, EPassOpaque);
	ExpectNear(Extent(), c_Edges);
	EXPECT_EQ(Pixel(200, 150)[0], c_Background);
	Draw(*m_pBox, EPassTransparent);
	ExpectNear(Extent(), c_Edges);
	// The far wall alone, lit from the eye and by the ambience, at an alpha of 0.08.
	EXPECT_NEAR(Pixel(200, 150)[0], 0.92 * c_Background + 0.08 * 0.7 * (0.5 + 0.2) * 255, 1);
	EXPECT_FALSE(IsDrawn(*m_pBox, EPassOverlay));

	for (const std::uint32_t mode : {CoreGraphics::ERenderPick, CoreGraphics::ERenderId})
	{
		m_Render.m_Mode = mode;
		EXPECT_FALSE(IsDrawn(*m_pBox, EPassOpaque));
		EXPECT_FALSE(IsDrawn(*m_pBox, EPassTransparent));
	}
	m_Render.m_Mode = CoreGraphics::ERenderNormal;
	m_Options.m_bReconstructionVolume = false;
	EXPECT_FALSE(IsDrawn(*m_pBox, EPassOpaque));
	EXPECT_FALSE(IsDrawn(*m_pBox, EPassTransparent));
}

TEST_P(RenderVolume, HandlesAreThereWhenAFrameBringsTheVolume)
{
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassOverlay)) << "before a frame brings a volume";
	Update(c_Volume);
	EXPECT_TRUE(IsDrawn(*m_pManipulator, EPassOverlay)) << "in the frame that brings it";
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassOpaque));
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassTransparent));
	m_Render.m_Mode = CoreGraphics::ERenderId;
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassOverlay));
	m_Render.m_Mode = CoreGraphics::ERenderNormal;
	m_Options.m_bManipulator = false;
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassOverlay));
	m_Options.m_bManipulator = true;
	m_Options.m_OverlayCamera = "camera";
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassOverlay));
	m_Options.m_OverlayCamera.clear();
	Update(VVolume{{1, 0, 0}, {0, 1, 1}});
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassOverlay)) << "without an inside";
	Update(c_Volume);
	Update({});
	EXPECT_FALSE(IsDrawn(*m_pManipulator, EPassOverlay)) << "when it is gone";
}

TEST_P(RenderVolume, WhatAFrameBringsWaitsForTheEndOfADrag)
{
	Update(c_Volume);
	EXPECT_FALSE(m_pManipulator->IsVisible()) << "before the exchange";
	Update(c_Volume);
	EXPECT_EQ(m_pManipulator->Volume(), c_Volume);
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
