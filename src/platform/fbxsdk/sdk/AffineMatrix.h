#pragma once

namespace fbxsdk
{

template <typename T>
class FbxVectorTemplate4
{
public:
	FbxVectorTemplate4() = default;
	FbxVectorTemplate4(const T& pData0, const T& pData1, const T& pData2, const T& pData3)
	    : mData{pData0, pData1, pData2, pData3}
	{
	}
	T& operator[](int pIndex) { return mData[pIndex]; }
	const T& operator[](int pIndex) const { return mData[pIndex]; }

	T mData[4]{};
};

using FbxDouble4 = FbxVectorTemplate4<double>;
using FbxDouble4x4 = FbxVectorTemplate4<FbxDouble4>;

class FbxVector4 : public FbxDouble4
{
public:
	FbxVector4() : FbxVector4(0.0, 0.0, 0.0) {}
	FbxVector4(double pX, double pY, double pZ, double pW = 1.0) : FbxDouble4(pX, pY, pZ, pW) {}
};

/// An affine map. It is stored for row vectors: rows 0 to 2 are the images of the axes, row 3 is the translation. Yet
/// products read as for column vectors: a * b maps by b first, so that a global transform is the parent's global
/// transform * the local transform.
class FbxAMatrix : public FbxDouble4x4
{
public:
	FbxAMatrix() { SetIdentity(); }

	/// Scales first, then rotates about x, y and z in this order by degrees, then translates.
	FbxAMatrix(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS);

	void SetIdentity();

	/// The stored entry in row pY and column pX.
	double Get(int pY, int pX) const { return mData[pY][pX]; }

	FbxAMatrix operator*(const FbxAMatrix& pOther) const;

	/// The identity if there is no inverse.
	FbxAMatrix Inverse() const;
};

} // namespace fbxsdk
