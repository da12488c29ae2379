#include "retarget/Program.h"

#include "retarget/Commands.h"
#include "retarget/HelpFormatter.h"
#include "retarget/Output.h"
#include "retarget/Suggest.h"

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
    "  retarget fbx hero.fbx                  the bones of the character, its units and axes\n"
    "  retarget dump performer.qrs            the segments of the performer\n"
    "  retarget create --fbx hero.fbx --source performer.qrs --position Hips:Hips --rotation Hips:Hips \\\n"
    "      --symmetry --position LeftFoot:LeftFoot --rotation LeftArm:LeftArm \\\n"
    "      --prune-joints --match-file-pose --update-targets -o hero.qrr\n"
    "  retarget targets hero.qrr --source performer.qrs\n"
    "  retarget edit hero.qrr --source performer.qrs --rotation Head:Head --weight 0=2 -o hero.qrr\n"
    "\n"
    "Results go to standard output, messages to standard error as \"level category: text\".\n"
    "Exit status: 0 fine; 1 findings; 2 wrong usage; 3 input that cannot be read or is invalid; 4 output that cannot "
    "be\nwritten. A command that fails writes nothing. Units are millimetres and radians.\n"
    "\"retarget COMMAND --help\" tells the options of a command with examples.";

void AddMessageOptions(CLI::App& io_rApp, const std::shared_ptr<VMessageSettings>& i_rpSettings)
{
	io_rApp
	    .add_flag_callback(
	        "-v,--verbose", [i_rpSettings] { ++i_rpSettings->m_Verbose; }, "Show more messages; twice for every detail")
	    ->trigger_on_parse()
	    ->group("Messages");
	io_rApp
	    .add_flag_callback(
	        "-q,--quiet", [i_rpSettings] { ++i_rpSettings->m_Quiet; }, "Show errors only")
	    ->trigger_on_parse()
	    ->group("Messages");
	io_rApp
	    .add_option_function<std::string>(
	        "--log",
	        [i_rpSettings](const std::string& i_rText)
	        {
		        if (!ParseCategoryLevel(i_rText, *i_rpSettings))
			        throw CLI::ValidationError("--log",
			            "\"" + i_rText
			                + "\" is not CATEGORY=LEVEL with a level of error, warning, information or detail");
	        },
	        "Level of one category of messages: error, warning, information or detail; also as -v CATEGORY=LEVEL")
	    ->option_text("CATEGORY=LEVEL")
	    ->trigger_on_parse()
	    ->group("Messages");
}

/// "-v CATEGORY=LEVEL" becomes "--log CATEGORY=LEVEL", and "help COMMAND" becomes "COMMAND --help".
std::vector<std::string> Expand(std::vector<std::string> i_Arguments)
{
	VMessageSettings ignored;
	for (std::size_t i = 0; i + 1 < i_Arguments.size() && i_Arguments[i] != "--"; ++i)
		if (i_Arguments[i] == "-v" && ParseCategoryLevel(i_Arguments[i + 1], ignored))
			i_Arguments[i] = "--log";
	if (!i_Arguments.empty() && i_Arguments.front() == "help")
	{
		i_Arguments.erase(i_Arguments.begin());
		i_Arguments.resize(std::min<std::size_t>(i_Arguments.size(), 1));
		i_Arguments.push_back("--help");
	}
	return i_Arguments;
}

std::string SeeHelp(const CLI::App& i_rApp)
{
	return "see \"retarget " + (i_rApp.get_parent() ? i_rApp.get_name() + " " : "") + "--help\"";
}

/// The closest of a few fixed names, if it can be a slip of the hand.
std::string Meant(const std::string& i_rWord, const std::vector<std::string>& i_rNames)
{
	const std::vector<std::string> closest = Closest(i_rWord, i_rNames, 1);
	if (closest.empty() || EditDistance(i_rWord, closest.front()) > std::max<std::size_t>(1, i_rWord.size() / 3))
		return "";
	return "; did you mean \"" + closest.front() + "\"?";
}

