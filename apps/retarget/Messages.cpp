#include "retarget/Messages.h"

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

} // namespace

int DefaultLevel(const VMessageSettings& i_rSettings)
{
	const int steps = i_rSettings.m_Verbose - i_rSettings.m_Quiet;
	if (steps < 0)
		return NVX::ELogError;
	return steps == 0 ? NVX::ELogWarning : steps == 1 ? NVX::ELogInformation : NVX::ELogDetail;
}

const char* LevelName(int i_Level)
{
	return LevelOf(i_Level).m_pName;
}

std::string OneLine(std::string i_Message)
{
	while (!i_Message.empty() && (i_Message.back() == '\n' || i_Message.back() == '\r'))
		i_Message.pop_back();
	for (char& rByte : i_Message)
		if (static_cast<unsigned char>(rByte) < 0x20 || rByte == 0x7F)
			rByte = ' ';
	return i_Message;
}

void PrintMessage(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
{
	static const bool s_bColour = []
	{
		const char* pNoColour = std::getenv("NO_COLOR");
		return isatty(STDERR_FILENO) && !(pNoColour && *pNoColour);
	}();
	const VLevel& rLevel = LevelOf(i_Level);
	std::fprintf(stderr, "%s%s%s %s: %s\n", s_bColour ? rLevel.m_pColour : "", rLevel.m_pName,
	    s_bColour ? "\033[0m" : "", i_rCategory.Name().c_str(), OneLine(i_rMessage).c_str());
}

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

	return NVX::GlobalLog::AddSink(PrintMessage);
}

} // namespace CommandLine
