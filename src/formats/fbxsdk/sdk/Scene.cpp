#include "fbxsdk/sdk/Scene.h"

#include "fbxsdk/scene/SceneBuilder.h"
#include "fbxsdk/sdk/Manager.h"
#include "fbxsdk/sdk/SceneContent.h"

fbxsdk::FbxDocument::FbxDocument(FbxManager& i_rManager, const char* i_pName)
    : FbxObject(i_pName), m_rManager(i_rManager)
{
}

void fbxsdk::FbxDocument::Destroy(bool /*pRecursive*/)
{
	m_rManager.End(this);
}

fbxsdk::FbxScene::FbxScene(FbxManager& i_rManager, const char* i_pName) : FbxDocument(i_rManager, i_pName)
{
	FbxFormat::VSceneBuilder(*this).BuildEmpty();
}

fbxsdk::FbxScene::~FbxScene() = default;

fbxsdk::FbxScene* fbxsdk::FbxScene::Create(FbxManager* pManager, const char* pName)
{
	auto* const pScene = new FbxScene(*pManager, pName);
	pManager->Own(std::unique_ptr<FbxObject>(pScene));
	return pScene;
}

fbxsdk::FbxNode* fbxsdk::FbxScene::GetRootNode() const
{
	return m_pContent->m_Nodes.front().get();
}
