#pragma once

#include "retarget/subject/Session.h"

#include "SetupIO/Setup.h"

#include <string>
#include <vector>

namespace CommandLine
{

/// What of a recipe's checks does not hold of the session's target subject, a sentence each. Checks that need the
/// performer throw VCommandError with EWrongUsage without one.
std::vector<std::string> BrokenChecks(VSession& io_rSession, const SetupIO::VChecks& i_rChecks);

} // namespace CommandLine
