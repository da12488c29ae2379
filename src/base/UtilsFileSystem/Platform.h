#pragma once

#include "UtilsFileSystem/LockingProcesses.h"
#include "UtilsFileSystem/Registry.h"

#include <boost/filesystem/path.hpp>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>
#include <string_view>

/// All that this library asks of the system. One file for each system implements it; everything else is portable.
/// Errors are numbers of the C runtime (errno) unless told otherwise.
namespace UtilsFileSystem::Platform
{

std::shared_ptr<IProcessTable> GetProcessTable();

/// Of this process; no other process of this machine has it as long as this one runs.
std::uint32_t ProcessId();
/// False where that cannot be told.
bool IsProcessGone(std::uint32_t i_ProcessId);
std::string MachineName();

/// The registry's root of the local machine; null on a system without a registry.
std::unique_ptr<IRegistryKey> OpenLocalMachine();

/// The path in the form that the system's calls take at any length.
boost::filesystem::path::string_type NativePath(const boost::filesystem::path& i_rPath);

/// @return null with o_rError set. A directory is refused.
std::FILE* Open(const boost::filesystem::path& i_rPath, const char* i_pMode, int& o_rError);
/// The same to read, and only what is a regular file when it is open: no pipe is waited for, no device read.
std::FILE* OpenRegular(const boost::filesystem::path& i_rPath, int& o_rError);
/// True if the error of an open that just failed on this thread means that another process holds the file.
bool IsSharingViolation(int i_Error);

/// A file that is mapped in views.
struct VMapped
{
	std::intptr_t m_File = -1;
	std::intptr_t m_Mapping = 0;
	std::uint64_t m_Size = 0;
	bool m_bWrite = false;
};
/// @param i_Size of an output file, which is made or replaced; an input file keeps its own.
/// @return 0 or an error; then nothing is held.
int OpenMapped(const boost::filesystem::path& i_rPath, bool i_bWrite, std::uint64_t i_Size, VMapped& o_rMapped);
/// @param i_Offset a multiple of GetMappingGranularity(). @param i_Length more than 0 and within the file.
/// @return null on failure.
void* MapView(const VMapped& i_rMapped, std::uint64_t i_Offset, std::size_t i_Length);
/// Copies bytes of a view. The file may have been cut short by another program since, where touching them would end the
/// process.
/// @return how many could be copied.
std::size_t CopyFromView(const char* i_pBytes, std::size_t i_Count, void* o_pBytes);
void UnmapView(void* i_pView, std::size_t i_Length);
void CloseMapped(VMapped& io_rMapped);
std::size_t GetMappingGranularity();

/// @name Parts of a save. Each returns 0 or an error of the system, which is not errno everywhere, for ErrorText.
/// @{
/// Makes a file that was not there, with the rights and owner of i_pModel if given, writes all bytes and waits until
/// they are on the disk. On failure the new file is gone.
int WriteNewFile(
    const boost::filesystem::path& i_rPath, std::string_view i_Bytes, const boost::filesystem::path* i_pModel);
/// True if the file may not be written to, be it by its rights or by who asks.
bool IsReadOnly(const boost::filesystem::path& i_rFile);
/// Puts a file in the place of another in one step.
int Replace(const boost::filesystem::path& i_rFrom, const boost::filesystem::path& i_rTo);
/// Waits until the names in a folder are on the disk, where the file system offers that.
int SyncFolder(const boost::filesystem::path& i_rFolder);
/// Removes a file, given as NativePath gives it; may be called from a signal handler.
void Unlink(const boost::filesystem::path::value_type* i_pNative) noexcept;
std::string ErrorText(int i_Error);
/// @}

} // namespace UtilsFileSystem::Platform
