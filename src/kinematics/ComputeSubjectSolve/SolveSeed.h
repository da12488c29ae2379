#pragma once

#include "ComputeSubjectSolve/SolveLinks.h"
#include "ComputeSubjectSolve/TargetTerms.h"

#include <vector>

namespace ComputeSubject
{

/// A start without a frame before: from the root on, each joint is brought to where the targets below it come nearest
/// to their observations, as if nothing else moved.
/// @param i_ShareOfFurther what a target counts for each joint between it and the one that is brought there: those may
/// do it, too.
/// @param io_rStates the bind pose, where joints stay as far as nothing below tells of them.
void Seed(const VObservations& i_rObservations, const std::vector<VSolvedTarget>& i_rTargets, double i_ShareOfFurther,
    VComputeSubjectFK& io_rKinematics, VSolveLinks& io_rLinks, std::vector<double>& io_rStates);

} // namespace ComputeSubject
