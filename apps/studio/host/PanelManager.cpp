#include "studio/host/PanelManager.h"

#include "DebugServices/GlobalLog.h"
#include "NVX/IQuickWidget.h"
#include "studio/window/Named.h"

#include <QDockWidget>
#include <QMainWindow>

#include <algorithm>

namespace StudioHost
{

VPanelManager::VPanelManager(QMainWindow& i_rWindow) : m_pWindow(&i_rWindow) {}

void VPanelManager::AddPanel(const std::string& i_rTitle, std::int32_t i_Order, QWidget* i_pWidget)
{
	if (!i_pWidget || !m_pWindow)
	{
		NVX_LOG("Tessel", NVX::ELogError, "The panel \"%1%\" could not be docked", i_rTitle);
		delete i_pWidget;
		return;
	}
	const QString title = QString::fromStdString(i_rTitle);
	auto* const pDock = new QDockWidget(title, m_pWindow);
	Named(pDock, QString("Panel " + title).toUtf8(), title);
	pDock->setAllowedAreas(Qt::AllDockWidgetAreas);
	pDock->setWidget(i_pWidget);
	// What the window has to spare goes to the panels; the upper and lower areas would share it evenly.
	pDock->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
	if (auto* const pQuick = qobject_cast<NVX::IQuickWidget*>(i_pWidget))
	{
		QObject::connect(pDock, &QDockWidget::visibilityChanged, i_pWidget,
		    [pQuick](bool i_bVisible) { i_bVisible ? pQuick->OnPanelShown() : pQuick->OnPanelHidden(); });
	}
	const auto behind = std::find_if(
	    m_Panels.begin(), m_Panels.end(), [i_Order](const VPanel& i_rPanel) { return i_rPanel.m_Order > i_Order; });
	m_Panels.insert(behind, {i_Order, pDock});

	m_pWindow->addDockWidget(Qt::LeftDockWidgetArea, pDock);
	const QList<QDockWidget*> docks = Docks();
	for (int i = 1; i < docks.size(); ++i)
		m_pWindow->tabifyDockWidget(docks[i - 1], docks[i]);
	// A dock that comes to a window on the screen is not shown by itself.
	pDock->show();
	docks.front()->raise();
}

QList<QDockWidget*> VPanelManager::Docks() const
{
	QList<QDockWidget*> docks;
	for (const VPanel& rPanel : m_Panels)
		if (rPanel.m_pDock)
			docks << rPanel.m_pDock;
	return docks;
}

QList<QWidget*> VPanelManager::Panels() const
{
	QList<QWidget*> panels;
	for (const QDockWidget* pDock : Docks())
		if (pDock->widget())
			panels << pDock->widget();
	return panels;
}

void VPanelManager::Clear()
{
	const QList<QDockWidget*> docks = Docks();
	m_Panels.clear();
	// Last come, first gone.
	for (auto dock = docks.rbegin(); dock != docks.rend(); ++dock)
		delete *dock;
}

} // namespace StudioHost
