#include "studio/panel/PanelCommands.h"

#include "DebugServices/GlobalLog.h"
#include "TesselPluginInterface/ITesselExecuteCommand.h"

#include <QRegularExpression>
#include <QWidget>

namespace StudioHost
{

bool RunCommand(const QList<QWidget*>& i_rPanels, const QString& i_rCommand)
{
	for (QWidget* pPanel : i_rPanels)
	{
		auto* const pCommands = static_cast<ITesselExecuteCommand*>(pPanel->qt_metacast("ITesselExecuteCommand"));
		if (pCommands && pCommands->ExecuteCommand(i_rCommand.toStdString()))
			return true;
	}
	// "Workspace3d:FrameSelected" as words.
	QString name = i_rCommand.section(':', -1);
	name.replace(QRegularExpression(QStringLiteral("(?<=[a-z])(?=[A-Z])")), QStringLiteral(" "));
	NVX_LOG("Command", NVX::ELogWarning, "%1%: No panel is open that can do this.", name.toStdString());
	return false;
}

} // namespace StudioHost
