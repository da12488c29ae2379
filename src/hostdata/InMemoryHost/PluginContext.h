#pragma once

#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Flow.h"
#include "InMemoryHost/PreferenceFolders.h"
#include "InMemoryHost/Selection.h"
#include "TesselPluginInterface/IPluginContext.h"
#include "TesselPluginInterface/IPluginGui.h"

namespace InMemoryHost
{

/// A host without a window and without a store: what it does not have it hands out as null.
class VPluginContext : public TesselPluginInterface::IPluginContext
{
public:
	VPluginContext();

	std::shared_ptr<TesselPluginInterface::IApplicationObject> GetApplicationObject() override
	{
		return m_pApplication;
	}
	std::shared_ptr<TesselPluginInterface::IPreferenceFolders> GetPreferenceFolders() override { return m_pFolders; }
	std::shared_ptr<TesselPluginInterface::IDataStore> GetDataStore() override { return {}; }
	std::shared_ptr<TesselPluginInterface::IParameterRegistry> GetParameterRegistry() override { return {}; }
	std::shared_ptr<TesselPluginInterface::IDispatcher> GetDispatcher() override { return m_pDispatcher; }
	NVX::CountedPointer<TesselPluginInterface::IItemFactory> GetItemFactory() override { return m_pItemFactory; }
	NVX::CountedPointer<TesselPluginInterface::IFrameFactory> GetFrameFactory() override { return m_pFrameFactory; }
	std::shared_ptr<TesselPluginInterface::ISelectionManager> GetSelectionManager() override
	{
		return m_pSelectionManager;
	}
	bool GetSceneFlag() override { return false; }

	/// What is handed out from now on; null at first.
	void SetApplicationObject(std::shared_ptr<TesselPluginInterface::IApplicationObject> i_pApplication)
	{
		m_pApplication = std::move(i_pApplication);
	}

	/// The same objects, as what they are.
	VDispatcher& Dispatcher() { return *m_pDispatcher; }
	VItemFactory& ItemFactory() { return *m_pItemFactory; }
	VPreferenceFolders& Folders() { return *m_pFolders; }
	VSelectionManager& SelectionManager() { return *m_pSelectionManager; }

private:
	std::shared_ptr<TesselPluginInterface::IApplicationObject> m_pApplication;
	const std::shared_ptr<VDispatcher> m_pDispatcher;
	const std::shared_ptr<VPreferenceFolders> m_pFolders;
	const std::shared_ptr<VSelectionManager> m_pSelectionManager;
	const NVX::CountedPointer<VItemFactory> m_pItemFactory;
	const NVX::CountedPointer<VFrameFactory> m_pFrameFactory;
};

/// Takes panels and keeps them in order; it shows none and owns none.
class VPanelManager : public NVX::VCounted<TesselPluginInterface::IPanelManager>
{
public:
	struct VPanel
	{
		std::string m_Title;
		std::int32_t m_Order = 0;
		QWidget* m_pWidget = nullptr;
	};

	void AddPanel(const std::string& i_rTitle, std::int32_t i_Order, QWidget* i_pWidget) override;
	const std::vector<VPanel>& Panels() const { return m_Panels; }

private:
	std::vector<VPanel> m_Panels;
};

class VPluginGui : public TesselPluginInterface::IPluginGui
{
public:
	VPluginGui();

	std::shared_ptr<TesselPluginInterface::IQuickEngine> GetQuickEngine() override { return {}; }
	NVX::CountedPointer<TesselPluginInterface::IPanelManager> GetPanelManager() override { return m_pPanelManager; }
	std::shared_ptr<CoreGraphics::VShaderLibrary> GetGraphicsContext() override { return {}; }
	std::shared_ptr<OrlexGraphics::VSkinCache> GetSkinCache() override { return {}; }

	VPanelManager& PanelManager() { return *m_pPanelManager; }

private:
	const NVX::CountedPointer<VPanelManager> m_pPanelManager;
};

} // namespace InMemoryHost
