#pragma once

#include <CLI/CLI.hpp>

namespace CommandLine
{

/// Wraps a text at blanks; lines after the first begin with the indent. Line ends in the text stay.
std::string Wrap(const std::string& i_rText, std::size_t i_Width, std::size_t i_Indent);

/// Help pages of 100 columns.
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
