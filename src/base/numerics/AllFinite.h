#pragma once

#include <algorithm>
#include <cmath>
#include <span>

/// False if a value is infinite or not a number.
inline bool AllFinite(std::span<const double> i_Values)
{
	return std::all_of(i_Values.begin(), i_Values.end(), [](double i_Value) { return std::isfinite(i_Value); });
}
