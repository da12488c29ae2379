#pragma once

#include "retarget/Program.h"

/// Each adds its options to the program; one source file for each.
namespace CommandLine
{

VCommand AddEvalCommand(CLI::App& io_rProgram);
VCommand AddSchemaCommand(CLI::App& io_rProgram);
VCommand AddFbxCommand(CLI::App& io_rProgram);
VCommand AddBonesCommand(CLI::App& io_rProgram);
VCommand AddSegmentsCommand(CLI::App& io_rProgram);
VCommand AddPerformerCommand(CLI::App& io_rProgram);
VCommand AddSolveCommand(CLI::App& io_rProgram);
VCommand AddTakeCommand(CLI::App& io_rProgram);
VCommand AddDumpCommand(CLI::App& io_rProgram);
VCommand AddConvertCommand(CLI::App& io_rProgram);
VCommand AddFkCommand(CLI::App& io_rProgram);
VCommand AddMapCommand(CLI::App& io_rProgram);
VCommand AddTargetsCommand(CLI::App& io_rProgram);
VCommand AddCheckCommand(CLI::App& io_rProgram);
VCommand AddAdviseCommand(CLI::App& io_rProgram);
VCommand AddDiffCommand(CLI::App& io_rProgram);
VCommand AddRebindCommand(CLI::App& io_rProgram);
VCommand AddCreateCommand(CLI::App& io_rProgram);
VCommand AddPresetCommand(CLI::App& io_rProgram);
VCommand AddBuildCommand(CLI::App& io_rProgram);
VCommand AddEditCommand(CLI::App& io_rProgram);
VCommand AddReportCommand(CLI::App& io_rProgram, const VRender& i_rRender);
VCommand AddRenderCommand(CLI::App& io_rProgram, const VRender& i_rRender);
/// Hidden: prints the manual page or the shell completion of the option table.
VCommand AddDocumentationCommand(CLI::App& io_rProgram);

} // namespace CommandLine
