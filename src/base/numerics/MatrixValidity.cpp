#include "numerics/MatrixValidity.h"

#include "numerics/AllFinite.h"
#include "numerics/Lapack.h"
#include "numerics/fnl_symmetric_eigensystem.h"

#include <algorithm>
#include <cmath>

namespace MatrixValidity
{
namespace
{

bool IsZero(std::span<const double> i_Matrix)
{
	return std::ranges::all_of(i_Matrix, [](double i_Value) { return i_Value == 0.0; });
}

/// Where LAPACK is missing, which is told once, no matrix is to blame.
bool HasKnownEigenvalues(std::span<const double> i_Matrix)
{
	return !IsZero(i_Matrix) && Lapack::IsLoaded();
}

/// What must hold before the eigenvalues are asked for.
EFault FaultOfEntries(std::span<const double> i_Matrix, std::size_t i_Size)
{
	if (!AllFinite(i_Matrix))
		return EFault::ENotFinite;
	for (std::size_t row = 0; row < i_Size; ++row)
		for (std::size_t column = 0; column < row; ++column)
			if (!(std::abs(i_Matrix[row * i_Size + column] - i_Matrix[column * i_Size + row]) <= c_SymmetryTolerance))
				return EFault::ENotSymmetric;
	return EFault::ENone;
}

template <std::size_t t_Size>
double SmallestEigenvalue(std::span<const double> i_Matrix)
{
	std::array<double, t_Size * t_Size> matrix;
	std::ranges::copy(i_Matrix, matrix.begin());
	return fnl_symmetric_eigensystem<t_Size>(matrix).Values().front();
}

/// The sizes of joints take the form for small matrices, which is twice as fast.
double SmallestEigenvalue(std::span<const double> i_Matrix, std::size_t i_Size)
{
	switch (i_Size)
	{
	case 1: return SmallestEigenvalue<1>(i_Matrix);
	case 2: return SmallestEigenvalue<2>(i_Matrix);
	case 3: return SmallestEigenvalue<3>(i_Matrix);
	case 6: return SmallestEigenvalue<6>(i_Matrix);
	default: break;
	}
	std::vector<double> vectors;
	std::vector<double> values;
	fnl_symmetric_eigensystem_compute({i_Matrix.begin(), i_Matrix.end()}, vectors, values);
	return values.front();
}

} // namespace

// The comparisons with 0 are written so that NaN fails.

template <std::size_t t_Size>
EFault FaultAsSemidefinite(std::span<const double, t_Size * t_Size> i_Matrix)
{
	const EFault fault = FaultOfEntries(i_Matrix, t_Size);
	if (fault != EFault::ENone || !HasKnownEigenvalues(i_Matrix))
		return fault;
	return SmallestEigenvalue<t_Size>(i_Matrix) >= 0.0 ? EFault::ENone : EFault::EEigenvalue;
}

template EFault FaultAsSemidefinite<3>(std::span<const double, 9> i_Matrix);
template EFault FaultAsSemidefinite<6>(std::span<const double, 36> i_Matrix);

template <std::size_t t_Size>
void TakeOffRounding(std::span<double, t_Size * t_Size> io_Matrix)
{
	// Of the largest eigenvalue: what may have been lost, and what is far enough from 0 not to be lost again.
	constexpr double c_Rounding = 1e-12;
	constexpr double c_Raised = 1e-14;
	if (!AllFinite(io_Matrix) || IsZero(io_Matrix))
		return;
	std::array<double, t_Size * t_Size> matrix;
	for (std::size_t row = 0; row < t_Size; ++row)
		for (std::size_t column = 0; column < t_Size; ++column)
			matrix[row * t_Size + column] = 0.5 * (io_Matrix[row * t_Size + column] + io_Matrix[column * t_Size + row]);
	const fnl_symmetric_eigensystem<t_Size> eigen(matrix);
	const double largest = eigen.Values().back();
	if (eigen.Values().front() < 0.0 && eigen.Values().front() >= -c_Rounding * largest)
		matrix = eigen.WithValuesOfAtLeast(c_Raised * largest);
	std::ranges::copy(matrix, io_Matrix.begin());
}

template void TakeOffRounding<2>(std::span<double, 4> io_Matrix);
template void TakeOffRounding<3>(std::span<double, 9> io_Matrix);
template void TakeOffRounding<6>(std::span<double, 36> io_Matrix);

EFault FaultAsDefinite(std::span<const double> i_Matrix, std::size_t i_Size)
{
	const EFault fault = FaultOfEntries(i_Matrix, i_Size);
	if (fault != EFault::ENone || !HasKnownEigenvalues(i_Matrix))
		return fault;
	return SmallestEigenvalue(i_Matrix, i_Size) > 0.0 ? EFault::ENone : EFault::EEigenvalue;
}

} // namespace MatrixValidity
