#pragma once

#include "CoreOrlexTypes/Subject.h"

#include "numerics/Rotation.h"

#include <vector>

namespace CoreOrlexTypesUtils
{

/// For each segment the pose that carries the points of its targets into the world, with every joint in its Mean; a
/// mean that is shorter than its joint's size counts as zeros for what is missing.
/// For both subject types, TSubject. False for a subject that gives no kinematics (told, category "RigidBodyUtils").
template <typename TSubject>
bool ComputeTargetFrames(const TSubject& i_rSubject, std::vector<Rotation::VPose<double>>& o_rFrames);

} // namespace CoreOrlexTypesUtils
