#include "fbxsdk/scene/Affine.h"

#include <cmath>
#include <numbers>

namespace
{

using namespace Rotation;

/// The rotation about axis 0, 1 or 2, times the matrix: a turn of two of its rows.
void TurnRows(VMatrix3& io_rMatrix, int i_Axis, double i_Degrees)
{
	const double angle = i_Degrees * (std::numbers::pi / 180.0);
	const double c = std::cos(angle);
	const double s = std::sin(angle);
	double* const pFirst = &io_rMatrix[3 * ((i_Axis + 1) % 3)];
	double* const pSecond = &io_rMatrix[3 * ((i_Axis + 2) % 3)];
	for (int column = 0; column < 3; ++column)
	{
		const double first = pFirst[column];
		const double second = pSecond[column];
		pFirst[column] = c * first - s * second;
		pSecond[column] = s * first + c * second;
	}
}

} // namespace

FbxFormat::VAffine FbxFormat::Product(const VAffine& i_rA, const VAffine& i_rB)
{
	VVector3 t = Rotation::Product(i_rA.L, i_rB.t);
	for (int i = 0; i < 3; ++i)
		t[i] += i_rA.t[i];
	return {Rotation::Product(i_rA.L, i_rB.L), t};
}

FbxFormat::VAffine FbxFormat::Inverse(const VAffine& i_rMap)
{
	const VMatrix3& m = i_rMap.L;
	const double determinant = Determinant(m);
	if (determinant == 0.0)
		return {};
	// The adjugate over the determinant.
	VMatrix3 inverse{m[4] * m[8] - m[5] * m[7], m[2] * m[7] - m[1] * m[8], m[1] * m[5] - m[2] * m[4],
	    m[5] * m[6] - m[3] * m[8], m[0] * m[8] - m[2] * m[6], m[2] * m[3] - m[0] * m[5], m[3] * m[7] - m[4] * m[6],
	    m[1] * m[6] - m[0] * m[7], m[0] * m[4] - m[1] * m[3]};
	for (double& rEntry : inverse)
		rEntry /= determinant;
	const VVector3 t = Rotation::Product(inverse, i_rMap.t);
	return {inverse, {-t[0], -t[1], -t[2]}};
}

FbxFormat::VAffine FbxFormat::Load(const fbxsdk::FbxAMatrix& i_rMatrix)
{
	VAffine map;
	for (int row = 0; row < 3; ++row)
	{
		for (int column = 0; column < 3; ++column)
			map.L[3 * row + column] = i_rMatrix[column][row];
		map.t[row] = i_rMatrix[3][row];
	}
	return map;
}

void FbxFormat::Store(const VAffine& i_rMap, fbxsdk::FbxAMatrix& o_rMatrix)
{
	for (int row = 0; row < 3; ++row)
	{
		for (int column = 0; column < 3; ++column)
			o_rMatrix[column][row] = i_rMap.L[3 * row + column];
		o_rMatrix[3][row] = i_rMap.t[row];
		o_rMatrix[row][3] = 0.0;
	}
	o_rMatrix[3][3] = 1.0;
}

Rotation::VMatrix3 FbxFormat::ScaledColumns(const VMatrix3& i_rMatrix, const VVector3& i_rScaling)
{
	VMatrix3 scaled = i_rMatrix;
	for (int row = 0; row < 9; row += 3)
		for (int column = 0; column < 3; ++column)
			scaled[row + column] *= i_rScaling[column];
	return scaled;
}

Rotation::VMatrix3 FbxFormat::EulerRotation(const VVector3& i_rDegrees, ERotationOrder i_Order)
{
	static constexpr int c_Axes[6][3] = {{0, 1, 2}, {0, 2, 1}, {1, 2, 0}, {1, 0, 2}, {2, 0, 1}, {2, 1, 0}};
	VMatrix3 rotation = c_Identity3;
	for (const int axis : c_Axes[int(i_Order)])
		if (i_rDegrees[axis] != 0.0)
			TurnRows(rotation, axis, i_rDegrees[axis]);
	return rotation;
}
