#include "CoreGraphics/Skin.h"

#include "DebugServices/GlobalLog.h"

namespace CoreGraphics
{

VSkin::VSkin(const FBXIO::VSkin& i_rData, std::string i_Name)
    : m_Name(std::move(i_Name)), m_pSkeleton(i_rData.m_pSkeleton)
{
	// Indices of bones are bytes.
	m_MovesVertices.resize(256);
	VMaterialMeshMaker maker;
	for (const FBXIO::VSkinMesh& rMesh : i_rData.m_Meshes)
	{
		m_Meshes.push_back(maker.Make(rMesh));
		for (const FBXIO::VSkinVertex& rVertex : rMesh.m_Vertices)
			for (std::size_t i = 0; i < rVertex.m_BoneIndices.size(); ++i)
				if (rVertex.m_BoneWeights[i] > 0)
					m_MovesVertices[rVertex.m_BoneIndices[i]] = true;
	}
}

void VSkin::WarnOnce(const std::string& i_rText)
{
	if (m_Warned.insert(i_rText).second)
		NVX_LOG("CoreGraphics", NVX::ELogWarning, "%1%", i_rText);
}

} // namespace CoreGraphics
