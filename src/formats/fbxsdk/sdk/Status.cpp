#include "fbxsdk/sdk/Status.h"

void fbxsdk::FbxStatus::SetCode(EStatusCode pStatus, const char* pErrorMsg)
{
	m_Code = pStatus;
	m_Text = pErrorMsg;
}
