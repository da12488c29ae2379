#pragma once

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

/// What bench/run --verdict gathers from each program: a row for each limit.
namespace Verdict
{

inline bool IsOption(const char* i_pArgument)
{
	return std::strcmp(i_pArgument, "--verdict") == 0;
}

inline bool WasAskedFor(int i_Count, char** i_ppArguments)
{
	return std::any_of(i_ppArguments, i_ppArguments + i_Count, IsOption);
}

/// The value that i_Share of the values are below.
inline double Quantile(std::vector<double> i_Values, double i_Share)
{
	const auto at = i_Values.begin() + std::ptrdiff_t(i_Share * double(i_Values.size() - 1) + 0.5);
	std::nth_element(i_Values.begin(), at, i_Values.end());
	return *at;
}

/// One line, fields parted by tabs: work, peer, size, median, quartiles, limit, and by how much the slow quarter of the
/// peer's own times is slower than its fast quarter. Values without a peer have no peers' times.
inline void Tell(const char* i_pWork, const char* i_pPeer, const std::string& i_rSize,
    const std::vector<double>& i_rValues, double i_Limit, const std::vector<double>& i_rPeers = {})
{
	if (i_rValues.empty())
	{
		std::printf("VERDICT\t%s\t%s\t%s\tnot measured\t\t\t%g\t\n", i_pWork, i_pPeer, i_rSize.c_str(), i_Limit);
		return;
	}
	std::printf("VERDICT\t%s\t%s\t%s\t%.3f\t%.3f\t%.3f\t%g\t%.2f\n", i_pWork, i_pPeer, i_rSize.c_str(),
	    Quantile(i_rValues, 0.5), Quantile(i_rValues, 0.25), Quantile(i_rValues, 0.75), i_Limit,
	    i_rPeers.empty() ? 1.0 : Quantile(i_rPeers, 0.75) / Quantile(i_rPeers, 0.25));
	std::fflush(stdout);
}

} // namespace Verdict
