#pragma once

namespace StudioHost
{

/// Makes panels draw without OpenGL where the display has none, which is told in the log: all of them work then but for
/// the preview. Where the processor draws, text cursors do not blink. After the application was made, before the first
/// panel.
/// @return true if there is OpenGL.
bool CheckOpenGL();

} // namespace StudioHost
