#pragma once

namespace CommandLine
{

/// From here on a signal that asks the process to end (INT, TERM, HUP) removes the files of saves on their way, and
/// then ends it as before. One that is ignored stays so.
void LeaveNothingOnSignals();

} // namespace CommandLine
