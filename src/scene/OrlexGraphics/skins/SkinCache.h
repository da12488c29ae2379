#pragma once

#include "FBXIO/MeshRules.h"
#include "NVX/Shared.h"
#include "NVX/Signal.h"
#include "NVX/Status.h"
#include "OrlexGraphics/item/IDelay.h"

#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <unordered_map>
#include <vector>

namespace CoreGraphics
{
class VSkin;
}

namespace FileSystemWatcher
{
class VFileSystemWatcher;
}

namespace TesselPluginInterface
{
class IJobRunner;
}

namespace OrlexGraphics
{

class VSkinLoadJob;

/// How far the cache is with a skin; the top bit marks those that give none.
namespace SkinStatus
{

inline constexpr std::uint32_t c_Ready = NVX::Status::c_Success;
inline constexpr std::uint32_t c_LoadFailed = NVX::Status::c_Failure;
inline constexpr std::uint32_t c_Disposed = 0x80000002u;
inline constexpr std::uint32_t c_Loading = 0x80000007u;
inline constexpr std::uint32_t c_NotLookedFor = 0x80000009u;
inline constexpr std::uint32_t c_NotFound = NVX::Status::c_NothingToActOn;

} // namespace SkinStatus

/// The group whose folders hold the skins of subjects.
inline constexpr const char* c_pSubjectSkins = "Subject";

/// Finds and loads the skins of each group, and watches their folders: a skin is an FBX file, by its name without the
/// extension. Made with NVX::MakeShared on the user interface thread, where all functions run but those that say
/// otherwise.
class VSkinCache : public NVX::VShared
{
public:
	/// @param i_pDispatcher brings changes of files and ends of jobs to the user interface thread
	/// @param i_pJobRunner loads skins; without one they are loaded at once, by whoever asks
	/// @param i_pDelay lets a burst of changes end; null for one of Qt's event loop
	explicit VSkinCache(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    std::shared_ptr<TesselPluginInterface::IJobRunner> i_pJobRunner = {}, std::unique_ptr<IDelay> i_pDelay = {});
	~VSkinCache() override;

	/// For the skins that are loaded from now on: before the first folders are set. Any other time some have other
	/// rules.
	void SetMeshRules(const FBXIO::VMeshRules& i_rRules);

	/// Replaces the folders of a group, and forgets what was found in those before. The same list again changes
	/// nothing.
	void SetFolders(const std::string& i_rGroup, const std::vector<boost::filesystem::path>& i_rFolders);

	/// Whether folders were set for a group, none included.
	bool HasFolders(const std::string& i_rGroup);

	/// A skin that is not there yet begins to be loaded; then ask again when ChangedSignal has fired, or before. Of
	/// folders that have the file the last one counts. Any thread.
	/// @param o_rpSkin stays as it is unless the skin is ready
	/// @return SkinStatus
	std::uint32_t GetSkin(
	    std::shared_ptr<CoreGraphics::VSkin>& o_rpSkin, const std::string& i_rName, const std::string& i_rGroup);

	/// Warns in the log that a skin was not found, with the folders that were looked in; once, until it is looked for
	/// anew. Any thread.
	void WarnOfMissing(const std::string& i_rName, const std::string& i_rGroup);

	/// The names of the skins that are being loaded. Any thread.
	std::vector<std::string> Loading();

	/// Fires after other folders were set, after each load, and a second after the last of a burst of changes in a
	/// folder.
	NVX::VSignal<>& ChangedSignal() { return m_ChangedSignal; }
	/// Fires on the thread that asks when a load begins, and then on the user interface thread when it has ended.
	/// Connect with the dispatcher.
	NVX::VSignal<>& LoadingSignal() { return m_LoadingSignal; }

	/// No folder is watched any more, and nothing is found.
	void Dispose();

private:
	struct VSkinEntry
	{
		boost::filesystem::path m_Path;
		/// Null when none runs.
		std::shared_ptr<VSkinLoadJob> m_pJob;
		std::uint32_t m_Status = SkinStatus::c_NotLookedFor;
		std::shared_ptr<CoreGraphics::VSkin> m_pSkin;
		bool m_bWarned = false;
	};

	struct VSkinGroup
	{
		std::vector<boost::filesystem::path> m_Folders;
		/// By name of the skin.
		std::unordered_map<std::string, VSkinEntry> m_Entries;
		std::shared_ptr<FileSystemWatcher::VFileSystemWatcher> m_pWatcher;
	};

	std::shared_ptr<FileSystemWatcher::VFileSystemWatcher> MakeWatcher(const std::string& i_rGroup);
	/// Looks for the file of a new entry, and makes the job for it. Under the lock.
	/// @return the job that is to be run; null if there is none
	std::shared_ptr<VSkinLoadJob> Find(
	    VSkinEntry& io_rEntry, const std::string& i_rName, const std::vector<boost::filesystem::path>& i_rFolders);
	void Run(const std::shared_ptr<VSkinLoadJob>& i_rpJob);
	void OnLoaded(const std::shared_ptr<VSkinLoadJob>& i_rpJob);
	void OnChange(const std::string& i_rGroup, const boost::filesystem::path& i_rPath);
	/// Forgets what was found in a folder of a group, and what is found elsewhere now.
	void OnFolder(const std::string& i_rGroup, const boost::filesystem::path& i_rFolder);

	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	const std::shared_ptr<TesselPluginInterface::IJobRunner> m_pJobRunner;
	const std::unique_ptr<IDelay> m_pDelay;
	/// Guards the groups, the rules and the jobs: scenes ask on their render threads.
	std::mutex m_Mutex;
	std::unordered_map<std::string, VSkinGroup> m_Groups;
	FBXIO::VMeshRules m_MeshRules;
	/// Begun, and not told to have ended.
	std::vector<std::shared_ptr<VSkinLoadJob>> m_Jobs;
	NVX::VSignal<> m_ChangedSignal;
	NVX::VSignal<> m_LoadingSignal;
	bool m_bDisposed = false;
};

} // namespace OrlexGraphics
