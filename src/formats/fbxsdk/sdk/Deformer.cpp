#include "fbxsdk/sdk/Deformer.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/sdk/Mesh.h"

#include <algorithm>

void fbxsdk::FbxCluster::AddJobs(std::vector<FbxFormat::VDecodeJob>& io_rJobs) const
{
	io_rJobs.push_back({m_Record.Child("Indexes"), GetName(), &m_Indices});
	io_rJobs.push_back({m_Record.Child("Weights"), GetName(), &m_Weights});
}

void fbxsdk::FbxCluster::Load() const
{
	if (m_bLoaded)
		return;
	// Who reads one reads them all, those of other skins too, and their meshes.
	std::vector<const FbxCluster*> clusters{this};
	std::vector<std::pair<const FbxMesh*, std::size_t>> meshes;
	std::vector<FbxFormat::VDecodeJob> jobs;
	for (const FbxSkin* const pSkin : *m_pSkins)
	{
		if (pSkin->m_pMesh && !pSkin->m_pMesh->m_bLoaded && pSkin->m_pMesh->GetDeformer(0, FbxDeformer::eSkin) == pSkin)
		{
			meshes.emplace_back(pSkin->m_pMesh, jobs.size());
			pSkin->m_pMesh->AddJobs(jobs);
		}
		for (const FbxCluster* const pOther : pSkin->m_Clusters)
			if (!pOther->m_bLoaded && pOther->m_pSkin == pSkin && pOther != this)
				clusters.push_back(pOther);
	}
	for (const FbxCluster* const pCluster : clusters)
		pCluster->AddJobs(jobs);
	FbxFormat::Decode(jobs);
	for (const auto& [pMesh, first] : meshes)
		pMesh->EndJobs(std::span(jobs).subspan(first));
	for (const FbxCluster* const pCluster : clusters)
		pCluster->EndJobs();
}

void fbxsdk::FbxCluster::EndJobs() const
{
	m_bLoaded = true;
	if (m_Indices.size() != m_Weights.size())
		NVX_LOG("FBXIO", NVX::ELogWarning, "Cluster %1% has %2% indices and %3% weights; the rest is left out",
		    GetName(), m_Indices.size(), m_Weights.size());
	const std::size_t count = std::min(m_Indices.size(), m_Weights.size());
	m_Indices.resize(count);
	m_Weights.resize(count);
}

int fbxsdk::FbxCluster::GetControlPointIndicesCount() const
{
	Load();
	return int(m_Indices.size());
}

int* fbxsdk::FbxCluster::GetControlPointIndices() const
{
	Load();
	return m_Indices.data();
}

double* fbxsdk::FbxCluster::GetControlPointWeights() const
{
	Load();
	return m_Weights.data();
}

const fbxsdk::FbxAMatrix& fbxsdk::FbxCluster::Matrix(
    std::unique_ptr<FbxAMatrix>& io_rpMatrix, const char* i_pName) const
{
	if (io_rpMatrix)
		return *io_rpMatrix;
	FbxAMatrix matrix;
	FbxFormat::VArrayNumbers<double> entries;
	FbxFormat::Decode({m_Record.Child(i_pName), GetName(), &entries});
	if (entries.size() == 16)
		for (int i = 0; i < 16; ++i)
			if (i % 4 != 3)
				matrix[i / 4][i % 4] = entries[i];
	io_rpMatrix = std::make_unique<FbxAMatrix>(matrix);
	return *io_rpMatrix;
}

fbxsdk::FbxAMatrix& fbxsdk::FbxCluster::GetTransformMatrix(FbxAMatrix& pMatrix) const
{
	// Files hold it relative to the bone.
	return pMatrix = Matrix(m_pLinkMatrix, "TransformLink") * Matrix(m_pMatrix, "Transform");
}

fbxsdk::FbxAMatrix& fbxsdk::FbxCluster::GetTransformLinkMatrix(FbxAMatrix& pMatrix) const
{
	return pMatrix = Matrix(m_pLinkMatrix, "TransformLink");
}
