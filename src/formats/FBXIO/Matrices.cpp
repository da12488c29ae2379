#include "FBXIO/Matrices.h"

#include "DebugServices/GlobalLog.h"

#include <cmath>

Rotation::VMatrix4 FBXIO::SystemMatrix(const FbxAMatrix& i_rMatrix)
{
	Rotation::VMatrix4 matrix;
	for (int row = 0; row < 4; ++row)
		for (int column = 0; column < 4; ++column)
			matrix(row, column) = float(i_rMatrix.Get(column, row));
	return matrix;
}

void FBXIO::CheckTransform(Rotation::VMatrix4& io_rMatrix, const std::string& i_rName, bool i_bTell)
{
	for (int i = 0; i < 16; ++i)
		if (!std::isfinite(io_rMatrix.data()[i]))
		{
			if (i_bTell)
				NVX_LOG("FBXIO", NVX::ELogError, "Invalid transform for: %1%; setting to identity", i_rName);
			io_rMatrix = {};
			return;
		}
}

void FBXIO::ScaleTranslation(Rotation::VMatrix4& io_rMatrix, float i_Scale)
{
	for (int row = 0; row < 3; ++row)
		io_rMatrix(row, 3) *= i_Scale;
}
