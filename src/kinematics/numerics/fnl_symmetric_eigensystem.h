#pragma once

#include "numerics/Lapack.h"

#include <array>
#include <cmath>
#include <limits>
#include <vector>

/// Tells on the standard error stream of a decomposition that went wrong.
void fnl_symmetric_eigensystem_report(int i_Error);

/// Eigenvalues in ascending order and eigenvectors, row by row, of a symmetric matrix of any size, row by row, of which
/// only the upper triangle is read. A matrix that is not finite, or a size that is not that of a square matrix, is
/// reported and gives values of NaN.
/// @return whether it went well.
bool fnl_symmetric_eigensystem_compute(
    std::vector<double> i_Matrix, std::vector<double>& o_rVectors, std::vector<double>& o_rValues);

/// The same of a small matrix. Allocates nothing.
template <std::size_t t_Size>
class fnl_symmetric_eigensystem
{
public:
	explicit fnl_symmetric_eigensystem(const std::array<double, t_Size * t_Size>& i_rMatrix) : m_Vectors(i_rMatrix)
	{
		std::array<double, 3 * t_Size> work;
		const int error = Lapack::Dsyev(t_Size, m_Vectors.data(), m_Values.data(), work.data(), work.size());
		if (error < 0)
			m_Values.fill(std::numeric_limits<double>::quiet_NaN());
		if (error != 0)
			fnl_symmetric_eigensystem_report(error);
	}

	/// In ascending order.
	const std::array<double, t_Size>& Values() const { return m_Values; }
	/// One eigenvector of length 1 in each row, in the order of the values.
	const std::array<double, t_Size * t_Size>& Vectors() const { return m_Vectors; }

private:
	std::array<double, t_Size * t_Size> m_Vectors;
	std::array<double, t_Size> m_Values;
};
