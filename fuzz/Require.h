#pragma once

#include <cstdio>
#include <cstdlib>

/// Ends a fuzz target where something does not hold that must.
inline void Require(bool i_bHolds, const char* i_pWhat = "what is required")
{
	if (i_bHolds)
		return;
	std::fprintf(stderr, "Broken: %s\n", i_pWhat);
	std::abort();
}