/// The first word of the line that no option and no command takes, with what may have been meant. Empty if there is
/// none.
std::string DescribeUnexpected(const CLI::App& i_rApp)
{
	for (const CLI::App* pCommand : i_rApp.get_subcommands())
		if (std::string text = DescribeUnexpected(*pCommand); !text.empty())
			return text;
	std::vector<std::string> rest = i_rApp.remaining();
	// The mark that ends the options is no word of its own.
	std::erase(rest, "--");
	if (rest.empty())
		return "";
	const std::string& rWord = rest.front();
	std::vector<std::string> names;
	if (rWord.size() > 1 && rWord[0] == '-')
	{
		for (const CLI::Option* pOption : i_rApp.get_options())
			for (const std::string& rName : pOption->get_lnames())
				names.push_back("--" + rName);
		std::string text =
		    "there is no option \"" + rWord + "\"" + Meant(rWord.substr(0, rWord.find('=')), names) + "; ";
		if (rWord[1] != '-')
			text += "put -- before a text that begins with -; ";
		return text + SeeHelp(i_rApp);
	}
	if (i_rApp.get_parent())
		return "\"" + rWord + "\" is one argument too many; " + SeeHelp(i_rApp);
	for (const CLI::App* pCommand :
	    i_rApp.get_subcommands([](const CLI::App* i_pApp) { return !i_pApp->get_group().empty(); }))
		names.push_back(pCommand->get_name());
	return "there is no command \"" + rWord + "\"" + Meant(rWord, names) + "; " + SeeHelp(i_rApp);
}

const CLI::App& ParsedApp(const CLI::App& i_rApp)
{
	const std::vector<CLI::App*> parsed = i_rApp.get_subcommands();
	return parsed.empty() ? i_rApp : *parsed.front();
}

void Parse(VProgram& io_rProgram, std::vector<std::string> i_Arguments)
{
	CLI::App& rApp = *io_rProgram.m_pApp;
	std::reverse(i_Arguments.begin(), i_Arguments.end());
	try
	{
		rApp.parse(std::move(i_Arguments));
	}
	catch (const CLI::CallForHelp&)
	{
		throw;
	}
	catch (const CLI::CallForVersion&)
	{
		throw;
	}
	catch (const CLI::ParseError& rError)
	{
		const std::string unexpected = DescribeUnexpected(rApp);
		throw VCommandError(EWrongUsage,
		    unexpected.empty() ? rError.what() + std::string("; ") + SeeHelp(ParsedApp(rApp)) : unexpected);
	}
	if (const std::string unexpected = DescribeUnexpected(rApp); !unexpected.empty())
		throw VCommandError(EWrongUsage, unexpected);
}

EExitStatus RunParsed(const VProgram& i_rProgram)
{
	for (const VCommand& rCommand : i_rProgram.m_Commands)
		if (rCommand.m_pApp->parsed())
			return rCommand.m_Run();
	std::fputs(i_rProgram.m_pApp->help().c_str(), stderr);
	return EWrongUsage;
}

int Fail(EExitStatus i_Status, const char* i_pMessage)
{
	NVX_LOG(c_pCategory, NVX::ELogError, "%1%", i_pMessage);
	return i_Status;
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

VProgram MakeProgram()
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
	for (const auto pAdd :
	    {AddCreateCommand, AddEditCommand, AddTargetsCommand, AddCheckCommand, AddFbxCommand, AddDumpCommand,
	        AddFkCommand, AddConvertCommand, AddSchemaCommand, AddEvalCommand, AddDocumentationCommand})
		program.m_Commands.push_back(pAdd(rApp));
	AddMessageOptions(rApp, program.m_pMessages);
	for (const VCommand& rCommand : program.m_Commands)
		AddMessageOptions(*rCommand.m_pApp, program.m_pMessages);
	return program;
}

int Run(std::vector<std::string> i_Arguments)
{
	VProgram program = MakeProgram();
	std::shared_ptr<void> pMessages = ShowMessages({});
	try
	{
		try
		{
			Parse(program, Expand(std::move(i_Arguments)));
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
		return RunParsed(program);
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
