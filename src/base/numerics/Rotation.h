#pragma once

#include "numerics/Lanes.h"

#include <array>
#include <cmath>

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

/// sin(a) / a and (1 - cos(a)) / a^2 of an angle, given by its square.
template <typename T>
struct VRodriguesFactors
{
	T m_Sine;
	T m_Cosine;
};

/// Chebyshev fits of degree 10 of both, which are smooth functions of the square, up to a square of c_LargestFitted,
/// half a turn and a little; they err by less than 2e-18.
inline constexpr double c_LargestFitted = 10.0;
inline constexpr VPair c_SineCosineFit[] = {{1.0, 0.5}, {-0.16666666666666663, -0.041666666666666664},
    {0.00833333333333317, 0.001388888888888882}, {-0.00019841269841244403, -2.480158730157663e-05},
    {2.7557319221948757e-06, 2.7557319223131184e-07}, {-2.505210829023197e-08, -2.087675694792642e-09},
    {1.605904106101696e-10, 1.1470744433444433e-11}, {-7.64711170793661e-13, -4.779455516988249e-14},
    {2.810829813582553e-15, 1.5616576932112435e-16}, {-8.173481013686722e-18, -4.0905653264146704e-19},
    {1.755264802987073e-20, 8.051663747841043e-22}};

/// i_Fit(n) is the n-th factor. Estrin's order: half as deep a chain of sums as Horner's.
template <typename TFit>
VPair EvaluateFit(VPair x, TFit i_Fit)
{
	const VPair x2 = x * x;
	const VPair x4 = x2 * x2;
	return ((i_Fit(0) + i_Fit(1) * x) + (i_Fit(2) + i_Fit(3) * x) * x2)
	    + ((i_Fit(4) + i_Fit(5) * x) + (i_Fit(6) + i_Fit(7) * x) * x2) * x4
	    + (i_Fit(8) + i_Fit(9) * x + i_Fit(10) * x2) * (x4 * x4);
}

/// Up to c_LargestFitted without a root, a division or a sine.
inline VRodriguesFactors<double> RodriguesFactors(double i_Square)
{
	if (!(i_Square <= c_LargestFitted))
	{
		const double angle = std::sqrt(i_Square);
		return {std::sin(angle) / angle, (1.0 - std::cos(angle)) / i_Square};
	}
	const VPair both = EvaluateFit(VPair{i_Square, i_Square}, [](int n) { return c_SineCosineFit[n]; });
	return {both[0], both[1]};
}

inline VRodriguesFactors<VLanes> RodriguesFactors(VLanes i_Square)
{
	if (!(i_Square[0] <= c_LargestFitted && i_Square[1] <= c_LargestFitted))
	{
		const auto first = RodriguesFactors(i_Square[0]);
		const auto second = RodriguesFactors(i_Square[1]);
		return {{first.m_Sine, second.m_Sine}, {first.m_Cosine, second.m_Cosine}};
	}
	return {VLanes(EvaluateFit(i_Square.m_Pair, [](int n) { return c_SineCosineFit[n][0]; })),
	    VLanes(EvaluateFit(i_Square.m_Pair, [](int n) { return c_SineCosineFit[n][1]; }))};
}

/// Rodrigues' formula.
template <typename T>
std::array<T, 9> RodriguesMatrix(const std::array<T, 3>& i_rAngleAxis)
{
	const auto [x, y, z] = i_rAngleAxis;
	const T xx = x * x;
	const T yy = y * y;
	const T zz = z * z;
	const auto [sine, cosine] = RodriguesFactors(xx + yy + zz);
	const T xs = sine * x;
	const T ys = sine * y;
	const T zs = sine * z;
	const T xy = cosine * x * y;
	const T xz = cosine * x * z;
	const T yz = cosine * y * z;
	return {1.0 - cosine * (yy + zz), xy - zs, xz + ys, xy + zs, 1.0 - cosine * (xx + zz), yz - xs, xz - ys, yz + xs,
	    1.0 - cosine * (xx + yy)};
}

/// Rodrigues' formula; the identity for angles below c_SmallestAngle.
inline VMatrix3 RotationMatrixFromAngleAxis(const VVector3& i_rAngleAxis)
{
	const auto [x, y, z] = i_rAngleAxis;
	return x * x + y * y + z * z < c_SmallestAngle * c_SmallestAngle ? c_Identity3 : RodriguesMatrix(i_rAngleAxis);
}

/// The same of several frames, T being VLanes.
template <typename T>
std::array<T, 9> RotationMatrixFromAngleAxis(const std::array<T, 3>& i_rAngleAxis)
{
	const auto [x, y, z] = i_rAngleAxis;
	const T square = x * x + y * y + z * z;
	const auto counts = [&](int i_Lane) { return !(square[i_Lane] < c_SmallestAngle * c_SmallestAngle); };
	// An angle of nothing at all is the identity, too.
	const T mask{counts(0) ? 1.0 : 0.0, counts(1) ? 1.0 : 0.0};
	return RodriguesMatrix(std::array<T, 3>{x * mask, y * mask, z * mask});
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
