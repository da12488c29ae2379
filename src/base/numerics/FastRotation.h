#pragma once

#include "numerics/Lanes.h"
#include "numerics/Rotation.h"

namespace Rotation
{

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

/// Whether the fits tell them.
inline bool IsFitted(double i_Square)
{
	return i_Square >= c_SmallestAngle * c_SmallestAngle && i_Square <= c_LargestFitted;
}

/// Of other angles: both 0 below c_SmallestAngle. Rare, and kept out of the code that calls it.
[[gnu::noinline]] inline VRodriguesFactors<double> UnfittedFactors(double i_Square)
{
	if (i_Square < c_SmallestAngle * c_SmallestAngle)
		return {0.0, 0.0};
	const double angle = std::sqrt(i_Square);
	return {std::sin(angle) / angle, (1.0 - std::cos(angle)) / i_Square};
}

/// Up to c_LargestFitted without a root, a division or a sine.
inline VRodriguesFactors<double> RodriguesFactors(double i_Square)
{
	if (!IsFitted(i_Square))
		return UnfittedFactors(i_Square);
	const VPair both = EvaluateFit(VPair{i_Square, i_Square}, [](int n) { return c_SineCosineFit[n]; });
	return {both[0], both[1]};
}

inline VRodriguesFactors<VLanes> RodriguesFactors(VLanes i_Square)
{
	if (!IsFitted(i_Square[0]) || !IsFitted(i_Square[1]))
	{
		const auto first = RodriguesFactors(i_Square[0]);
		const auto second = RodriguesFactors(i_Square[1]);
		return {{first.m_Sine, second.m_Sine}, {first.m_Cosine, second.m_Cosine}};
	}
	return {VLanes(EvaluateFit(i_Square.m_Pair, [](int n) { return c_SineCosineFit[n][0]; })),
	    VLanes(EvaluateFit(i_Square.m_Pair, [](int n) { return c_SineCosineFit[n][1]; }))};
}

/// Rodrigues' formula by those factors, for one frame (T is double) or two (VLanes): for what is computed for each
/// frame. Entries are within 5e-16 of RotationMatrixFromAngleAxis, but not the same bits: where two axes tie, what is
/// made of the matrix may fall on the other side. The identity for angles below c_SmallestAngle.
template <typename T>
std::array<T, 9> FastRotationMatrix(const std::array<T, 3>& i_rAngleAxis)
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

} // namespace Rotation
