#pragma once

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/picture/RenderCommand.h"

#include <CLI/CLI.hpp>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace CommandLine
{

/// One command: its options, and what it does once they are parsed. Throws VCommandError to fail.
struct VCommand
{
	CLI::App* m_pApp = nullptr;
	std::function<EExitStatus()> m_Run;
};

/// The option table of the whole program: what is parsed, shown as help, printed as manual and completed by the shell.
struct VProgram
{
	std::unique_ptr<CLI::App> m_pApp;
	std::vector<VCommand> m_Commands;
	std::shared_ptr<VMessageSettings> m_pMessages;
};

/// @param i_rRender what draws, where the table is not only to be shown
VProgram MakeProgram(const VRender& i_rRender = {});

/// Adds a command with its description and its examples, one to a line and without the program's name.
CLI::App* AddCommand(CLI::App& io_rProgram, const std::string& i_rName, const std::string& i_rDescription,
    const std::vector<std::string>& i_rExamples);

/// Parses and runs a command line, the program's own name left out.
int Run(std::vector<std::string> i_Arguments, const VRender& i_rRender);

} // namespace CommandLine
