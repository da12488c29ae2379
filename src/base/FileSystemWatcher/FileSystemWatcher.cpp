#include "FileSystemWatcher/FileSystemWatcher.h"

#include "DebugServices/GlobalLog.h"
#include "FileSystemWatcher/DirectoryMonitor.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/algorithm/string/predicate.hpp>
#include <boost/filesystem/operations.hpp>
#include <boost/system/system_error.hpp>

#include <atomic>
#include <functional>
#include <map>
#include <mutex>
#include <thread>

namespace FileSystemWatcher
{
namespace
{

using boost::filesystem::path;

void LogFailure(const std::string& i_rError)
{
	NVX_LOG("FilesystemWatcher", NVX::ELogError, "Error monitoring directory for changes:%1%", i_rError);
}

/// A directory that is watched: for callbacks of its own, for the signals of the watcher, or because it stands above
/// one of those.
struct VDirectory
{
	path m_Path;
	int m_Watch = 0;
	bool m_bCallbacks = false;
	/// The listed directories that are this one, as they were given.
	std::set<path> m_Listed;
	/// By the next name on the way: the listed directories below this one.
	std::multimap<std::string, path> m_ListedBelow;
	VFileSystemWatcher::VChangeSignal m_Files;
	VFileSystemWatcher::VChangeSignal m_Directories;
};

/// What there is to tell of a listed directory once the lock is gone.
struct VNews
{
	path m_Directory;
	boost::system::error_code m_Error;
	/// What the system said; empty if the directory is watched.
	std::string m_Reason;
};

void TellOperator(const VNews& i_rNews)
{
	const std::string directory = UtilsFileSystem::ToUtf8(i_rNews.m_Directory);
	if (i_rNews.m_Reason.empty())
		NVX_LOG("FilesystemWatcher", NVX::ELogInformation, "The folder %1% is there: what it holds is looked at again",
		    directory);
	else if (i_rNews.m_Error == boost::system::errc::no_such_file_or_directory)
		NVX_LOG("FilesystemWatcher", NVX::ELogWarning,
		    "The folder %1% does not exist. Make it, or choose another one; it is used as soon as it is there",
		    directory);
	else
		NVX_LOG("FilesystemWatcher", NVX::ELogWarning,
		    "The folder %1% cannot be watched (%2%): what changes in it is not followed", directory,
		    i_rNews.m_Error.message());
}

} // namespace

struct VFileSystemWatcher::VState
{
	VState(const std::string& i_rExtension, std::shared_ptr<IDirectoryMonitor> i_pMonitor)
	    : m_Extension(i_rExtension), m_pMonitor(std::move(i_pMonitor))
	{
	}

	/// Under the lock: an event may come before the watch is known here.
	VDirectory& FindOrAdd(const path& i_rDirectory)
	{
		const auto it = m_Directories.find(UtilsFileSystem::Canonical(i_rDirectory));
		return it != m_Directories.end() ? *it->second : Renew(i_rDirectory);
	}

	/// The directory that stands at a path now, which may be another one than before.
	VDirectory& Renew(const path& i_rDirectory)
	{
		const int watch = m_pMonitor->Add(i_rDirectory);
		if (const auto known = m_Watches.find(watch); known != m_Watches.end())
			return *m_Directories[known->second];
		const path key = UtilsFileSystem::Canonical(i_rDirectory);
		std::shared_ptr<VDirectory>& rpDirectory = m_Directories[key];
		if (!rpDirectory)
		{
			rpDirectory = std::make_shared<VDirectory>();
			rpDirectory->m_Path = i_rDirectory;
		}
		else
		{
			m_pMonitor->Remove(rpDirectory->m_Watch);
			m_Watches.erase(rpDirectory->m_Watch);
		}
		rpDirectory->m_Watch = watch;
		m_Watches[watch] = key;
		return *rpDirectory;
	}

