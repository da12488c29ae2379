#pragma once

#include <CLI/CLI.hpp>

#include <string>

/// Made from the option table, so that they cannot tell anything else than the program does.
namespace CommandLine
{

/// Manual page of section 1, in the man macros.
std::string ManualPage(const CLI::App& i_rProgram);

/// Completion of commands, options and files for bash.
std::string BashCompletion(const CLI::App& i_rProgram);

} // namespace CommandLine
