#pragma once

#include "DebugServices/Assert.h"

#include <string>
#include <utility>
#include <vector>

/// Gathers, while it lives, the expressions of the assertions that fail, in their order.
class VAssertions
{
public:
	VAssertions()
	    : m_pBefore(DebugServices::SetAssertFailHandler(
	        [](const char* i_pExpression, const char*, int) { s_Failed.emplace_back(i_pExpression); }))
	{
		s_Failed.clear();
	}
	~VAssertions() { DebugServices::SetAssertFailHandler(m_pBefore); }
	VAssertions(const VAssertions&) = delete;
	VAssertions& operator=(const VAssertions&) = delete;

	static std::vector<std::string> Take() { return std::exchange(s_Failed, {}); }

private:
	static inline std::vector<std::string> s_Failed;
	DebugServices::VAssertFailHandler m_pBefore;
};
