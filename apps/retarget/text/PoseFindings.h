#pragma once

#include "retarget/text/Output.h"

#include "SetupProposal/PoseCheck.h"

#include <string>
#include <vector>

namespace CommandLine
{

VJson PoseJson(const std::vector<SetupProposal::VPoseFinding>& i_rFindings);

/// With a heading and lines of their own for the options that mend what is not fine; empty for none.
std::string PoseText(const std::vector<SetupProposal::VPoseFinding>& i_rFindings);

} // namespace CommandLine
