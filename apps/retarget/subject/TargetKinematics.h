#pragma once

#include "ComputeSubjectFK/SegmentFKInterfaces.h"
#include "CoreOrlexTypes/Subject.h"

namespace ComputeSubject
{
class ITargetFK;
}

namespace CommandLine
{

/// The segments of a subject; empty if they make no tree, or have a joint without kinematics.
ComputeSubject::VSegmentTree SegmentKinematics(const CoreOrlexTypes::VSubject& i_rSubject);

/// Null for a target of a type that has no kinematics, or that does not fit its type.
std::shared_ptr<ComputeSubject::ITargetFK> TargetKinematics(
    const CoreOrlexTypes::VSubject::VTarget& i_rTarget, const ComputeSubject::VSegmentTree& i_rTree);

} // namespace CommandLine
