#pragma once

#include "fbxsdk/sdk/Object.h"
#include "fbxsdk/sdk/Status.h"

#include <cstdint>
#include <memory>

namespace FbxFormat
{
class VFileBytes;
}

namespace fbxsdk
{

/// Gets what SetProgressCallback was given, how far the import is, and what it does; false ends it.
using FbxProgressCallback = bool (*)(void* pArgs, float pPercentage, const char* pStatus);

class FbxDocument;
class FbxIOSettings;
class FbxManager;
class FbxStream;

class FbxImporter : public FbxObject
{
public:
	/// The manager owns it, until one of the two is destroyed.
	static FbxImporter* Create(FbxManager* pManager, const char* pName);

	~FbxImporter() override;

	/// Ends this; the pointer is no longer valid.
	void Destroy(bool pRecursive = false);

	/// Looks at the first bytes of the file only. pFileFormat is one of the registry's, or -1 for whichever it is;
	/// there are no settings, so pIOSettings is null.
	bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr);

	/// The same for what a stream holds, which is copied and read at once; it may end with the call.
	bool Initialize(FbxStream* pStream, void* pStreamData = nullptr, const int pFileFormat = -1,
	    FbxIOSettings* pIOSettings = nullptr);

	/// For each Import from now on; one that it ends fails, with nothing of the file in the scene.
	void SetProgressCallback(FbxProgressCallback pCallback, void* pArgs = nullptr)
	{
		m_pProgress = pCallback;
		m_pProgressArguments = pArgs;
	}

	/// Fills the scene. False if anything in the file was broken: what could be read is in the scene all the same.
	/// There is no import in the background.
	bool Import(FbxDocument* pDocument, bool pNonBlocking = false);

	/// Zeros before Initialize, and if the file does not tell.
	void GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const;

	FbxStatus& GetStatus() { return m_Status; }

private:
	FbxImporter(FbxManager& i_rManager, const char* i_pName);
	bool Fail(FbxStatus::EStatusCode i_Code, const std::string& i_rText);
	bool AcceptsFormat(int i_FileFormat, const FbxIOSettings* i_pSettings);
	/// Looks at the beginning of the file.
	bool AcceptsHead(const FbxFormat::VFileBytes& i_rHead);

	FbxManager& m_rManager;
	FbxStatus m_Status;
	std::string m_FileName;
	/// Set if it is no file on disk; taken by Import.
	std::unique_ptr<FbxFormat::VFileBytes> m_pStreamBytes;
	FbxProgressCallback m_pProgress = nullptr;
	void* m_pProgressArguments = nullptr;
	bool m_bInitialized = false;
	std::uint32_t m_Version = 0;
};

} // namespace fbxsdk
