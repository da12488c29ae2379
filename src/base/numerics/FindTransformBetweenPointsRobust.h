#pragma once

#include "numerics/Rotation.h"

#include <vector>

/// Finds the pose that maps the points 1 onto the points 2 although up to nearly half of the pairs may be wrong: least
/// median of squares over poses from triples of pairs, then a least-squares fit over the pairs that agree with the best
/// (P. J. Rousseeuw, A. M. Leroy, "Robust Regression and Outlier Detection", 1987). The same input gives the same pose.
/// The least median is logged in detail, category "System".
/// @return false, with the pose untouched, for lists of different sizes, for fewer than three pairs, and where no
/// triple spans a triangle.
bool FindTransformBetweenPointsRobust(const std::vector<Rotation::VVector3>& a_rPoints1,
    const std::vector<Rotation::VVector3>& a_rPoints2, Rotation::VPose<double>& o_rPose);
