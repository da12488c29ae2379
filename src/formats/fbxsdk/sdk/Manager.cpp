#include "fbxsdk/sdk/Manager.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/container/FileKind.h"

#include <algorithm>

bool fbxsdk::FbxIOPluginRegistry::DetectReaderFileFormat(const char* pFileName, int& pFileFormat) const
{
	FbxFormat::VFileBytes head;
	std::string reason;
	if (!head.Read(pFileName, FbxFormat::Limits::c_TextHeaderBytes, reason))
		return false;
	switch (FbxFormat::DetectFileKind(head.View()).m_Kind)
	{
	case FbxFormat::EFileKind::None: return false;
	case FbxFormat::EFileKind::Text: pFileFormat = c_TextFormat; return true;
	case FbxFormat::EFileKind::Binary:
	case FbxFormat::EFileKind::BinaryBigEndian:
	case FbxFormat::EFileKind::DamagedBinary: break;
	}
	pFileFormat = c_BinaryFormat;
	return true;
}

int fbxsdk::FbxIOPluginRegistry::FindReaderIDByExtension(const char* pExt) const
{
	const std::string_view extension(pExt);
	return extension == "fbx" || extension == "FBX" ? c_BinaryFormat : -1;
}

fbxsdk::FbxManager* fbxsdk::FbxManager::Create()
{
	return new FbxManager;
}

void fbxsdk::FbxManager::Destroy()
{
	delete this;
}

void fbxsdk::FbxManager::End(const FbxObject* i_pObject)
{
	std::erase_if(m_Objects, [i_pObject](const auto& i_rpOwned) { return i_rpOwned.get() == i_pObject; });
}
