#include "Folder.h"
#include "Log.h"

#include "NVX/Status.h"
#include "UtilsFileSystem/FileStreams.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <sys/stat.h>

namespace
{

using namespace UtilsFileSystem;
using boost::filesystem::path;
using VTexts = std::vector<std::string>;

TEST(Files, ReadsWholeFilesWithinALimit)
{
	const VTestFolder folder;
	const path file = folder / "a";
	std::string bytes;
	std::string error;
	for (const std::size_t size : {0, 1, 65535, 65536, 200000})
	{
		Put(file, std::string(size, 'x'));
		EXPECT_EQ(ReadWholeFile(file, size, bytes, error), NVX::Status::c_Success) << error;
		EXPECT_EQ(bytes, std::string(size, 'x'));
		EXPECT_EQ(ReadRegularFile(file, size, bytes, error), NVX::Status::c_Success) << error;
		EXPECT_EQ(bytes, std::string(size, 'x'));
	}
	auto pRead = ReadWholeFile;
	const auto refused = [&](const path& i_rPath, std::uint32_t i_Status, const std::string& i_rReason)
	{
		bytes = "old";
		EXPECT_EQ(pRead(i_rPath, 199999, bytes, error), i_Status);
		EXPECT_EQ(error, "Could not read '" + i_rPath.native() + "': " + i_rReason);
		EXPECT_EQ(bytes, "");
	};
	refused(file, NVX::Status::c_Failure, "it is larger than 199999 bytes");
	refused("/dev/zero", NVX::Status::c_Failure, "it is larger than 199999 bytes");
	refused(folder.Path(), NVX::Status::c_FileNotOpened, "Is a directory");
	refused(folder / "no", NVX::Status::c_FileNotOpened, "No such file or directory");
	refused(file / "a", NVX::Status::c_FileNotOpened, "Not a directory");
	// Files without a size of their own.
	EXPECT_EQ(ReadWholeFile("/proc/self/status", 100000, bytes, error), NVX::Status::c_Success);
	EXPECT_EQ(bytes.substr(0, 5), "Name:");
	EXPECT_EQ(ReadWholeFile("/dev/null", 0, bytes, error), NVX::Status::c_Success);
	// What only may be a file: nobody ever writes into this pipe.
	pRead = ReadRegularFile;
	ASSERT_EQ(::mkfifo((folder / "pipe").c_str(), 0600), 0);
	refused(folder / "pipe", NVX::Status::c_FileNotOpened, "Invalid argument");
	refused("/dev/zero", NVX::Status::c_FileNotOpened, "Invalid argument");
	refused(folder.Path(), NVX::Status::c_FileNotOpened, "Is a directory");
	refused(folder / "no", NVX::Status::c_FileNotOpened, "No such file or directory");
	refused(file, NVX::Status::c_Failure, "it is larger than 199999 bytes");
}

TEST(Files, Removes)
{
	const VTestFolder folder;
	VTestLog log("System");
	const std::string name = (folder / "a").native();
	Put(name, "x");
	EXPECT_TRUE(RemoveFile(name));
	EXPECT_TRUE(RemoveFile(name));
	EXPECT_EQ(
	    log.Take(), (VTexts{"4 Removed file '" + name + "'.", "4 Nothing to remove: '" + name + "' did not exist."}));
	create_directory(path(name));
	EXPECT_FALSE(RemoveFile(name));
	EXPECT_EQ(log.Take(), VTexts{"2 Failed to remove file '" + name + "': Is a directory"});
	EXPECT_TRUE(is_directory(path(name)));
	create_symlink("nowhere", folder / "link");
	EXPECT_TRUE(RemoveFile(folder / "link"));
	EXPECT_EQ(log.Take(), VTexts{"4 Removed file '" + (folder / "link").native() + "'."});
}

TEST(Files, CreatesDirectories)
{
	const VTestFolder folder;
	VTestLog log("System");
	const path deep = folder / "a/b \xC3\xA4/c";
	EXPECT_EQ(CreateDirectories(deep), NVX::Status::c_Success);
	EXPECT_TRUE(is_directory(deep));
	EXPECT_EQ(log.Take(), VTexts{"4 Created directory: " + deep.native()});
	EXPECT_EQ(CreateDirectories(deep), NVX::Status::c_Success);
	Put(folder / "file", "x");
	EXPECT_EQ(CreateDirectories(folder / "file"), NVX::Status::c_Success);
	EXPECT_EQ(CreateDirectories(folder / "file/a"), NVX::Status::c_Failure);
	EXPECT_EQ(log.Take(), VTexts{});
}

TEST(Files, BuffersFully)
{
	const VTestFolder folder;
	VTestLog log("System");
	VFile pFile = OpenFile(folder / "a", "wb");
	ASSERT_TRUE(SetFullBuffering(pFile, folder / "a"));
	const std::string bytes(0x100000, 'x');
	for (int part = 0; part < 7; ++part)
		ASSERT_EQ(std::fwrite(bytes.data(), 1, bytes.size(), pFile.get()), bytes.size());
	EXPECT_EQ(file_size(folder / "a"), 0u);
	pFile.reset();
	EXPECT_EQ(file_size(folder / "a"), 7 * bytes.size());
	EXPECT_FALSE(SetFullBuffering(pFile, "a"));
	EXPECT_EQ(log.Take(), VTexts{"2 Failed to enable full buffering for file stream a."});
}

TEST(FileStreams, OpenOrFail)
{
	const VTestFolder folder;
	VTestLog log("System");
	{
		VFileOutputStream out(folder / "a");
		EXPECT_TRUE(out << "hello");
	}
	std::string word;
	EXPECT_TRUE(VFileInputStream(folder / "a") >> word);
	EXPECT_EQ(word, "hello");
	EXPECT_TRUE(OpenFileStream(folder / "a", std::ios_base::out | std::ios_base::app) << " world");
	EXPECT_EQ(Get(folder / "a"), "hello world");
	EXPECT_EQ(log.Take(), VTexts{});

	const std::string missing = "4 Std error code: " + std::to_string(ENOENT);
	const std::string directory = "4 Std error code: " + std::to_string(EISDIR);
	EXPECT_TRUE(VFileInputStream(folder / "no").fail());
	EXPECT_TRUE(VFileInputStream(folder.Path()).fail());
	EXPECT_TRUE(VFileOutputStream(folder / "no/a").fail());
	EXPECT_TRUE(OpenFileStream(folder / "no", std::ios_base::in).fail());
	EXPECT_EQ(OpenFile(folder / "no", "rb"), nullptr);
	EXPECT_EQ(log.Take(), (VTexts{missing, directory, missing, missing, missing}));
}

TEST(Paths, LongOnesGetTheirPrefix)
{
	const std::wstring tail(260, L'n');
	const struct
	{
		std::wstring m_Path;
		std::wstring m_Expected;
	} c_Rows[] = {
	    {L"C:\\short/a", L"C:\\short/a"},
	    {L"C:\\" + tail, L"\\\\?\\C:\\" + tail},
	    {L"C:/" + tail, L"\\\\?\\C:\\" + tail},
	    {L"\\\\server\\share\\" + tail, L"\\\\?\\UNC\\server\\share\\" + tail},
	    {L"//server/share/" + tail, L"\\\\?\\UNC\\server\\share\\" + tail},
	    {L"\\\\?\\C:\\" + tail, L"\\\\?\\C:\\" + tail},
	    {L"\\\\.\\pipe\\" + tail, L"\\\\.\\pipe\\" + tail},
	    {std::wstring(259, L'n'), std::wstring(259, L'n')},
	    {std::wstring(260, L'n'), L"\\\\?\\" + std::wstring(260, L'n')},
	};
	for (const auto& rRow : c_Rows)
		EXPECT_EQ(AddLongPathPrefix(rRow.m_Path, 260), rRow.m_Expected);
}

} // namespace
