#pragma once

#include "fbxsdk/sdk/AffineMatrix.h"
#include "numerics/Rotation.h"

namespace FbxFormat
{

/// x -> L x + t, for column vectors.
struct VAffine
{
	Rotation::VMatrix3 L = Rotation::c_Identity3;
	Rotation::VVector3 t{};
};

/// First b, then a.
VAffine Product(const VAffine& i_rA, const VAffine& i_rB);

/// The identity if the determinant is 0.
VAffine Inverse(const VAffine& i_rMap);

VAffine Load(const fbxsdk::FbxAMatrix& i_rMatrix);
void Store(const VAffine& i_rMap, fbxsdk::FbxAMatrix& o_rMatrix);

/// The matrix times the diagonal matrix of the scaling.
Rotation::VMatrix3 ScaledColumns(const Rotation::VMatrix3& i_rMatrix, const Rotation::VVector3& i_rScaling);

/// The axes in the order in which they turn; as the format counts them.
enum class ERotationOrder
{
	XYZ,
	XZY,
	YZX,
	YXZ,
	ZXY,
	ZYX
};

/// Turns about the fixed axes, in degrees: order XYZ turns about x first, and is Rz Ry Rx.
Rotation::VMatrix3 EulerRotation(const Rotation::VVector3& i_rDegrees, ERotationOrder i_Order);

} // namespace FbxFormat
