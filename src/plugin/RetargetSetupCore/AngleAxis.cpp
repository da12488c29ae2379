#include "RetargetSetupCore/AngleAxis.h"

#include <cmath>

namespace RetargetSetup
{

namespace
{

/// How far from orthonormal a matrix of a file may be. A 32-bit number, so that its double is not quite 0.01.
constexpr double c_RotationTolerance = 0.01f;

bool IsRotation(const Rotation::VMatrix3& i_rMatrix)
{
	const Rotation::VMatrix3 product = Rotation::Product(Rotation::Transposed(i_rMatrix), i_rMatrix);
	double squares = 0.0;
	for (std::size_t i = 0; i < product.size(); ++i)
		squares += (product[i] - Rotation::c_Identity3[i]) * (product[i] - Rotation::c_Identity3[i]);
	return squares < c_RotationTolerance && std::abs(Rotation::Determinant(i_rMatrix) - 1.0) < c_RotationTolerance;
}

} // namespace

std::optional<Rotation::VVector3> RotationOf(const Rotation::VMatrix4& i_rMatrix)
{
	Rotation::VMatrix3 rotation;
	for (int column = 0; column < 3; ++column)
	{
		double squares = 0.0;
		for (int row = 0; row < 3; ++row)
			squares += double(i_rMatrix(row, column)) * double(i_rMatrix(row, column));
		const double length = std::sqrt(squares);
		for (int row = 0; row < 3; ++row)
			rotation[3 * row + column] = double(i_rMatrix(row, column)) / length;
	}
	if (!IsRotation(rotation))
		return std::nullopt;
	return Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(rotation));
}

Rotation::VVector3 MatrixToAngleAxis(const Rotation::VMatrix4& i_rMatrix)
{
	return RotationOf(i_rMatrix).value_or(Rotation::VVector3{});
}

Rotation::VMatrix4 AngleAxisToMatrix(const Rotation::VVector3& i_rAngleAxis)
{
	const Rotation::VMatrix3 rotation = Rotation::RotationMatrixFromAngleAxis(i_rAngleAxis);
	Rotation::VMatrix4 matrix;
	for (int row = 0; row < 3; ++row)
		for (int column = 0; column < 3; ++column)
			matrix(row, column) = float(rotation[3 * row + column]);
	return matrix;
}

} // namespace RetargetSetup
