#pragma once

#include <QString>

namespace StudioHost
{

/// Gives a widget the name that tests and style sheets find it by, and the one that is read out. Returns the widget.
template <typename TWidget>
TWidget* Named(TWidget* io_pWidget, const char* i_pObjectName, const QString& i_rAccessibleName)
{
	io_pWidget->setObjectName(QLatin1String(i_pObjectName));
	io_pWidget->setAccessibleName(i_rAccessibleName);
	return io_pWidget;
}

} // namespace StudioHost
