#include <windows.h>

#include "Log.h"

#include "NVX/Status.h"
#include "UtilsFileSystem/FileStreams.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/MemoryMappedFile.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"
#include "UtilsFileSystem/SaveFile.h"

#include <boost/filesystem/operations.hpp>

#include <gtest/gtest.h>

namespace
{

using namespace UtilsFileSystem;
using boost::filesystem::path;

struct VPlace
{
	const char* m_pName;
	/// Below a folder of the test, in UTF-8.
	std::string m_Folder;
	std::string m_File;
	/// As "\\localhost\c$\..." instead of by its drive.
	bool m_bUnc = false;
};

std::string Deep()
{
	std::string folders;
	for (int i = 0; i < 8; ++i)
		folders += std::string(50, char('a' + i)) + "/";
	return folders;
}

class WindowsFiles : public testing::TestWithParam<VPlace>
{
protected:
	WindowsFiles()
	{
		const path root = boost::filesystem::temp_directory_path() / boost::filesystem::unique_path();
		m_Root = GetParam().m_bUnc
		    ? path(L"\\\\localhost\\" + std::wstring(1, root.native()[0]) + L"$") / root.relative_path()
		    : root;
		m_Folder = m_Root / PathFromUtf8(GetParam().m_Folder);
		m_File = m_Folder / PathFromUtf8(GetParam().m_File);
	}
	~WindowsFiles() override
	{
		boost::system::error_code error;
		remove_all(path(Platform::NativePath(m_Root)), error);
	}

	std::string Bytes(const path& i_rPath)
	{
		std::string bytes, error;
		EXPECT_EQ(ReadWholeFile(i_rPath, 1000, bytes, error), NVX::Status::c_Success) << error;
		return bytes;
	}
	void Save(const std::string& i_rBytes, std::uint32_t i_Status = NVX::Status::c_Success)
	{
		std::string error;
		EXPECT_EQ(SaveFile(m_File, i_rBytes, error), i_Status) << error;
		EXPECT_EQ(error.empty(), i_Status == NVX::Status::c_Success);
	}
	std::ptrdiff_t FilesInFolder() const
	{
		return std::distance(boost::filesystem::directory_iterator(path(Platform::NativePath(m_Folder))), {});
	}

	path m_Root, m_Folder, m_File;
};

TEST_P(WindowsFiles, AreSavedReadMappedAndRemoved)
{
	ASSERT_EQ(CreateDirectories(m_Folder), NVX::Status::c_Success);
	Save("one");
	Save("second");
	EXPECT_EQ(Bytes(m_File), "second");
	EXPECT_EQ(FilesInFolder(), 1);
	EXPECT_EQ(ToUtf8(m_File.filename()), GetParam().m_File);
	{
		VFileInputStream stream(m_File);
		std::string text;
		EXPECT_TRUE(stream >> text);
		EXPECT_EQ(text, "second");
		VMemoryMappedInputStreamVirtual mapped(m_File);
		std::string bytes(6, ' ');
		EXPECT_EQ(mapped.Read(bytes.data(), 6), 6u);
		EXPECT_EQ(bytes, "second");
	}
	EXPECT_TRUE(RemoveFile(m_File));
	EXPECT_EQ(FilesInFolder(), 0);
}

TEST_P(WindowsFiles, AnOpenOneStaysWhole)
{
	ASSERT_EQ(CreateDirectories(m_Folder), NVX::Status::c_Success);
	Save("yesterday's");
	const std::wstring native = Platform::NativePath(m_File);
	VTestLog log("System");
	{
		// As a program has it that lets others read it, but neither write nor replace it.
		const HANDLE file =
		    ::CreateFileW(native.c_str(), GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING, 0, nullptr);
		ASSERT_NE(file, INVALID_HANDLE_VALUE);
		Save("today's", NVX::Status::c_WriteFailure);
		EXPECT_EQ(FilesInFolder(), 1);
		EXPECT_EQ(Bytes(m_File), "yesterday's");
		::CloseHandle(file);
	}
	{
		// Alone.
		const HANDLE file = ::CreateFileW(native.c_str(), GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr);
		ASSERT_NE(file, INVALID_HANDLE_VALUE);
		std::string bytes, error;
		EXPECT_EQ(ReadWholeFile(m_File, 1000, bytes, error), NVX::Status::c_FileNotOpened);
		EXPECT_FALSE(VFileOutputStream(m_File).is_open());
		::CloseHandle(file);
	}
	Save("today's");
	EXPECT_EQ(Bytes(m_File), "today's");
	::SetFileAttributesW(native.c_str(), FILE_ATTRIBUTE_READONLY);
	Save("tomorrow's", NVX::Status::c_FileNotOpened);
	::SetFileAttributesW(native.c_str(), FILE_ATTRIBUTE_NORMAL);
	EXPECT_EQ(Bytes(m_File), "today's");
}

INSTANTIATE_TEST_SUITE_P(Places, WindowsFiles,
    testing::Values(VPlace{"Plain", "a", "b.qrr"},
        VPlace{"NotAscii", "Gr\xC3\xB6\xC3\x9F\x65", "\xE6\xBC\x94\xE5\x93\xA1 \xF0\x9F\x8E\xAD.qrr"},
        VPlace{"Long", Deep(), "b.qrr"}, VPlace{"Unc", "a", "b.qrr", true}, VPlace{"LongUnc", Deep(), "b.qrr", true}),
    [](const auto& i_rInfo) { return std::string(i_rInfo.param.m_pName); });

} // namespace
