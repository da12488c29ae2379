#pragma once

#include "CommandLineText/ExitStatus.h"

#include "DebugServices/GlobalLog.h"

#include <functional>
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
	/// Results and messages are JSON.
	bool m_bJson = false;
	/// Warnings are errors.
	bool m_bStrict = false;
	/// Where messages are kept besides; empty for nowhere.
	std::string m_LogFile;
};

/// All that messages of this system may have, so that a slip of the hand is told.
inline constexpr const char* c_Categories[] = {"Command", "CoreGraphics", "FBXIO", "FilesystemWatcher", "Import",
    "Motion", "MotionIO", "QRTIO", "Qt", "QuickWidget", "RetargetSetup", "RigidBodyUtils", "Store",
    "SubjectCalibrationAlgo", "SubjectCheck", "SubjectParametrisedUtils", "SubjectUtils", "System", "TakeIO", "Tessel",
    "VParameter", "VSkinCache", "retarget", "retarget-studio"};

/// Reads "CATEGORY=LEVEL" with a level of error, warning, information or detail. @return empty, or what is wrong
/// with the text.
std::string ParseCategoryLevel(const std::string& i_rText, VMessageSettings& io_rSettings);

/// Whether a text is most likely meant as CATEGORY=LEVEL: it has one of the two.
bool LooksLikeCategoryLevel(const std::string& i_rText);

/// The level of all categories without one of their own.
int DefaultLevel(const VMessageSettings& i_rSettings);

/// "error", "warning", "information" or "detail".
const char* LevelName(int i_Level);

/// Whether text that goes to this descriptor may have colours: to a terminal that knows them, unless NO_COLOR is set.
bool HasColours(int i_Descriptor);

/// The message in one line, without what could drive a terminal or pretend to be another message.
std::string OneLine(std::string i_Message);

/// Prints a message on standard error, one line, as "level category: text"; coloured on a terminal unless NO_COLOR is
/// set.
void PrintMessage(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage);

/// From here on each message that is printed is appended to a file, too, without colours; any number of processes may
/// append to one. Throws VCommandError for a file that cannot be written or has no name of a log's.
void KeepMessages(const std::string& i_rFile);

/// Sends the log to standard error as these settings have it. Lasts as long as the result. Where only errors are shown,
/// an error brings the warnings of its category that came right before it: they tell its reason.
[[nodiscard]] std::shared_ptr<void> ShowMessages(const VMessageSettings& i_rSettings);

bool JsonAsked();
bool StrictAsked();
/// As if --strict had been given.
void AskStrict();

/// From here on messages wait, so that what a later step mends need not be told.
void HoldMessages();

/// Tells what waits, and lets nothing wait any more.
void ReleaseMessages();

/// Forgets of what waits all whose category and text the function takes.
void ForgetMessages(const std::function<bool(const std::string& i_rCategory, const std::string& i_rText)>& i_rMended);

/// Ends the program's messages with the reason why it ends with this status. Of what waits, only errors are told where
/// the command line itself is wrong.
void TellFailure(EExitStatus i_Status, const std::string& i_rText);

/// Tells what waits. Then throws VCommandError if an error has been told since the last call (EBadInput), and with
/// --strict if a warning has (EFindings). To be called before something is written, and at the end of a command that
/// calls itself fine.
void RequireNoErrors();

/// Tells what waits, and lets errors count as warnings from here on: the user has said that they are no matter.
void ForgiveErrors();

/// Tells what waits, and lets none of it count: it is of a file of many that has failed by itself.
void ForgetCounts();

} // namespace CommandLine