	void Drop(int i_Watch)
	{
		const auto it = m_Watches.find(i_Watch);
		if (it == m_Watches.end())
			return;
		m_pMonitor->Remove(i_Watch);
		m_Directories.erase(it->second);
		m_Watches.erase(it);
	}

	void DropUnused()
	{
		std::vector<int> unused;
		for (const auto& [rKey, rpDirectory] : m_Directories)
			if (!rpDirectory->m_bCallbacks && rpDirectory->m_Listed.empty() && rpDirectory->m_ListedBelow.empty())
				unused.push_back(rpDirectory->m_Watch);
		for (const int watch : unused)
			Drop(watch);
	}

	void Unlist(const path& i_rListed)
	{
		for (const auto& [rKey, rpDirectory] : m_Directories)
		{
			rpDirectory->m_Listed.erase(i_rListed);
			std::erase_if(
			    rpDirectory->m_ListedBelow, [&](const auto& i_rBelow) { return i_rBelow.second == i_rListed; });
		}
	}

	/// Watches a listed directory, and all above it as far as they are there: that is where it appears, and where
	/// another one takes its place. From the top, so that what appears meanwhile is told.
	/// @return its watch, 0 for none
	int Follow(const path& i_rListed, VNews& o_rNews)
	{
		Unlist(i_rListed);
		const path whole = boost::filesystem::absolute(i_rListed);
		path above = whole.root_path();
		for (const path& rPart : whole.relative_path())
		{
			try
			{
				Renew(above).m_ListedBelow.emplace(UtilsFileSystem::ToUtf8(rPart), i_rListed);
			}
			catch (const boost::system::system_error&)
			{
				// It is not there, or closed to this user.
			}
			above /= rPart;
		}
		o_rNews.m_Directory = i_rListed;
		try
		{
			VDirectory& rDirectory = Renew(whole);
			rDirectory.m_Listed.insert(i_rListed);
			return rDirectory.m_Watch;
		}
		catch (const boost::system::system_error& rError)
		{
			o_rNews.m_Error = rError.code();
			o_rNews.m_Reason = rError.what();
			return 0;
		}
	}

	/// The listed directories that may be others, or not be there, after an event.
	/// @param o_rLost those whose content must be looked at again in any case.
	std::set<path> Concerned(const VSystemEvent& i_rEvent, std::set<path>& o_rLost) const
	{
		std::set<path> concerned;
		for (const auto& [rKey, rpDirectory] : m_Directories)
		{
			if (rpDirectory->m_Watch != i_rEvent.m_Watch && i_rEvent.m_Watch >= 0)
				continue;
			if (!i_rEvent.m_Error.empty())
				o_rLost.insert(rpDirectory->m_Listed.begin(), rpDirectory->m_Listed.end());
			const auto [begin, end] = i_rEvent.m_Name.empty()
			    ? std::pair(rpDirectory->m_ListedBelow.begin(), rpDirectory->m_ListedBelow.end())
			    : rpDirectory->m_ListedBelow.equal_range(i_rEvent.m_Name);
			for (auto it = begin; it != end; ++it)
				// A change of rights may open one that was closed; all else that is modified stays what it is.
				if (i_rEvent.m_Name.empty() || i_rEvent.m_Change != EModified || m_Listed.at(it->second) == 0)
					concerned.insert(it->second);
		}
		concerned.insert(o_rLost.begin(), o_rLost.end());
		return concerned;
	}

	/// Brings listed directories up to date.
	/// @param i_Changed those to be looked at again in any case
	void Refresh(const std::set<path>& i_rConcerned, std::set<path> i_Changed)
	{
		std::vector<VNews> news;
		{
			const std::lock_guard lock(m_Mutex);
			for (const path& rListed : i_rConcerned)
			{
				const auto listed = m_Listed.find(rListed);
				if (listed == m_Listed.end())
					continue;
				VNews of;
				const int watch = Follow(rListed, of);
				if (std::exchange(listed->second, watch) != watch)
				{
					i_Changed.insert(rListed);
					news.push_back(std::move(of));
				}
			}
			if (!i_rConcerned.empty())
				DropUnused();
		}
		for (const VNews& rNews : news)
			TellOperator(rNews);
		for (const path& rListed : i_Changed)
			m_Refreshed.Fire(rListed);
	}

