#pragma once

#include "TakeIO/Take.h"

namespace TakeIO
{

/// An axis of a file as one of ours.
struct VAxis
{
	int m_Axis;
	double m_Sign;
};

/// x is x; of a file with Y up y is our z, and z our -y.
constexpr VAxis AxisFromFile(EUp i_Up, int i_Axis)
{
	return i_Up == EUp::Z || i_Axis == 0 ? VAxis{i_Axis, 1.0} : i_Axis == 1 ? VAxis{2, 1.0} : VAxis{1, -1.0};
}

constexpr VAxis AxisToFile(EUp i_Up, int i_Axis)
{
	return i_Up == EUp::Z || i_Axis == 0 ? VAxis{i_Axis, 1.0} : i_Axis == 2 ? VAxis{1, 1.0} : VAxis{2, -1.0};
}

/// i_Map is one of the two above.
template <typename TMap>
Rotation::VVector3 MapVector(TMap i_Map, EUp i_Up, double i_Factor, const Rotation::VVector3& i_rVector)
{
	Rotation::VVector3 mapped{};
	for (int i = 0; i < 3; ++i)
	{
		const VAxis axis = i_Map(i_Up, i);
		// A zero stays one without a sign.
		mapped[axis.m_Axis] = axis.m_Sign * i_Factor * i_rVector[i] + 0.0;
	}
	return mapped;
}

} // namespace TakeIO
