#include "fbxsdk/sdk/Manager.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/container/FileKind.h"

#include <algorithm>

bool fbxsdk::FbxIOPluginRegistry::DetectReaderFileFormat(const char* pFileName, int& pFileFormat) const
{
	FbxFile::VFileBytes head;
	std::string reason;
	if (!head.Read(pFileName, FbxFile::Limits::c_TextHeaderBytes, reason))
		return false;
	switch (FbxFile::DetectFileKind(head.View()).m_Kind)
	{
	case FbxFile::EFileKind::None: return false;
	case FbxFile::EFileKind::Text: pFileFormat = c_TextFormat; return true;
	case FbxFile::EFileKind::Binary:
	case FbxFile::EFileKind::BinaryBigEndian:
	case FbxFile::EFileKind::DamagedBinary: break;
	}
	pFileFormat = c_BinaryFormat;
	return true;
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
