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

const char* BashCompletion()
{
	return R"(# Completion of retarget for bash.
_retarget()
{
	local line
	COMPREPLY=()
	while IFS= read -r line; do
		case $line in
		$'\tfiles') compopt -o default ;;
		$'\tfolders') compopt -o dirnames ;;
		*) COMPREPLY+=("${line%%$'\t'*}") ;;
		esac
	done < <("$1" complete bash "$COMP_LINE" "$COMP_POINT" 2>/dev/null)
	case ${#COMPREPLY[@]}${COMPREPLY[0]} in 1*[:=]) compopt -o nospace ;; esac
}
complete -F _retarget retarget
)";
}

const char* ZshCompletion()
{
	return R"(#compdef retarget
# Completion of retarget for zsh.
_retarget()
{
	local line text
	local -a texts shown open openShown
	for line in "${(@f)$("${(Q)words[1]}" complete words "${(@Q)words[2,CURRENT-1]}" "${(Q)PREFIX}" 2>/dev/null)}"; do
		text="${line%%$'\t'*}"
		case $line in
		'') ;;
		$'\tfiles') compset -P '--*='; _files; return ;;
		$'\tfolders') compset -P '--*='; _files -/; return ;;
		*[:=]) open+=("$text"); openShown+=("$text") ;;
		*$'\t'*) texts+=("$text"); shown+=("$text  -- ${line#*$'\t'}") ;;
		*) texts+=("$text"); shown+=("$text") ;;
		esac
	done
	local missing=1
	compadd -l -d shown -a texts && missing=0
	compadd -S '' -d openShown -a open && missing=0
	return missing
}
if [[ $funcstack[1] == _retarget ]]; then _retarget "$@"; else compdef _retarget retarget; fi
)";
}

const char* FishCompletion()
{
	return R"(# Completion of retarget for fish.
function __retarget_complete
	set -l words (commandline -opc)
	set -l current (commandline -ct | string unescape | string trim --left --chars "'\"")
	set -l option (string match -r '^--[a-z-]+=' -- "$current")
	set -l value (string replace -r '^--[a-z-]+=' '' -- "$current")
	for line in ($words[1] complete words $words[2..-1] "$current" 2>/dev/null)
		switch $line
		case \tfiles
			for path in (__fish_complete_path "$value")
				echo $option$path
			end
		case \tfolders
			for path in (__fish_complete_directories "$value")
				echo $option$path
			end
		case '*'
			echo $line
		end
	end
end
complete -c retarget -f -a '(__retarget_complete)'
)";
}

} // namespace CommandLine
