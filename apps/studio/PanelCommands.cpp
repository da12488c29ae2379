#include "studio/PanelCommands.h"

#include "DebugServices/GlobalLog.h"
#include "TesselPluginInterface/ITesselExecuteCommand.h"

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
	NVX_LOG(
	    "Command", NVX::ELogWarning, "Nothing happened: no panel knows the command \"%1%\"", i_rCommand.toStdString());
	return false;
}

} // namespace StudioHost
