#pragma once

#include "CommandLineText/ExitStatus.h"

#include <string>
#include <vector>

namespace CommandLine
{

/// Has the program that draws, retarget-render, run this command line, its own name left out.
EExitStatus RunRenderer(const std::vector<std::string>& i_rArguments);

} // namespace CommandLine
