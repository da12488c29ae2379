#pragma once

#include "CommandLineText/Messages.h"

#include <CLI/CLI.hpp>

#include <memory>
#include <string>
#include <vector>

namespace CommandLine
{

/// Adds the options that every program has for its messages.
void AddMessageOptions(CLI::App& io_rApp, const std::shared_ptr<VMessageSettings>& i_rpSettings);

/// Takes one of a few words and tells them where another is given.
CLI::Validator OneOf(const std::vector<std::string>& i_rTexts);

/// Refuses an empty text, as scripts give it from a variable that is not set.
CLI::Validator NotEmpty();

/// Parses a command line, the program's own name left out; "-v CATEGORY=LEVEL" stands for "--log CATEGORY=LEVEL".
/// Throws CLI::CallForHelp and CLI::CallForVersion, and VCommandError for a line that is wrong, with what may have been
/// meant. The program must allow extras.
void Parse(CLI::App& io_rProgram, std::vector<std::string> i_Arguments);

} // namespace CommandLine
