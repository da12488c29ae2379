#include "CommandLineText/Messages.h"

#include "CommandLineText/ProgressBar.h"
#include "CommandLineText/Suggest.h"
#include "CommandLineText/System.h"
#include "math/VisibleText.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <mutex>
#include <string_view>
#include <unistd.h>
#include <utility>
#include <vector>

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

const VLevel* FindLevel(const std::string& i_rName)
{
	const auto it = std::find_if(
	    std::begin(c_Levels), std::end(c_Levels), [&](const VLevel& i_rLevel) { return i_rName == i_rLevel.m_pName; });
	return it == std::end(c_Levels) ? nullptr : it;
}

bool IsCategory(const std::string& i_rName)
{
	return std::find(std::begin(c_Categories), std::end(c_Categories), i_rName) != std::end(c_Categories);
}

struct VMessage
{
	const NVX::VLogCategory* m_pCategory;
	int m_Level;
	std::string m_Text;
};

/// What has come in since ShowMessages. The log's sinks are called on any thread.
struct VInbox
{
	std::mutex m_Mutex;
	VMessageSettings m_Settings;
	bool m_bHold = false;
	std::vector<VMessage> m_Held;
	/// Not shown; the reason of an error that may follow.
	std::vector<VMessage> m_Reasons;
	std::size_t m_Warnings = 0;
	std::size_t m_Errors = 0;
};

VInbox& Inbox()
{
	static VInbox s_Inbox;
	return s_Inbox;
}

/// So many messages wait at most: a hostile file must not fill the memory.
constexpr std::size_t c_MaximumHeld = 10000;
/// So many warnings tell the reason of an error.
constexpr std::size_t c_MaximumReasons = 10;

/// Of the file that messages are appended to; -1 for none.
std::atomic<int>& LogDescriptor()
{
	static std::atomic<int> s_Descriptor{-1};
	return s_Descriptor;
}

/// In one piece, so that the lines of several processes do not mix.
void Keep(const std::string& i_rLine)
{
	const int descriptor = LogDescriptor();
	if (descriptor < 0 || WriteAtOnce(descriptor, i_rLine))
		return;
	LogDescriptor() = -1;
	std::fprintf(stderr, "warning %s: The log file is not complete: %s\n", c_pCategory, std::strerror(errno));
}

void Show(const VMessageSettings& i_rSettings, const VMessage& i_rMessage, EExitStatus i_Status = EFine)
{
	if (!i_rSettings.m_bJson)
		return PrintMessage(*i_rMessage.m_pCategory, i_rMessage.m_Level, i_rMessage.m_Text);
	nlohmann::ordered_json json{{"level", LevelName(i_rMessage.m_Level)}, {"category", i_rMessage.m_pCategory->Name()},
	    {"text", OneLine(i_rMessage.m_Text)}};
	if (i_Status != EFine)
		json["status"] = int(i_Status);
	const std::string line = json.dump(-1, ' ', false, nlohmann::ordered_json::error_handler_t::replace) + "\n";
	ClearProgress();
	std::fputs(line.c_str(), stderr);
	Keep(line);
}

void Deliver(VInbox& io_rInbox, const VMessage& i_rMessage, EExitStatus i_Status = EFine)
{
	const VMessageSettings& rSettings = io_rInbox.m_Settings;
	io_rInbox.m_Errors += i_rMessage.m_Level <= NVX::ELogError;
	io_rInbox.m_Warnings += i_rMessage.m_Level == NVX::ELogWarning;
	const auto own = rSettings.m_CategoryLevels.find(i_rMessage.m_pCategory->Name());
	std::vector<VMessage>& rReasons = io_rInbox.m_Reasons;
	if (!rReasons.empty() && rReasons.back().m_pCategory != i_rMessage.m_pCategory)
		rReasons.clear();
	if (i_rMessage.m_Level <= (own == rSettings.m_CategoryLevels.end() ? DefaultLevel(rSettings) : own->second))
	{
		for (const VMessage& rReason : rReasons)
			Show(rSettings, rReason);
		rReasons.clear();
		Show(rSettings, i_rMessage, i_Status);
	}
	else if (own == rSettings.m_CategoryLevels.end() && i_rMessage.m_Level == NVX::ELogWarning)
	{
		if (rReasons.size() == c_MaximumReasons)
			rReasons.erase(rReasons.begin());
		rReasons.push_back(i_rMessage);
	}
}

