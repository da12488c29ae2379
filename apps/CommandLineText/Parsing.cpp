#include "CommandLineText/Parsing.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Suggest.h"

#include <algorithm>

namespace CommandLine
{
namespace
{

std::string SeeHelp(const CLI::App& i_rApp)
{
	const CLI::App* const pProgram = i_rApp.get_parent();
	return "see \"" + (pProgram ? pProgram->get_name() + " " : "") + i_rApp.get_name() + " --help\"";
}

std::string NoCommand(const CLI::App& i_rProgram, const std::string& i_rWord)
{
	std::vector<std::string> names;
	for (const CLI::App* pCommand :
	    i_rProgram.get_subcommands([](const CLI::App* i_pApp) { return !i_pApp->get_group().empty(); }))
		names.push_back(pCommand->get_name());
	return "there is no command \"" + i_rWord + "\"" + Meant(i_rWord, names) + "; " + SeeHelp(i_rProgram);
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
	return NoCommand(i_rApp, rWord);
}

/// A mistyped command is told before any help, which would be of the program as a whole.
void RequireCommand(const CLI::App& i_rProgram, const std::vector<std::string>& i_rArguments)
{
	const auto commands =
	    i_rProgram.get_subcommands([](const CLI::App* i_pApp) { return !i_pApp->get_name().empty(); });
	if (commands.empty())
		return;
	for (std::size_t i = 0; i < i_rArguments.size(); ++i)
	{
		const std::string& rWord = i_rArguments[i];
		if (rWord == "--log")
			++i;
		if (rWord.starts_with('-'))
			continue;
		if (std::none_of(
		        commands.begin(), commands.end(), [&](const CLI::App* i_pApp) { return i_pApp->get_name() == rWord; }))
			throw VCommandError(EWrongUsage, NoCommand(i_rProgram, rWord));
		return;
	}
}

/// What is wrong with the line, in this program's words.
std::string Describe(const CLI::ParseError& i_rError, const CLI::App& i_rApp)
{
	std::string text = i_rError.what();
	const std::string name = text.substr(0, text.find_first_of(": "));
	const CLI::Option* const pOption = i_rApp.get_option_no_throw(name);
	if (dynamic_cast<const CLI::RequiredError*>(&i_rError))
		return name + " is missing";
	if (dynamic_cast<const CLI::ArgumentMismatch*>(&i_rError) && pOption)
		return pOption->get_expected_max() == 0 ? name + " takes no value"
		                                        : name + " needs a value: " + pOption->get_option_text();
	return text;
}

const CLI::App& ParsedApp(const CLI::App& i_rApp)
{
	const std::vector<CLI::App*> parsed = i_rApp.get_subcommands();
	return parsed.empty() ? i_rApp : *parsed.front();
}

} // namespace

CLI::Validator OneOf(const std::vector<std::string>& i_rTexts)
{
	return CLI::Validator(
	    [i_rTexts](const std::string& i_rText) -> std::string
	    {
		    if (std::find(i_rTexts.begin(), i_rTexts.end(), i_rText) != i_rTexts.end())
			    return "";
		    std::string message = "there is no \"" + i_rText + "\"" + Meant(i_rText, i_rTexts) + "; give";
		    for (std::size_t i = 0; i < i_rTexts.size(); ++i)
			    message += (i == 0 ? " " : i + 1 == i_rTexts.size() ? " or " : ", ") + i_rTexts[i];
		    return message;
	    },
	    "");
}

CLI::Validator NotEmpty()
{
	return CLI::Validator([](const std::string& i_rText) -> std::string
	    { return i_rText.empty() ? "the text is empty: give a name, or leave the option out" : ""; },
	    "");
}

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
		        if (const std::string wrong = ParseCategoryLevel(i_rText, *i_rpSettings); !wrong.empty())
			        throw CLI::ValidationError("--log", wrong);
	        },
	        "Level of one category of messages: error, warning, information or detail; also as -v CATEGORY=LEVEL")
	    ->option_text("CATEGORY=LEVEL")
	    ->trigger_on_parse()
	    ->group("Messages");
	io_rApp
	    .add_option_function<std::string>(
	        "--log-file", [i_rpSettings](const std::string& i_rText) { i_rpSettings->m_LogFile = i_rText; },
	        "Append the messages to this file, too, a line each; any number of processes may share it")
	    ->option_text("FILE.log")
	    ->check(NotEmpty())
	    ->trigger_on_parse()
	    ->group("Messages");
}

void Parse(CLI::App& io_rProgram, std::vector<std::string> i_Arguments)
{
	for (std::size_t i = 0; i + 1 < i_Arguments.size() && i_Arguments[i] != "--"; ++i)
		if (i_Arguments[i] == "-v" && LooksLikeCategoryLevel(i_Arguments[i + 1]))
			i_Arguments[i] = "--log";
	RequireCommand(io_rProgram, i_Arguments);
	std::reverse(i_Arguments.begin(), i_Arguments.end());
	try
	{
		io_rProgram.parse(std::move(i_Arguments));
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
		const std::string unexpected = DescribeUnexpected(io_rProgram);
		throw VCommandError(EWrongUsage,
		    unexpected.empty() ? Describe(rError, ParsedApp(io_rProgram)) + "; " + SeeHelp(ParsedApp(io_rProgram))
		                       : unexpected);
	}
	if (const std::string unexpected = DescribeUnexpected(io_rProgram); !unexpected.empty())
		throw VCommandError(EWrongUsage, unexpected);
}

} // namespace CommandLine
