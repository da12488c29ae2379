#include "CoreGraphics/ShaderLibrary.h"
#include "Flow2Graphics/FlowRenderFloorGrid.h"
#include "Flow2Graphics/FlowRenderReconstructionVolume.h"
#include "Flow2TypesUtils/ParameterSet.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/frame/SceneOptions.h"
#include "OrlexGraphics/manipulator/RenderVolumeManipulator.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/stage/RenderFloorGrid.h"
#include "OrlexGraphics/stage/RenderReconstructionVolume.h"
#include "TestSubject.h"

#include <gtest/gtest.h>

#include <limits>

using namespace Flow2Graphics;
using namespace Flow2TypesUtils;
using OrlexGraphics::VFloor;
using OrlexGraphics::VVolume;
using TestSubject::Item;
using TestSubject::MakeFrame;

namespace
{

NVX::CountedPointer<TesselPluginInterface::IFlowItem> Floor(const std::array<std::int32_t, 4>& i_rExtents)
{
	return Item(FlowFloorItem::c_pName, FlowFloorItem{i_rExtents});
}

NVX::CountedPointer<TesselPluginInterface::IFlowItem> Arrangement(const std::array<std::int32_t, 4>& i_rExtents)
{
	return Item(FlowSubjectSceneTransformItem::c_pName, FlowSubjectSceneTransformItem{{}, i_rExtents});
}

template <typename T>
void Add(Flow2Utils::VParameterSet& io_rSet, const std::string& i_rName, T i_Value)
{
	auto pParameter = std::make_unique<Flow2Utils::VParameterTyped<T>>(i_rName);
	pParameter->Set(i_Value);
	io_rSet.Add(std::move(pParameter));
}

/// Of the six numbers of a volume, all but the first as floats.
template <typename T>
std::shared_ptr<Flow2Utils::VParameterSet> Volume(const std::string& i_rName, T i_First, float i_Last = 60.0f)
{
	auto pSet = std::make_shared<Flow2Utils::VParameterSet>();
	Add(*pSet, "Min" + i_rName + "X", i_First);
	Add(*pSet, "Min" + i_rName + "Y", 20.0f);
	Add(*pSet, "Min" + i_rName + "Z", 30.0f);
	Add(*pSet, "Max" + i_rName + "X", 40.0f);
	Add(*pSet, "Max" + i_rName + "Y", 50.0f);
	Add(*pSet, "Max" + i_rName + "Z", i_Last);
	return pSet;
}

class StageTypes : public testing::Test
{
protected:
	std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> Manipulator(const char* i_pName)
	{
		return std::make_shared<OrlexGraphics::VRenderVolumeManipulator>(
		    m_Library, m_pRegistry, nullptr, i_pName, QVector3D(), VVolume());
	}

	/// Without OpenGL there are no programs, and nothing is drawn here.
	CoreGraphics::VShaderLibrary m_Library;
	const std::shared_ptr<OrlexGraphics::VSelectionRegistry> m_pRegistry =
	    std::make_shared<OrlexGraphics::VSelectionRegistry>();
	const std::shared_ptr<OrlexGraphics::VRenderFloorGrid> m_pFloor =
	    std::make_shared<OrlexGraphics::VRenderFloorGrid>(m_Library);
	const std::shared_ptr<OrlexGraphics::VRenderReconstructionVolume> m_pVolume =
	    std::make_shared<OrlexGraphics::VRenderReconstructionVolume>(m_Library);
	const std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> m_pManipulator = Manipulator("ReconstructionVolume");
	const std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> m_pHotspot = Manipulator("HotspotVolume");
	VFlowRenderReconstructionVolume m_Volumes{m_pVolume, m_pManipulator, m_pHotspot};
};

} // namespace

