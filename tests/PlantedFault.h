#pragma once
// What tests/mutate includes into the files that it plants faults in. Each fault has a number and sleeps; PLANTED_FAULT
// in the environment wakes one. PLANTED_REACHED names a folder in which each fault that is passed leaves an empty file.
#include <atomic>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <unistd.h>

namespace PlantedFault
{
inline void LeaveMark(const char* i_pFolder, int i_Number)
{
	// Neither the error that our caller is about to read nor its count of allocations may change.
	const int error = errno;
	char name[4096];
	std::snprintf(name, sizeof name, "%s/%d", i_pFolder, i_Number);
	if (const int file = ::open(name, O_CREAT | O_WRONLY | O_CLOEXEC, 0666); file >= 0)
		::close(file);
	errno = error;
}

inline bool IsAwake(int i_Number)
{
	static const int s_Awake = std::getenv("PLANTED_FAULT") ? std::atoi(std::getenv("PLANTED_FAULT")) : -1;
	static const char* const s_pFolder = std::getenv("PLANTED_REACHED");
	static std::atomic<bool> s_Marked[10000];
	if (s_pFolder && !s_Marked[i_Number].exchange(true, std::memory_order_relaxed))
		LeaveMark(s_pFolder, i_Number);
	return i_Number == s_Awake;
}

// A sum and a difference of matrices have types of their own; their values have one.
template <typename T>
auto Value(const T& i_rValue)
{
	if constexpr (requires { i_rValue.eval(); })
		return i_rValue.eval();
	else
		return i_rValue;
}
} // namespace PlantedFault
