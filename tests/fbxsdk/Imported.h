#pragma once

#include "../UtilsFileSystem/Folder.h"

#include <fbxsdk.h>

#include <gtest/gtest.h>

namespace FbxTest
{

/// A file imported into a scene; what goes wrong has its text.
struct VImported
{
	explicit VImported(const std::string& i_rBytes)
	{
		Put(m_Path, i_rBytes);
		m_bInitialized = m_pImporter->Initialize(m_Path.c_str(), -1, nullptr);
		m_bImported = m_pImporter->Import(m_pScene, false);
		EXPECT_EQ(m_bImported, m_pImporter->GetStatus().GetCode() == FbxStatus::eSuccess);
		EXPECT_EQ(m_bInitialized && m_bImported, *m_pImporter->GetStatus().GetErrorString() == '\0');
	}
	~VImported() { m_pManager->Destroy(); }
	VImported(const VImported&) = delete;
	VImported& operator=(const VImported&) = delete;

	FbxNode* Root() { return m_pScene->GetRootNode(); }

	const VTestFolder m_Folder;
	const std::string m_Path = (m_Folder / "file.fbx").string();
	FbxManager* const m_pManager = FbxManager::Create();
	FbxScene* const m_pScene = FbxScene::Create(m_pManager, "scene");
	FbxImporter* const m_pImporter = FbxImporter::Create(m_pManager, "importer");
	bool m_bInitialized;
	bool m_bImported;
};

} // namespace FbxTest
