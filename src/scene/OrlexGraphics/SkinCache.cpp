#include "OrlexGraphics/SkinCache.h"

#include "DebugServices/GlobalLog.h"
#include "FileSystemWatcher/FileSystemWatcher.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/filesystem/operations.hpp>

#include <set>

namespace OrlexGraphics
{

namespace
{

constexpr const char* c_pExtension = ".fbx";

/// Copying a file changes it many times.
constexpr int c_ChangeDelay = 1000;

} // namespace

VSkinCache::VSkinCache(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
    : m_pDispatcher(std::move(i_pDispatcher))
{
	m_ChangeTimer.setSingleShot(true);
	m_ChangeTimer.setInterval(c_ChangeDelay);
	QObject::connect(&m_ChangeTimer, &QTimer::timeout, &m_ChangeTimer, [this] { m_ChangedSignal.Fire(); });
}

VSkinCache::~VSkinCache() = default;

void VSkinCache::SetFolders(const std::string& i_rGroup, const std::vector<boost::filesystem::path>& i_rFolders)
{
	std::shared_ptr<FileSystemWatcher::VFileSystemWatcher> pWatcher;
	{
		const std::lock_guard lock(m_Mutex);
		if (m_bDisposed)
			return;
		VSkinGroup& rGroup = m_Groups[i_rGroup];
		if (rGroup.m_Folders == i_rFolders)
			return;
		rGroup.m_Entries.clear();
		rGroup.m_Folders = i_rFolders;
		if (!rGroup.m_pWatcher)
			rGroup.m_pWatcher = MakeWatcher(i_rGroup);
		pWatcher = rGroup.m_pWatcher;
	}
	if (pWatcher)
		pWatcher->SetDirectories({i_rFolders.begin(), i_rFolders.end()});
	m_ChangedSignal.Fire();
}

std::shared_ptr<FileSystemWatcher::VFileSystemWatcher> VSkinCache::MakeWatcher(const std::string& i_rGroup)
{
	try
	{
		auto pWatcher = std::make_shared<FileSystemWatcher::VFileSystemWatcher>(c_pExtension);
		const auto onChange = [i_rGroup, call = WeakBind(&VSkinCache::OnChange)](const boost::filesystem::path& i_rPath)
		{ call(i_rGroup, i_rPath); };
		for (auto* const pSignal : {&pWatcher->GetAdded(), &pWatcher->GetRemoved(), &pWatcher->GetModified()})
			pSignal->Connect(onChange, m_pDispatcher);
		return pWatcher;
	}
	catch (const boost::system::system_error& rError)
	{
		// Skins are still found, but their changes are not seen.
		NVX_LOG("VSkinCache", NVX::ELogError, "Folders of skins are not watched: %1%", rError.what());
		return {};
	}
}

bool VSkinCache::HasFolders(const std::string& i_rGroup)
{
	const std::lock_guard lock(m_Mutex);
	return m_Groups.contains(i_rGroup);
}

std::uint32_t VSkinCache::GetPath(
    boost::filesystem::path& o_rPath, const std::string& i_rName, const std::string& i_rGroup)
{
	const std::lock_guard lock(m_Mutex);
	if (m_bDisposed)
		return SkinStatus::c_Disposed;
	const auto group = m_Groups.find(i_rGroup);
	if (group == m_Groups.end())
		return SkinStatus::c_NotFound;
	VSkinEntry& rEntry = group->second.m_Entries[i_rName];
	if (rEntry.m_Status == SkinStatus::c_NotLookedFor)
	{
		rEntry.m_Status = SkinStatus::c_NotFound;
		for (const boost::filesystem::path& rFolder : group->second.m_Folders)
		{
			const boost::filesystem::path path = rFolder / UtilsFileSystem::PathFromUtf8(i_rName + c_pExtension);
			boost::system::error_code error;
			if (!boost::filesystem::exists(path, error))
				continue;
			rEntry.m_Path = path;
			rEntry.m_Status = SkinStatus::c_Ready;
		}
	}
	o_rPath = rEntry.m_Path;
	return rEntry.m_Status;
}

void VSkinCache::OnChange(const std::string& i_rGroup, const boost::filesystem::path& i_rPath)
{
	{
		const std::lock_guard lock(m_Mutex);
		if (m_bDisposed)
			return;
		NVX_LOG("VSkinCache", NVX::ELogDetail, "Detected a change to %1%", UtilsFileSystem::ToUtf8(i_rPath));
		if (const auto group = m_Groups.find(i_rGroup); group != m_Groups.end())
			group->second.m_Entries.erase(UtilsFileSystem::ToUtf8(i_rPath.stem()));
	}
	m_ChangeTimer.start();
}

void VSkinCache::Dispose()
{
	m_ChangeTimer.stop();
	// The watchers end outside of the lock: they wait for their threads.
	std::unordered_map<std::string, VSkinGroup> groups;
	{
		const std::lock_guard lock(m_Mutex);
		m_bDisposed = true;
		groups.swap(m_Groups);
	}
}

} // namespace OrlexGraphics
