#pragma once

#include "fbxsdk/scene/NodeTransform.h"
#include "fbxsdk/sdk/Node.h"

#include <vector>

struct fbxsdk::FbxNode::VData
{
	FbxNode* m_pParent = nullptr;
	std::vector<FbxNode*> m_Children;
	FbxSkeleton* m_pSkeleton = nullptr;
	FbxMesh* m_pMesh = nullptr;
	std::vector<FbxSurfaceMaterial*> m_Materials;
	FbxFormat::VNodeTransform m_Properties;

	/// All that follows is filled by the first evaluation.
	bool m_bEvaluated = false;
	FbxFormat::VGlobalTransform m_Global;
	FbxVector4 m_LocalScaling;
	FbxAMatrix m_LocalMatrix;
	FbxAMatrix m_GlobalMatrix;

	void Evaluate(const VData* i_pParent);
	static VData& Evaluated(FbxNode& io_rNode);
};
