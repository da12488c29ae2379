#pragma once

#include "SetupProposal/BodyParts.h"

namespace SetupProposal
{

/// How usual a part is beneath another, as a logarithm; helpers between the two do not count. EOther as parent is none.
double UsualBeneath(EBodyPart i_Parent, EBodyPart i_Child);

/// The probabilities of all parts for each joint by what the other voters say of all joints, and by which part is usual
/// beneath which: sums over the tree from its leaves up and from its roots down.
std::vector<VPartScores> LikelyParts(const VRestSkeleton& i_rSkeleton, const std::vector<VPartLogs>& i_rVotes);

} // namespace SetupProposal
