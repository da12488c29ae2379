#include "fbxsdk/sdk/AffineMatrix.h"

#include "fbxsdk/scene/Affine.h"

using FbxFormat::VAffine;

fbxsdk::FbxAMatrix::FbxAMatrix(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS)
{
	const Rotation::VVector3 scaling{pS[0], pS[1], pS[2]};
	const Rotation::VMatrix3 rotation = FbxFormat::EulerRotation({pR[0], pR[1], pR[2]}, FbxFormat::ERotationOrder::XYZ);
	FbxFormat::Store({FbxFormat::ScaledColumns(rotation, scaling), {pT[0], pT[1], pT[2]}}, *this);
}

void fbxsdk::FbxAMatrix::SetIdentity()
{
	FbxFormat::Store(VAffine(), *this);
}

void fbxsdk::FbxAMatrix::SetT(const FbxVector4& pT)
{
	for (int i = 0; i < 3; ++i)
		mData[3][i] = pT[i];
}

fbxsdk::FbxAMatrix fbxsdk::FbxAMatrix::operator*(const FbxAMatrix& pOther) const
{
	FbxAMatrix product;
	FbxFormat::Store(FbxFormat::Product(FbxFormat::Load(*this), FbxFormat::Load(pOther)), product);
	return product;
}

fbxsdk::FbxAMatrix fbxsdk::FbxAMatrix::Inverse() const
{
	FbxAMatrix inverse;
	FbxFormat::Store(FbxFormat::Inverse(FbxFormat::Load(*this)), inverse);
	return inverse;
}
