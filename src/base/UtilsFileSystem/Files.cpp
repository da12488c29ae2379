#include "UtilsFileSystem/Files.h"

#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "UtilsFileSystem/LockingProcesses.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cerrno>
#include <cstring>

namespace UtilsFileSystem
{
namespace
{

using boost::filesystem::path;
using boost::system::error_code;

constexpr std::size_t c_FullBufferBytes = 0x800000;

std::string RuntimeErrorText(int i_Error)
{
	return boost::system::generic_category().message(i_Error);
}

bool WritesOnly(const char* i_pMode)
{
	return std::strchr(i_pMode, 'r') == nullptr;
}

VFile OpenFile(const path& i_rPath, const char* i_pMode, int& o_rError)
{
	VFile pFile(Platform::Open(i_rPath, i_pMode, o_rError));
	if (!pFile)
		LogOpenFailure(i_rPath, o_rError,
		    WritesOnly(i_pMode) ? "Failed to open output file %1% locked by processes '%2%'."
		                        : "Failed to open input file %1% locked by processes '%2%'.");
	return pFile;
}

} // namespace

void LogOpenFailure(const path& i_rPath, int i_Error, const char* i_pLockedMessage)
{
	std::vector<std::string> names;
	if (Platform::IsSharingViolation(i_Error) && GetLockingProcesses(i_rPath, names) && !names.empty())
		NVX_LOG("System", NVX::ELogError, i_pLockedMessage, ToUtf8(i_rPath), JoinNames(names));
	else
		NVX_LOG("System", NVX::ELogInformation, "Std error code: %1%", i_Error);
}

VFile OpenFile(const path& i_rPath, const char* i_pMode)
{
	int error = 0;
	return OpenFile(i_rPath, i_pMode, error);
}

namespace
{

/// @param i_OpenError of a file that could not be opened.
std::uint32_t ReadOpened(const VFile& i_rpFile, int i_OpenError, const path& i_rPath, std::size_t i_MaximumBytes,
    std::string& o_rBytes, std::string& o_rError)
{
	o_rBytes.clear();
	const auto fail = [&](std::uint32_t i_Status, const std::string& i_rReason)
	{
		o_rBytes = {};
		o_rError = "Could not read '" + ToUtf8(i_rPath) + "': " + i_rReason;
		return i_Status;
	};
	if (!i_rpFile)
		return fail(NVX::Status::c_FileNotOpened, RuntimeErrorText(i_OpenError));

	// The size is a guess only: pipes have none, and a file may grow.
	error_code sizeError;
	const std::uintmax_t guess = file_size(i_rPath, sizeError);
	if (!sizeError && guess > i_MaximumBytes)
		return fail(NVX::Status::c_Failure, "it is larger than " + std::to_string(i_MaximumBytes) + " bytes");
	constexpr std::size_t c_Step = 1 << 16;
	std::size_t read = 0;
	o_rBytes.resize((sizeError ? 0 : std::size_t(guess)) + 1);
	for (;;)
	{
		errno = 0;
		read += std::fread(o_rBytes.data() + read, 1, o_rBytes.size() - read, i_rpFile.get());
		if (read > i_MaximumBytes)
			return fail(NVX::Status::c_Failure, "it is larger than " + std::to_string(i_MaximumBytes) + " bytes");
		if (read < o_rBytes.size())
			break;
		o_rBytes.resize(std::min(read + std::max(read, c_Step), i_MaximumBytes + 1));
	}
	if (std::ferror(i_rpFile.get()))
		return fail(NVX::Status::c_Failure, RuntimeErrorText(errno));
	o_rBytes.resize(read);
	return NVX::Status::c_Success;
}

} // namespace

std::uint32_t ReadWholeFile(
    const path& i_rPath, std::size_t i_MaximumBytes, std::string& o_rBytes, std::string& o_rError)
{
	int error = 0;
	const VFile pFile = OpenFile(i_rPath, "rb", error);
	return ReadOpened(pFile, error, i_rPath, i_MaximumBytes, o_rBytes, o_rError);
}

std::uint32_t ReadRegularFile(
    const path& i_rPath, std::size_t i_MaximumBytes, std::string& o_rBytes, std::string& o_rError)
{
	int error = 0;
	const VFile pFile(Platform::OpenRegular(i_rPath, error));
	return ReadOpened(pFile, error, i_rPath, i_MaximumBytes, o_rBytes, o_rError);
}

bool RemoveFile(const path& i_rPath)
{
	const std::string name = ToUtf8(i_rPath);
	error_code error;
	const boost::filesystem::file_status status = symlink_status(i_rPath, error);
	if (status.type() == boost::filesystem::file_not_found)
	{
		NVX_LOG("System", NVX::ELogInformation, "Nothing to remove: '%1%' did not exist.", name);
		return true;
	}
	error.clear();
	if (is_directory(status))
		error.assign(EISDIR, boost::system::generic_category());
	else
		boost::filesystem::remove(i_rPath, error);
	if (!error)
	{
		NVX_LOG("System", NVX::ELogInformation, "Removed file '%1%'.", name);
		return true;
	}
	std::vector<std::string> names;
	if (GetLockingProcesses(i_rPath, names) && !names.empty())
		NVX_LOG("System", NVX::ELogError, "Failed to remove file '%1%': file is locked by processes '%2%'.", name,
		    JoinNames(names));
	else
		NVX_LOG("System", NVX::ELogError, "Failed to remove file '%1%': %2%", name, error.message());
	return false;
}

std::uint32_t CreateDirectories(const path& i_rPath)
{
	error_code error;
	const boost::filesystem::file_type type = status(i_rPath, error).type();
	if (type != boost::filesystem::status_error && type != boost::filesystem::file_not_found)
		return NVX::Status::c_Success;
	create_directories(i_rPath, error);
	if (error)
		return NVX::Status::c_Failure;
	NVX_LOG("System", NVX::ELogInformation, "Created directory: %1%", ToUtf8(i_rPath));
	return NVX::Status::c_Success;
}

bool SetFullBuffering(VFile& io_rFile, const path& i_rPath)
{
	// A size alone is only a wish that C libraries do not all grant: the buffer is ours.
	std::unique_ptr<char[]> pBuffer(new char[c_FullBufferBytes]);
	if (io_rFile && std::setvbuf(io_rFile.get(), pBuffer.get(), _IOFBF, c_FullBufferBytes) == 0)
	{
		io_rFile.get_deleter().m_pBuffer = std::move(pBuffer);
		return true;
	}
	NVX_LOG("System", NVX::ELogError, "Failed to enable full buffering for file stream %1%.", ToUtf8(i_rPath));
	return false;
}

} // namespace UtilsFileSystem
