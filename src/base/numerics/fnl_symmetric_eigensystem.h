#pragma once

#include "numerics/Lapack.h"

#include <algorithm>
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

	/// The matrix with each eigenvalue raised to at least this; symmetric to the last bit.
	std::array<double, t_Size * t_Size> WithValuesOfAtLeast(double i_Smallest) const
	{
		std::array<double, t_Size * t_Size> matrix{};
		for (std::size_t row = 0; row < t_Size; ++row)
			for (std::size_t column = 0; column < t_Size; ++column)
				for (std::size_t k = 0; k < t_Size; ++k)
					matrix[row * t_Size + column] += std::max(m_Values[k], i_Smallest)
					    * (m_Vectors[k * t_Size + row] * m_Vectors[k * t_Size + column]);
		return matrix;
	}

private:
	std::array<double, t_Size * t_Size> m_Vectors;
	std::array<double, t_Size> m_Values;
};
