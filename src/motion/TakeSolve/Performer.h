#pragma once

#include "CoreOrlexTypes/SubjectRecord.h"
#include "TakeIO/Take.h"
#include "TakeSolve/Finding.h"
#include "TakeSolve/StandingPose.h"

#include <string>
#include <vector>

namespace TakeSolve
{

/// A performer's skeleton with a segment for each joint of a take, in mm with Z up. The root joint is free, the others
/// are balls that are at zero in the take's rest pose; one without channels and without length is fixed. Markers stand
/// at the joints and at the ends of bones, with a stick for each bone. Names are those of the joints without a
/// namespace; one that stands there twice gets a number.
/// A pose that reaches below the floor is raised onto it. Of several trees the one with the most joints is taken, and
/// the others are told. Without joints the subject has no segments.
/// @param i_rPose of this take; the bind pose.
CoreOrlexTypes::VSubjectRecord MakePerformer(const TakeIO::VTake& i_rTake, const VStandingPose& i_rPose,
    const std::string& i_rName, std::vector<VFinding>& o_rFindings);

} // namespace TakeSolve
