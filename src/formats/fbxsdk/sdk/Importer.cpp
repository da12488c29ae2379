#include "fbxsdk/sdk/Importer.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/scene/SceneBuilder.h"
#include "fbxsdk/sdk/Manager.h"
#include "fbxsdk/sdk/Scene.h"
#include "fbxsdk/sdk/Stream.h"

#include <algorithm>

namespace
{

constexpr const char* c_pCancelled = "Import was cancelled";

} // namespace

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

fbxsdk::FbxImporter::~FbxImporter() = default;

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
	m_bInitialized = false;
	m_pStreamBytes.reset();
	FbxFormat::VFileBytes head;
	std::string reason;
	if (!AcceptsFormat(pFileFormat, pIOSettings))
		return false;
	if (!head.Read(pFileName, FbxFormat::Limits::c_TextHeaderBytes, reason))
		return Fail(FbxStatus::eFailure, reason);
	m_FileName = pFileName;
	return AcceptsHead(head);
}

bool fbxsdk::FbxImporter::Initialize(
    FbxStream* pStream, void* pStreamData, const int pFileFormat, FbxIOSettings* pIOSettings)
{
	m_bInitialized = false;
	m_pStreamBytes.reset();
	if (!AcceptsFormat(pFileFormat, pIOSettings))
		return false;
	if (!pStream || !pStream->Open(pStreamData))
		return Fail(FbxStatus::eFailure, "File cannot be opened");
	pStream->Seek(0, FbxFile::eEnd);
	const FbxInt64 size = pStream->GetPosition();
	if (size > FbxInt64(FbxFormat::Limits::c_FileBytes))
		return Fail(FbxStatus::eFailure, "File is larger than 2 GiB");
	pStream->Seek(0, FbxFile::eBegin);
	auto pBytes = std::make_unique<FbxFormat::VFileBytes>();
	const auto wanted = FbxUInt64(std::max<FbxInt64>(size, 0));
	const bool bRead = pStream->Read(pBytes->Resize(wanted), wanted) == wanted && pStream->GetError() == 0;
	pStream->Close();
	if (!bRead)
		return Fail(FbxStatus::eFailure, "File cannot be read");
	m_pStreamBytes = std::move(pBytes);
	return AcceptsHead(*m_pStreamBytes);
}

bool fbxsdk::FbxImporter::AcceptsFormat(int i_FileFormat, const FbxIOSettings* i_pSettings)
{
	m_Version = 0;
	const bool bAccepts = i_FileFormat >= -1 && i_FileFormat <= FbxIOPluginRegistry::c_TextFormat && !i_pSettings;
	return bAccepts || Fail(FbxStatus::eInvalidParameter, "No reader of that format with those settings");
}

bool fbxsdk::FbxImporter::AcceptsHead(const FbxFormat::VFileBytes& i_rHead)
{
	using FbxFormat::EFileKind;
	const FbxFormat::VFileKind kind = FbxFormat::DetectFileKind(i_rHead.View());
	m_Version = kind.m_Version;
	if (kind.m_Kind == EFileKind::None)
		return Fail(FbxStatus::eInvalidFile, i_rHead.View().empty() ? "File is empty" : "File is not an FBX file");
	if (kind.m_Kind == EFileKind::DamagedBinary)
		return Fail(FbxStatus::eInvalidFile, "File is corrupted: its first bytes are damaged");
	if (kind.m_Kind == EFileKind::BinaryBigEndian)
		return Fail(FbxStatus::eInvalidFile, "File is written in big-endian byte order, which is not read");
	if (kind.m_Version < FbxFormat::c_OldestVersion || kind.m_Version >= FbxFormat::c_TooNewVersion)
		return Fail(FbxStatus::eInvalidFileVersion, "File version is not one of 5.0 to 7.9");
	m_bInitialized = true;
	m_Status = {};
	return true;
}

bool fbxsdk::FbxImporter::Import(FbxDocument* pDocument, bool pNonBlocking)
{
	auto* const pScene = dynamic_cast<FbxScene*>(pDocument);
	if (!m_bInitialized || !pScene || pNonBlocking)
		return Fail(FbxStatus::eInvalidParameter, "Import needs an initialized importer and a scene to wait for");
	FbxFormat::VFileBytes bytes;
	FbxFormat::VProgress progress(m_pProgress, m_pProgressArguments);
	std::string reason;
	if (m_pStreamBytes)
	{
		bytes = std::move(*m_pStreamBytes);
		m_pStreamBytes.reset();
		m_bInitialized = false;
	}
	else if (!bytes.Read(m_FileName, progress, reason))
		return Fail(FbxStatus::eFailure, reason);
	if (progress.IsCancelled())
		return Fail(FbxStatus::eFailure, c_pCancelled);
	// The file may have changed since it was looked at.
	const FbxFormat::VFileKind kind = FbxFormat::DetectFileKind(bytes.View());
	const FbxFormat::VImportResult result = FbxFormat::VSceneBuilder(*pScene).Build(std::move(bytes), kind, progress);
	if (progress.IsCancelled())
		return Fail(FbxStatus::eFailure, c_pCancelled);
	if (result.m_bEncrypted)
		return Fail(FbxStatus::ePasswordError, "File asks for a password");
	if (!result.m_Error.empty())
		return Fail(FbxStatus::eInvalidFile,
		    (result.m_bBeyondLimit ? "File holds more than is read: " : "File is corrupted: ") + result.m_Error);
	m_Status = {};
	return true;
}

void fbxsdk::FbxImporter::GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const
{
	pMajor = int(m_Version / 1000);
	pMinor = int(m_Version / 100 % 10);
	pRevision = int(m_Version / 10 % 10);
}
