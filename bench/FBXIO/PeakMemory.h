#pragma once

#include <sys/resource.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <string>

/// The most memory that some work takes, each in a process of its own: this program started again.
namespace PeakMemory
{

inline long Now()
{
	rusage usage{};
	getrusage(RUSAGE_SELF, &usage);
	return usage.ru_maxrss;
}

/// For main of the started program: true, with the work done and its KiB printed, if it was started for that.
/// i_rWork gets the name of the work and the file.
template <typename TWork>
bool WasAskedFor(int i_Count, char** i_ppArguments, const TWork& i_rWork)
{
	if (i_Count != 4 || std::string(i_ppArguments[1]) != "--peak")
		return false;
	const long before = Now();
	i_rWork(std::string(i_ppArguments[2]), std::string(i_ppArguments[3]));
	std::printf("%ld\n", Now() - before);
	return true;
}

/// In MiB, above what the program takes before it begins; negative if it could not be measured.
inline double Of(const std::string& i_rWork, const std::string& i_rFile)
{
	char path[4096]{};
	if (readlink("/proc/self/exe", path, sizeof(path) - 1) <= 0)
		return -1.0;
	const std::string command = "'" + std::string(path) + "' --peak " + i_rWork + " '" + i_rFile + "' 2>/dev/null";
	std::FILE* const pOutput = popen(command.c_str(), "r");
	long size = -1024;
	if (pOutput && std::fscanf(pOutput, "%ld", &size) != 1)
		size = -1024;
	if (pOutput)
		pclose(pOutput);
	return double(size) / 1024.0;
}

} // namespace PeakMemory
