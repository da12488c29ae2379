#pragma once

#include "Flow2Graphics/FlowSubjectSceneArrangement.h"
#include "NVX/IFlowStateTransform.h"
#include "TesselPluginInterface/IItemFactory.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace Flow2Utils
{
class VParameterSet;
}

namespace Flow2Graphics
{

/// The stage of the flow before a scene: poses subjects as one of their pose statistics has it, and places them side by
/// side. One thread at a time; touches no OpenGL.
class VFlowSubjectSceneTransform : public NVX::IFlowStateTransform
{
public:
	explicit VFlowSubjectSceneTransform(NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory);

	/// 0: subjects stay in one world, where they are. Any other: as VFlowSubjectSceneArrangement lays them out.
	void SetMode(std::uint32_t i_Mode);

	/// Read at each frame: numbers "PoseIndex", "LabellingPoseIndex" and "SolvingPoseIndex", of which the last that is
	/// not 0 counts: 1 Mean, 2 RangeCentringState, 3 TemplateMean, 4 TemplateRangeCentringState, 5 TPoseMean, 6
	/// BindPose. 0, and any number that is no pose, leaves the poses that came with the frame.
	void SetParameters(std::shared_ptr<const Flow2Utils::VParameterSet> i_pParameters);

	void Transform(NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& o_rpOut,
	    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpIn, std::uint64_t i_Time) override;

	const VFlowSubjectSceneArrangement& Arrangement() const { return *m_pArrangement; }

private:
	std::uint32_t PoseIndex() const;
	void MakeItems(std::uint32_t i_PoseIndex);

	const NVX::CountedPointer<TesselPluginInterface::IItemFactory> m_pItemFactory;
	std::shared_ptr<const Flow2Utils::VParameterSet> m_pParameters;
	const std::shared_ptr<VFlowSubjectSceneArrangement> m_pArrangement;
	std::uint32_t m_Mode = 1;
	bool m_bModeChanged = false;
	/// What the last change gave, which holds for the frames after it, too.
	std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> m_Poses;
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> m_pSceneTransform;
};

} // namespace Flow2Graphics
