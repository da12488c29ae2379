#pragma once

#include "TesselPluginInterface/IHostRules.h"

#include <functional>
#include <memory>
#include <string>

namespace StudioHost
{

class VPreferences;

/// Among the numbers of the preferences: target subjects that are made take the pose of their FBX file. Without it they
/// do.
inline constexpr const char* c_pPoseFromFileKey = "PoseFromFBX";

/// This program as modules see it: the rules that its preferences set, and the question before work is lost.
class VApplicationObject : public TesselPluginInterface::IApplicationObject, public TesselPluginInterface::IHostRules
{
public:
	explicit VApplicationObject(std::shared_ptr<const VPreferences> i_pPreferences);

	TesselPluginInterface::VHostRules Rules() const override;
	bool MayReplaceTargetSubject(const std::string& i_rAction) override;
	bool MayOverwriteChangedFile(const std::string& i_rPath) override;

	/// Asks whoever sits at the window; until it is set the answer is yes.
	std::function<bool(const std::string& i_rAction)> m_AskToReplace;
	std::function<bool(const std::string& i_rPath)> m_AskToOverwrite;

private:
	const std::shared_ptr<const VPreferences> m_pPreferences;
};

} // namespace StudioHost
