#include "OrlexGraphics/skins/SkinCache.h"

#include "DebugServices/GlobalLog.h"
#include "FileSystemWatcher/FileSystemWatcher.h"
#include "OrlexGraphics/skins/SkinLoadJob.h"
#include "TesselPluginInterface/IJobRunner.h"
#include "UtilsFileSystem/Paths.h"

#include <QTimer>
#include <boost/filesystem/operations.hpp>

#include <set>

namespace OrlexGraphics
{

namespace
{

constexpr const char* c_pExtension = ".fbx";

/// Copying a file changes it many times.
constexpr std::chrono::milliseconds c_ChangeDelay{1000};

boost::filesystem::path FileIn(const boost::filesystem::path& i_rFolder, const std::string& i_rName)
{
	return i_rFolder / UtilsFileSystem::PathFromUtf8(i_rName + c_pExtension);
}

/// The file of a skin in the last folder that has one; empty for none.
boost::filesystem::path FindFile(const std::vector<boost::filesystem::path>& i_rFolders, const std::string& i_rName)
{
	boost::filesystem::path found;
	for (const boost::filesystem::path& rFolder : i_rFolders)
	{
		boost::system::error_code error;
		if (boost::filesystem::exists(FileIn(rFolder, i_rName), error))
			found = FileIn(rFolder, i_rName);
	}
	return found;
}

class VQtDelay : public IDelay
{
public:
	VQtDelay()
	{
		m_Timer.setSingleShot(true);
		QObject::connect(&m_Timer, &QTimer::timeout, &m_Timer, [this] { m_Callback(); });
	}
	void Start(std::chrono::milliseconds i_Time, std::function<void()> i_Callback) override
	{
		m_Callback = std::move(i_Callback);
		m_Timer.start(i_Time);
	}
	void Stop() override { m_Timer.stop(); }

private:
	QTimer m_Timer;
	std::function<void()> m_Callback;
};

} // namespace

VSkinCache::VSkinCache(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
    std::shared_ptr<TesselPluginInterface::IJobRunner> i_pJobRunner, std::unique_ptr<IDelay> i_pDelay)
    : m_pDispatcher(std::move(i_pDispatcher)), m_pJobRunner(std::move(i_pJobRunner)),
      m_pDelay(i_pDelay ? std::move(i_pDelay) : std::make_unique<VQtDelay>())
{
}

VSkinCache::~VSkinCache()
{
	m_pDelay->Stop();
}

void VSkinCache::SetMeshRules(const FBXIO::VMeshRules& i_rRules)
{
	const std::lock_guard lock(m_Mutex);
	m_MeshRules = i_rRules;
}

void VSkinCache::SetFolders(const std::string& i_rGroup, const std::vector<boost::filesystem::path>& i_rFolders)
{
	std::shared_ptr<FileSystemWatcher::VFileSystemWatcher> pWatcher;
	{
		const std::lock_guard lock(m_Mutex);
		if (m_bDisposed)
			return;
		const auto [group, bNew] = m_Groups.try_emplace(i_rGroup);
		VSkinGroup& rGroup = group->second;
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
		pWatcher->GetRefreshed().Connect([i_rGroup, call = WeakBind(&VSkinCache::OnFolder)](
		                                     const boost::filesystem::path& i_rFolder) { call(i_rGroup, i_rFolder); },
		    m_pDispatcher);
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

std::shared_ptr<VSkinLoadJob> VSkinCache::Find(
    VSkinEntry& io_rEntry, const std::string& i_rName, const std::vector<boost::filesystem::path>& i_rFolders)
{
	io_rEntry.m_Status = SkinStatus::c_NotFound;
	io_rEntry.m_Path = FindFile(i_rFolders, i_rName);
	if (io_rEntry.m_Path.empty())
		return {};
	io_rEntry.m_Status = SkinStatus::c_Loading;
	io_rEntry.m_pJob = std::make_shared<VSkinLoadJob>(io_rEntry.m_Path, i_rName, m_MeshRules);
	m_Jobs.push_back(io_rEntry.m_pJob);
	return io_rEntry.m_pJob;
}

std::uint32_t VSkinCache::GetSkin(
    std::shared_ptr<CoreGraphics::VSkin>& o_rpSkin, const std::string& i_rName, const std::string& i_rGroup)
{
	std::unique_lock lock(m_Mutex);
	if (m_bDisposed)
		return SkinStatus::c_Disposed;
	const auto group = m_Groups.find(i_rGroup);
	if (group == m_Groups.end())
		return SkinStatus::c_NotFound;
	VSkinEntry* pEntry = &group->second.m_Entries[i_rName];
	if (pEntry->m_Status == SkinStatus::c_NotLookedFor)
		if (const auto pJob = Find(*pEntry, i_rName, group->second.m_Folders))
		{
			// Nobody waits for the file, nor for what hears of it.
			lock.unlock();
			Run(pJob);
			lock.lock();
			// Meanwhile all may have been forgotten.
			if (m_bDisposed)
				return SkinStatus::c_Disposed;
			pEntry = &m_Groups[i_rGroup].m_Entries[i_rName];
		}
	if (pEntry->m_pJob)
	{
		const std::uint32_t status = pEntry->m_pJob->Result(pEntry->m_pSkin);
		if (status == SkinStatus::c_NotLookedFor)
			return SkinStatus::c_Loading;
		pEntry->m_Status = status;
		pEntry->m_pJob.reset();
	}
	if (pEntry->m_Status == SkinStatus::c_Ready)
		o_rpSkin = pEntry->m_pSkin;
	return pEntry->m_Status;
}

void VSkinCache::Run(const std::shared_ptr<VSkinLoadJob>& i_rpJob)
{
	m_LoadingSignal.Fire();
	std::function<void()> completion = [call = WeakBind(&VSkinCache::OnLoaded), i_rpJob]
	{
		try
		{
			call(i_rpJob);
		}
		catch (const NVX::VDeregisterWeakCallbackException&)
		{
			// Nobody waits for the skin any more.
		}
	};
	if (m_pJobRunner)
		return m_pJobRunner->Run([i_rpJob] { i_rpJob->Run(); }, std::move(completion), m_pDispatcher);
	i_rpJob->Run();
	m_pDispatcher->Post(std::move(completion));
}

void VSkinCache::OnLoaded(const std::shared_ptr<VSkinLoadJob>& i_rpJob)
{
	{
		const std::lock_guard lock(m_Mutex);
		std::erase(m_Jobs, i_rpJob);
		if (m_bDisposed)
			return;
	}
	m_LoadingSignal.Fire();
	m_ChangedSignal.Fire();
}

void VSkinCache::WarnOfMissing(const std::string& i_rName, const std::string& i_rGroup)
{
	std::string folders;
	{
		const std::lock_guard lock(m_Mutex);
		const auto group = m_Groups.find(i_rGroup);
		if (m_bDisposed || group == m_Groups.end())
			return;
		const auto entry = group->second.m_Entries.find(i_rName);
		if (entry == group->second.m_Entries.end() || std::exchange(entry->second.m_bWarned, true))
			return;
		for (const boost::filesystem::path& rFolder : group->second.m_Folders)
			folders += (folders.empty() ? "" : ", ") + UtilsFileSystem::ToUtf8(rFolder);
	}
	if (folders.empty())
		NVX_LOG("VSkinCache", NVX::ELogWarning, "The skin %1% is not shown: there are no folders of skins", i_rName);
	else
		NVX_LOG("VSkinCache", NVX::ELogWarning, "The skin %1% is not shown: no file %1%%2% in %3%", i_rName,
		    c_pExtension, folders);
}

std::vector<std::string> VSkinCache::Loading()
{
	const std::lock_guard lock(m_Mutex);
	std::vector<std::string> names;
	for (const std::shared_ptr<VSkinLoadJob>& rpJob : m_Jobs)
		names.push_back(rpJob->Name());
	return names;
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
	m_pDelay->Start(c_ChangeDelay, [this] { m_ChangedSignal.Fire(); });
}

void VSkinCache::OnFolder(const std::string& i_rGroup, const boost::filesystem::path& i_rFolder)
{
	{
		const std::lock_guard lock(m_Mutex);
		const auto group = m_Groups.find(i_rGroup);
		if (m_bDisposed || group == m_Groups.end())
			return;
		NVX_LOG("VSkinCache", NVX::ELogDetail, "Detected a change to %1%", UtilsFileSystem::ToUtf8(i_rFolder));
		std::erase_if(group->second.m_Entries,
		    [&](const auto& i_rNamed)
		    {
			    const auto& [rName, rEntry] = i_rNamed;
			    const boost::filesystem::path file = FindFile(group->second.m_Folders, rName);
			    return file != rEntry.m_Path || file == FileIn(i_rFolder, rName);
		    });
	}
	m_pDelay->Start(c_ChangeDelay, [this] { m_ChangedSignal.Fire(); });
}

void VSkinCache::Dispose()
{
	m_pDelay->Stop();
	// The watchers end outside of the lock: they wait for their threads.
	std::unordered_map<std::string, VSkinGroup> groups;
	{
		const std::lock_guard lock(m_Mutex);
		m_bDisposed = true;
		groups.swap(m_Groups);
		m_Jobs.clear();
	}
}

} // namespace OrlexGraphics
