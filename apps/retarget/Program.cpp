#include "retarget/Program.h"

#include "CommandLineText/HelpFormatter.h"
#include "CommandLineText/Parsing.h"
#include "CommandLineText/ProgressBar.h"
#include "retarget/Signals.h"
#include "retarget/commands/Commands.h"
#include "retarget/text/Completion.h"
#include "retarget/text/Output.h"

#include "DebugServices/GlobalLog.h"

#include <cstdio>

namespace CommandLine
{
namespace
{

constexpr const char* c_pDescription =
    "Relates a performer's skeleton to a character's: builds a retarget subject (.qrr) from an FBX file, adds and "
    "updates its targets, and shows what skeleton and FBX files hold.";

constexpr const char* c_pWalkThrough =
    "A first retarget subject, from the character's FBX and the performer's skeleton:\n"
    "  retarget bones hero.fbx                the bones of the character\n"
    "  retarget segments performer.qrs        the segments of the performer\n"
    "  retarget create --fbx hero.fbx --source performer.qrs --position Hips:Hips --rotation Hips:Hips \\\n"
    "      --symmetry --position LeftFoot:LeftFoot --rotation LeftArm:LeftArm \\\n"
    "      --prune-joints --match-file-pose --update-targets -o hero.qrr\n"
    "  retarget targets hero.qrr --source performer.qrs\n"
    "  retarget edit hero.qrr --source performer.qrs --rotation Head:Head --weight 0=2 -o hero.qrr\n"
    "\n"
    "Results go to standard output, messages to standard error as \"level category: text\".\n"
    "One of the files that are read may be -, standard input; of what is written, - is standard output.\n"
    "Exit status: 0 fine; 1 findings; 2 wrong usage; 3 input that cannot be read or is invalid; 4 output that cannot "
    "be written.\nA command that fails writes nothing. Units are millimetres and radians.\n"
    "\"retarget COMMAND --help\" tells the options of a command with examples.";

/// "help COMMAND" becomes "COMMAND --help", and "help help" the same as "help".
std::vector<std::string> Expand(std::vector<std::string> i_Arguments)
{
	if (!i_Arguments.empty() && i_Arguments.front() == "help")
	{
		i_Arguments.erase(i_Arguments.begin());
		i_Arguments.resize(!i_Arguments.empty() && i_Arguments.front() != "help" ? 1 : 0);
		i_Arguments.push_back("--help");
	}
	return i_Arguments;
}

EExitStatus RunParsed(const VProgram& i_rProgram)
{
	for (const VCommand& rCommand : i_rProgram.m_Commands)
		if (rCommand.m_pApp->parsed())
			return rCommand.m_Run();
	std::fputs(i_rProgram.m_pApp->help().c_str(), stderr);
	return EWrongUsage;
}

int Fail(EExitStatus i_Status, const std::string& i_rMessage)
{
	TellFailure(i_Status, i_rMessage);
	return i_Status;
}

/// A shell asks this while its user types: there is nobody to tell anything.
int Complete(const CLI::App& i_rProgram, const std::vector<std::string>& i_rArguments)
{
	try
	{
		PrintCandidates(i_rProgram, i_rArguments);
		return EFine;
	}
	catch (const std::exception&)
	{
		return EBadInput;
	}
}

/// What scripts ask of every command.
void AddScriptOptions(CLI::App& io_rApp, const std::shared_ptr<VMessageSettings>& i_rpSettings)
{
	io_rApp
	    .add_flag_callback(
	        "--json", [i_rpSettings] { i_rpSettings->m_bJson = true; },
	        "The result as JSON on standard output, or a report of it where a file is written; messages as JSON on "
	        "standard error, one object a line")
	    ->trigger_on_parse()
	    ->group("Messages");
	io_rApp
	    .add_flag_callback(
	        "--strict", [i_rpSettings] { i_rpSettings->m_bStrict = true; },
	        "A warning is an error: exit status 1, and nothing is written")
	    ->trigger_on_parse()
	    ->group("Messages");
}

} // namespace

CLI::App* AddCommand(CLI::App& io_rProgram, const std::string& i_rName, const std::string& i_rDescription,
    const std::vector<std::string>& i_rExamples)
{
	CLI::App* const pApp = io_rProgram.add_subcommand(i_rName, i_rDescription);
	std::string footer = "Examples:";
	for (const std::string& rExample : i_rExamples)
		footer += "\n  retarget " + rExample;
	pApp->footer(footer);
	pApp->allow_extras();
	pApp->group("Commands");
	return pApp;
}

VProgram MakeProgram(const VRender& i_rRender)
{
	VProgram program;
	program.m_pMessages = std::make_shared<VMessageSettings>();
	program.m_pApp = std::make_unique<CLI::App>(c_pDescription, "retarget");
	CLI::App& rApp = *program.m_pApp;
	rApp.formatter(std::make_shared<VHelpFormatter>());
	rApp.set_help_flag("-h,--help", "Show this help and exit");
	rApp.set_version_flag("--version", "retarget " RETARGET_VERSION, "Show the version and exit");
	rApp.footer(c_pWalkThrough);
	rApp.require_subcommand(0, 1);
	rApp.allow_extras();
	// A word that begins with a slash is a path, on every system.
	rApp.allow_windows_style_options(false);
	const auto addRender = [&](CLI::App& io_rProgram) { return AddRenderCommand(io_rProgram, i_rRender); };
	const auto addReport = [&](CLI::App& io_rProgram) { return AddReportCommand(io_rProgram, i_rRender); };
	using VAdd = std::function<VCommand(CLI::App&)>;
	for (const VAdd& rAdd : {VAdd(AddCreateCommand), VAdd(AddEditCommand), VAdd(AddRebindCommand),
	         VAdd(AddBuildCommand), VAdd(AddPresetCommand), VAdd(AddMapCommand), VAdd(AddTargetsCommand),
	         VAdd(AddCheckCommand), VAdd(AddAdviseCommand), VAdd(AddDiffCommand), VAdd(AddBonesCommand),
	         VAdd(AddSegmentsCommand), VAdd(addRender), VAdd(addReport), VAdd(AddSolveCommand), VAdd(AddFbxCommand),
	         VAdd(AddTakeCommand), VAdd(AddPerformerCommand), VAdd(AddDumpCommand), VAdd(AddFkCommand),
	         VAdd(AddConvertCommand), VAdd(AddSchemaCommand), VAdd(AddEvalCommand), VAdd(AddDocumentationCommand)})
		program.m_Commands.push_back(rAdd(rApp));
	std::vector<CLI::App*> apps{&rApp};
	for (const VCommand& rCommand : program.m_Commands)
		apps.push_back(rCommand.m_pApp);
	for (CLI::App* const pApp : apps)
	{
		AddMessageOptions(*pApp, program.m_pMessages);
		AddScriptOptions(*pApp, program.m_pMessages);
	}
	return program;
}

int Run(std::vector<std::string> i_Arguments, const VRender& i_rRender)
{
	LeaveNothingOnSignals();
	AllowProgress();
	VProgram program = MakeProgram(i_rRender);
	if (!i_Arguments.empty() && i_Arguments.front() == "complete")
		return Complete(*program.m_pApp, i_Arguments);
	std::shared_ptr<void> pMessages = ShowMessages({});
	try
	{
		try
		{
			Parse(*program.m_pApp, Expand(std::move(i_Arguments)));
		}
		catch (const CLI::CallForHelp&)
		{
			Print(program.m_pApp->help());
			return EFine;
		}
		catch (const CLI::CallForVersion&)
		{
			Print(program.m_pApp->version() + "\n");
			return EFine;
		}
		pMessages.reset();
		pMessages = ShowMessages(*program.m_pMessages);
		if (!program.m_pMessages->m_LogFile.empty())
			KeepMessages(program.m_pMessages->m_LogFile);
		HoldMessages();
		const EExitStatus status = RunParsed(program);
		if (status == EFine)
			RequireNoErrors();
		ReleaseMessages();
		return status;
	}
	catch (const VCommandError& rError)
	{
		return Fail(rError.Status(), rError.what());
	}
	catch (const std::bad_alloc&)
	{
		return Fail(EBadInput, "Out of memory");
	}
	catch (const std::exception& rError)
	{
		return Fail(EBadInput, rError.what());
	}
}

} // namespace CommandLine
