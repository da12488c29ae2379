#include "Folder.h"
#include "Log.h"

#include "UtilsFileSystem/FileStreams.h"
#include "UtilsFileSystem/MemoryMappedFile.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <numeric>
#include <random>

namespace
{

using namespace UtilsFileSystem;
using boost::filesystem::path;
using VTexts = std::vector<std::string>;

std::string Pattern(std::size_t i_Size)
{
	std::mt19937 generator(7);
	std::string bytes(i_Size, '\0');
	for (char& rByte : bytes)
		rByte = char(generator());
	return bytes;
}

/// Both streams must read alike, wherever one reads from and however much.
void ExpectReads(NVX::IInputStreamSeekable& io_rStream, const std::string& i_rBytes)
{
	ASSERT_TRUE(io_rStream.IsGood());
	ASSERT_EQ(io_rStream.GetSize(), i_rBytes.size());
	std::mt19937 generator(8);
	std::string read;
	for (int round = 0; round < 500; ++round)
	{
		const std::size_t position = generator() % (i_rBytes.size() + 1);
		ASSERT_TRUE(io_rStream.Seek(position));
		read.assign(generator() % 20000, '\0');
		const std::size_t expected = std::min(read.size(), i_rBytes.size() - position);
		ASSERT_EQ(io_rStream.Read(read.data(), read.size()), expected);
		ASSERT_EQ(io_rStream.GetPosition(), position + expected);
		ASSERT_TRUE(read.compare(0, expected, i_rBytes, position, expected) == 0);
	}
	const std::uint64_t position = io_rStream.GetPosition();
	EXPECT_FALSE(io_rStream.Seek(i_rBytes.size() + 1));
	EXPECT_EQ(io_rStream.GetPosition(), position);
	EXPECT_TRUE(io_rStream.IsGood());
}

TEST(InputStreamSeekable, ReadsFromAnyPlace)
{
	const VTestFolder folder;
	const std::string bytes = Pattern(100001);
	Put(folder / "a", bytes);
	Put(folder / "empty", "");
	VFileInputStreamVirtual file(folder / "a");
	ExpectReads(file, bytes);
	VMemoryMappedInputStreamVirtual mapped(folder / "a", 1);
	ExpectReads(mapped, bytes);
	VFileInputStreamVirtual emptyFile(folder / "empty");
	ExpectReads(emptyFile, "");
	VMemoryMappedInputStreamVirtual emptyMapped(folder / "empty");
	ExpectReads(emptyMapped, "");
}

TEST(InputStreamSeekable, FailsWithoutAFile)
{
	const VTestFolder folder;
	VTestLog log("System");
	char byte = 0;
	for (const path& rPath : {folder / "no", folder.Path()})
	{
		VFileInputStreamVirtual file(rPath);
		EXPECT_FALSE(file.IsGood());
		EXPECT_FALSE(file.Seek(0));
		EXPECT_EQ(file.Read(&byte, 1), 0u);
		VMemoryMappedInputFile mapped(rPath);
		EXPECT_FALSE(mapped.IsOpen());
		EXPECT_TRUE(mapped.View(0).empty());
	}
	const std::string missing = "4 Std error code: " + std::to_string(ENOENT);
	const std::string directory = "4 Std error code: " + std::to_string(EISDIR);
	EXPECT_EQ(log.Take(), (VTexts{missing, missing, directory, directory}));
}

TEST(InputStreamSeekable, FailsWhereTheFileWasCutShort)
{
	const VTestFolder folder;
	const std::string bytes = Pattern(100000);
	Put(folder / "a", bytes);
	VMemoryMappedInputStreamVirtual mapped(folder / "a");
	std::string read(1000, '\0');
	ASSERT_EQ(mapped.Read(read.data(), read.size()), read.size());
	boost::filesystem::resize_file(folder / "a", 4096);
	ASSERT_EQ(mapped.Read(read.data(), read.size()), read.size());
	EXPECT_EQ(read, bytes.substr(1000, 1000));
	ASSERT_TRUE(mapped.Seek(50000));
	EXPECT_EQ(mapped.Read(read.data(), read.size()), 0u);
	EXPECT_FALSE(mapped.IsGood());
}

TEST(MemoryMappedFile, CountsSwapsAndPages)
{
	const VTestFolder folder;
	const std::size_t unit = Platform::GetMappingGranularity();
	const std::string bytes = Pattern(unit * 5 + 10);
	Put(folder / "a", bytes);
	VTestLog log("System");
	{
		VMemoryMappedInputStreamVirtual stream(folder / "a", 2 * unit);
		std::string read(bytes.size(), '\0');
		EXPECT_EQ(stream.Read(read.data(), read.size()), bytes.size());
		EXPECT_TRUE(read == bytes);
		// Within the last window, then back to the first.
		ASSERT_TRUE(stream.Seek(unit * 4));
		EXPECT_EQ(stream.Read(read.data(), 10), 10u);
		ASSERT_TRUE(stream.Seek(3));
		EXPECT_EQ(stream.Read(read.data(), 10), 10u);
	}
	EXPECT_EQ(log.Take(), VTexts{"6 VMemoryMappedInputStream stats: 4 swaps, 3 pages in file."});
}

TEST(MemoryMappedFile, WindowsBeginAtTheUnitBefore)
{
	const VTestFolder folder;
	const std::size_t unit = Platform::GetMappingGranularity();
	const std::string bytes = Pattern(unit * 4);
	Put(folder / "a", bytes);
	VMemoryMappedInputFile file(folder / "a", 2 * unit);
	EXPECT_EQ(file.View(unit + 5), std::string_view(bytes).substr(unit + 5, 2 * unit - 5));
	EXPECT_EQ(file.View(unit), std::string_view(bytes).substr(unit, 2 * unit));
	EXPECT_EQ(file.GetSwaps(), 1u);
	EXPECT_EQ(file.View(unit - 1), std::string_view(bytes).substr(unit - 1, unit + 1));
	EXPECT_EQ(file.GetSwaps(), 2u);
	EXPECT_TRUE(file.View(bytes.size()).empty());
	EXPECT_EQ(file.GetSwaps(), 2u);
}

TEST(MemoryMappedFile, WritesThroughTheView)
{
	const VTestFolder folder;
	const std::string bytes = Pattern(70000);
	Put(folder / "a", "older and to be overwritten");
	{
		VMemoryMappedOutputFile file(folder / "a", bytes.size());
		ASSERT_NE(file.GetData(), nullptr);
		bytes.copy(file.GetData(), bytes.size());
	}
	EXPECT_TRUE(Get(folder / "a") == bytes);
	EXPECT_EQ(VMemoryMappedOutputFile(folder / "a", 0).GetData(), nullptr);
	EXPECT_EQ(file_size(folder / "a"), 0u);
}

} // namespace
