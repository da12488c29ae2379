#pragma once

#include "SetupProposal/BodyParts.h"

namespace SetupProposal
{

/// How well each part fits each joint by height, distance from the mirror plane, and direction and length of its bone,
/// which goes to the child that most joints hang on. Never below c_WorstVote in all.
std::vector<VPartLogs> VoteByRestPose(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame);

} // namespace SetupProposal
