#pragma once

#include "SetupProposal/BodyParts.h"

#include <string>

namespace SetupProposal
{

/// Why a skeleton is no body that stands on two legs, as a sentence's end; empty if it is one. Half a body is one if it
/// has arms or legs on both sides, or names that tell parts.
std::string WhyNoBody(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody);

} // namespace SetupProposal
