#include <windows.h>

#include "CommandLineText/System.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/operations.hpp>

#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <io.h>

namespace CommandLine
{
namespace
{

boost::filesystem::path& ScratchFile()
{
	static boost::filesystem::path s_Path;
	return s_Path;
}

} // namespace

std::size_t TerminalWidth()
{
	CONSOLE_SCREEN_BUFFER_INFO info{};
	return ::GetConsoleScreenBufferInfo(::GetStdHandle(STD_OUTPUT_HANDLE), &info) ? std::size_t(info.dwSize.X) : 0;
}

void PrepareStreams()
{
	for (std::FILE* const pStream : {stdin, stdout, stderr})
		::_setmode(::_fileno(pStream), _O_BINARY);
	::SetConsoleOutputCP(CP_UTF8);
}

int OpenToAppend(const std::string& i_rFile)
{
	// The right to append alone has the system itself find the end.
	const HANDLE file = ::CreateFileW(UtilsFileSystem::Platform::NativePath(i_rFile).c_str(), FILE_APPEND_DATA,
	    FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr, OPEN_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
	if (file != INVALID_HANDLE_VALUE)
		return ::_open_osfhandle(reinterpret_cast<std::intptr_t>(file), 0);
	const DWORD error = ::GetLastError();
	errno = error == ERROR_PATH_NOT_FOUND ? ENOENT : error == ERROR_DISK_FULL ? ENOSPC : EACCES;
	return -1;
}

bool WriteAtOnce(int i_Descriptor, std::string_view i_Text)
{
	const auto size = unsigned(i_Text.size());
	return size == i_Text.size() && ::_write(i_Descriptor, i_Text.data(), size) == int(size);
}

std::FILE* OpenScratchFile()
{
	boost::system::error_code error;
	ScratchFile() =
	    boost::filesystem::temp_directory_path(error) / boost::filesystem::unique_path("retarget-%%%%%%%%%%%%", error);
	int failure = 0;
	std::FILE* const pFile = UtilsFileSystem::Platform::Open(ScratchFile(), "wb", failure);
	errno = failure;
	if (pFile)
		std::atexit([] { UtilsFileSystem::Platform::Unlink(ScratchFile().c_str()); });
	return pFile;
}

boost::filesystem::path FinishScratchFile(std::FILE* io_pFile)
{
	// Nobody can read it as long as it is open for writing.
	return std::fclose(io_pFile) == 0 ? ScratchFile() : boost::filesystem::path();
}

bool HasEndedItself(int i_Code)
{
	// The system's own codes for what ends a process are errors of the highest kind.
	return unsigned(i_Code) >> 30 != 3;
}

} // namespace CommandLine
