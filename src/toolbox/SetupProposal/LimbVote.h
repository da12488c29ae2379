#pragma once

#include "SetupProposal/BodyParts.h"

namespace SetupProposal
{

/// What speaks against each part by the limbs of the tree. A pair of twins that hangs on the trunk is a pair of legs if
/// it reaches the floor, one of arms if it is long, else neither; the trunk goes from the root to the legs, from there
/// to the arms and on to the head. Nothing without twins.
std::vector<VPartLogs> VoteByLimbs(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame);

} // namespace SetupProposal
