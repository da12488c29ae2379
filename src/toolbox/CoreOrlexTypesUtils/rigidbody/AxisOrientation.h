#pragma once

#include "numerics/Rotation.h"

#include <cstddef>

namespace CoreOrlexTypesUtils
{

/// The rotation, as an angle-axis vector in radians, whose matrix has the direction a as the column i_FirstDesiredAxis,
/// what of b is orthogonal to a as the column i_SecondDesiredAxis, and the third column so that the determinant is 1.
/// The axes are 0, 1 or 2 and differ: anything else is a failed assertion and gives no rotation, and so do directions
/// of no length or of the same line.
Rotation::VVector3 TwoAxisOrientation(const Rotation::VVector3& i_rA, const Rotation::VVector3& i_rB,
    std::size_t i_FirstDesiredAxis, std::size_t i_SecondDesiredAxis);

/// As TwoAxisOrientation with a second direction of its own choice, orthogonal to the unit vector a, as the next axis.
Rotation::VVector3 SingleAxisOrientation(const Rotation::VVector3& i_rA, std::size_t i_FirstDesiredAxis);

} // namespace CoreOrlexTypesUtils
