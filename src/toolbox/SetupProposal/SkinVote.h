#pragma once

#include "SetupProposal/BodyParts.h"

namespace SetupProposal
{

/// How well each part fits what a joint moves of the skin: where in the body that is, however the joint itself stands,
/// and how large; a joint that moves nothing is rather a helper. Nothing speaks for joints of which no skin is known.
std::vector<VPartLogs> VoteBySkin(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame);

} // namespace SetupProposal
