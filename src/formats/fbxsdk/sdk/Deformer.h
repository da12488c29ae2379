#pragma once

#include "fbxsdk/scene/ArraySource.h"
#include "fbxsdk/sdk/AffineMatrix.h"
#include "fbxsdk/sdk/Object.h"

#include <memory>

namespace FbxFormat
{
class VSceneBuilder;
}

namespace fbxsdk
{

class FbxMesh;
class FbxNode;
class FbxSkin;

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
	friend class FbxFormat::VSceneBuilder;

	FbxCluster(
	    std::string i_Name, const FbxFormat::VArraySource& i_rRecord, const std::vector<const FbxSkin*>& i_rSkins)
	    : FbxObject(std::move(i_Name)), m_Record(i_rRecord), m_pSkins(&i_rSkins)
	{
	}
	void Load() const;
	void AddJobs(std::vector<FbxFormat::VDecodeJob>& io_rJobs) const;
	void EndJobs() const;
	/// Reads it once: many meshes may share a skin.
	const FbxAMatrix& Matrix(std::unique_ptr<FbxAMatrix>& io_rpMatrix, const char* i_pName) const;

	FbxFormat::VArraySource m_Record;
	FbxNode* m_pLink = nullptr;
	/// All of the scene.
	const std::vector<const FbxSkin*>* m_pSkins;
	/// The first that it belongs to.
	const FbxSkin* m_pSkin = nullptr;
	mutable bool m_bLoaded = false;
	mutable FbxFormat::VArrayNumbers<int> m_Indices;
	mutable FbxFormat::VArrayNumbers<double> m_Weights;
	mutable std::unique_ptr<FbxAMatrix> m_pMatrix;
	mutable std::unique_ptr<FbxAMatrix> m_pLinkMatrix;
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
	friend class FbxCluster;
	friend class FbxFormat::VSceneBuilder;
	using FbxDeformer::FbxDeformer;

	std::vector<FbxCluster*> m_Clusters;
	/// The first that it moves.
	const FbxMesh* m_pMesh = nullptr;
};

} // namespace fbxsdk