void DeliverHeld(VInbox& io_rInbox)
{
	for (const VMessage& rMessage : io_rInbox.m_Held)
		Deliver(io_rInbox, rMessage);
	io_rInbox.m_Held.clear();
}

/// What a library calls an error though all goes on without it is a warning: an error ends the command.
int LevelHere(const std::string& i_rCategory, int i_Level, std::string_view i_Text)
{
	constexpr std::pair<const char*, std::string_view> c_Harmless[] = {{"Import", ""}, {"FilesystemWatcher", ""},
	    {"FBXIO", "Invalid transform for: "}, {"FBXIO", "Missing bone "},
	    {"VSkinCache", "Folders of skins are not watched"}};
	for (const auto& [pCategory, begin] : c_Harmless)
		if (i_rCategory == pCategory && i_Text.starts_with(begin))
			return std::max<int>(i_Level, NVX::ELogWarning);
	return i_Level;
}

void Receive(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rText)
{
	const int level = LevelHere(i_rCategory.Name(), i_Level, i_rText);
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	if (!rInbox.m_bHold)
		return Deliver(rInbox, {&i_rCategory, level, i_rText});
	rInbox.m_Held.push_back({&i_rCategory, level, i_rText});
	if (rInbox.m_Held.size() > c_MaximumHeld)
		DeliverHeld(rInbox);
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

bool HasColours(int i_Descriptor)
{
	const char* const pNoColour = std::getenv("NO_COLOR");
	const char* const pTerminal = std::getenv("TERM");
	return isatty(i_Descriptor) && !(pNoColour && *pNoColour) && pTerminal && std::string_view(pTerminal) != "dumb";
}

std::string OneLine(std::string i_Message)
{
	while (!i_Message.empty() && (i_Message.back() == '\n' || i_Message.back() == '\r'))
		i_Message.pop_back();
	return VisibleText::OnOneLine(i_Message);
}

void PrintMessage(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
{
	static const bool s_bColour = HasColours(STDERR_FILENO);
	const VLevel& rLevel = LevelOf(i_Level);
	const std::string text = " " + i_rCategory.Name() + ": " + OneLine(i_rMessage) + "\n";
	ClearProgress();
	std::fprintf(stderr, "%s%s%s%s", s_bColour ? rLevel.m_pColour : "", rLevel.m_pName, s_bColour ? "\033[0m" : "",
	    text.c_str());
	Keep(rLevel.m_pName + text);
}

void KeepMessages(const std::string& i_rFile)
{
	if (!i_rFile.ends_with(".log"))
		throw VCommandError(EWrongUsage, "--log-file: \"" + i_rFile + "\" does not end in .log");
	const int descriptor = OpenToAppend(i_rFile);
	if (descriptor < 0)
		throw VCommandError(EBadOutput, "\"" + i_rFile + "\" cannot be written: " + std::strerror(errno));
	if (const int before = LogDescriptor().exchange(descriptor); before >= 0)
		close(before);
}

std::string ParseCategoryLevel(const std::string& i_rText, VMessageSettings& io_rSettings)
{
	const std::size_t split = std::min(i_rText.find('='), i_rText.size());
	const std::string name = i_rText.substr(0, split);
	const VLevel* const pLevel = FindLevel(split == i_rText.size() ? "" : i_rText.substr(split + 1));
	if (name.empty() || !pLevel)
		return "\"" + i_rText + "\" is not CATEGORY=LEVEL with a level of error, warning, information or detail";
	if (IsCategory(name))
	{
		io_rSettings.m_CategoryLevels[name] = pLevel->m_Level;
		return "";
	}
	const std::vector<std::string> names(std::begin(c_Categories), std::end(c_Categories));
	std::string text = "there is no category \"" + name + "\"" + Meant(name, names) + "; the categories are";
	for (const std::string& rName : names)
		text += (&rName == &names.front() ? " " : ", ") + rName;
	return text;
}

bool LooksLikeCategoryLevel(const std::string& i_rText)
{
	const std::size_t split = i_rText.find('=');
	return split != std::string::npos && (IsCategory(i_rText.substr(0, split)) || FindLevel(i_rText.substr(split + 1)));
}

std::shared_ptr<void> ShowMessages(const VMessageSettings& i_rSettings)
{
	{
		VInbox& rInbox = Inbox();
		const std::lock_guard lock(rInbox.m_Mutex);
		rInbox.m_Settings = i_rSettings;
	}
	// Warnings come in whether they are shown or not: they count, and may be the reason of an error.
	const auto wanted = [](int i_Level) { return std::max<int>(i_Level, NVX::ELogWarning); };
	NVX::GlobalLog::SetDefaultLevel(wanted(DefaultLevel(i_rSettings)));
	for (const auto& [rName, level] : i_rSettings.m_CategoryLevels)
		NVX::GlobalLog::Category(rName).SetLevel(wanted(level));
	return NVX::GlobalLog::AddSink(Receive);
}

bool JsonAsked()
{
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	return rInbox.m_Settings.m_bJson;
}

bool StrictAsked()
{
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	return rInbox.m_Settings.m_bStrict;
}

void AskStrict()
{
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	rInbox.m_Settings.m_bStrict = true;
}

void HoldMessages()
{
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	rInbox.m_bHold = true;
}

void ReleaseMessages()
{
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	rInbox.m_bHold = false;
	DeliverHeld(rInbox);
}

void ForgetMessages(const std::function<bool(const std::string& i_rCategory, const std::string& i_rText)>& i_rMended)
{
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	std::erase_if(rInbox.m_Held,
	    [&](const VMessage& i_rMessage) { return i_rMended(i_rMessage.m_pCategory->Name(), i_rMessage.m_Text); });
}

void TellFailure(EExitStatus i_Status, const std::string& i_rText)
{
	const NVX::VLogCategory& rCategory = NVX::GlobalLog::Category(c_pCategory);
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	rInbox.m_bHold = false;
	if (i_Status == EWrongUsage)
		std::erase_if(rInbox.m_Held, [](const VMessage& i_rMessage) { return i_rMessage.m_Level > NVX::ELogError; });
	DeliverHeld(rInbox);
	Deliver(rInbox, {&rCategory, NVX::ELogError, i_rText}, i_Status);
}

void RequireNoErrors()
{
	ReleaseMessages();
	VInbox& rInbox = Inbox();
	std::size_t errors = 0;
	std::size_t warnings = 0;
	{
		const std::lock_guard lock(rInbox.m_Mutex);
		errors = std::exchange(rInbox.m_Errors, 0);
		warnings = std::exchange(rInbox.m_Warnings, 0);
		if (!rInbox.m_Settings.m_bStrict)
			warnings = 0;
	}
	if (errors > 0)
		throw VCommandError(EBadInput,
		    "Nothing is written after an error, and what is shown may be wrong: mend what the errors above tell of");
	if (warnings > 0)
		throw VCommandError(EFindings,
		    "--strict: " + std::to_string(warnings) + (warnings == 1 ? " warning counts" : " warnings count")
		        + " as errors");
}

void ForgiveErrors()
{
	ReleaseMessages();
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	rInbox.m_Warnings += std::exchange(rInbox.m_Errors, 0);
}

void ForgetCounts()
{
	ReleaseMessages();
	VInbox& rInbox = Inbox();
	const std::lock_guard lock(rInbox.m_Mutex);
	rInbox.m_Errors = 0;
	rInbox.m_Warnings = 0;
}

} // namespace CommandLine
