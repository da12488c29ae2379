#pragma once

#include "FileSystemWatcher/FileChange.h"
#include "NVX/Signal.h"

#include <boost/filesystem/path.hpp>

#include <memory>
#include <set>
#include <string>

namespace FileSystemWatcher
{

class IDirectoryMonitor;

/// Tells of changes in directories, not in what lies below them. One thread of the watcher's own waits for them and
/// runs the callbacks that have no dispatcher. One write may be told as more than one modification, and a file that is
/// written is whole only with the last. A rename is told as the old name and right after it the new one; a file that
/// comes from or goes to another directory is one that is added or removed.
/// Functions may be called from any thread, also from callbacks.
class VFileSystemWatcher
{
public:
	using VChangeSignal = NVX::VSignal<EFileChange, boost::filesystem::path>;
	using VPathSignal = NVX::VSignal<boost::filesystem::path>;

	/// @param i_rExtension of the files that the signals tell of, such as ".fbx", in any case; empty for all.
	/// @throw boost::system::system_error if the system has no means left to watch directories.
	explicit VFileSystemWatcher(const std::string& i_rExtension = {});
	/// For tests: events come from the given monitor.
	VFileSystemWatcher(const std::string& i_rExtension, std::shared_ptr<IDirectoryMonitor> i_pMonitor);
	/// No callback runs any more afterwards, unless this is called by one.
	~VFileSystemWatcher();
	VFileSystemWatcher(const VFileSystemWatcher&) = delete;
	VFileSystemWatcher& operator=(const VFileSystemWatcher&) = delete;

	/// Registers callbacks for the files in a directory and, if given, for its directories. What happens to the
	/// directory itself is told with its own path: removed when its watch has ended, modified when changes were lost
	/// and its content should be looked at again.
	/// @throw boost::system::system_error if the directory cannot be watched.
	void Watch(const boost::filesystem::path& i_rDirectory, VChangeSignal::VCallback i_FileCallback,
	    VChangeSignal::VCallback i_DirectoryCallback = {},
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher = {});

	/// Replaces the directories whose files the signals tell of. One that cannot be watched, or is gone, is told in the
	/// log and watched as soon as it is there: the directories above it are watched, too.
	void SetDirectories(const std::set<boost::filesystem::path>& i_rDirectories);
	/// A new name is added, an old one removed.
	VPathSignal& GetAdded();
	VPathSignal& GetRemoved();
	VPathSignal& GetModified();
	/// One of the directories, as it was given, whose content should be looked at again: it appeared, another one took
	/// its place, it is gone, or changes in it were lost.
	VPathSignal& GetRefreshed();

private:
	struct VState;
	std::shared_ptr<VState> m_pState;
};

} // namespace FileSystemWatcher
