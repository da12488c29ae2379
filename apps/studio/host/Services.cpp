#include "studio/host/Services.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselDataStore/DataStore.h"
#include "TesselParametersGUI/ParameterGroupModel.h"
#include "studio/host/JobRunner.h"

namespace StudioHost
{

VPluginContext::VPluginContext(QSettings& i_rSettings, std::shared_ptr<VQtDispatcher> i_pDispatcher)
    : m_pDispatcher(std::move(i_pDispatcher)), m_pStore(std::make_shared<TesselDataStore::VDataStore>()),
      m_StoreFile(i_rSettings, m_pStore, m_pDispatcher),
      m_pPreferences(std::make_shared<VPreferences>(m_pStore, m_pDispatcher)),
      m_pApplication(std::make_shared<VApplicationObject>(m_pPreferences)),
      m_pRegistry(std::make_shared<InMemoryHost::VParameterRegistry>()),
      m_pSelection(std::make_shared<InMemoryHost::VSelectionManager>()), m_pItemFactory(new InMemoryHost::VItemFactory),
      m_pFrameFactory(new InMemoryHost::VFrameFactory)
{
}

namespace
{

std::shared_ptr<CoreGraphics::VShaderLibrary> MakeShaderLibrary(bool i_bDeveloper)
{
	CoreGraphics::VShaderLibrary::VSettings settings;
	settings.m_bDevelopment = i_bDeveloper;
	if (i_bDeveloper)
		settings.m_SourceFolders = {RETARGET_SHADER_SOURCES};
	return std::make_shared<CoreGraphics::VShaderLibrary>(std::move(settings));
}

VQmlServices QmlServices(VPluginContext& i_rContext, VCommandRunner i_RunCommand)
{
	const auto makeModel = [pRegistry = i_rContext.GetParameterRegistry(), pDispatcher = i_rContext.GetDispatcher()](
	                           const QString& i_rPath, const QString& i_rGroup)
	{ return std::make_unique<TesselParametersGUI::VParameterGroupModel>(pRegistry, pDispatcher, i_rPath, i_rGroup); };
	return {i_rContext.GetSelectionManager(), makeModel, std::move(i_RunCommand)};
}

} // namespace

VPluginGui::VPluginGui(
    QMainWindow& i_rWindow, VPluginContext& i_rContext, bool i_bDeveloper, VCommandRunner i_RunCommand)
    : m_pShaderLibrary(MakeShaderLibrary(i_bDeveloper)),
      m_pSkinCache(
          NVX::MakeShared<OrlexGraphics::VSkinCache>(i_rContext.GetDispatcher(), std::make_shared<VJobRunner>())),
      m_pQuickEngine(std::make_shared<VQuickEngine>(i_bDeveloper, QmlServices(i_rContext, std::move(i_RunCommand)))),
      m_pPanelManager(new VPanelManager(i_rWindow))
{
	m_pSkinCache->SetMeshRules(FBXIO::c_FaithfulMeshes);
}

VPluginGui::~VPluginGui()
{
	m_pPanelManager->Clear();
	m_pSkinCache->Dispose();
}

} // namespace StudioHost