	/// Under the lock.
	/// @return the directories that an event is about: one, or all when the system lost changes of any.
	std::vector<std::shared_ptr<VDirectory>> Find(const VSystemEvent& i_rEvent)
	{
		std::vector<std::shared_ptr<VDirectory>> found;
		for (const auto& [rKey, rpDirectory] : m_Directories)
			if (rpDirectory->m_Watch == i_rEvent.m_Watch || i_rEvent.m_Watch < 0)
				found.push_back(rpDirectory);
		return found;
	}

	void Handle(const VSystemEvent& i_rEvent)
	{
		std::vector<std::shared_ptr<VDirectory>> directories;
		std::set<path> concerned;
		std::set<path> lost;
		{
			const std::lock_guard lock(m_Mutex);
			directories = Find(i_rEvent);
			concerned = Concerned(i_rEvent, lost);
			// Before it is told: who hears of the end may watch what stands at the path by then.
			if (i_rEvent.m_bEnded)
				Drop(i_rEvent.m_Watch);
		}
		Guarded([&] { Deliver(i_rEvent, directories); });
		Guarded([&] { Refresh(concerned, std::move(lost)); });
	}

	void Deliver(const VSystemEvent& i_rEvent, const std::vector<std::shared_ptr<VDirectory>>& i_rDirectories)
	{
		if (i_rEvent.m_Watch < 0 && i_rEvent.m_Error.empty())
			return;
		for (const std::shared_ptr<VDirectory>& rpDirectory : i_rDirectories)
		{
			if (!i_rEvent.m_Error.empty())
			{
				LogFailure(UtilsFileSystem::ToUtf8(rpDirectory->m_Path) + ": " + i_rEvent.m_Error);
				rpDirectory->m_Directories.Fire(i_rEvent.m_bEnded ? ERemoved : EModified, rpDirectory->m_Path);
			}
			else if (i_rEvent.m_Change < EAdded || i_rEvent.m_Change > ERenamedNew)
				NVX_LOG("FilesystemWatcher", NVX::ELogError,
				    i_rEvent.m_bDirectory ? "Unexpected type of change to directory reported."
				                          : "Unexpected type of change to regular file reported.");
			else
				DeliverChange(*rpDirectory, i_rEvent);
		}
	}

	void DeliverChange(VDirectory& i_rDirectory, const VSystemEvent& i_rEvent)
	{
		const path name = UtilsFileSystem::PathFromUtf8(i_rEvent.m_Name);
		(i_rEvent.m_bDirectory ? i_rDirectory.m_Directories : i_rDirectory.m_Files)
		    .Fire(i_rEvent.m_Change, i_rDirectory.m_Path / name);
		if (i_rEvent.m_bDirectory
		    || (!m_Extension.empty()
		        && !boost::algorithm::iequals(UtilsFileSystem::ToUtf8(name.extension()), m_Extension)))
			return;
		std::set<path> listed;
		{
			const std::lock_guard lock(m_Mutex);
			listed = i_rDirectory.m_Listed;
		}
		for (const path& rListed : listed)
			switch (i_rEvent.m_Change)
			{
			case EAdded:
			case ERenamedNew: m_Added.Fire(rListed / name); break;
			case ERemoved:
			case ERenamedOld: m_Removed.Fire(rListed / name); break;
			case EModified: m_Modified.Fire(rListed / name); break;
			}
	}

	/// Callbacks of others run on the watcher's thread: what they throw must not end the process.
	static void Guarded(const std::function<void()>& i_rCall)
	{
		try
		{
			i_rCall();
		}
		catch (const std::exception& rError)
		{
			LogFailure(rError.what());
		}
	}

