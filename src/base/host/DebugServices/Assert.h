#pragma once

namespace DebugServices
{

using VAssertFailHandler = void (*)(const char* i_pExpression, const char* i_pFile, int i_Line);

/// Tells of a broken expectation and returns: callers go on and must still test what they rely on.
/// Without a handler of the host it is logged as an error of category "System".
void CallAssertFailHandler(const char* i_pExpression, const char* i_pFile, int i_Line);

/// Null restores the default. Returns the handler that stood before.
VAssertFailHandler SetAssertFailHandler(VAssertFailHandler i_pHandler);

} // namespace DebugServices

/// The expression's own text is what the handler gets.
#define NVX_ASSERT(...)                                                                                                \
	((__VA_ARGS__) ? void(0) : ::DebugServices::CallAssertFailHandler(#__VA_ARGS__, __FILE__, __LINE__))
