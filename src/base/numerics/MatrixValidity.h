#pragma once

#include <cstddef>
#include <span>

/// What a matrix must be to stand for a covariance. Matrices are square, row by row. One whose entries are all 0 is
/// valid, and so is one of size 0.
namespace MatrixValidity
{

/// Largest absolute difference between an entry and its mirror.
inline constexpr double c_SymmetryTolerance = 1e-12;

/// In the order in which they are looked for.
enum class EFault
{
	ENone,
	ENotFinite,
	ENotSymmetric,
	/// The smallest eigenvalue is too small.
	EEigenvalue
};

/// No eigenvalue may be negative. Allocates nothing.
/// @param i_Matrix t_Size times t_Size values.
template <std::size_t t_Size>
EFault FaultAsSemidefinite(std::span<const double, t_Size * t_Size> i_Matrix);

extern template EFault FaultAsSemidefinite<3>(std::span<const double, 9> i_Matrix);
extern template EFault FaultAsSemidefinite<6>(std::span<const double, 36> i_Matrix);

/// Takes off what rounding does to a valid matrix that is scaled or turned: makes it symmetric, and raises eigenvalues
/// that are below 0 by no more than 1e-12 of the largest. Any other matrix stays as it is.
/// @param io_Matrix t_Size times t_Size values.
template <std::size_t t_Size>
void TakeOffRounding(std::span<double, t_Size * t_Size> io_Matrix);

extern template void TakeOffRounding<2>(std::span<double, 4> io_Matrix);
extern template void TakeOffRounding<3>(std::span<double, 9> io_Matrix);
extern template void TakeOffRounding<6>(std::span<double, 36> io_Matrix);

/// All eigenvalues must be above 0.
/// @param i_Matrix i_Size times i_Size values.
EFault FaultAsDefinite(std::span<const double> i_Matrix, std::size_t i_Size);

} // namespace MatrixValidity
