#include "retarget/text/Documentation.h"

#include <algorithm>

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
		if ((pOption->get_group() == "Messages") != i_bMessages)
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

std::string Words(const std::vector<std::string>& i_rWords)
{
	std::string text;
	for (const std::string& rWord : i_rWords)
		text += (text.empty() ? "" : " ") + rWord;
	return text;
}

std::string OptionWords(const CLI::App& i_rApp, bool i_bWithValueOnly)
{
	std::vector<std::string> words;
	for (const CLI::Option* pOption : i_rApp.get_options())
	{
		if (i_bWithValueOnly && pOption->get_expected_max() == 0)
			continue;
		for (const std::string& rName : pOption->get_lnames())
			words.push_back("--" + rName);
		for (const std::string& rName : pOption->get_snames())
			words.push_back("-" + rName);
	}
	return Words(words);
}

/// Options whose value is the name of a file.
std::string FileOptionWords(const CLI::App& i_rApp)
{
	std::vector<std::string> words;
	for (const CLI::Option* pOption : i_rApp.get_options())
	{
		const std::string text = pOption->get_option_text();
		if (text.rfind("FILE", 0) != 0 && text.rfind("OUT", 0) != 0)
			continue;
		for (const std::string& rName : pOption->get_lnames())
			words.push_back("--" + rName);
		for (const std::string& rName : pOption->get_snames())
			words.push_back("-" + rName);
	}
	return Words(words);
}

} // namespace

std::string ManualPage(const CLI::App& i_rProgram)
{
	std::string page = ".TH RETARGET 1 \"\" \"" RETARGET_VERSION
	                   "\" \"Retarget Setup\"\n.SH NAME\nretarget \\- build and "
	                   "edit retarget subjects\n.SH SYNOPSIS\n.B retarget\n.I COMMAND\n[OPTIONS]\n.SH DESCRIPTION\n"
	    + Escaped(i_rProgram.get_description()) + "\n";
	AppendExamples(page, i_rProgram);
	page += ".SH OPTIONS\n";
	AppendOptions(page, i_rProgram, false);
	AppendOptions(page, i_rProgram, true);
	page += ".PP\nThe options of messages stand behind any command too.\n.SH COMMANDS\n";
	for (const CLI::App* pCommand : ShownCommands(i_rProgram))
	{
		page += ".SS retarget " + Escaped(pCommand->get_name()) + "\n" + Escaped(pCommand->get_description()) + "\n";
		AppendOptions(page, *pCommand, false);
		AppendExamples(page, *pCommand);
	}
	return page;
}

std::string BashCompletion(const CLI::App& i_rProgram)
{
	std::vector<std::string> names;
	for (const CLI::App* pCommand : ShownCommands(i_rProgram))
		names.push_back(pCommand->get_name());
	std::string text = "# Completion of retarget for bash.\n_retarget()\n{\n"
	                   "\tlocal current=\"${COMP_WORDS[COMP_CWORD]}\" previous=\"${COMP_WORDS[COMP_CWORD-1]}\"\n"
	                   "\tlocal command=\"\" options=\"\" valued=\"\" files=\"\" word\n"
	                   "\tfor word in \"${COMP_WORDS[@]:1:COMP_CWORD-1}\"; do\n"
	                   "\t\tcase \"$word\" in -*) ;; *) command=\"$word\"; break ;; esac\n\tdone\n"
	                   "\tCOMPREPLY=()\n\tcase \"$command\" in\n";
	const auto addCase = [&](const std::string& i_rName, const CLI::App& i_rApp)
	{
		text += "\t" + i_rName + ")\n\t\toptions=\"" + OptionWords(i_rApp, false) + "\"\n\t\tvalued=\""
		    + OptionWords(i_rApp, true) + "\"\n\t\tfiles=\"" + FileOptionWords(i_rApp) + "\" ;;\n";
	};
	for (const CLI::App* pCommand : ShownCommands(i_rProgram))
		addCase(pCommand->get_name(), *pCommand);
	addCase("\"\"", i_rProgram);
	text += "\tesac\n"
	        "\tif [[ \" $files \" == *\" $previous \"* ]]; then\n"
	        "\t\tCOMPREPLY=($(compgen -f -- \"$current\"))\n"
	        "\telif [[ \" $valued \" == *\" $previous \"* ]]; then\n"
	        "\t\tCOMPREPLY=()\n"
	        "\telif [[ $current == -* ]]; then\n"
	        "\t\tCOMPREPLY=($(compgen -W \"$options\" -- \"$current\"))\n"
	        "\telif [[ -z $command ]]; then\n"
	        "\t\tCOMPREPLY=($(compgen -W \""
	    + Words(names)
	    + "\" -- \"$current\"))\n"
	      "\telse\n"
	      "\t\tCOMPREPLY=($(compgen -f -- \"$current\"))\n"
	      "\tfi\n}\ncomplete -o filenames -F _retarget retarget\n";
	return text;
}

} // namespace CommandLine
