#pragma once

#include "numerics/Rotation.h"

#include <pybind11/numpy.h>

#include <vector>

namespace CommandLine::Python
{

/// Rows of doubles one after the other, made from whatever Python gives.
using VNumbers = pybind11::array_t<double, pybind11::array::c_style | pybind11::array::forcecast>;

inline VNumbers ToArray(const std::vector<double>& i_rValues)
{
	return VNumbers(pybind11::ssize_t(i_rValues.size()), i_rValues.data());
}

/// Writes the 16 numbers of a pose, row by row, and goes behind them.
inline void WriteMatrix(const Rotation::VPose<double>& i_rPose, double*& io_rpOut)
{
	for (std::size_t row = 0; row < 3; ++row)
	{
		for (std::size_t column = 0; column < 3; ++column)
			*io_rpOut++ = i_rPose.R[3 * row + column];
		*io_rpOut++ = i_rPose.t[row];
	}
	for (const double value : {0.0, 0.0, 0.0, 1.0})
		*io_rpOut++ = value;
}

} // namespace CommandLine::Python
