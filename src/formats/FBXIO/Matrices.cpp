#include "FBXIO/Matrices.h"

#include "DebugServices/GlobalLog.h"

#include <cmath>

QMatrix4x4 FBXIO::SystemMatrix(const FbxAMatrix& i_rMatrix)
{
	QMatrix4x4 matrix;
	for (int row = 0; row < 4; ++row)
		for (int column = 0; column < 4; ++column)
			matrix(row, column) = float(i_rMatrix.Get(column, row));
	return matrix;
}

void FBXIO::CheckTransform(QMatrix4x4& io_rMatrix, const std::string& i_rName, bool i_bTell)
{
	// Asking for the entries this way makes Qt forget what special kind of matrix it takes this one for.
	const float* const pEntries = io_rMatrix.data();
	for (int i = 0; i < 16; ++i)
		if (!std::isfinite(pEntries[i]))
		{
			if (i_bTell)
				NVX_LOG("FBXIO", NVX::ELogError, "Invalid transform for: %1%; setting to identity", i_rName);
			io_rMatrix.setToIdentity();
			return;
		}
}

void FBXIO::ScaleTranslation(QMatrix4x4& io_rMatrix, float i_Scale)
{
	for (int row = 0; row < 3; ++row)
		io_rMatrix(row, 3) *= i_Scale;
}
