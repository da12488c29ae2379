#pragma once

#include "numerics/Rotation.h"

#include <algorithm>
#include <cmath>

namespace TakeSolve
{

using Rotation::c_Degrees;
using Rotation::VMatrix3;
using Rotation::VVector3;
using VWorldPose = Rotation::VPose<double>;

inline VVector3 Difference(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]};
}

inline VVector3 Sum(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[0] + i_rB[0], i_rA[1] + i_rB[1], i_rA[2] + i_rB[2]};
}

inline double Length(const VVector3& i_rVector)
{
	return std::hypot(i_rVector[0], i_rVector[1], i_rVector[2]);
}

inline double Dot(const VVector3& i_rA, const VVector3& i_rB)
{
	return i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2];
}

inline VVector3 CrossProduct(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[1] * i_rB[2] - i_rA[2] * i_rB[1], i_rA[2] * i_rB[0] - i_rA[0] * i_rB[2],
	    i_rA[0] * i_rB[1] - i_rA[1] * i_rB[0]};
}

/// In radians; 0 if one of them has no length.
inline double AngleBetween(const VVector3& i_rA, const VVector3& i_rB)
{
	return std::atan2(Length(CrossProduct(i_rA, i_rB)), Dot(i_rA, i_rB));
}

/// In radians, the shorter way.
inline double AngleBetween(const VMatrix3& i_rA, const VMatrix3& i_rB)
{
	return Length(Rotation::CanonicalAngleAxis(
	    Rotation::AngleAxisFromRotationMatrix(Rotation::Product(Rotation::Transposed(i_rA), i_rB))));
}

/// Turns the first direction onto the second; of opposite ones about any axis across.
inline VMatrix3 ShortestArc(const VVector3& i_rFrom, const VVector3& i_rTo)
{
	VVector3 axis = CrossProduct(i_rFrom, i_rTo);
	double length = Length(axis);
	const double angle = std::atan2(length, Dot(i_rFrom, i_rTo));
	if (!(length > 1e-12 * Length(i_rFrom) * Length(i_rTo)))
	{
		if (!(angle > 1.0))
			return Rotation::c_Identity3;
		const std::size_t least = std::size_t(
		    std::ranges::min_element(i_rFrom, {}, [](double i_Value) { return std::abs(i_Value); }) - i_rFrom.begin());
		VVector3 across{};
		across[least] = 1.0;
		axis = CrossProduct(i_rFrom, across);
		length = Length(axis);
	}
	return Rotation::RotationMatrixFromAngleAxis(
	    {angle / length * axis[0], angle / length * axis[1], angle / length * axis[2]});
}

} // namespace TakeSolve
