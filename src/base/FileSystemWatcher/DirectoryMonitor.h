#pragma once

#include "FileSystemWatcher/FileChange.h"

#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

/// What this library asks of the system, one file for each system, and what the systems have in common.
namespace FileSystemWatcher
{

/// One event as a system tells it.
struct VSystemEvent
{
	/// What Add returned; below 0 for all, without an error: other directories may stand where those watched stood.
	int m_Watch = 0;
	EFileChange m_Change = EAdded;
	/// Name within the directory in UTF-8; empty for an error.
	std::string m_Name = {};
	bool m_bDirectory = false;
	/// Joins the two halves of a rename; 0 for none. A half without its partner is a file that came or went.
	std::uint32_t m_Rename = 0;
	/// Why changes are lost; empty for a change.
	std::string m_Error = {};
	/// With an error: nothing more will come from this watch.
	bool m_bEnded = false;
};

/// Brings the halves of each rename within a directory together, old name first, and turns halves without a partner
/// into files that came or went.
/// @param i_bMoreToCome the last old name may still find its partner: it is left at the end as it is, for the next
/// call.
/// @return true if such a name is left.
bool PairRenames(std::vector<VSystemEvent>& io_rEvents, bool i_bMoreToCome);

/// Directories that are watched without what lies below them. Wait is for one thread, the others for any.
class IDirectoryMonitor
{
public:
	virtual ~IDirectoryMonitor() = default;
	/// @return a number above 0 that is never used again; for a directory that is watched already it may be the same.
	/// @throw boost::system::system_error
	virtual int Add(const boost::filesystem::path& i_rDirectory) = 0;
	virtual void Remove(int i_Watch) = 0;
	/// Waits for events, whose names are in their final form.
	/// @return false once Stop was called.
	virtual bool Wait(std::vector<VSystemEvent>& o_rEvents) = 0;
	virtual void Stop() = 0;
};

/// @throw boost::system::system_error
std::unique_ptr<IDirectoryMonitor> MakeDirectoryMonitor();

/// What the error says when a directory cannot be watched.
inline constexpr const char* c_pMonitorFailure =
    "boost::asio::basic_dir_monitor_service::init_iocp: CreateIoCompletionPort failed";

} // namespace FileSystemWatcher
