#pragma once

#include "CommandLineText/Messages.h"

#include <QSize>
#include <QString>
#include <QStringList>

#include <optional>
#include <string>
#include <vector>

namespace StudioHost
{

/// What the command line asks for.
struct VOptions
{
	/// Empty for the one that stands beside the program.
	QString m_Module;
	/// Empty for the user's own settings.
	QString m_Settings;
	/// To open at the start, in this order.
	QStringList m_Files;
	/// To play; empty for none.
	QString m_Take;
	/// Of the take, to be shown first.
	std::size_t m_Frame = 0;
	/// A dialog to open when the files are open; empty for none.
	std::string m_Dialog;
	/// Where the picture goes; empty for a window that stays.
	QString m_Screenshot;
	QSize m_Size;
	bool m_bDeveloper = false;
	CommandLine::VMessageSettings m_Messages;
};

/// Reads a command line, the program's own name left out. Throws CommandLine::VCommandError for one that is wrong.
/// @param o_rText what is to be printed instead of a run: the help, the version or the manual page.
/// @return nothing if there is something to print.
std::optional<VOptions> ParseOptions(std::vector<std::string> i_Arguments, std::string& o_rText);

} // namespace StudioHost
