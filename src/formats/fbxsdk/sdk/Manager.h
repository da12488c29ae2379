#pragma once

#include "fbxsdk/sdk/Object.h"

#include <memory>
#include <vector>

namespace fbxsdk
{

/// The formats that can be read: 0 is binary FBX, 1 is FBX as text. Either opens both.
class FbxIOPluginRegistry
{
public:
	/// By the file's first bytes. False, with pFileFormat untouched, if it is no FBX file.
	bool DetectReaderFileFormat(const char* pFileName, int& pFileFormat) const;

	int GetNativeReaderFormat() const { return c_BinaryFormat; }

	/// -1 if it is not "fbx".
	int FindReaderIDByExtension(const char* pExt) const;

	static constexpr int c_BinaryFormat = 0;
	static constexpr int c_TextFormat = 1;
};

/// Owns the scenes and importers that are made with it.
class FbxManager
{
public:
	static FbxManager* Create();

	/// Ends this and all that it still owns; the pointer is no longer valid.
	void Destroy();

	FbxIOPluginRegistry* GetIOPluginRegistry() { return &m_Registry; }

private:
	friend class FbxDocument;
	friend class FbxImporter;
	friend class FbxScene;

	FbxManager() = default;
	~FbxManager() = default;
	void Own(std::unique_ptr<FbxObject> i_pObject) { m_Objects.push_back(std::move(i_pObject)); }
	void End(const FbxObject* i_pObject);

	FbxIOPluginRegistry m_Registry;
	std::vector<std::unique_ptr<FbxObject>> m_Objects;
};

} // namespace fbxsdk
