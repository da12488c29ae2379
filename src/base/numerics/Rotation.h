#pragma once

#include <array>
#include <cmath>
#include <numbers>

/// Rotations are 3x3 matrices, row by row, or angle-axis vectors: direction the axis, length the angle in radians.
namespace Rotation
{

using VVector3 = std::array<double, 3>;
using VMatrix3 = std::array<double, 9>;

inline constexpr VMatrix3 c_Identity3{1, 0, 0, 0, 1, 0, 0, 0, 1};

/// Of a radian.
inline constexpr double c_Degrees = 180.0 / std::numbers::pi;

/// Angles below ten times the machine epsilon count as no rotation.
inline constexpr double c_SmallestAngle = 2.220446049250313e-15;

/// A rigid motion x -> R x + t, translations in millimetres.
template <typename T>
struct VPose
{
	std::array<T, 9> R{1, 0, 0, 0, 1, 0, 0, 0, 1};
	std::array<T, 3> t{};
};

inline VMatrix3 Product(const VMatrix3& i_rA, const VMatrix3& i_rB)
{
	VMatrix3 result;
	for (int row = 0; row < 3; ++row)
		for (int column = 0; column < 3; ++column)
			result[3 * row + column] = i_rA[3 * row] * i_rB[column] + i_rA[3 * row + 1] * i_rB[3 + column]
			    + i_rA[3 * row + 2] * i_rB[6 + column];
	return result;
}

inline VVector3 Product(const VMatrix3& i_rA, const VVector3& i_rVector)
{
	const auto [x, y, z] = i_rVector;
	return {i_rA[0] * x + i_rA[1] * y + i_rA[2] * z, i_rA[3] * x + i_rA[4] * y + i_rA[5] * z,
	    i_rA[6] * x + i_rA[7] * y + i_rA[8] * z};
}

VMatrix3 Transposed(const VMatrix3& i_rMatrix);
double Determinant(const VMatrix3& i_rMatrix);

/// R x + t.
inline VVector3 Apply(const VPose<double>& i_rPose, const VVector3& i_rPoint)
{
	const VVector3 turned = Product(i_rPose.R, i_rPoint);
	return {turned[0] + i_rPose.t[0], turned[1] + i_rPose.t[1], turned[2] + i_rPose.t[2]};
}

/// First b, then a: rotation a.R b.R, translation a.R b.t + a.t.
VPose<double> Compose(const VPose<double>& i_rA, const VPose<double>& i_rB);

/// The inverse of a composed with b: rotation a.R' b.R, translation a.R' (b.t - a.t).
VPose<double> Relative(const VPose<double>& i_rA, const VPose<double>& i_rB);

VPose<double> Inverse(const VPose<double>& i_rPose);

/// Rodrigues' formula; the identity for angles below c_SmallestAngle.
inline VMatrix3 RotationMatrixFromAngleAxis(const VVector3& i_rAngleAxis)
{
	const auto [vx, vy, vz] = i_rAngleAxis;
	const double angle = std::sqrt(vx * vx + vy * vy + vz * vz);
	if (angle < c_SmallestAngle)
		return c_Identity3;
	const double c = std::cos(angle);
	const double s = std::sin(angle);
	const double C = 1.0 - c;
	const double x = vx / angle;
	const double y = vy / angle;
	const double z = vz / angle;
	return {C * x * x + c, C * x * y - s * z, C * x * z + s * y, C * y * x + s * z, C * y * y + c, C * y * z - s * x,
	    C * z * x - s * y, C * z * y + s * x, C * z * z + c};
}

VPose<double> PoseFromAngleAxis(const VVector3& i_rRotation, const VVector3& i_rTranslation);

/// Through the unit quaternion (x, y, z, w): (x, y, z) 2 atan2(s, w) / s with s the length of (x, y, z), or (x, y, z)
/// itself where s is below c_SmallestAngle. The matrix is taken as a rotation without a test.
VVector3 AngleAxisFromRotationMatrix(const VMatrix3& i_rRotation);

/// True if every entry of R' R minus the identity, and the determinant minus 1, are within the tolerance; NaN is not.
bool IsRotationMatrix(const VMatrix3& i_rMatrix, double i_Tolerance);

/// Orders of Euler angles: ABC is the rotation R_A(first) R_B(second) R_C(third). The values are the three axes as
/// digits to base 4.
enum EEulerOrder : int
{
	EXYZ = 6,
	EXZY = 9,
	EYXZ = 18,
	EYZX = 24,
	EZXY = 33,
	EZYX = 36
};

/// The angles in radians in the sequence of the order, the second within a quarter turn of 0. Where that is a quarter
/// turn, so that the outer axes coincide, the first angle is 0.
void EulerFromRotationMatrix(const VMatrix3& i_rRotation, EEulerOrder i_Order, VVector3& o_rAngles);

VMatrix3 RotationMatrixFromEuler(const VVector3& i_rAngles, EEulerOrder i_Order);

/// The same rotation with an angle of at most pi: a length l above pi is scaled by (l - 2 pi round(l / 2 pi)) / l.
VVector3 CanonicalAngleAxis(const VVector3& i_rAngleAxis);

} // namespace Rotation
