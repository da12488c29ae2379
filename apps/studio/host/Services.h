#pragma once

#include "InMemoryHost/Flow.h"
#include "InMemoryHost/ParameterRegistry.h"
#include "InMemoryHost/Selection.h"
#include "TesselPluginInterface/IPluginContext.h"
#include "TesselPluginInterface/IPluginGui.h"
#include "studio/host/ApplicationObject.h"
#include "studio/host/PanelManager.h"
#include "studio/host/Preferences.h"
#include "studio/host/QtDispatcher.h"
#include "studio/host/QuickEngine.h"
#include "studio/host/StoreFile.h"

namespace StudioHost
{

/// What modules are given of this program, but for its window.
class VPluginContext : public TesselPluginInterface::IPluginContext
{
public:
	/// @param i_rSettings where the store is kept; must outlive this.
	VPluginContext(QSettings& i_rSettings, std::shared_ptr<VQtDispatcher> i_pDispatcher);

	std::shared_ptr<TesselPluginInterface::IApplicationObject> GetApplicationObject() override
	{
		return m_pApplication;
	}
	std::shared_ptr<TesselPluginInterface::IPreferenceFolders> GetPreferenceFolders() override
	{
		return m_pPreferences;
	}
	std::shared_ptr<TesselPluginInterface::IDataStore> GetDataStore() override { return m_pStore; }
	std::shared_ptr<TesselPluginInterface::IParameterRegistry> GetParameterRegistry() override { return m_pRegistry; }
	std::shared_ptr<TesselPluginInterface::IDispatcher> GetDispatcher() override { return m_pDispatcher; }
	NVX::CountedPointer<TesselPluginInterface::IItemFactory> GetItemFactory() override { return m_pItemFactory; }
	NVX::CountedPointer<TesselPluginInterface::IFrameFactory> GetFrameFactory() override { return m_pFrameFactory; }
	std::shared_ptr<TesselPluginInterface::ISelectionManager> GetSelectionManager() override { return m_pSelection; }
	bool GetSceneFlag() override { return false; }

	VPreferences& Preferences() { return *m_pPreferences; }
	VApplicationObject& Application() { return *m_pApplication; }

private:
	const std::shared_ptr<VQtDispatcher> m_pDispatcher;
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pStore;
	const VStoreFile m_StoreFile;
	const std::shared_ptr<VPreferences> m_pPreferences;
	const std::shared_ptr<VApplicationObject> m_pApplication;
	const std::shared_ptr<TesselPluginInterface::IParameterRegistry> m_pRegistry;
	const std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pSelection;
	const NVX::CountedPointer<TesselPluginInterface::IItemFactory> m_pItemFactory;
	const NVX::CountedPointer<TesselPluginInterface::IFrameFactory> m_pFrameFactory;
};

/// What modules are given of this program's window.
class VPluginGui : public TesselPluginInterface::IPluginGui
{
public:
	/// @param i_rWindow docks the panels; must outlive this.
	VPluginGui(QMainWindow& i_rWindow, VPluginContext& i_rContext, bool i_bDeveloper, VCommandRunner i_RunCommand);
	/// Ends the panels.
	~VPluginGui() override;

	std::shared_ptr<TesselPluginInterface::IQuickEngine> GetQuickEngine() override { return m_pQuickEngine; }
	NVX::CountedPointer<TesselPluginInterface::IPanelManager> GetPanelManager() override { return m_pPanelManager; }
	std::shared_ptr<CoreGraphics::VShaderLibrary> GetGraphicsContext() override { return m_pShaderLibrary; }
	std::shared_ptr<OrlexGraphics::VSkinCache> GetSkinCache() override { return m_pSkinCache; }

	VPanelManager& PanelManager() { return *m_pPanelManager; }
	VQuickEngine& QuickEngine() { return *m_pQuickEngine; }

private:
	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaderLibrary;
	const std::shared_ptr<OrlexGraphics::VSkinCache> m_pSkinCache;
	const std::shared_ptr<VQuickEngine> m_pQuickEngine;
	const NVX::CountedPointer<VPanelManager> m_pPanelManager;
};

} // namespace StudioHost
