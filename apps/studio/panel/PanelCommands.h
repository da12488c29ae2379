#pragma once

#include <QList>
#include <QString>

class QWidget;

namespace StudioHost
{

/// Runs a named command on the first panel that knows it. That none does is told in the log.
bool RunCommand(const QList<QWidget*>& i_rPanels, const QString& i_rCommand);

} // namespace StudioHost
