#pragma once

#include <string>

namespace fbxsdk
{

class FbxStatus
{
public:
	enum EStatusCode
	{
		eSuccess = 0,
		eFailure,
		eInsufficientMemory,
		eInvalidParameter,
		eIndexOutOfRange,
		ePasswordError,
		eInvalidFileVersion,
		eInvalidFile,
		eSceneCheckFail
	};

	EStatusCode GetCode() const { return m_Code; }
	void SetCode(EStatusCode pStatus, const char* pErrorMsg);

	/// Lives until the code is set again.
	const char* GetErrorString() const { return m_Text.c_str(); }

private:
	EStatusCode m_Code = eSuccess;
	std::string m_Text;
};

} // namespace fbxsdk
