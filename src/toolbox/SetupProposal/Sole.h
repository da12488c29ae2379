#pragma once

#include "SetupProposal/RestSkeleton.h"

#include <optional>

/// What a foot or a toe stands on: the skin that it carries.
namespace SetupProposal
{

/// The height of the lowest point of it, in mm; nothing if it carries none.
std::optional<double> LowestPoint(const VRestJoint& i_rJoint);

/// Turns a joint, in the world, to where it was held against the vertical when its skin was bound: the identity if its
/// sole is as level as it stands. Nothing if it carries too little to stand on.
std::optional<Rotation::VMatrix3> LevelAsBound(const VRestJoint& i_rJoint);

} // namespace SetupProposal
