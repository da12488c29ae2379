#pragma once

#include "TesselPluginInterface/IHostRules.h"
#include "TesselPluginInterface/IPreviewFrames.h"

#include <functional>
#include <memory>
#include <string>

namespace StudioHost
{

class VPreferences;

/// Among the numbers of the preferences: target subjects that are made take the pose of their FBX file. Without it they
/// do.
inline constexpr const char* c_pPoseFromFileKey = "PoseFromFBX";

/// This program as modules see it: the rules that its preferences set, the question before work is lost, and what the
/// preview shows instead of bind poses.
class VApplicationObject : public TesselPluginInterface::IApplicationObject,
                           public TesselPluginInterface::IHostRules,
                           public TesselPluginInterface::IPreviewFrames
{
public:
	explicit VApplicationObject(std::shared_ptr<const VPreferences> i_pPreferences);

	TesselPluginInterface::VHostRules Rules() const override;
	bool MayReplaceTargetSubject(const std::string& i_rAction) override;
	bool MayOverwriteChangedFile(const std::string& i_rPath) override;
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> Shown(
	    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpDocument) override;
	NVX::VSignal<>& ShownChangedSignal() override { return m_ShownChangedSignal; }

	/// Asks whoever sits at the window; until it is set the answer is yes.
	std::function<bool(const std::string& i_rAction)> m_AskToReplace;
	std::function<bool(const std::string& i_rPath)> m_AskToOverwrite;
	/// As Shown; until it is set bind poses are shown.
	std::function<NVX::CountedPointer<TesselPluginInterface::IFlowFrame>(
	    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>&)>
	    m_Show;

private:
	const std::shared_ptr<const VPreferences> m_pPreferences;
	NVX::VSignal<> m_ShownChangedSignal;
};

} // namespace StudioHost
