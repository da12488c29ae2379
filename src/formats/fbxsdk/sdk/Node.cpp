#include "fbxsdk/sdk/Node.h"

#include "DebugServices/Assert.h"
#include "fbxsdk/sdk/Mesh.h"
#include "fbxsdk/sdk/NodeData.h"

fbxsdk::FbxNode::FbxNode(std::string i_Name) : FbxObject(std::move(i_Name)), m_pData(std::make_unique<VData>()) {}

fbxsdk::FbxNode::~FbxNode() = default;

fbxsdk::FbxNode* fbxsdk::FbxNode::GetParent()
{
	return m_pData->m_pParent;
}

int fbxsdk::FbxNode::GetChildCount(bool pRecursive) const
{
	std::size_t count = m_pData->m_Children.size();
	if (pRecursive)
	{
		std::vector<const FbxNode*> open(m_pData->m_Children.begin(), m_pData->m_Children.end());
		while (!open.empty())
		{
			const std::vector<FbxNode*>& rChildren = open.back()->m_pData->m_Children;
			open.pop_back();
			open.insert(open.end(), rChildren.begin(), rChildren.end());
			count += rChildren.size();
		}
	}
	return int(count);
}

fbxsdk::FbxNode* fbxsdk::FbxNode::GetChild(int pIndex)
{
	const bool bValid = pIndex >= 0 && std::size_t(pIndex) < m_pData->m_Children.size();
	return bValid ? m_pData->m_Children[pIndex] : nullptr;
}

fbxsdk::FbxSkeleton* fbxsdk::FbxNode::GetSkeleton()
{
	return m_pData->m_pSkeleton;
}

int fbxsdk::FbxNode::GetNodeAttributeCount() const
{
	return int(m_pData->m_pSkeleton != nullptr) + int(m_pData->m_pMesh != nullptr);
}

fbxsdk::FbxNodeAttribute* fbxsdk::FbxNode::GetNodeAttributeByIndex(int pIndex)
{
	if (pIndex < 0 || pIndex >= GetNodeAttributeCount())
		return nullptr;
	return pIndex == 0 && m_pData->m_pSkeleton ? static_cast<FbxNodeAttribute*>(m_pData->m_pSkeleton)
	                                           : m_pData->m_pMesh;
}

fbxsdk::FbxMesh* fbxsdk::FbxNode::GetMesh()
{
	return m_pData->m_pMesh && m_pData->m_pMesh->IsSound() ? m_pData->m_pMesh : nullptr;
}

fbxsdk::FbxGeometry* fbxsdk::FbxNode::GetGeometry()
{
	return m_pData->m_pMesh;
}

int fbxsdk::FbxNode::GetMaterialCount() const
{
	return int(m_pData->m_Materials.size());
}

fbxsdk::FbxSurfaceMaterial* fbxsdk::FbxNode::GetMaterial(int pIndex) const
{
	const bool bValid = pIndex >= 0 && pIndex < GetMaterialCount();
	return bValid ? m_pData->m_Materials[pIndex] : nullptr;
}

fbxsdk::FbxVector4 fbxsdk::FbxNode::GetPreRotation(EPivotSet pPivotSet) const
{
	const FbxFormat::VNodeTransform& rProperties = m_pData->m_Properties;
	if (pPivotSet != eSourcePivot || !rProperties.HasRotationSpace())
		return {};
	const auto& [x, y, z] = rProperties.m_PreRotation;
	return {x, y, z};
}

fbxsdk::FbxVector4 fbxsdk::FbxNode::GetGeometricTranslation(EPivotSet pPivotSet) const
{
	const auto& [x, y, z] = m_pData->m_Properties.m_GeometricTranslation;
	return pPivotSet == eSourcePivot ? FbxVector4(x, y, z) : FbxVector4();
}

fbxsdk::FbxVector4 fbxsdk::FbxNode::GetGeometricRotation(EPivotSet pPivotSet) const
{
	const auto& [x, y, z] = m_pData->m_Properties.m_GeometricRotation;
	return pPivotSet == eSourcePivot ? FbxVector4(x, y, z) : FbxVector4();
}

fbxsdk::FbxVector4 fbxsdk::FbxNode::GetGeometricScaling(EPivotSet pPivotSet) const
{
	const auto& [x, y, z] = m_pData->m_Properties.m_GeometricScaling;
	return pPivotSet == eSourcePivot ? FbxVector4(x, y, z) : FbxVector4(1.0, 1.0, 1.0);
}

void fbxsdk::FbxNode::VData::Evaluate(const VData* i_pParent)
{
	const FbxFormat::VLocalTransform local = FbxFormat::LocalTransform(m_Properties);
	m_Global = FbxFormat::GlobalTransform(
	    i_pParent ? i_pParent->m_Global : FbxFormat::VGlobalTransform(), local, m_Properties.m_InheritType);
	const auto& [x, y, z] = m_Properties.m_Scaling;
	m_LocalScaling = {x, y, z};
	FbxFormat::Store(local.m_Map, m_LocalMatrix);
	FbxFormat::Store(m_Global.m_Map, m_GlobalMatrix);
	m_bEvaluated = true;
}

fbxsdk::FbxNode::VData& fbxsdk::FbxNode::VData::Evaluated(FbxNode& io_rNode)
{
	std::vector<VData*> open;
	VData* pData = io_rNode.m_pData.get();
	while (!pData->m_bEvaluated)
	{
		open.push_back(pData);
		if (!pData->m_pParent)
			break;
		pData = pData->m_pParent->m_pData.get();
	}
	for (; !open.empty(); open.pop_back())
	{
		const FbxNode* const pParent = open.back()->m_pParent;
		open.back()->Evaluate(pParent ? pParent->m_pData.get() : nullptr);
	}
	return *io_rNode.m_pData;
}

namespace
{

/// Nothing else is kept of a file; code that asks for more would silently get the wrong pose.
void ExpectDefaultPose(fbxsdk::FbxTime i_Time, fbxsdk::FbxNode::EPivotSet i_PivotSet, bool i_bTarget, bool i_bForce)
{
	NVX_ASSERT(i_Time.Get() == FBXSDK_TIME_INFINITE.Get());
	NVX_ASSERT(i_PivotSet == fbxsdk::FbxNode::eSourcePivot);
	NVX_ASSERT(!i_bTarget && !i_bForce);
}

} // namespace

fbxsdk::FbxAMatrix& fbxsdk::FbxNode::EvaluateLocalTransform(
    FbxTime pTime, EPivotSet pPivotSet, bool pApplyTarget, bool pForceEval)
{
	ExpectDefaultPose(pTime, pPivotSet, pApplyTarget, pForceEval);
	return VData::Evaluated(*this).m_LocalMatrix;
}

fbxsdk::FbxAMatrix& fbxsdk::FbxNode::EvaluateGlobalTransform(
    FbxTime pTime, EPivotSet pPivotSet, bool pApplyTarget, bool pForceEval)
{
	ExpectDefaultPose(pTime, pPivotSet, pApplyTarget, pForceEval);
	return VData::Evaluated(*this).m_GlobalMatrix;
}

fbxsdk::FbxVector4& fbxsdk::FbxNode::EvaluateLocalScaling(
    FbxTime pTime, EPivotSet pPivotSet, bool pApplyTarget, bool pForceEval)
{
	ExpectDefaultPose(pTime, pPivotSet, pApplyTarget, pForceEval);
	return VData::Evaluated(*this).m_LocalScaling;
}
