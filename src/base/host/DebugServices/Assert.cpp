#include "DebugServices/Assert.h"

#include "DebugServices/GlobalLog.h"

#include <atomic>

namespace DebugServices
{
namespace
{

std::atomic<VAssertFailHandler> g_pHandler{nullptr};

} // namespace

void CallAssertFailHandler(const char* i_pExpression, const char* i_pFile, int i_Line)
{
	if (const VAssertFailHandler pHandler = g_pHandler.load())
		pHandler(i_pExpression, i_pFile, i_Line);
	else
		NVX_LOG("System", NVX::ELogError, "Assertion failed: %1% (%2%:%3%)", i_pExpression, i_pFile, i_Line);
}

VAssertFailHandler SetAssertFailHandler(VAssertFailHandler i_pHandler)
{
	return g_pHandler.exchange(i_pHandler);
}

} // namespace DebugServices
