#pragma once

#include "numerics/Rotation.h"

namespace ComputeSubject
{

/// Of the angle-axis vectors along one axis that are the same rotation, the one nearest to the previous state, so that
/// a moving joint does not jump by a turn. A previous state of length up to 1e-5 counts as none: the result then turns
/// by at most half a turn. The zero rotation takes the direction of the previous state.
Rotation::VVector3 NearestRevolution(const Rotation::VVector3& i_rState, const Rotation::VVector3& i_rPrevious);

} // namespace ComputeSubject
