#include "TesselPluginRetargetSetup/TesselPluginRetargetSetup.h"

#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/item/TesselInteractionMapper.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/RetargetSetupSelection.h"
#include "TesselPluginInterface/IPluginContext.h"
#include "TesselPluginInterface/IPluginGui.h"
#include "TesselPluginRetargetSetup/RetargetSetupScene.h"
#include "TesselPluginRetargetSetup/RetargetSetupWidget.h"

#include <QtQml>

namespace
{

/// The mouse in the preview as the host's preferences want it, between CreateContent and ReleaseContent.
std::shared_ptr<CoreGraphics::VInteractionMapper> g_pInteractionMapper;

} // namespace

bool VTesselPluginRetargetSetup::RegisterQmlTypes()
{
	qmlRegisterType<OrlexGraphics::VSceneFramebufferObject>(
	    "TesselPluginRetargetSetup", 1, 0, "SceneFramebufferObject");
	return true;
}

bool VTesselPluginRetargetSetup::CreateContent(
    TesselPluginInterface::IPluginContext& i_rContext, TesselPluginInterface::IPluginGui& i_rGui)
{
	g_pInteractionMapper = NVX::MakeShared<OrlexGraphics::VTesselInteractionMapper>(
	    i_rContext.GetPreferenceFolders(), i_rContext.GetDispatcher());
	CoreGraphics::VInteractionMapper::SetActive(g_pInteractionMapper);
	const auto pRetargetSetup = std::make_shared<VRetargetSetup>(
	    i_rContext.GetDispatcher(), i_rContext.GetFrameFactory(), i_rContext.GetItemFactory());
	pRetargetSetup->SetHostRules(TesselPluginInterface::HostRulesOf(i_rContext.GetApplicationObject()));
	if (pRetargetSetup->HostRules().m_bKeepsHistory)
		pRetargetSetup->KeepHistory(i_rContext.GetSelectionManager());
	const auto pSelection =
	    NVX::MakeShared<VRetargetSetupSelection>(i_rContext.GetDispatcher(), i_rContext.GetSelectionManager());
	const bool bSceneFlag = i_rContext.GetSceneFlag();
	const auto pScene = NVX::MakeShared<VRetargetSetupScene>(i_rGui.GetGraphicsContext(), i_rContext.GetDispatcher(),
	    i_rContext.GetSelectionManager(), i_rGui.GetSkinCache(), pRetargetSetup, i_rContext.GetItemFactory(),
	    bSceneFlag);
	pScene->SetPreviewFrames(TesselPluginInterface::PreviewFramesOf(i_rContext.GetApplicationObject()));
	auto pWidget = std::make_unique<VRetargetSetupWidget>(i_rGui.GetQuickEngine(), i_rContext.GetDataStore(),
	    i_rContext.GetParameterRegistry(), i_rContext.GetPreferenceFolders(), i_rContext.GetApplicationObject(),
	    i_rContext.GetDispatcher(), i_rGui.GetSkinCache(), pRetargetSetup, pSelection, pScene);
	i_rGui.GetPanelManager()->AddPanel("Retarget Setup", 5500, pWidget.get());
	// The host owns it from here on.
	static_cast<void>(pWidget.release());
	return true;
}

bool VTesselPluginRetargetSetup::ReleaseContent()
{
	CoreGraphics::VInteractionMapper::SetActive(nullptr);
	g_pInteractionMapper.reset();
	return true;
}
