#pragma once

#include "fbxsdk/sdk/Object.h"
#include "fbxsdk/sdk/Status.h"

#include <cstdint>

namespace fbxsdk
{

class FbxDocument;
class FbxIOSettings;
class FbxManager;

class FbxImporter : public FbxObject
{
public:
	/// The manager owns it, until one of the two is destroyed.
	static FbxImporter* Create(FbxManager* pManager, const char* pName);

	/// Ends this; the pointer is no longer valid.
	void Destroy(bool pRecursive = false);

	/// Looks at the first bytes of the file only. pFileFormat is one of the registry's, or -1 for whichever it is;
	/// there are no settings, so pIOSettings is null.
	bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr);

	/// Fills the scene. False if anything in the file was broken: what could be read is in the scene all the same.
	/// There is no import in the background.
	bool Import(FbxDocument* pDocument, bool pNonBlocking = false);

	/// Zeros before Initialize, and if the file does not tell.
	void GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const;

	FbxStatus& GetStatus() { return m_Status; }

private:
	FbxImporter(FbxManager& i_rManager, const char* i_pName);
	bool Fail(FbxStatus::EStatusCode i_Code, const std::string& i_rText);

	FbxManager& m_rManager;
	FbxStatus m_Status;
	std::string m_FileName;
	bool m_bInitialized = false;
	std::uint32_t m_Version = 0;
};

} // namespace fbxsdk
