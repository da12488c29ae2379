#pragma once

#include "fbxsdk/sdk/GlobalSettings.h"
#include "fbxsdk/sdk/Object.h"

#include <memory>

namespace fbxsdk
{

class FbxManager;
class FbxNode;

/// What an importer fills.
class FbxDocument : public FbxObject
{
public:
	/// Ends this and all that it owns; the pointer is no longer valid.
	void Destroy(bool pRecursive = false);

protected:
	FbxDocument(FbxManager& i_rManager, const char* i_pName);

private:
	FbxManager& m_rManager;
};

class FbxScene : public FbxDocument
{
public:
	/// The manager owns it, until one of the two is destroyed.
	static FbxScene* Create(FbxManager* pManager, const char* pName);

	~FbxScene() override;

	FbxGlobalSettings& GetGlobalSettings() { return m_GlobalSettings; }
	FbxNode* GetRootNode() const;

private:
	friend class FbxFormat::VSceneBuilder;
	struct VContent;

	FbxScene(FbxManager& i_rManager, const char* i_pName);

	FbxGlobalSettings m_GlobalSettings;
	std::unique_ptr<VContent> m_pContent;
};

} // namespace fbxsdk
