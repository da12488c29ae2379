#pragma once

#include <boost/filesystem/path.hpp>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <memory>
#include <string>

namespace UtilsFileSystem
{

struct VCloseFile
{
	void operator()(std::FILE* i_pFile) const { std::fclose(i_pFile); }
	/// What SetFullBuffering gave to the file: it must outlive it.
	std::unique_ptr<char[]> m_pBuffer;
};
using VFile = std::unique_ptr<std::FILE, VCloseFile>;

/// Opens a file of the C runtime. A directory is refused. On a sharing failure the processes that hold the file are
/// logged.
/// @param i_pMode of fopen.
/// @return null on failure.
VFile OpenFile(const boost::filesystem::path& i_rPath, const char* i_pMode);

/// Reads all of a file, or of a pipe to its end.
/// @param i_MaximumBytes a file that is longer is refused without reading more than that.
/// @return NVX::Status::c_Success, c_FileNotOpened, or c_Failure for a file that is too long or cannot be read; then
/// o_rBytes is empty and o_rError tells why.
std::uint32_t ReadWholeFile(
    const boost::filesystem::path& i_rPath, std::size_t i_MaximumBytes, std::string& o_rBytes, std::string& o_rError);

/// The same of a file that somebody else's file names: anything but a regular file is refused, whenever it came to
/// stand there, without waiting for a pipe's other end. Nothing is logged.
std::uint32_t ReadRegularFile(
    const boost::filesystem::path& i_rPath, std::size_t i_MaximumBytes, std::string& o_rBytes, std::string& o_rError);

/// @return true if there is no such file afterwards. Directories are not removed.
bool RemoveFile(const boost::filesystem::path& i_rPath);

/// Makes the whole chain of folders if nothing stands at the path.
/// @return a result code.
std::uint32_t CreateDirectories(const boost::filesystem::path& i_rPath);

/// Gives a file that was just opened a buffer of 8 MiB that is written only when full.
/// @param i_rPath for the message.
bool SetFullBuffering(VFile& io_rFile, const boost::filesystem::path& i_rPath);

/// Logs why an open failed: who holds the file, if that is the reason and the system can tell, otherwise the error.
/// @param i_pLockedMessage with %1% for the path and %2% for the names.
void LogOpenFailure(const boost::filesystem::path& i_rPath, int i_Error, const char* i_pLockedMessage);

} // namespace UtilsFileSystem
