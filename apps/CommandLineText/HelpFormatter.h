#pragma once

#include <CLI/CLI.hpp>

namespace CommandLine
{

/// Columns that help may take: those of the terminal, at most 100.
std::size_t TextWidth();

/// One line of a footer at a width: text is wrapped, a name and its meaning, three blanks apart, go under each other,
/// and a command goes on behind a backslash.
std::string FitLine(const std::string& i_rLine, std::size_t i_Width);

/// Wraps a text at blanks; lines after the first begin with the indent. Line ends in the text stay.
std::string Wrap(const std::string& i_rText, std::size_t i_Width, std::size_t i_Indent);

/// Wrapped to the terminal where standard output is one, with the indent in all lines but the first; otherwise as it
/// is.
std::string FitTerminal(const std::string& i_rText, std::size_t i_Indent);

/// Help pages as wide as the terminal, at most 100 columns.
class VHelpFormatter : public CLI::Formatter
{
public:
	VHelpFormatter();
	std::string make_help(const CLI::App* i_pApp, std::string i_Name, CLI::AppFormatMode i_Mode) const override;
	std::string make_group(
	    std::string i_Group, bool i_bPositional, std::vector<const CLI::Option*> i_Options) const override;
	std::string make_usage(const CLI::App* i_pApp, std::string i_Name) const override;
	std::string make_description(const CLI::App* i_pApp) const override;
	std::string make_option(const CLI::Option* i_pOption, bool i_bPositional) const override;
	std::string make_subcommand(const CLI::App* i_pApp) const override;
};

} // namespace CommandLine
