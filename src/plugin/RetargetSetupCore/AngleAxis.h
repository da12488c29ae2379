#pragma once

#include "numerics/Matrix4.h"
#include "numerics/Rotation.h"

#include <optional>

namespace RetargetSetup
{

/// The rotation of a transform as a vector along the axis, of the angle's length in radians, at most pi. Scale is taken
/// out first by normalising the three columns. Nothing if what is left is no rotation: a mirror, a shear, a column of
/// zeros, a value that is not finite.
std::optional<Rotation::VVector3> RotationOf(const Rotation::VMatrix4& i_rMatrix);

/// As RotationOf, with (0, 0, 0) for what is no rotation.
Rotation::VVector3 MatrixToAngleAxis(const Rotation::VMatrix4& i_rMatrix);

/// The rotation of angle |r| about r, without a translation.
Rotation::VMatrix4 AngleAxisToMatrix(const Rotation::VVector3& i_rAngleAxis);

} // namespace RetargetSetup
