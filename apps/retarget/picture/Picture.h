#pragma once

#include "retarget/picture/RenderCommand.h"

namespace CommandLine
{

/// Draws what is asked for with the display's OpenGL, as the panel's preview draws it, and saves it. Throws
/// VCommandError: EBadInput for files that cannot be read, EBadOutput where there is no OpenGL and where the picture
/// cannot be written. The file is written whole or not at all.
EExitStatus RenderPicture(const VRenderSettings& i_rSettings);

} // namespace CommandLine
