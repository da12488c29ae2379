#include "retarget/text/InputFile.h"

#include "CommandLineText/ExitStatus.h"

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

/// Open until the process ends, which removes it.
std::FILE* CopyOfStandardInput(std::uint64_t i_MaximumBytes)
{
	std::FILE* const pCopy = std::tmpfile();
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
	if (std::ferror(stdin) || std::fflush(pCopy) != 0)
		FailToCopy();
	return pCopy;
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
	return "/dev/fd/" + std::to_string(fileno(CopyOfStandardInput(i_MaximumBytes)));
}

} // namespace CommandLine
