#pragma once

#include "Flow2Graphics/FlowRenderSubject.h"
#include "Flow2Graphics/IFlowRenderType.h"
#include "Flow2TypesUtils/SceneItems.h"
#include "Flow2TypesUtils/TaggedCoreTypeExtractor.h"

#include <atomic>
#include <memory>
#include <vector>

namespace Flow2Graphics
{

/// The subjects of one class in a scene. Render thread, but for SetRebind.
class VFlowRenderSubjectList
{
public:
	explicit VFlowRenderSubjectList(std::shared_ptr<const ISubjectSelectionMaker> i_pSelectionMaker);

	/// Makes the subjects anew when their items are others, and poses them.
	/// @param i_pSceneTransform null: subjects stand where their pose puts them
	void Update(const TesselPluginInterface::IFlowFrame& i_rFrame, VFlowContext& io_rContext,
	    const Flow2TypesUtils::FlowSubjectSceneTransformItem* i_pSceneTransform);

	/// Has no subject until a frame brings one, were it the one from before.
	void Forget();

	/// Skins are to be looked for again. Any thread.
	void SetRebind() { m_bRebind = true; }
	bool IsRebindSet() const { return m_bRebind; }

	const std::vector<std::unique_ptr<VFlowRenderSubject>>& Subjects() const { return m_Subjects; }
	/// Of the subjects, in order; others only when the subjects were made anew.
	const std::vector<std::shared_ptr<const VRenderSubjectData>>& Data() const { return m_Data; }
	const std::vector<std::shared_ptr<const VRenderSubjectMarkerData>>& Markers() const { return m_Markers; }

private:
	void Clear();
	void MakeSubjects(const TesselPluginInterface::IFlowFrame& i_rFrame);

	const std::shared_ptr<const ISubjectSelectionMaker> m_pSelectionMaker;
	const VSubjectTypes& m_rTypes;
	Flow2TypesUtils::VTaggedCoreTypeExtractor m_Items;
	std::atomic<bool> m_bRebind{false};
	std::vector<std::unique_ptr<VFlowRenderSubject>> m_Subjects;
	std::vector<std::shared_ptr<const VRenderSubjectData>> m_Data;
	std::vector<std::shared_ptr<const VRenderSubjectMarkerData>> m_Markers;
};

} // namespace Flow2Graphics
