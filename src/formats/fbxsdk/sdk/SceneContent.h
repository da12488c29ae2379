#pragma once

#include "fbxsdk/container/Arrays.h"
#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/document/Document.h"
#include "fbxsdk/sdk/Deformer.h"
#include "fbxsdk/sdk/Node.h"
#include "fbxsdk/sdk/Scene.h"

#include <memory>
#include <vector>

/// Node 0 is the root. The file stays, since what is large in it is read from there when somebody asks.
struct fbxsdk::FbxScene::VContent
{
	FbxFormat::VFileBytes m_Bytes;
	FbxFormat::VElementTree m_Tree;
	std::unique_ptr<FbxFormat::VDocument> m_pDocument;
	std::vector<std::unique_ptr<FbxNode>> m_Nodes;
	/// What nodes consist of: attributes, deformers, materials, textures.
	std::vector<std::unique_ptr<FbxObject>> m_Parts;
	/// Those among the parts.
	std::vector<const FbxSkin*> m_Skins;
	FbxFormat::VDecodeBudget m_Budget;
};
