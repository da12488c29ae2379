#include "UtilsFileSystem/SaveFile.h"

#include "NVX/Status.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <atomic>
#include <charconv>
#include <cstdio>
#include <iterator>
#include <vector>

namespace UtilsFileSystem
{
namespace
{

using boost::filesystem::path;
using boost::system::error_code;

/// The file that a path means at last; a link may point to a file that is yet to be made.
/// @return why that cannot be told; empty if it can. What is not known to be no link must not be replaced.
std::string FollowLinks(path& io_rPath)
{
	constexpr int c_MaximumLinks = 40;
	for (int links = 0; links < c_MaximumLinks; ++links)
	{
		error_code error;
		const boost::filesystem::file_status status = symlink_status(io_rPath, error);
		if (status.type() == boost::filesystem::status_error)
			return error.message();
		if (!is_symlink(status))
			return {};
		const path target = read_symlink(io_rPath, error);
		if (error)
			return error.message();
		io_rPath = target.is_absolute() ? target : io_rPath.parent_path() / target;
	}
	return "too many symbolic links";
}

/// The file of a save on its way, where a signal handler finds it.
struct VUnfinished
{
	enum EState
	{
		EFree,
		ETaken,
		ESet
	};
	std::atomic<int> m_State{EFree};
	path::value_type m_Path[4096];
};
VUnfinished s_Unfinished[8];
static_assert(std::atomic<int>::is_always_lock_free);

/// Keeps a file in the list as long as it lives; one that finds no place goes without.
class VUnfinishedFile
{
public:
	explicit VUnfinishedFile(const path& i_rPath)
	{
		const path::string_type native = Platform::NativePath(i_rPath);
		for (VUnfinished& rSlot : s_Unfinished)
		{
			int expected = VUnfinished::EFree;
			if (native.size() >= std::size(rSlot.m_Path)
			    || !rSlot.m_State.compare_exchange_strong(expected, VUnfinished::ETaken))
				continue;
			std::copy_n(native.c_str(), native.size() + 1, rSlot.m_Path);
			rSlot.m_State = VUnfinished::ESet;
			m_pSlot = &rSlot;
			return;
		}
	}
	~VUnfinishedFile()
	{
		if (m_pSlot)
			m_pSlot->m_State = VUnfinished::EFree;
	}
	VUnfinishedFile(const VUnfinishedFile&) = delete;
	VUnfinishedFile& operator=(const VUnfinishedFile&) = delete;

private:
	VUnfinished* m_pSlot = nullptr;
};

/// What the names of all unfinished files of one target begin with. The machine is part of it, since in a shared folder
/// the processes of other machines cannot be asked. All have one size: names made from the target's could get too long.
std::string UnfinishedPrefix(const path& i_rTarget)
{
	// FNV-1a, which is the same in every program.
	std::uint64_t hash = 0xCBF29CE484222325u;
	for (const char byte : Platform::MachineName() + '\n' + ToUtf8(i_rTarget.filename()))
		hash = (hash ^ static_cast<unsigned char>(byte)) * 0x100000001B3u;
	char text[32];
	std::snprintf(text, sizeof(text), ".save-%016llx-", static_cast<unsigned long long>(hash));
	return text;
}

/// Removes what processes left that are no more.
void RemoveLeftovers(const path& i_rFolder, const std::string& i_rPrefix)
{
	error_code error;
	std::vector<path> leftovers;
	for (boost::filesystem::directory_iterator it(i_rFolder, error), end; !error && it != end; it.increment(error))
	{
		const std::string name = ToUtf8(it->path().filename());
		std::uint32_t process = 0;
		if (name.starts_with(i_rPrefix) && name.ends_with(".tmp")
		    && std::from_chars(name.data() + i_rPrefix.size(), name.data() + name.size(), process).ec == std::errc()
		    && Platform::IsProcessGone(process))
			leftovers.push_back(it->path());
	}
	for (const path& rPath : leftovers)
		remove(rPath, error);
}

} // namespace

void RemoveUnfinishedSaves() noexcept
{
	for (const VUnfinished& rSlot : s_Unfinished)
		if (rSlot.m_State == VUnfinished::ESet)
			Platform::Unlink(rSlot.m_Path);
}

std::uint32_t SaveFile(const path& i_rPath, std::string_view i_Bytes, std::string& o_rError)
{
	const auto fail = [&](std::uint32_t i_Status, const std::string& i_rReason)
	{
		o_rError = "Could not save '" + ToUtf8(i_rPath) + "': " + i_rReason;
		return i_Status;
	};

	path target = i_rPath;
	if (const std::string reason = FollowLinks(target); !reason.empty())
		return fail(NVX::Status::c_FileNotOpened, reason);
	error_code error;
	const boost::filesystem::file_status status = boost::filesystem::status(target, error);
	// Its rights are not known.
	if (status.type() == boost::filesystem::status_error)
		return fail(NVX::Status::c_FileNotOpened, error.message());
	const bool bExists = exists(status);
	if (is_directory(status))
		return fail(NVX::Status::c_FileNotOpened, "it is a folder");
	if (bExists && !is_regular_file(status))
		return fail(NVX::Status::c_FileNotOpened, "it is not a regular file");
	if (bExists && Platform::IsReadOnly(target))
		return fail(NVX::Status::c_FileNotOpened, "the file is read-only");

	const path folder = target.has_parent_path() ? target.parent_path() : path(".");
	if (!is_directory(boost::filesystem::status(folder, error)))
		return fail(NVX::Status::c_FileNotOpened, "there is no folder '" + ToUtf8(folder) + "'");
	const std::string prefix = UnfinishedPrefix(target);
	RemoveLeftovers(folder, prefix);
	const path temporary = folder
	    / boost::filesystem::unique_path(prefix + std::to_string(Platform::ProcessId()) + "-%%%%%%%%.tmp", error);
	const VUnfinishedFile unfinished(temporary);
	if (const int failure = Platform::WriteNewFile(temporary, i_Bytes, bExists ? &target : nullptr))
		return fail(NVX::Status::c_WriteFailure, Platform::ErrorText(failure));
	if (const int failure = Platform::Replace(temporary, target))
	{
		remove(temporary, error);
		return fail(NVX::Status::c_WriteFailure, Platform::ErrorText(failure));
	}
	if (const int failure = Platform::SyncFolder(folder))
		return fail(NVX::Status::c_WriteFailure,
		    "the new file is in place, but the folder did not reach the disk: " + Platform::ErrorText(failure));
	return NVX::Status::c_Success;
}

} // namespace UtilsFileSystem
