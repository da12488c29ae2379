#pragma once

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

/// Sends the log to standard error, one message a line, as "level category: text"; coloured on a terminal unless
/// NO_COLOR is set. Lasts as long as the result.
[[nodiscard]] std::shared_ptr<void> ShowMessages(const VMessageSettings& i_rSettings);

} // namespace CommandLine