TEST_F(StageTypes, FloorIsTheMeasuredOneOrLiesBelowTheSubjects)
{
	VFlowRenderFloorGrid type(m_pFloor);
	const VFloor byOptions{-3000, -3000, 3000, 3000};
	const auto floor = [&](const std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>>& i_rItems)
	{
		type.UpdateStatic(*MakeFrame(i_rItems));
		return m_pFloor->GetFloor(OrlexGraphics::VSceneOptions());
	};
	EXPECT_EQ(floor({}), byOptions);
	// Extents are least and greatest X, then least and greatest row.
	EXPECT_EQ(floor({Arrangement({-1000, 3000, -500, 700})}), (VFloor{-1000, -500, 3000, 700}));
	const VFloor measured{-4000, -2000, 5000, 2500};
	EXPECT_EQ(floor({Floor({-4000, 5000, -2000, 2500}), Arrangement({-1000, 1000, -1000, 1000})}), measured);
	EXPECT_EQ(floor({Arrangement({-9000, 9000, -9000, 9000})}), measured) << "as long as nobody measures it again";
	EXPECT_EQ(floor({}), measured);
	EXPECT_EQ(floor({Floor({0, 0, 0, 0})}), (VFloor{-9000, -9000, 9000, 9000})) << "without an area";
	EXPECT_EQ(floor({Arrangement({10, -10, 0, 5})}), byOptions);

	// The same item does not undo what came after it.
	const auto pItem = Floor({-1, 1, -2, 2});
	EXPECT_EQ(floor({pItem}), (VFloor{-1, -2, 1, 2}));
	m_pFloor->SetFloor({});
	EXPECT_EQ(floor({pItem}), byOptions);
}

TEST_F(StageTypes, VolumesComeFromTheParametersOfTheirGroup)
{
	const std::optional<VVolume> expected = VVolume{{10, 20, 30}, {40, 50, 60}};
	const char* const pGroup = "Processing:Reconstruction";
	auto pIncomplete = std::make_shared<Flow2Utils::VParameterSet>();
	Add(*pIncomplete, "MinReconX", 10.0f);
	struct VRow
	{
		const char* m_pName;
		const char* m_pTag;
		std::shared_ptr<Flow2Utils::VParameterSet> m_pSet;
		bool m_bVolume;
		bool m_bHotspot;
	};
	const VRow rows[] = {{"floats", pGroup, Volume("Recon", 10.0f), true, false},
	    {"nothing", pGroup, nullptr, false, false}, {"a double", pGroup, Volume("Recon", 10.0), true, false},
	    {"one of six", pGroup, pIncomplete, false, false}, {"an integer", pGroup, Volume("Recon", 10), true, false},
	    {"another group", "Processing:Labelling", Volume("Recon", 11.0f), true, false},
	    {"a text", pGroup, Volume("Recon", std::string("10")), false, false},
	    {"the hotspot", pGroup, Volume("Hotspot", 10.0f), false, true},
	    {"no inside", pGroup, Volume("Recon", 10.0f, 30.0f), false, false},
	    {"no number", pGroup, Volume("Recon", std::numeric_limits<double>::quiet_NaN()), false, false}};
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		m_Volumes.UpdateStatic(
		    *MakeFrame({Item(FlowParametersItem::c_pName, FlowParametersItem{rRow.m_pSet, rRow.m_pTag, {}})}));
		m_pManipulator->Synchronise();
		m_pHotspot->Synchronise();
		EXPECT_EQ(m_pVolume->Volume(), rRow.m_bVolume ? expected : std::nullopt);
		EXPECT_EQ(m_pManipulator->IsVisible(), rRow.m_bVolume);
		EXPECT_EQ(m_pHotspot->IsVisible(), rRow.m_bHotspot);
		EXPECT_TRUE(!rRow.m_bVolume || m_pManipulator->Volume() == expected);
		EXPECT_TRUE(!rRow.m_bHotspot || m_pHotspot->Volume() == expected);
	}
}

TEST_F(StageTypes, ParametersOfOneRevisionAreTakenOnce)
{
	FlowParametersItem item{Volume("Recon", 10.0f), "Processing:Reconstruction", {}};
	const auto update = [&](const FlowParametersItem& i_rItem)
	{ m_Volumes.UpdateStatic(*MakeFrame({Item(FlowParametersItem::c_pName, i_rItem)})); };
	update(item);
	m_pVolume->SetVolume({});
	update(item);
	EXPECT_FALSE(m_pVolume->Volume()) << "an item made anew";
	++item.m_Revision;
	update(item);
	EXPECT_TRUE(m_pVolume->Volume());
}
