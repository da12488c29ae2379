#include "Flow2Graphics/FlowRenderSubjectList.h"

#include "Flow2TypesUtils/ItemCatalogue.h"
#include "OrlexGraphics/skins/SkinCache.h"

using TesselPluginInterface::IFlowFrame;

namespace Flow2Graphics
{

namespace
{

/// What this very frame holds; null without it.
template <typename T>
std::shared_ptr<const T> FromFrame(const IFlowFrame& i_rFrame, std::uint32_t i_Tag)
{
	const Flow2TypesUtils::VItemDescriptor* const pType = Flow2TypesUtils::FindItemType(i_Tag);
	return pType ? TesselPluginInterface::ItemValue<T>(i_rFrame.Item(pType->m_Name)) : nullptr;
}

} // namespace

VFlowRenderSubjectList::VFlowRenderSubjectList(std::shared_ptr<const ISubjectSelectionMaker> i_pSelectionMaker)
    : m_pSelectionMaker(std::move(i_pSelectionMaker)), m_rTypes(m_pSelectionMaker->Types())
{
	for (const std::uint32_t tag :
	    {m_rTypes.m_Subject, m_rTypes.m_ApplicationData, m_rTypes.m_Parametrised, m_rTypes.m_Settings})
		m_Items.Insert(tag);
}

void VFlowRenderSubjectList::Clear()
{
	m_Subjects.clear();
	m_Data.clear();
	m_Markers.clear();
}

void VFlowRenderSubjectList::Forget()
{
	m_Items.Reset();
	Clear();
}

void VFlowRenderSubjectList::MakeSubjects(const IFlowFrame& i_rFrame)
{
	Clear();
	// The cache keeps a subject that the frame does not have any more.
	if (!i_rFrame.Item(m_Items.Cache(m_rTypes.m_Subject)->FlowType()))
		return;
	auto pSubject = m_Items.Get<CoreOrlexTypes::VSubject>(m_rTypes.m_Subject);
	if (!pSubject || !IsOfClass(m_Items, m_rTypes, pSubject->m_SubjectId))
		return;
	m_Subjects.push_back(std::make_unique<VFlowRenderSubject>(std::move(pSubject),
	    m_Items.Get<CoreOrlexTypes::VSubjectApplicationData>(m_rTypes.m_ApplicationData), m_pSelectionMaker));
	m_Data.push_back(m_Subjects.back()->Data());
	m_Markers.push_back(m_Subjects.back()->Markers());
}

void VFlowRenderSubjectList::Update(const IFlowFrame& i_rFrame, VFlowContext& io_rContext,
    const Flow2TypesUtils::FlowSubjectSceneTransformItem* i_pSceneTransform)
{
	if (m_Items.Update(i_rFrame))
	{
		MakeSubjects(i_rFrame);
		m_bRebind = true;
	}
	if (io_rContext.m_pSkinCache && m_bRebind.exchange(false))
		for (const std::unique_ptr<VFlowRenderSubject>& rpSubject : m_Subjects)
			if (!rpSubject->BindSkins(*io_rContext.m_pSkinCache))
				m_bRebind = true;
	const auto pPose = FromFrame<CoreOrlexTypes::VSubjectDynamicParameters>(i_rFrame, m_rTypes.m_Pose);
	const auto pLabels = FromFrame<CoreOrlexTypes::VReconstructionLabelSet>(i_rFrame, m_rTypes.m_Labels);
	for (const std::unique_ptr<VFlowRenderSubject>& rpSubject : m_Subjects)
	{
		QMatrix4x4 transform;
		if (i_pSceneTransform)
			if (const auto found =
			        i_pSceneTransform->m_Translations.find({m_rTypes.m_Subject, rpSubject->Subject().m_SubjectId});
			    found != i_pSceneTransform->m_Translations.end())
				transform.translate(static_cast<float>(found->second[0]), static_cast<float>(found->second[1]),
				    static_cast<float>(found->second[2]));
		rpSubject->Update({pPose.get(), pLabels.get()}, io_rContext.m_rRegistry, transform);
	}
}

} // namespace Flow2Graphics
