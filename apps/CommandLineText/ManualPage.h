#pragma once

#include <CLI/CLI.hpp>

#include <string>

namespace CommandLine
{

/// Manual page of section 1 of a program's option table, in the man macros: it can tell nothing else than the program
/// does. Hidden commands and options are left out.
/// @param i_rPurpose what the program does, in a few words behind its name.
std::string ManualPage(const CLI::App& i_rProgram, const std::string& i_rPurpose, const std::string& i_rVersion);

} // namespace CommandLine
