#include "retarget/text/InputFile.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/System.h"

#include "UtilsFileSystem/Paths.h"

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>

namespace CommandLine
{
namespace
{

[[noreturn]] void FailToCopy()
{
	throw VCommandError(EBadInput, std::string("Standard input could not be read: ") + std::strerror(errno));
}

/// Where it lies until the process ends.
boost::filesystem::path CopyOfStandardInput(std::uint64_t i_MaximumBytes)
{
	std::FILE* const pCopy = OpenScratchFile();
	if (!pCopy)
		FailToCopy();
	std::array<char, 65536> bytes;
	std::uint64_t copied = 0;
	while (const std::size_t count = std::fread(bytes.data(), 1, bytes.size(), stdin))
	{
		if (std::fwrite(bytes.data(), 1, count, pCopy) != count)
			FailToCopy();
		if ((copied += count) > i_MaximumBytes)
			break;
	}
	boost::filesystem::path path = FinishScratchFile(pCopy);
	if (std::ferror(stdin) || path.empty())
		FailToCopy();
	return path;
}

} // namespace

boost::filesystem::path InputPath(const std::string& i_rWord, std::uint64_t i_MaximumBytes)
{
	if (i_rWord != c_pStandardStream)
		return UtilsFileSystem::PathFromUtf8(i_rWord);
	static bool s_bCopied = false;
	if (s_bCopied)
		throw VCommandError(EWrongUsage, "- is given for more than one file, and standard input holds only one");
	s_bCopied = true;
	return CopyOfStandardInput(i_MaximumBytes);
}

} // namespace CommandLine
