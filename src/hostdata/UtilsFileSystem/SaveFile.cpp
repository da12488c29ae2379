#include "UtilsFileSystem/SaveFile.h"

#include "NVX/Status.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/operations.hpp>

namespace UtilsFileSystem
{
namespace
{

using boost::filesystem::path;
using boost::system::error_code;

/// The file that a path means at last; a link may point to a file that is yet to be made.
/// @return false if links go round in circles.
bool FollowLinks(path& io_rPath)
{
	constexpr int c_MaximumLinks = 40;
	for (int links = 0; links < c_MaximumLinks; ++links)
	{
		error_code error;
		if (!is_symlink(symlink_status(io_rPath, error)))
			return true;
		const path target = read_symlink(io_rPath, error);
		if (error)
			return true;
		io_rPath = target.is_absolute() ? target : io_rPath.parent_path() / target;
	}
	return false;
}

} // namespace

std::uint32_t SaveFile(const path& i_rPath, std::string_view i_Bytes, std::string& o_rError)
{
	const auto fail = [&](std::uint32_t i_Status, const std::string& i_rReason)
	{
		o_rError = "Could not save '" + ToUtf8(i_rPath) + "': " + i_rReason;
		return i_Status;
	};

	path target = i_rPath;
	if (!FollowLinks(target))
		return fail(NVX::Status::c_FileNotOpened, "too many symbolic links");
	error_code error;
	const boost::filesystem::file_status status = boost::filesystem::status(target, error);
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
	// A name of its own, which cannot get too long as one made from the target's could.
	const path temporary = folder / boost::filesystem::unique_path(".save-%%%%%%%%%%%%.tmp", error);
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
