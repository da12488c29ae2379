#pragma once

namespace fbxsdk
{

template <typename T>
class FbxVectorTemplate2
{
public:
	FbxVectorTemplate2() = default;
	FbxVectorTemplate2(const T& pData0, const T& pData1) : mData{pData0, pData1} {}
	T& operator[](int pIndex) { return mData[pIndex]; }
	const T& operator[](int pIndex) const { return mData[pIndex]; }

	T mData[2]{};
};

template <typename T>
class FbxVectorTemplate3
{
public:
	FbxVectorTemplate3() = default;
	FbxVectorTemplate3(const T& pData0, const T& pData1, const T& pData2) : mData{pData0, pData1, pData2} {}
	T& operator[](int pIndex) { return mData[pIndex]; }
	const T& operator[](int pIndex) const { return mData[pIndex]; }

	T mData[3]{};
};

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

using FbxDouble = double;
using FbxDouble2 = FbxVectorTemplate2<double>;
using FbxDouble3 = FbxVectorTemplate3<double>;
using FbxDouble4 = FbxVectorTemplate4<double>;
using FbxDouble4x4 = FbxVectorTemplate4<FbxDouble4>;

class FbxVector2 : public FbxDouble2
{
public:
	using FbxDouble2::FbxDouble2;
};

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

	FbxVector4 GetT() const { return {mData[3][0], mData[3][1], mData[3][2], mData[3][3]}; }

	/// The fourth component is left out: the map stays affine.
	void SetT(const FbxVector4& pT);

	FbxAMatrix operator*(const FbxAMatrix& pOther) const;

	/// The identity if there is no inverse.
	FbxAMatrix Inverse() const;
};

} // namespace fbxsdk
