#include "InMemoryHost/PluginContext.h"

#include <algorithm>

namespace InMemoryHost
{

VPluginContext::VPluginContext()
    : m_pDispatcher(std::make_shared<VDispatcher>()), m_pFolders(std::make_shared<VPreferenceFolders>()),
      m_pSelectionManager(std::make_shared<VSelectionManager>()), m_pItemFactory(new VItemFactory),
      m_pFrameFactory(new VFrameFactory)
{
}

void VPanelManager::AddPanel(const std::string& i_rTitle, std::int32_t i_Order, QWidget* i_pWidget)
{
	const auto behind = std::find_if(
	    m_Panels.begin(), m_Panels.end(), [i_Order](const VPanel& i_rPanel) { return i_rPanel.m_Order > i_Order; });
	m_Panels.insert(behind, {i_rTitle, i_Order, i_pWidget});
}

VPluginGui::VPluginGui() : m_pPanelManager(new VPanelManager) {}

} // namespace InMemoryHost
