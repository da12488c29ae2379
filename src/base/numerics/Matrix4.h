#pragma once

#include <array>
#include <cmath>

namespace Rotation
{

/// A transform of points as column vectors in single precision, with its translation in column 3; the identity at
/// first. It is kept row by row.
class VMatrix4
{
public:
	constexpr float& operator()(int i_Row, int i_Column) { return m_Values[4 * i_Row + i_Column]; }
	constexpr float operator()(int i_Row, int i_Column) const { return m_Values[4 * i_Row + i_Column]; }

	/// Sixteen values, row by row.
	const float* data() const { return m_Values.data(); }

	bool operator==(const VMatrix4&) const = default;

	/// First b, then a.
	friend constexpr VMatrix4 operator*(const VMatrix4& i_rA, const VMatrix4& i_rB)
	{
		VMatrix4 product;
		for (int row = 0; row < 4; ++row)
			for (int column = 0; column < 4; ++column)
				product(row, column) = i_rA(row, 0) * i_rB(0, column) + i_rA(row, 1) * i_rB(1, column)
				    + i_rA(row, 2) * i_rB(2, column) + i_rA(row, 3) * i_rB(3, column);
		return product;
	}

	/// Where a direction points to: without the translation.
	std::array<float, 3> MapVector(const std::array<float, 3>& i_rVector) const
	{
		std::array<float, 3> mapped;
		for (int row = 0; row < 3; ++row)
			mapped[row] =
			    (*this)(row, 0) * i_rVector[0] + (*this)(row, 1) * i_rVector[1] + (*this)(row, 2) * i_rVector[2];
		return mapped;
	}

	/// Where a point goes. The last row is taken for 0, 0, 0, 1.
	std::array<float, 3> Map(const std::array<float, 3>& i_rPoint) const
	{
		std::array<float, 3> mapped = MapVector(i_rPoint);
		for (int row = 0; row < 3; ++row)
			mapped[row] += (*this)(row, 3);
		return mapped;
	}

	/// Where the origin goes.
	std::array<float, 3> Translation() const { return {m_Values[3], m_Values[7], m_Values[11]}; }

private:
	std::array<float, 16> m_Values{1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
};

} // namespace Rotation