	void Run()
	{
		std::vector<VSystemEvent> events;
		while (m_pMonitor->Wait(events))
			for (const VSystemEvent& rEvent : events)
			{
				if (m_bStopped)
					return;
				Handle(rEvent);
			}
	}

	const std::string m_Extension;
	const std::shared_ptr<IDirectoryMonitor> m_pMonitor;
	VPathSignal m_Added;
	VPathSignal m_Removed;
	VPathSignal m_Modified;
	VPathSignal m_Refreshed;
	std::thread m_Thread;
	std::atomic<bool> m_bStopped{false};

	std::mutex m_Mutex;
	/// By canonical path.
	std::map<path, std::shared_ptr<VDirectory>> m_Directories;
	std::map<int, path> m_Watches;
	/// As they were given, with their watch; 0 for one that is not there.
	std::map<path, int> m_Listed;
};

VFileSystemWatcher::VFileSystemWatcher(const std::string& i_rExtension)
    : VFileSystemWatcher(i_rExtension, MakeDirectoryMonitor())
{
}

VFileSystemWatcher::VFileSystemWatcher(const std::string& i_rExtension, std::shared_ptr<IDirectoryMonitor> i_pMonitor)
    : m_pState(std::make_shared<VState>(i_rExtension, std::move(i_pMonitor)))
{
	m_pState->m_Thread = std::thread([pState = m_pState] { pState->Run(); });
}

VFileSystemWatcher::~VFileSystemWatcher()
{
	m_pState->m_bStopped = true;
	m_pState->m_pMonitor->Stop();
	// A callback may let go of the watcher: its thread then ends by itself, with the state that it shares.
	if (m_pState->m_Thread.get_id() == std::this_thread::get_id())
		m_pState->m_Thread.detach();
	else
		m_pState->m_Thread.join();
}

void VFileSystemWatcher::Watch(const path& i_rDirectory, VChangeSignal::VCallback i_FileCallback,
    VChangeSignal::VCallback i_DirectoryCallback, std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
{
	const std::lock_guard lock(m_pState->m_Mutex);
	VDirectory& rDirectory = m_pState->FindOrAdd(i_rDirectory);
	rDirectory.m_bCallbacks = true;
	if (i_FileCallback)
		rDirectory.m_Files.Connect(std::move(i_FileCallback), i_pDispatcher);
	if (i_DirectoryCallback)
		rDirectory.m_Directories.Connect(std::move(i_DirectoryCallback), std::move(i_pDispatcher));
}

void VFileSystemWatcher::SetDirectories(const std::set<path>& i_rDirectories)
{
	std::vector<VNews> failures;
	{
		const std::lock_guard lock(m_pState->m_Mutex);
		for (const auto& [rListed, watch] : std::exchange(m_pState->m_Listed, {}))
			m_pState->Unlist(rListed);
		for (const path& rDirectory : i_rDirectories)
		{
			VNews news;
			if ((m_pState->m_Listed[rDirectory] = m_pState->Follow(rDirectory, news)) == 0)
				failures.push_back(std::move(news));
		}
		m_pState->DropUnused();
	}
	for (const VNews& rFailure : failures)
	{
		LogFailure(UtilsFileSystem::ToUtf8(rFailure.m_Directory) + ": " + rFailure.m_Reason);
		TellOperator(rFailure);
	}
}

VFileSystemWatcher::VPathSignal& VFileSystemWatcher::GetAdded()
{
	return m_pState->m_Added;
}

VFileSystemWatcher::VPathSignal& VFileSystemWatcher::GetRemoved()
{
	return m_pState->m_Removed;
}

VFileSystemWatcher::VPathSignal& VFileSystemWatcher::GetModified()
{
	return m_pState->m_Modified;
}

VFileSystemWatcher::VPathSignal& VFileSystemWatcher::GetRefreshed()
{
	return m_pState->m_Refreshed;
}

} // namespace FileSystemWatcher
