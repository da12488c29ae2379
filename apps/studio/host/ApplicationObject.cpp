#include "studio/host/ApplicationObject.h"

#include "studio/host/Preferences.h"

namespace StudioHost
{

VApplicationObject::VApplicationObject(std::shared_ptr<const VPreferences> i_pPreferences)
    : m_pPreferences(std::move(i_pPreferences))
{
}

TesselPluginInterface::VHostRules VApplicationObject::Rules() const
{
	TesselPluginInterface::VHostRules rules;
	rules.m_bOwnFormsAreDetails = true;
	rules.m_bEachPairOnce = true;
	rules.m_bPartnersBySides = true;
	rules.m_bPoseFromFile = m_pPreferences->Number(c_pPoseFromFileKey, 1) != 0;
	rules.m_bMirrorChange = true;
	rules.m_bWheelInFixedViews = true;
	rules.m_bKeepsHistory = true;
	rules.m_bSkinBesideFile = true;
	return rules;
}

bool VApplicationObject::MayReplaceTargetSubject(const std::string& i_rAction)
{
	return !m_AskToReplace || m_AskToReplace(i_rAction);
}

bool VApplicationObject::MayOverwriteChangedFile(const std::string& i_rPath)
{
	return !m_AskToOverwrite || m_AskToOverwrite(i_rPath);
}

NVX::CountedPointer<TesselPluginInterface::IFlowFrame> VApplicationObject::Shown(
    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpDocument)
{
	return m_Show ? m_Show(i_rpDocument) : nullptr;
}

} // namespace StudioHost
