#include "Folder.h"

#include "NVX/Status.h"
#include "UtilsFileSystem/SaveFile.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <csignal>
#include <sched.h>
#include <sys/mount.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

using boost::filesystem::path;
using UtilsFileSystem::SaveFile;

mode_t Mode(const path& i_rPath)
{
	struct stat about = {};
	EXPECT_EQ(::stat(i_rPath.c_str(), &about), 0);
	return about.st_mode & 07777;
}

void ExpectSaved(const path& i_rPath, const std::string& i_rBytes)
{
	std::string error;
	EXPECT_EQ(SaveFile(i_rPath, i_rBytes, error), NVX::Status::c_Success) << error;
	EXPECT_EQ(Get(i_rPath), i_rBytes);
}

/// @param i_rReason what the error says after the path.
void ExpectRefused(const path& i_rPath, const std::string& i_rReason, std::uint32_t i_Status, std::size_t i_Bytes = 3)
{
	std::string error;
	EXPECT_EQ(SaveFile(i_rPath, std::string(i_Bytes, 'n'), error), i_Status) << i_rPath;
	EXPECT_EQ(error, "Could not save '" + i_rPath.native() + "': " + i_rReason);
}

TEST(SaveFile, MakesAndReplaces)
{
	const VTestFolder folder;
	const path file = folder / "a \xC3\xA4.qrr";
	const mode_t before = ::umask(027);
	ExpectSaved(file, std::string("one\0two", 7));
	::umask(before);
	EXPECT_EQ(Mode(file), 0640u);
	ExpectSaved(file, "");
	ExpectSaved(file, std::string(3000000, 'x'));
	EXPECT_EQ(folder.Count(), 1);
}

TEST(SaveFile, TakesTheLongestName)
{
	const VTestFolder folder;
	ExpectSaved(folder / std::string(255, 'n'), "one");
	EXPECT_EQ(folder.Count(), 1);
}

TEST(SaveFile, TakesANameWithoutAFolder)
{
	const VTestFolder folder;
	const path before = boost::filesystem::current_path();
	boost::filesystem::current_path(folder.Path());
	ExpectSaved("here.qrr", "one");
	boost::filesystem::current_path(before);
	EXPECT_EQ(Get(folder / "here.qrr"), "one");
}

TEST(SaveFile, KeepsTheRightsOfTheFile)
{
	const VTestFolder folder;
	const path file = folder / "a.qrr";
	for (const mode_t mode : {0600, 0664, 0777})
	{
		Put(file, "old");
		ASSERT_EQ(::chmod(file.c_str(), mode), 0);
		ExpectSaved(file, "new");
		EXPECT_EQ(Mode(file), mode);
	}
}

TEST(SaveFile, FollowsLinks)
{
	const VTestFolder folder;
	create_directory(folder / "real");
	create_symlink("real/file.qrr", folder / "near");
	create_symlink(folder / "near", folder / "far");
	ExpectSaved(folder / "far", "through a link to a file that is made");
	Put(folder / "real/file.qrr", "old");
	ExpectSaved(folder / "far", "through a link");
	EXPECT_EQ(Get(folder / "real/file.qrr"), "through a link");
	EXPECT_TRUE(is_symlink(symlink_status(folder / "near")));
	EXPECT_TRUE(is_symlink(symlink_status(folder / "far")));

	create_symlink("b", folder / "a");
	create_symlink("a", folder / "b");
	ExpectRefused(folder / "a", "too many symbolic links", NVX::Status::c_FileNotOpened);
	ExpectRefused(folder / std::string(300, 'x'), "File name too long", NVX::Status::c_FileNotOpened);
}

TEST(SaveFile, RefusesWhatIsNoPlaceForAFile)
{
	const VTestFolder folder;
	create_directory(folder / "sub");
	ExpectRefused(folder / "sub", "it is a folder", NVX::Status::c_FileNotOpened);
	ExpectRefused(
	    folder / "no/a.qrr", "there is no folder '" + (folder / "no").native() + "'", NVX::Status::c_FileNotOpened);
	Put(folder / "file", "old");
	ExpectRefused(
	    folder / "file/a.qrr", "there is no folder '" + (folder / "file").native() + "'", NVX::Status::c_FileNotOpened);
	ASSERT_EQ(::chmod((folder / "file").c_str(), 0444), 0);
	ExpectRefused(folder / "file", "the file is read-only", NVX::Status::c_FileNotOpened);
	EXPECT_EQ(Get(folder / "file"), "old");
	ExpectRefused("/dev/full", "it is not a regular file", NVX::Status::c_FileNotOpened);
	// A folder in which no one may make files.
	ExpectRefused("/proc/a.qrr", ::geteuid() == 0 ? "No such file or directory" : "Permission denied",
	    NVX::Status::c_WriteFailure);
	EXPECT_EQ(folder.Count(), 2);
}

/// A limit that a write goes over in its middle: the signal that comes with it must not end the process.
TEST(SaveFile, KeepsTheOldFileWhenNotAllCanBeWritten)
{
	const VTestFolder folder;
	const path file = folder / "a.qrr";
	Put(file, "old");
	rlimit before = {};
	ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &before), 0);
	const rlimit small = {100000, before.rlim_max};
	ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &small), 0);
	ExpectRefused(file, "File too large", NVX::Status::c_WriteFailure, 100001);
	ExpectRefused(folder / "new.qrr", "File too large", NVX::Status::c_WriteFailure, 100001);
	EXPECT_EQ(Get(file), "old");
	EXPECT_EQ(folder.Count(), 1);
	ExpectSaved(file, std::string(100000, 'x'));
	ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &before), 0);
	sigset_t pending;
	ASSERT_EQ(::sigpending(&pending), 0);
	EXPECT_EQ(sigismember(&pending, SIGXFSZ), 0);
}

