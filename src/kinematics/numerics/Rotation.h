#pragma once

#include <array>

/// Rotations are 3x3 matrices, row by row, or angle-axis vectors: direction the axis, length the angle in radians.
namespace Rotation
{

using VVector3 = std::array<double, 3>;
using VMatrix3 = std::array<double, 9>;

inline constexpr VMatrix3 c_Identity3{1, 0, 0, 0, 1, 0, 0, 0, 1};

/// Angles below ten times the machine epsilon count as no rotation.
inline constexpr double c_SmallestAngle = 2.220446049250313e-15;

/// A rigid motion x -> R x + t, translations in millimetres.
template <typename T>
struct VPose
{
	std::array<T, 9> R{1, 0, 0, 0, 1, 0, 0, 0, 1};
	std::array<T, 3> t{};
};

/// First b, then a: rotation a.R b.R, translation a.R b.t + a.t.
VPose<double> Compose(const VPose<double>& i_rA, const VPose<double>& i_rB);

/// The inverse of a composed with b: rotation a.R' b.R, translation a.R' (b.t - a.t).
VPose<double> Relative(const VPose<double>& i_rA, const VPose<double>& i_rB);

VPose<double> Inverse(const VPose<double>& i_rPose);

VPose<double> PoseFromAngleAxis(const VVector3& i_rRotation, const VVector3& i_rTranslation);

/// R x + t.
VVector3 Apply(const VPose<double>& i_rPose, const VVector3& i_rPoint);

VMatrix3 Product(const VMatrix3& i_rA, const VMatrix3& i_rB);
VMatrix3 Transposed(const VMatrix3& i_rMatrix);
VVector3 Product(const VMatrix3& i_rA, const VVector3& i_rVector);
double Determinant(const VMatrix3& i_rMatrix);

/// Rodrigues' formula; the identity for angles below c_SmallestAngle.
VMatrix3 RotationMatrixFromAngleAxis(const VVector3& i_rAngleAxis);

/// Through the unit quaternion (x, y, z, w): (x, y, z) 2 atan2(s, w) / s with s the length of (x, y, z), or (x, y, z)
/// itself where s is below c_SmallestAngle. The matrix is taken as a rotation without a test.
VVector3 AngleAxisFromRotationMatrix(const VMatrix3& i_rRotation);

/// The same rotation with an angle of at most pi: a length l above pi is scaled by (l - 2 pi round(l / 2 pi)) / l.
VVector3 CanonicalAngleAxis(const VVector3& i_rAngleAxis);

} // namespace Rotation
