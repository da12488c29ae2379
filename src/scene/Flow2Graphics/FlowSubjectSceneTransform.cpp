#include "Flow2Graphics/FlowSubjectSceneTransform.h"

#include "CoreOrlexTypes/SubjectState.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "Flow2TypesUtils/ItemCatalogue.h"
#include "Flow2TypesUtils/ParameterSet.h"

using TesselPluginInterface::IFlowFrame;
using TesselPluginInterface::IFlowItem;

namespace Flow2Graphics
{

namespace
{

using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

/// Null for the frame's own poses.
std::vector<double> VJoint::*PoseStatistic(std::uint32_t i_PoseIndex)
{
	constexpr std::vector<double> VJoint::*c_Statistics[] = {nullptr, &VJoint::m_Mean, &VJoint::m_RangeCentringState,
	    &VJoint::m_TemplateMean, &VJoint::m_TemplateRangeCentringState, &VJoint::m_TPoseMean, &VJoint::m_BindPose};
	return i_PoseIndex < std::size(c_Statistics) ? c_Statistics[i_PoseIndex] : nullptr;
}

} // namespace

VFlowSubjectSceneTransform::VFlowSubjectSceneTransform(
    NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory)
    : m_pItemFactory(std::move(i_pItemFactory)), m_pArrangement(std::make_shared<VFlowSubjectSceneArrangement>())
{
}

void VFlowSubjectSceneTransform::SetMode(std::uint32_t i_Mode)
{
	m_bModeChanged |= i_Mode != m_Mode;
	m_Mode = i_Mode;
}

void VFlowSubjectSceneTransform::SetParameters(std::shared_ptr<const Flow2Utils::VParameterSet> i_pParameters)
{
	m_pParameters = std::move(i_pParameters);
}

std::uint32_t VFlowSubjectSceneTransform::PoseIndex() const
{
	std::uint32_t index = 0;
	if (m_pParameters)
		for (const char* const pName : {"PoseIndex", "LabellingPoseIndex", "SolvingPoseIndex"})
			if (const auto value = m_pParameters->Value<std::uint32_t>(pName, 0); value != 0)
				index = value;
	return index;
}

void VFlowSubjectSceneTransform::MakeItems(std::uint32_t i_PoseIndex)
{
	m_Poses.clear();
	const auto pStatistic = PoseStatistic(i_PoseIndex);
	if (pStatistic)
		for (const auto& [group, rSubjects] : m_pArrangement->Groups())
		{
			const VSubjectTypes& rTypes = c_SubjectTypes[group];
			const auto pParametrised = m_pArrangement->Parametrised(rTypes);
			if (!pParametrised)
				continue;
			const auto pItem = m_pItemFactory->CreateItem(Flow2TypesUtils::FindItemType(rTypes.m_Pose)->m_Name);
			if (TesselPluginInterface::SetItemValue(pItem,
			        std::make_shared<const CoreOrlexTypes::VSubjectDynamicParameters>(
			            CoreOrlexTypes::VSubjectDynamicParameters{
			                pParametrised->m_SubjectId, CoreOrlexTypesUtils::PoseVector(*pParametrised, pStatistic)})))
				m_Poses.push_back(pItem);
		}

	m_pSceneTransform = nullptr;
	if (m_Mode == 0)
		return;
	using Flow2TypesUtils::FlowSubjectSceneTransformItem;
	const auto pItem = m_pItemFactory->CreateItem(FlowSubjectSceneTransformItem::c_pName);
	if (TesselPluginInterface::SetItemValue(
	        pItem, std::make_shared<const FlowSubjectSceneTransformItem>(m_pArrangement->SceneTransform())))
		m_pSceneTransform = pItem;
}

void VFlowSubjectSceneTransform::Transform(
    NVX::CountedPointer<IFlowFrame>& o_rpOut, const NVX::CountedPointer<IFlowFrame>& i_rpIn, std::uint64_t /*i_Time*/)
{
	o_rpOut = i_rpIn ? i_rpIn->Copy() : nullptr;
	if (!o_rpOut)
		return;
	const std::uint32_t poseIndex = PoseIndex();
	if (m_pArrangement->Update(*i_rpIn, poseIndex) || m_bModeChanged)
		MakeItems(poseIndex);
	m_bModeChanged = false;
	for (const NVX::CountedPointer<IFlowItem>& rpItem : m_Poses)
		o_rpOut->AddItem(rpItem);
	o_rpOut->AddItem(m_pSceneTransform);
}

} // namespace Flow2Graphics
