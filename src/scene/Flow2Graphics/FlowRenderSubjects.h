#pragma once

#include "Flow2Graphics/FlowRenderSubjectList.h"
#include "Flow2Graphics/RenderSubjectDynamics.h"
#include "Flow2Graphics/RenderSubjectMarkers.h"
#include "Flow2TypesUtils/ItemCache.h"
#include "Flow2TypesUtils/SceneItems.h"

#include <array>
#include <memory>
#include <vector>

namespace Flow2Graphics
{

/// Markers and sticks of the scene's subjects. VFlowRenderSubjectDynamics, whose subjects have them, hands them over
/// with each frame.
class VFlowRenderSubjectMarkers : public IFlowRenderType
{
public:
	using VFlowSubject = VRenderSubjectMarkerData;

	explicit VFlowRenderSubjectMarkers(std::shared_ptr<VRenderSubjectMarkers> i_pPartner)
	    : m_pPartner(std::move(i_pPartner))
	{
	}

	void SetSubjects(ESubjectClass i_Class, const VRenderSubjectMarkers::VSubjects& i_rSubjects)
	{
		m_pPartner->SetSubjects(i_Class, i_rSubjects);
	}

private:
	const std::shared_ptr<VRenderSubjectMarkers> m_pPartner;
};

/// The subjects of all classes.
class VFlowRenderSubjectDynamics : public IFlowRenderType
{
public:
	/// @param i_pMarkers take the markers of props, rigid objects and subjects
	/// @param i_pMarkersForSolving take those of subjects for solving
	VFlowRenderSubjectDynamics(std::shared_ptr<VRenderSubjectDynamics> i_pPartner,
	    std::shared_ptr<VFlowRenderSubjectMarkers> i_pMarkers,
	    std::shared_ptr<VFlowRenderSubjectMarkers> i_pMarkersForSolving);

	void Update(const TesselPluginInterface::IFlowFrame& i_rFrame, VFlowContext& io_rContext) override;

	/// As VFlowRenderSubjectList::Forget, of all classes.
	void Forget();

	/// All subjects look for their skins again. Any thread.
	void SetRebind();

	/// The names of the subjects of the last frame, by class.
	std::vector<OrlexGraphics::VSubjectLabel> Labels(bool i_bProps, bool i_bYUp) const;
	const VFlowRenderSubjectList& List(ESubjectClass i_Class) const { return *m_Lists[i_Class]; }

private:
	const std::shared_ptr<VRenderSubjectDynamics> m_pPartner;
	const std::shared_ptr<VFlowRenderSubjectMarkers> m_pMarkers;
	const std::shared_ptr<VFlowRenderSubjectMarkers> m_pMarkersForSolving;
	std::array<std::unique_ptr<VFlowRenderSubjectList>, ESubjectClassCount> m_Lists;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowSubjectSceneTransformItem> m_SceneTransform;
};

} // namespace Flow2Graphics
