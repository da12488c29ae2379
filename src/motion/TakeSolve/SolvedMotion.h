#pragma once

#include "TakeIO/Take.h"
#include "TakeSolve/TakeSolve.h"

#include <span>

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace TakeSolve
{

/// A solved character as a take: a joint for each segment, at rest as in the bind pose, with the frames' poses from
/// there to the segment above as channels: place and angles about Z, Y and X of the root and of joints that move along,
/// angles alone of the others that move.
/// Throws ComputeSubject::VConstructionException for a joint of a type that has no class.
/// @param i_BindPose as for the solve.
TakeIO::VTake MotionOf(const CoreOrlexTypes::VSubject& i_rTarget, std::span<const double> i_BindPose,
    const VSolvedTake& i_rSolved, double i_Rate);

} // namespace TakeSolve
