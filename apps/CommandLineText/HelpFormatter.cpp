#include "CommandLineText/HelpFormatter.h"

#include "CommandLineText/System.h"

#include <algorithm>

namespace CommandLine
{
namespace
{

constexpr std::size_t c_LargestColumn = 32;

std::string Entry(const std::string& i_rName, const std::string& i_rText)
{
	const std::size_t width = TextWidth();
	const std::size_t column = std::min(c_LargestColumn, width / 3);
	std::string line = "  " + i_rName;
	line += line.size() + 1 < column ? std::string(column - line.size(), ' ') : "\n" + std::string(column, ' ');
	return line + Wrap(i_rText, width - column, column) + "\n";
}

} // namespace

std::size_t TextWidth()
{
	constexpr std::size_t c_Narrowest = 40;
	constexpr std::size_t c_Widest = 100;
	const std::size_t width = TerminalWidth();
	return width == 0 ? c_Widest : std::clamp(width, c_Narrowest, c_Widest);
}

std::string FitTerminal(const std::string& i_rText, std::size_t i_Indent)
{
	const std::size_t width = TerminalWidth();
	return width <= i_Indent ? i_rText : Wrap(i_rText, width - i_Indent, i_Indent);
}

std::string FitLine(const std::string& i_rLine, std::size_t i_Width)
{
	if (i_rLine.size() <= i_Width)
		return i_rLine;
	const std::size_t indent = i_rLine.find_first_not_of(' ');
	if (indent == 0)
		return Wrap(i_rLine, i_Width, 0);
	// A name and what it means.
	const std::size_t gap = i_rLine.find("   ", indent);
	if (gap != std::string::npos)
		return i_rLine.substr(0, gap) + "\n" + std::string(indent + 4, ' ')
		    + Wrap(i_rLine.substr(i_rLine.find_first_not_of(' ', gap)), i_Width - indent - 4, indent + 4);
	// A command, which goes on behind a backslash; not within quotes.
	std::size_t cut = 0;
	bool bQuoted = false;
	for (std::size_t i = indent; i + 2 < i_Width; ++i)
	{
		bQuoted ^= i_rLine[i] == '\'';
		if (i_rLine[i] == ' ' && !bQuoted)
			cut = i;
	}
	if (cut <= indent)
		return i_rLine;
	const std::string rest = std::string(6, ' ') + i_rLine.substr(cut + 1);
	return i_rLine.substr(0, cut) + " \\\n" + (rest.size() < i_rLine.size() ? FitLine(rest, i_Width) : rest);
}

std::string Wrap(const std::string& i_rText, std::size_t i_Width, std::size_t i_Indent)
{
	std::string wrapped;
	std::size_t column = 0;
	for (std::size_t begin = 0; begin < i_rText.size();)
	{
		const std::size_t end = std::min(i_rText.find_first_of(" \n", begin), i_rText.size());
		if (column > 0 && column + 1 + (end - begin) > i_Width)
		{
			wrapped += "\n" + std::string(i_Indent, ' ');
			column = 0;
		}
		if (column > 0)
		{
			wrapped += ' ';
			++column;
		}
		wrapped.append(i_rText, begin, end - begin);
		column += end - begin;
		if (end < i_rText.size() && i_rText[end] == '\n')
		{
			wrapped += "\n" + std::string(i_Indent, ' ');
			column = 0;
		}
		begin = end + 1;
	}
	return wrapped;
}

VHelpFormatter::VHelpFormatter()
{
	label("Positionals", "Arguments");
}

std::string VHelpFormatter::make_help(const CLI::App* i_pApp, std::string i_Name, CLI::AppFormatMode i_Mode) const
{
	std::string help = make_description(i_pApp) + make_usage(i_pApp, i_Name);
	help += make_subcommands(i_pApp, i_Mode) + make_positionals(i_pApp) + make_groups(i_pApp, i_Mode);
	// The library puts blank lines of its own between groups.
	for (std::size_t at = help.find("\n\n\n"); at != std::string::npos; at = help.find("\n\n\n", at))
		help.erase(at, 1);
	help += '\n';
	const std::string footer = i_pApp->get_footer();
	for (std::size_t begin = 0; begin < footer.size();)
	{
		const std::size_t end = std::min(footer.find('\n', begin), footer.size());
		help += FitLine(footer.substr(begin, end - begin), TextWidth()) + "\n";
		begin = end + 1;
	}
	return help;
}

std::string VHelpFormatter::make_group(
    std::string i_Group, bool i_bPositional, std::vector<const CLI::Option*> i_Options) const
{
	std::string group = "\n" + i_Group + ":\n";
	for (const CLI::Option* pOption : i_Options)
		group += make_option(pOption, i_bPositional);
	return group;
}

std::string VHelpFormatter::make_usage(const CLI::App* i_pApp, std::string i_Name) const
{
	// CLI11 hands the chain of names for a command's help.
	std::string usage = "Usage: " + (i_Name.empty() ? i_pApp->get_name() : i_Name);
	for (const CLI::Option* pOption : i_pApp->get_options())
		if (pOption->get_positional())
			usage += " " + make_option_usage(pOption);
	for (const CLI::Option* pOption : i_pApp->get_options())
		if (pOption->nonpositional() && pOption->get_required())
			usage += " " + pOption->get_name() + " " + pOption->get_option_text();
	usage += i_pApp->get_subcommands({}).empty() ? " [OPTIONS]" : " COMMAND [OPTIONS]";
	return "\n" + Wrap(usage, TextWidth() - 4, 4) + "\n";
}

std::string VHelpFormatter::make_description(const CLI::App* i_pApp) const
{
	return Wrap(i_pApp->get_description(), TextWidth(), 0) + "\n";
}

std::string VHelpFormatter::make_option(const CLI::Option* i_pOption, bool i_bPositional) const
{
	const std::string text = i_pOption->get_option_text();
	return Entry(make_option_name(i_pOption, i_bPositional) + (i_bPositional || text.empty() ? "" : " " + text),
	    make_option_desc(i_pOption));
}

std::string VHelpFormatter::make_subcommand(const CLI::App* i_pApp) const
{
	return Entry(i_pApp->get_name(), i_pApp->get_description());
}

} // namespace CommandLine
