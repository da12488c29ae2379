#include "fbxsdk/sdk/Importer.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/scene/SceneBuilder.h"
#include "fbxsdk/sdk/Manager.h"
#include "fbxsdk/sdk/Scene.h"

#include <limits>

fbxsdk::FbxImporter::FbxImporter(FbxManager& i_rManager, const char* i_pName)
    : FbxObject(i_pName), m_rManager(i_rManager)
{
}

fbxsdk::FbxImporter* fbxsdk::FbxImporter::Create(FbxManager* pManager, const char* pName)
{
	auto* const pImporter = new FbxImporter(*pManager, pName);
	pManager->Own(std::unique_ptr<FbxObject>(pImporter));
	return pImporter;
}

void fbxsdk::FbxImporter::Destroy(bool /*pRecursive*/)
{
	m_rManager.End(this);
}

bool fbxsdk::FbxImporter::Fail(FbxStatus::EStatusCode i_Code, const std::string& i_rText)
{
	m_Status.SetCode(i_Code, i_rText.c_str());
	return false;
}

bool fbxsdk::FbxImporter::Initialize(const char* pFileName, int pFileFormat, FbxIOSettings* pIOSettings)
{
	using FbxFile::EFileKind;
	m_bInitialized = false;
	m_Version = 0;
	if (pFileFormat < -1 || pFileFormat > FbxIOPluginRegistry::c_TextFormat || pIOSettings)
		return Fail(FbxStatus::eInvalidParameter, "No reader of that format with those settings");
	FbxFile::VFileBytes head;
	std::string reason;
	if (!head.Read(pFileName, FbxFile::Limits::c_TextHeaderBytes, reason))
		return Fail(FbxStatus::eFailure, reason);
	const FbxFile::VFileKind kind = FbxFile::DetectFileKind(head.View());
	m_Version = kind.m_Version;
	if (kind.m_Kind == EFileKind::None)
		return Fail(FbxStatus::eInvalidFile, head.View().empty() ? "File is empty" : "File is not an FBX file");
	if (kind.m_Kind == EFileKind::DamagedBinary)
		return Fail(FbxStatus::eInvalidFile, "File is corrupted: its first bytes are damaged");
	if (kind.m_Kind == EFileKind::BinaryBigEndian)
		return Fail(FbxStatus::eInvalidFile, "File is written in big-endian byte order, which is not read");
	if (kind.m_Version < FbxFile::c_OldestVersion || kind.m_Version >= FbxFile::c_TooNewVersion)
		return Fail(FbxStatus::eInvalidFileVersion, "File version is not one of 6.0 to 7.9");
	m_FileName = pFileName;
	m_bInitialized = true;
	m_Status = {};
	return true;
}

bool fbxsdk::FbxImporter::Import(FbxDocument* pDocument, bool pNonBlocking)
{
	auto* const pScene = dynamic_cast<FbxScene*>(pDocument);
	if (!m_bInitialized || !pScene || pNonBlocking)
		return Fail(FbxStatus::eInvalidParameter, "Import needs an initialized importer and a scene to wait for");
	FbxFile::VFileBytes bytes;
	std::string reason;
	if (!bytes.Read(m_FileName, std::numeric_limits<std::size_t>::max(), reason))
		return Fail(FbxStatus::eFailure, reason);
	// The file may have changed since it was looked at.
	const FbxFile::VFileKind kind = FbxFile::DetectFileKind(bytes.View());
	const FbxFile::VImportResult result = FbxFile::VSceneBuilder(*pScene).Build(std::move(bytes), kind);
	if (result.m_bEncrypted)
		return Fail(FbxStatus::ePasswordError, "File asks for a password");
	if (!result.m_Error.empty())
		return Fail(FbxStatus::eInvalidFile, "File is corrupted: " + result.m_Error);
	m_Status = {};
	return true;
}

void fbxsdk::FbxImporter::GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const
{
	pMajor = int(m_Version / 1000);
	pMinor = int(m_Version / 100 % 10);
	pRevision = int(m_Version / 10 % 10);
}
