#pragma once

#include "fbxsdk/scene/ArraySource.h"
#include "fbxsdk/sdk/AffineMatrix.h"
#include "fbxsdk/sdk/Object.h"

namespace FbxFile
{
class VSceneBuilder;
}

namespace fbxsdk
{

class FbxNode;

class FbxDeformer : public FbxObject
{
public:
	enum EDeformerType
	{
		eUnknown,
		eSkin
	};

	virtual EDeformerType GetDeformerType() const = 0;

protected:
	using FbxObject::FbxObject;
};

/// The control points that one bone moves.
class FbxCluster : public FbxObject
{
public:
	/// Null if the file connects no node.
	FbxNode* GetLink() { return m_pLink; }

	/// Indices and weights are as many as both of the file's arrays have. They are decoded when they are asked for.
	int GetControlPointIndicesCount() const;
	int* GetControlPointIndices() const;
	double* GetControlPointWeights() const;

	/// Global transform of the mesh, and of the bone, at the time of binding; in file units.
	FbxAMatrix& GetTransformMatrix(FbxAMatrix& pMatrix) const;
	FbxAMatrix& GetTransformLinkMatrix(FbxAMatrix& pMatrix) const;

private:
	friend class FbxFile::VSceneBuilder;

	FbxCluster(std::string i_Name, const FbxFile::VArraySource& i_rRecord)
	    : FbxObject(std::move(i_Name)), m_Record(i_rRecord)
	{
	}
	void Load() const;
	FbxAMatrix Matrix(const char* i_pName) const;

	FbxFile::VArraySource m_Record;
	FbxNode* m_pLink = nullptr;
	mutable bool m_bLoaded = false;
	mutable std::vector<int> m_Indices;
	mutable std::vector<double> m_Weights;
};

class FbxSkin : public FbxDeformer
{
public:
	EDeformerType GetDeformerType() const override { return eSkin; }
	int GetClusterCount() const { return int(m_Clusters.size()); }
	FbxCluster* GetCluster(int pIndex)
	{
		return pIndex >= 0 && pIndex < GetClusterCount() ? m_Clusters[pIndex] : nullptr;
	}

private:
	friend class FbxFile::VSceneBuilder;
	using FbxDeformer::FbxDeformer;

	std::vector<FbxCluster*> m_Clusters;
};

} // namespace fbxsdk
