#include "Flow2Graphics/FlowRenderSubjects.h"

namespace Flow2Graphics
{

namespace
{

template <typename T>
std::unique_ptr<VFlowRenderSubjectList> MakeList()
{
	return std::make_unique<VFlowRenderSubjectList>(std::make_shared<const VSubjectSelectionMaker<T>>());
}

constexpr bool IsProp(ESubjectClass i_Class)
{
	return i_Class == ESubjectClassProp || i_Class == ESubjectClassRigidObject;
}

} // namespace

VFlowRenderSubjectDynamics::VFlowRenderSubjectDynamics(std::shared_ptr<VRenderSubjectDynamics> i_pPartner,
    std::shared_ptr<VFlowRenderSubjectMarkers> i_pMarkers,
    std::shared_ptr<VFlowRenderSubjectMarkers> i_pMarkersForSolving)
    : m_pPartner(std::move(i_pPartner)), m_pMarkers(std::move(i_pMarkers)),
      m_pMarkersForSolving(std::move(i_pMarkersForSolving)), m_Lists{MakeList<VFlowPropTypes>(),
                                                                 MakeList<VFlowSubjectTypes>(),
                                                                 MakeList<VFlowRigidObjectTypes>(),
                                                                 MakeList<VFlowSubjectForSolvingTypes>(),
                                                                 MakeList<VFlowSubjectForRetargetingTypes>()},
      m_SceneTransform(Flow2TypesUtils::FlowSubjectSceneTransformItem::c_pName)
{
}

void VFlowRenderSubjectDynamics::Update(const TesselPluginInterface::IFlowFrame& i_rFrame, VFlowContext& io_rContext)
{
	m_SceneTransform.Update(i_rFrame);
	for (const VSubjectTypes& rTypes : c_SubjectTypes)
	{
		VFlowRenderSubjectList& rList = *m_Lists[rTypes.m_Class];
		rList.Update(i_rFrame, io_rContext, m_SceneTransform.Value().get());
		m_pPartner->SetSubjects(rTypes.m_Class, rList.Data());
		(rTypes.m_Class == ESubjectClassSolving ? m_pMarkersForSolving : m_pMarkers)
		    ->SetSubjects(rTypes.m_Class, rList.Markers());
	}
}

void VFlowRenderSubjectDynamics::Forget()
{
	for (const std::unique_ptr<VFlowRenderSubjectList>& rpList : m_Lists)
		rpList->Forget();
}

void VFlowRenderSubjectDynamics::SetRebind()
{
	for (const std::unique_ptr<VFlowRenderSubjectList>& rpList : m_Lists)
		rpList->SetRebind();
}

std::vector<OrlexGraphics::VSubjectLabel> VFlowRenderSubjectDynamics::Labels(bool i_bProps, bool i_bYUp) const
{
	std::vector<OrlexGraphics::VSubjectLabel> labels;
	for (const VSubjectTypes& rTypes : c_SubjectTypes)
		if (IsProp(rTypes.m_Class) == i_bProps)
			for (const std::unique_ptr<VFlowRenderSubject>& rpSubject : m_Lists[rTypes.m_Class]->Subjects())
				if (auto label = rpSubject->Label(i_bYUp))
					labels.push_back(std::move(*label));
	return labels;
}

} // namespace Flow2Graphics
