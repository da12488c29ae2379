#pragma once

#include "DebugServices/GlobalLog.h"

#include <map>
#include <memory>
#include <string>

namespace CommandLine
{

/// Category of the program's own messages.
inline constexpr const char* c_pCategory = "retarget";

struct VMessageSettings
{
	/// How often -v and -q were given.
	int m_Verbose = 0;
	int m_Quiet = 0;
	/// Levels of single categories, by name.
	std::map<std::string, int> m_CategoryLevels;
};

/// Reads "CATEGORY=LEVEL" with a level of error, warning, information or detail. False if the text is anything else.
bool ParseCategoryLevel(const std::string& i_rText, VMessageSettings& io_rSettings);

/// The level of all categories without one of their own.
int DefaultLevel(const VMessageSettings& i_rSettings);

/// "error", "warning", "information" or "detail".
const char* LevelName(int i_Level);

/// The message in one line, without what could drive a terminal or pretend to be another message.
std::string OneLine(std::string i_Message);

/// Prints a message on standard error, one line, as "level category: text"; coloured on a terminal unless NO_COLOR is
/// set.
void PrintMessage(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage);

/// Sends the log to standard error. Lasts as long as the result.
[[nodiscard]] std::shared_ptr<void> ShowMessages(const VMessageSettings& i_rSettings);

} // namespace CommandLine
