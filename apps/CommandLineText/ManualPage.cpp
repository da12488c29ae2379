#include "CommandLineText/ManualPage.h"

#include <algorithm>
#include <cctype>
#include <vector>

namespace CommandLine
{
namespace
{

/// Text as troff takes it literally.
std::string Escaped(const std::string& i_rText)
{
	std::string text;
	for (const char byte : i_rText)
	{
		const bool bLineStart = text.empty() || text.back() == '\n';
		if (byte == '\\')
			text += "\\e";
		else if (byte == '-')
			text += "\\-";
		else if (bLineStart && (byte == '.' || byte == '\''))
			(text += "\\&") += byte;
		else
			text += byte;
	}
	return text;
}

std::vector<const CLI::App*> ShownCommands(const CLI::App& i_rProgram)
{
	return i_rProgram.get_subcommands([](const CLI::App* i_pApp) { return !i_pApp->get_group().empty(); });
}

void AppendOptions(std::string& io_rPage, const CLI::App& i_rApp, bool i_bMessages)
{
	for (const CLI::Option* pOption : i_rApp.get_options())
	{
		if (pOption->get_group().empty() || (pOption->get_group() == "Messages") != i_bMessages)
			continue;
		const bool bPositional = pOption->get_positional();
		io_rPage += ".TP\n.B " + Escaped(pOption->get_name(bPositional, !bPositional));
		if (!bPositional && !pOption->get_option_text().empty())
			io_rPage += " " + Escaped(pOption->get_option_text());
		io_rPage += "\n" + Escaped(pOption->get_description()) + "\n";
	}
}

/// The footer of a command: a title, then one example to a line.
void AppendExamples(std::string& io_rPage, const CLI::App& i_rApp)
{
	io_rPage += ".PP\n.nf\n" + Escaped(i_rApp.get_footer()) + "\n.fi\n";
}

} // namespace

std::string ManualPage(const CLI::App& i_rProgram, const std::string& i_rPurpose, const std::string& i_rVersion)
{
	const std::string& name = i_rProgram.get_name();
	const std::vector<const CLI::App*> commands = ShownCommands(i_rProgram);
	std::string title = name;
	std::ranges::transform(title, title.begin(), [](unsigned char i_Letter) { return std::toupper(i_Letter); });
	std::string page = ".TH " + Escaped(title) + " 1 \"\" \"" + i_rVersion + "\" \"Retarget Setup\"\n.SH NAME\n"
	    + Escaped(name) + " \\- " + Escaped(i_rPurpose) + "\n.SH SYNOPSIS\n.B " + Escaped(name) + "\n"
	    + (commands.empty() ? "[OPTIONS]\n.RI [ FILE ...]\n" : ".I COMMAND\n[OPTIONS]\n") + ".SH DESCRIPTION\n"
	    + Escaped(i_rProgram.get_description()) + "\n";
	AppendExamples(page, i_rProgram);
	page += ".SH OPTIONS\n";
	AppendOptions(page, i_rProgram, false);
	AppendOptions(page, i_rProgram, true);
	if (commands.empty())
		return page;
	page += ".PP\nThe options of messages stand behind any command too.\n.SH COMMANDS\n";
	for (const CLI::App* pCommand : commands)
	{
		page += ".SS " + Escaped(name) + " " + Escaped(pCommand->get_name()) + "\n"
		    + Escaped(pCommand->get_description()) + "\n";
		AppendOptions(page, *pCommand, false);
		AppendExamples(page, *pCommand);
	}
	return page;
}

} // namespace CommandLine
