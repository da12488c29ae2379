#pragma once

namespace CommandLine
{

/// Scripts for the shells, which ask the program itself what may stand at the cursor.
const char* BashCompletion();
const char* ZshCompletion();
const char* FishCompletion();

} // namespace CommandLine