/// Runs in a process of its own, with a file system of 64 KiB that only it sees.
/// @return 0, or 77 if the system does not let this be tried.
int SaveOnAFullDisk(const path& i_rFolder)
{
	if (::unshare(CLONE_NEWNS) != 0 && ::unshare(CLONE_NEWUSER | CLONE_NEWNS) != 0)
		return 77;
	if (::mount("none", "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0
	    || ::mount("none", i_rFolder.c_str(), "tmpfs", 0, "size=64k") != 0)
		return 77;
	const path file = i_rFolder / "a.qrr";
	Put(file, "old");
	std::string error;
	if (SaveFile(file, std::string(100000, 'x'), error) != NVX::Status::c_WriteFailure
	    || error != "Could not save '" + file.native() + "': No space left on device")
		return 1;
	const auto count = std::distance(boost::filesystem::directory_iterator(i_rFolder), {});
	return Get(file) == "old" && count == 1 ? 0 : 2;
}

TEST(SaveFile, KeepsTheOldFileWhenTheDiskIsFull)
{
	const VTestFolder folder;
	const pid_t child = ::fork();
	ASSERT_GE(child, 0);
	if (child == 0)
		::_exit(SaveOnAFullDisk(folder.Path()));
	int status = 0;
	ASSERT_EQ(::waitpid(child, &status, 0), child);
	ASSERT_TRUE(WIFEXITED(status));
	if (WEXITSTATUS(status) == 77)
		GTEST_SKIP() << "no file system can be mounted here";
	EXPECT_EQ(WEXITSTATUS(status), 0);
}

/// A process that saves to a file without end; TERM ends it as a program that keeps its folders clean ends.
/// @return its id, in the middle of a save as far as that can be seen.
pid_t StartSaving(const path& i_rFile, const std::string& i_rA, const std::string& i_rB)
{
	int ready[2];
	EXPECT_EQ(::pipe(ready), 0);
	const pid_t child = ::fork();
	if (child == 0)
	{
		::signal(SIGTERM,
		    [](int)
		    {
			    UtilsFileSystem::RemoveUnfinishedSaves();
			    ::_exit(0);
		    });
		std::string error;
		for (int round = 0;; ++round)
			if (SaveFile(i_rFile, round % 2 == 0 ? i_rA : i_rB, error) != 0
			    || (round < 4 && ::write(ready[1], "x", 1) != 1))
				::_exit(1);
	}
	char byte = 0;
	for (int round = 0; round < 4; ++round)
		EXPECT_EQ(::read(ready[0], &byte, 1), 1);
	::close(ready[0]);
	::close(ready[1]);
	const auto isTemporary = [](const auto& i_rEntry) { return i_rEntry.path().extension() == ".tmp"; };
	const boost::filesystem::directory_iterator end;
	while (std::find_if(boost::filesystem::directory_iterator(i_rFile.parent_path()), end, isTemporary) == end)
		;
	return child;
}

void End(pid_t i_Child, int i_Signal)
{
	::kill(i_Child, i_Signal);
	int status = 0;
	EXPECT_EQ(::waitpid(i_Child, &status, 0), i_Child);
	EXPECT_TRUE(i_Signal == SIGKILL ? WIFSIGNALED(status) : WIFEXITED(status) && WEXITSTATUS(status) == 0) << status;
}

TEST(SaveFile, ASignalLeavesNothingBehind)
{
	const VTestFolder folder;
	// Files of their own, so that none clears what another left, and large ones, so that the signal falls into a save.
	const std::string bytes(8000000, 'a');
	for (int round = 0; round < 10; ++round)
		End(StartSaving(folder / std::to_string(round), bytes, bytes), SIGTERM);
	EXPECT_EQ(folder.Count(), 10);
}

TEST(SaveFile, TheNextSaveClearsWhatAKilledOneLeft)
{
	const VTestFolder folder;
	const path file = folder / "a.qrr";
	const std::string bytes(8000000, 'a');
	for (int round = 0; folder.Count() < 2; ++round)
	{
		ASSERT_LT(round, 100) << "never killed within a save";
		End(StartSaving(file, bytes, bytes), SIGKILL);
	}
	ExpectSaved(folder / "b.qrr", "another file clears its own alone");
	EXPECT_EQ(folder.Count(), 3);
	ExpectSaved(file, "one");
	EXPECT_EQ(folder.Count(), 2);
	const pid_t child = StartSaving(file, bytes, bytes);
	std::string error;
	for (int round = 0; round < 20; ++round)
		EXPECT_EQ(SaveFile(file, bytes, error), NVX::Status::c_Success);
	EXPECT_EQ(::waitpid(child, nullptr, WNOHANG), 0) << "it failed: what was on its way is gone";
	End(child, SIGTERM);
}

/// A process that saves without end is read from all the time, and killed in the middle.
TEST(SaveFile, IsWholeAtEveryMoment)
{
	const VTestFolder folder;
	const path file = folder / "a.qrr";
	const std::string contents[] = {std::string(300000, 'a'), std::string(200000, 'b')};
	Put(file, contents[0]);
	const pid_t child = StartSaving(file, contents[0], contents[1]);
	for (int round = 0; round < 100; ++round)
	{
		const std::string bytes = Get(file);
		ASSERT_TRUE(bytes == contents[0] || bytes == contents[1]) << bytes.size();
	}
	End(child, SIGKILL);
	const std::string bytes = Get(file);
	EXPECT_TRUE(bytes == contents[0] || bytes == contents[1]) << bytes.size();
}

} // namespace
