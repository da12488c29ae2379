#pragma once

#include "numerics/Lapack.h"

#include <algorithm>
#include <array>
#include <limits>

/// Tells on the standard error stream, in a form that can be pasted, of a decomposition that went wrong.
void fnl_svd_report(int i_Info, const double* i_pM, std::size_t i_Rows, std::size_t i_Columns);

/// Singular value decomposition M = U diag(W) Vt of a small matrix, row by row. Allocates nothing. A matrix that is not
/// finite is reported and gives factors of NaN.
template <std::size_t t_Rows, std::size_t t_Columns>
class fnl_svd_fixed
{
public:
	static constexpr std::size_t c_Smaller = std::min(t_Rows, t_Columns);

	explicit fnl_svd_fixed(const std::array<double, t_Rows * t_Columns>& i_rM)
	{
		m_W.fill(std::numeric_limits<double>::quiet_NaN());
		m_U.fill(std::numeric_limits<double>::quiet_NaN());
		m_Vt.fill(std::numeric_limits<double>::quiet_NaN());
		std::array<double, t_Rows* t_Columns> matrix = i_rM;
		std::array<double, Lapack::DgesvdWork(t_Rows, t_Columns)> work;
		const int info = Lapack::Dgesvd(
		    t_Rows, t_Columns, matrix.data(), m_W.data(), m_U.data(), m_Vt.data(), work.data(), work.size());
		if (info != 0)
			fnl_svd_report(info, i_rM.data(), t_Rows, t_Columns);
	}

	/// t_Rows x c_Smaller.
	const std::array<double, t_Rows * c_Smaller>& U() const { return m_U; }
	/// In descending order.
	const std::array<double, c_Smaller>& W() const { return m_W; }
	/// c_Smaller x t_Columns.
	const std::array<double, c_Smaller * t_Columns>& Vt() const { return m_Vt; }

	/// The pseudo-inverse, t_Columns x t_Rows: singular values up to the threshold count as 0.
	std::array<double, t_Columns * t_Rows> Inverse(double i_Threshold) const
	{
		std::array<double, t_Columns * t_Rows> inverse{};
		for (std::size_t k = 0; k < c_Smaller; ++k)
			if (!(m_W[k] <= i_Threshold))
				for (std::size_t row = 0; row < t_Columns; ++row)
					for (std::size_t column = 0; column < t_Rows; ++column)
						inverse[row * t_Rows + column] +=
						    m_Vt[k * t_Columns + row] / m_W[k] * m_U[column * c_Smaller + k];
		return inverse;
	}

private:
	std::array<double, t_Rows * c_Smaller> m_U;
	std::array<double, c_Smaller> m_W;
	std::array<double, c_Smaller * t_Columns> m_Vt;
};
