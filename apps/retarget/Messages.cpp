#include "retarget/Messages.h"

#include "DebugServices/GlobalLog.h"

#include <cstdio>
#include <cstdlib>
#include <unistd.h>

namespace CommandLine
{
namespace
{

struct VLevel
{
	int m_Level;
	const char* m_pName;
	const char* m_pColour;
};

constexpr VLevel c_Levels[] = {{NVX::ELogError, "error", "\033[1;31m"}, {NVX::ELogWarning, "warning", "\033[1;33m"},
    {NVX::ELogInformation, "information", "\033[1;34m"}, {NVX::ELogDetail, "detail", "\033[2m"}};

const VLevel& LevelOf(int i_Level)
{
	for (const VLevel& rLevel : c_Levels)
		if (i_Level <= rLevel.m_Level)
			return rLevel;
	return c_Levels[3];
}

int DefaultLevel(const VMessageSettings& i_rSettings)
{
	const int steps = i_rSettings.m_Verbose - i_rSettings.m_Quiet;
	if (steps < 0)
		return NVX::ELogError;
	return steps == 0 ? NVX::ELogWarning : steps == 1 ? NVX::ELogInformation : NVX::ELogDetail;
}

} // namespace

bool ParseCategoryLevel(const std::string& i_rText, VMessageSettings& io_rSettings)
{
	const std::size_t split = i_rText.find('=');
	if (split == std::string::npos || split == 0)
		return false;
	for (const VLevel& rLevel : c_Levels)
	{
		if (i_rText.substr(split + 1) == rLevel.m_pName)
		{
			io_rSettings.m_CategoryLevels[i_rText.substr(0, split)] = rLevel.m_Level;
			return true;
		}
	}
	return false;
}

std::shared_ptr<void> ShowMessages(const VMessageSettings& i_rSettings)
{
	NVX::GlobalLog::SetDefaultLevel(DefaultLevel(i_rSettings));
	for (const auto& [rName, level] : i_rSettings.m_CategoryLevels)
		NVX::GlobalLog::Category(rName).SetLevel(level);

	const char* pNoColour = std::getenv("NO_COLOR");
	const bool bColour = isatty(STDERR_FILENO) && !(pNoColour && *pNoColour);
	return NVX::GlobalLog::AddSink(
	    [bColour](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
	    {
		    const VLevel& rLevel = LevelOf(i_Level);
		    std::string text = i_rMessage;
		    while (!text.empty() && (text.back() == '\n' || text.back() == '\r'))
			    text.pop_back();
		    // What comes out of a file must not drive the terminal, nor pretend to be another message.
		    for (char& rByte : text)
			    if (static_cast<unsigned char>(rByte) < 0x20 || rByte == 0x7F)
				    rByte = ' ';
		    std::fprintf(stderr, "%s%s%s %s: %s\n", bColour ? rLevel.m_pColour : "", rLevel.m_pName,
		        bColour ? "\033[0m" : "", i_rCategory.Name().c_str(), text.c_str());
	    });
}

} // namespace CommandLine
