#pragma once

#include "TesselPluginInterface/IPanelManager.h"

#include <QList>
#include <QPointer>

class QDockWidget;
class QMainWindow;

namespace StudioHost
{

/// Docks panels in the middle of a window, as tabs in ascending order if there are several.
class VPanelManager : public NVX::VCounted<TesselPluginInterface::IPanelManager>
{
public:
	explicit VPanelManager(QMainWindow& i_rWindow);

	void AddPanel(const std::string& i_rTitle, std::int32_t i_Order, QWidget* i_pWidget) override;

	/// In ascending order; those of the same order as they came.
	QList<QDockWidget*> Docks() const;
	QList<QWidget*> Panels() const;

	/// Ends all panels and their docks.
	void Clear();

private:
	struct VPanel
	{
		std::int32_t m_Order;
		QPointer<QDockWidget> m_pDock;
	};

	const QPointer<QMainWindow> m_pWindow;
	QList<VPanel> m_Panels;
};

} // namespace StudioHost
