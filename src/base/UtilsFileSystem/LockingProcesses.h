#pragma once

#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace UtilsFileSystem
{

/// Holders beyond this number: no list at all.
inline constexpr std::size_t c_MaximumHolders = 10;

/// A process that holds a file, as the system listed it.
struct VLockHolder
{
	std::uint32_t m_ProcessId = 0;
	/// When the process began, in units of the system. Together with the id it tells one process from a later one that
	/// got its id.
	std::uint64_t m_StartTime = 0;
};

/// An opened process; it stays the same one for as long as it is held, even if its id is used again.
class IProcess
{
public:
	virtual ~IProcess() = default;
	virtual bool GetStartTime(std::uint64_t& o_rTime) = 0;
	/// The full path of the program in UTF-8.
	virtual bool GetImagePath(std::string& o_rPath) = 0;
};

/// What the system tells about who holds a file.
class IProcessTable
{
public:
	virtual ~IProcessTable() = default;
	/// @return false if the system cannot tell.
	virtual bool FindHolders(const boost::filesystem::path& i_rPath, std::vector<VLockHolder>& o_rHolders) = 0;
	/// @return null if the process is gone or may not be asked.
	virtual std::unique_ptr<IProcess> Open(std::uint32_t i_ProcessId) = 0;
};

/// The names of the programs that hold a file: their full paths, "unknown process" for one whose identity or path could
/// not be made sure of, nothing for one that could not be opened.
/// @return false if the system cannot tell or there are more than c_MaximumHolders. No list is given then.
bool GetLockingProcesses(const boost::filesystem::path& i_rPath, std::vector<std::string>& o_rNames);
bool GetLockingProcesses(
    IProcessTable& i_rTable, const boost::filesystem::path& i_rPath, std::vector<std::string>& o_rNames);

/// The names as they stand in messages between quotes: joined by "', '".
std::string JoinNames(const std::vector<std::string>& i_rNames);

} // namespace UtilsFileSystem
