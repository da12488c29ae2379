#pragma once

#include "numerics/Matrix4.h"

#include <fbxsdk.h>

#include <string>

namespace FBXIO
{

/// A matrix of the SDK, which is stored for row vectors.
Rotation::VMatrix4 SystemMatrix(const FbxAMatrix& i_rMatrix);

/// Makes a matrix with entries that are no numbers the identity, and tells the name if i_bTell.
void CheckTransform(Rotation::VMatrix4& io_rMatrix, const std::string& i_rName, bool i_bTell = true);

void ScaleTranslation(Rotation::VMatrix4& io_rMatrix, float i_Scale);

} // namespace FBXIO
