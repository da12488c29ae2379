#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "numerics/Rotation.h"

#include <span>
#include <vector>

namespace TakeSolve
{

/// The same subject with each segment on a free joint, so that states can bring it to any world poses: what shows a
/// performer who moves by a take, which his own joints may not follow.
CoreOrlexTypes::VSubject WithFreeJoints(CoreOrlexTypes::VSubject i_Subject);

/// The states that bring such a subject to these world poses, in the order of the segments.
/// @param i_World a pose for each segment.
void FreeStates(const CoreOrlexTypes::VSubject& i_rFree, std::span<const Rotation::VPose<double>> i_World,
    std::vector<double>& o_rStates);

} // namespace TakeSolve
