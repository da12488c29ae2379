#pragma once

#include "CommandLineText/ExitStatus.h"
#include "retarget/picture/RenderCommand.h"

#include <string>
#include <vector>

namespace CommandLine
{

/// Has the program that draws, retarget-render, run this command line, its own name left out.
EExitStatus RunRenderer(const std::vector<std::string>& i_rArguments);

/// What it draws for another command: the bytes of a PNG picture. Throws VCommandError with what it tells where it
/// fails.
std::string RenderedPicture(const VRenderSettings& i_rSettings);

} // namespace CommandLine
