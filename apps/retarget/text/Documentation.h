#pragma once

#include <CLI/CLI.hpp>

#include <string>

/// Nothing here can tell anything else than the program does.
namespace CommandLine
{

/// Manual page of section 1 of the option table, in the man macros.
std::string ManualPage(const CLI::App& i_rProgram);

/// Scripts for the shells, which ask the program itself what may stand at the cursor.
const char* BashCompletion();
const char* ZshCompletion();
const char* FishCompletion();

} // namespace CommandLine
