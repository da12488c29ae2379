#pragma once

namespace StudioHost
{

/// The program: parses the command line, shows the window, and returns the exit status.
int Run(int i_Count, char** i_ppArguments);

} // namespace StudioHost
