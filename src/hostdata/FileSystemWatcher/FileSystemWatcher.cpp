#include "FileSystemWatcher/FileSystemWatcher.h"

#include "DebugServices/GlobalLog.h"
#include "FileSystemWatcher/DirectoryMonitor.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/algorithm/string/predicate.hpp>
#include <boost/filesystem/operations.hpp>
#include <boost/system/system_error.hpp>

#include <atomic>
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

/// One directory however it is spelled.
path Key(const path& i_rDirectory)
{
	boost::system::error_code error;
	const path canonical = boost::filesystem::canonical(i_rDirectory, error);
	return error ? i_rDirectory : canonical;
}

/// A directory that is watched, for callbacks of its own, for the three signals of the watcher, or both.
struct VDirectory
{
	path m_Path;
	int m_Watch = 0;
	bool m_bListed = false;
	bool m_bCallbacks = false;
	VFileSystemWatcher::VChangeSignal m_Files;
	VFileSystemWatcher::VChangeSignal m_Directories;
};

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
		const path key = Key(i_rDirectory);
		const auto it = m_Directories.find(key);
		if (it != m_Directories.end())
			return *it->second;
		auto pDirectory = std::make_shared<VDirectory>();
		pDirectory->m_Path = i_rDirectory;
		pDirectory->m_Watch = m_pMonitor->Add(i_rDirectory);
		m_Watches[pDirectory->m_Watch] = key;
		return *(m_Directories[key] = std::move(pDirectory));
	}

	void Drop(int i_Watch)
	{
		const auto it = m_Watches.find(i_Watch);
		if (it == m_Watches.end())
			return;
		m_Directories.erase(it->second);
		m_Watches.erase(it);
	}

	/// @return the directories that an event is about: one, or all when the system lost changes of any.
	std::vector<std::shared_ptr<VDirectory>> Find(const VSystemEvent& i_rEvent)
	{
		const std::lock_guard lock(m_Mutex);
		std::vector<std::shared_ptr<VDirectory>> found;
		for (const auto& [rKey, rpDirectory] : m_Directories)
			if (rpDirectory->m_Watch == i_rEvent.m_Watch || i_rEvent.m_Watch < 0)
				found.push_back(rpDirectory);
		if (i_rEvent.m_bEnded)
		{
			m_pMonitor->Remove(i_rEvent.m_Watch);
			Drop(i_rEvent.m_Watch);
		}
		return found;
	}

	void Deliver(const VSystemEvent& i_rEvent)
	{
		for (const std::shared_ptr<VDirectory>& rpDirectory : Find(i_rEvent))
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
		const path file = i_rDirectory.m_Path / UtilsFileSystem::PathFromUtf8(i_rEvent.m_Name);
		(i_rEvent.m_bDirectory ? i_rDirectory.m_Directories : i_rDirectory.m_Files).Fire(i_rEvent.m_Change, file);
		bool bListed = false;
		{
			const std::lock_guard lock(m_Mutex);
			bListed = i_rDirectory.m_bListed;
		}
		if (!bListed || i_rEvent.m_bDirectory
		    || (!m_Extension.empty()
		        && !boost::algorithm::iequals(UtilsFileSystem::ToUtf8(file.extension()), m_Extension)))
			return;
		switch (i_rEvent.m_Change)
		{
		case EAdded:
		case ERenamedNew: m_Added.Fire(file); break;
		case ERemoved:
		case ERenamedOld: m_Removed.Fire(file); break;
		case EModified: m_Modified.Fire(file); break;
		}
	}

	/// Callbacks of others run on the watcher's thread: what they throw must not end the process.
	void Run()
	{
		std::vector<VSystemEvent> events;
		while (m_pMonitor->Wait(events))
			for (const VSystemEvent& rEvent : events)
			{
				if (m_bStopped)
					return;
				try
				{
					Deliver(rEvent);
				}
				catch (const std::exception& rError)
				{
					LogFailure(rError.what());
				}
			}
	}

	const std::string m_Extension;
	const std::shared_ptr<IDirectoryMonitor> m_pMonitor;
	VPathSignal m_Added;
	VPathSignal m_Removed;
	VPathSignal m_Modified;
	std::thread m_Thread;
	std::atomic<bool> m_bStopped{false};

	std::mutex m_Mutex;
	/// By Key.
	std::map<path, std::shared_ptr<VDirectory>> m_Directories;
	std::map<int, path> m_Watches;
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
		rDirectory.m_Directories.Connect(std::move(i_DirectoryCallback), i_pDispatcher);
}

void VFileSystemWatcher::SetDirectories(const std::set<path>& i_rDirectories)
{
	std::set<path> keys;
	std::vector<std::string> failures;
	{
		const std::lock_guard lock(m_pState->m_Mutex);
		for (const path& rDirectory : i_rDirectories)
			try
			{
				m_pState->FindOrAdd(rDirectory).m_bListed = true;
				keys.insert(Key(rDirectory));
			}
			catch (const boost::system::system_error& rError)
			{
				failures.push_back(UtilsFileSystem::ToUtf8(rDirectory) + ": " + rError.what());
			}
		std::vector<int> unused;
		for (const auto& [rKey, rpDirectory] : m_pState->m_Directories)
			if (!keys.contains(rKey))
			{
				rpDirectory->m_bListed = false;
				if (!rpDirectory->m_bCallbacks)
					unused.push_back(rpDirectory->m_Watch);
			}
		for (const int watch : unused)
		{
			m_pState->m_pMonitor->Remove(watch);
			m_pState->Drop(watch);
		}
	}
	for (const std::string& rFailure : failures)
		LogFailure(rFailure);
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

} // namespace FileSystemWatcher
