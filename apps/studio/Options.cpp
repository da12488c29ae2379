#include "studio/Options.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/HelpFormatter.h"
#include "CommandLineText/ManualPage.h"
#include "CommandLineText/Parsing.h"
#include "studio/panel/FileKind.h"
#include "studio/window/StudioWindow.h"

#include <charconv>

namespace StudioHost
{
namespace
{

constexpr const char* c_pDescription =
    "A window around the Retarget Setup panel: choose the performer's skeleton and the character's FBX, build the "
    "retarget subject, tie segments by targets, look at it and save it.";

constexpr const char* c_pExamples =
    "Examples:\n"
    "  retarget-studio\n"
    "  retarget-studio --source performer.qrs --fbx hero.fbx\n"
    "  retarget-studio hero.qrr\n"
    "  retarget-studio --source performer.qrs --target hero.qrr --take walk.bvh\n"
    "  retarget-studio --source performer.qrs --target hero.qrr --screenshot hero.png --size 1920x1080\n"
    "\n"
    "Messages go to the log list of the window and to standard error as \"level category: text\".\n"
    "Exit status: 0 fine; 2 wrong usage; 3 no display, module or file that can be read, with --screenshot; 4 a picture "
    "that cannot be written.";

constexpr QSize c_ScreenshotSize(1280, 800);
/// Pictures beyond this are not drawn by the common OpenGL implementations.
constexpr int c_MaxSide = 8192;

QSize ParseSize(const std::string& i_rText)
{
	int width = 0, height = 0;
	const char* const pEnd = i_rText.data() + i_rText.size();
	const auto [pX, widthError] = std::from_chars(i_rText.data(), pEnd, width);
	if (widthError == std::errc() && pX != pEnd && *pX == 'x')
	{
		const auto [pRead, heightError] = std::from_chars(pX + 1, pEnd, height);
		if (heightError == std::errc() && pRead == pEnd && width > 0 && height > 0 && width <= c_MaxSide
		    && height <= c_MaxSide)
			return {width, height};
	}
	throw CommandLine::VCommandError(CommandLine::EWrongUsage,
	    "--size: \"" + i_rText + "\" is not WIDTHxHEIGHT with numbers from 1 to " + std::to_string(c_MaxSide));
}

} // namespace

std::optional<VOptions> ParseOptions(std::vector<std::string> i_Arguments, std::string& o_rText)
{
	const auto pMessages = std::make_shared<CommandLine::VMessageSettings>();
	std::string module, settings, fbx, source, target, take, dialog, screenshot, size;
	std::size_t frame = 0;
	std::vector<std::string> files;
	bool bDeveloper = false, bManual = false;

	CLI::App app(c_pDescription, "retarget-studio");
	app.formatter(std::make_shared<CommandLine::VHelpFormatter>());
	app.set_help_flag("-h,--help", "Show this help and exit");
	app.set_version_flag("--version", "retarget-studio " RETARGET_VERSION, "Show the version and exit");
	app.footer(c_pExamples);
	app.allow_extras();
	app.add_option("FILE", files, "Files to open, by kind: " + AllExtensions().toStdString());
	app.add_option("--source", source, "Open the performer's skeleton")->option_text("FILE.qrs");
	app.add_option("--fbx", fbx, "Open the character's skeleton")->option_text("FILE.fbx");
	app.add_option("--target", target, "Open a retarget subject")->option_text("FILE.qrr");
	CLI::Option* const pTake = app.add_option("--take", take, "Play a take of the performer: BVH or FBX file");
	pTake->option_text("TAKE");
	app.add_option("--frame", frame, "Show this frame of the take first; its first is 0")
	    ->option_text("NUMBER")
	    ->needs(pTake);
	app.add_option("--open", dialog,
	       "Open a dialog, too: the proposed targets, the alignment, advice, the check of the pose, "
	       "what is not saved yet, or the preferences")
	    ->option_text("advice|align|check-pose|compare|preferences|propose")
	    ->check(CLI::IsMember(VStudioWindow::Dialogs()));
	app.add_option("--screenshot", screenshot, "Save a picture of the window when it is ready, and end")
	    ->option_text("OUT.png");
	app.add_option("--size", size, "Size of the window in pixels; 1280x800 for pictures")->option_text("WxH");
	app.add_option("--module", module, "The module to load instead of the one that comes with this program")
	    ->option_text("PATH");
	app.add_option("--settings", settings, "Keep settings in this file instead of the user's own")
	    ->option_text("FILE.ini");
	app.add_flag("--developer", bDeveloper, "QML comes from the sources; F5 loads it again");
	// For the build: there is nothing else to ask than the program.
	app.add_flag("--manual", bManual, "Print the manual page and exit")->group("");
	CommandLine::AddMessageOptions(app, pMessages);
	try
	{
		CommandLine::Parse(app, std::move(i_Arguments));
	}
	catch (const CLI::CallForHelp&)
	{
		o_rText = app.help();
		return std::nullopt;
	}
	catch (const CLI::CallForVersion&)
	{
		o_rText = app.version() + "\n";
		return std::nullopt;
	}

	if (bManual)
	{
		o_rText =
		    CommandLine::ManualPage(app, "tie a performer's skeleton to a character's in a window", RETARGET_VERSION);
		return std::nullopt;
	}

	VOptions options;
	options.m_Messages = *pMessages;
	options.m_Module = QString::fromStdString(module);
	options.m_Settings = QString::fromStdString(settings);
	options.m_Screenshot = QString::fromStdString(screenshot);
	options.m_bDeveloper = bDeveloper;
	options.m_Take = QString::fromStdString(take);
	options.m_Frame = frame;
	options.m_Dialog = dialog;
	if (!size.empty())
		options.m_Size = ParseSize(size);
	else if (!screenshot.empty())
		options.m_Size = c_ScreenshotSize;
	// The source counts for the target's message about it, and the FBX resets the root: in this order nothing that was
	// asked for is undone.
	const std::pair<const std::string&, EFileKind> named[] = {
	    {source, EFileKind::ESource}, {fbx, EFileKind::EFbx}, {target, EFileKind::ETarget}};
	for (const auto& [rFile, kind] : named)
	{
		const QString file = QString::fromStdString(rFile);
		if (file.isEmpty())
			continue;
		if (KindOf(file) != kind)
			throw CommandLine::VCommandError(CommandLine::EWrongUsage,
			    "\"" + rFile + "\" is no " + Description(kind).toStdString() + "; see \"retarget-studio --help\"");
		options.m_Files << file;
	}
	for (const std::string& rFile : files)
	{
		if (KindOf(QString::fromStdString(rFile)) == EFileKind::EOther)
			throw CommandLine::VCommandError(CommandLine::EWrongUsage,
			    "\"" + rFile + "\" is of no kind that can be opened: " + AllExtensions().toStdString());
		options.m_Files << QString::fromStdString(rFile);
	}
	SortByKind(options.m_Files);
	return options;
}

} // namespace StudioHost
