#pragma once

#include "NVX/Shared.h"
#include "NVX/Signal.h"
#include "NVX/Status.h"

#include <QTimer>
#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <unordered_map>
#include <vector>

namespace FileSystemWatcher
{
class VFileSystemWatcher;
}

namespace OrlexGraphics
{

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

/// Knows where the skins of each group lie, and watches their folders: a skin is an FBX file, by its name without the
/// extension. Made with NVX::MakeShared on the user interface thread, where all functions but GetPath run.
class VSkinCache : public NVX::VShared
{
public:
	/// @param i_pDispatcher brings changes of files to the user interface thread
	explicit VSkinCache(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher);
	~VSkinCache() override;

	/// Replaces the folders of a group, and forgets what was found in those before. The same list again changes
	/// nothing.
	void SetFolders(const std::string& i_rGroup, const std::vector<boost::filesystem::path>& i_rFolders);

	/// Whether folders were set for a group, none included.
	bool HasFolders(const std::string& i_rGroup);

	/// The file of a skin; of two folders that have it the later one counts.
	/// @return SkinStatus: ready, not found, or disposed.
	std::uint32_t GetPath(boost::filesystem::path& o_rPath, const std::string& i_rName, const std::string& i_rGroup);

	/// Fires after other folders were set, and a second after the last of a burst of changes in a folder.
	NVX::VSignal<>& ChangedSignal() { return m_ChangedSignal; }

	/// No folder is watched any more, and nothing is found.
	void Dispose();

private:
	struct VSkinEntry
	{
		boost::filesystem::path m_Path;
		std::uint32_t m_Status = SkinStatus::c_NotLookedFor;
	};

	struct VSkinGroup
	{
		std::vector<boost::filesystem::path> m_Folders;
		/// By name of the skin.
		std::unordered_map<std::string, VSkinEntry> m_Entries;
		std::shared_ptr<FileSystemWatcher::VFileSystemWatcher> m_pWatcher;
	};

	std::shared_ptr<FileSystemWatcher::VFileSystemWatcher> MakeWatcher(const std::string& i_rGroup);
	void OnChange(const std::string& i_rGroup, const boost::filesystem::path& i_rPath);

	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	/// Guards the groups: scenes ask on their render threads.
	std::mutex m_Mutex;
	std::unordered_map<std::string, VSkinGroup> m_Groups;
	NVX::VSignal<> m_ChangedSignal;
	QTimer m_ChangeTimer;
	bool m_bDisposed = false;
};

} // namespace OrlexGraphics
