#include "CommandLineText/System.h"

#include <fcntl.h>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace CommandLine
{

std::size_t TerminalWidth()
{
	winsize size{};
	return isatty(STDOUT_FILENO) && ::ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0 ? size.ws_col : 0;
}

void PrepareStreams() {}

int OpenToAppend(const std::string& i_rFile)
{
	return ::open(i_rFile.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0666);
}

bool WriteAtOnce(int i_Descriptor, std::string_view i_Text)
{
	return ::write(i_Descriptor, i_Text.data(), i_Text.size()) == ssize_t(i_Text.size());
}

std::FILE* OpenScratchFile()
{
	return std::tmpfile();
}

boost::filesystem::path FinishScratchFile(std::FILE* io_pFile)
{
	// It has no name, and stays as long as it is open.
	return std::fflush(io_pFile) == 0 ? "/dev/fd/" + std::to_string(fileno(io_pFile)) : std::string();
}

bool HasEndedItself(int i_Code)
{
	return WIFEXITED(i_Code);
}

} // namespace CommandLine
