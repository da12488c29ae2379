#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXReader.h"
#include "fbxsdk/container/Arrays.h"
#include "fbxsdk/container/FileKind.h"

#include <boost/filesystem/operations.hpp>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

namespace
{

/// One file for the life of the process, rewritten for every input.
struct VInputFile
{
	VInputFile() : m_Path((boost::filesystem::temp_directory_path() / boost::filesystem::unique_path()).string()) {}
	~VInputFile() { std::remove(m_Path.c_str()); }
	bool Write(const std::uint8_t* i_pData, std::size_t i_Size) const
	{
		std::FILE* const pFile = std::fopen(m_Path.c_str(), "wb");
		const bool bWritten = pFile && std::fwrite(i_pData, 1, i_Size, pFile) == i_Size;
		return pFile && std::fclose(pFile) == 0 && bWritten;
	}
	std::string m_Path;
};

void Require(bool i_bHolds)
{
	if (!i_bHolds)
		std::abort();
}

} // namespace

/// The whole road from a file to its bones, and every array in it.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static const std::shared_ptr<void> s_pQuiet = NVX::GlobalLog::AddSink([](const auto&, int, const std::string&) {});
	static const VInputFile s_File;
	Require(s_File.Write(i_pData, i_Size));
	FBXIO::FBXReader reader;
	const bool bLoaded = reader.LoadFile(s_File.m_Path);
	Require(bLoaded || (!reader.HasSkeleton() && !reader.IsComplete()));
	if (reader.HasSkeleton())
		for (const FBXIO::VSkinBone& rBone : *reader.GetSkeleton())
			Require(rBone.m_ParentIndex >= -1 && rBone.m_ParentIndex < &rBone - reader.GetSkeleton()->data());

	const std::string bytes(reinterpret_cast<const char*>(i_pData), i_Size);
	FbxFile::VElementTree tree;
	tree.Read(bytes, FbxFile::DetectFileKind(bytes));
	FbxFile::VDecodeBudget budget{16'000'000};
	for (FbxFile::VElementIndex element = 0; element < tree.Size(); ++element)
	{
		std::vector<float> reals;
		FbxFile::ReadArray(tree, element, budget, reals);
		std::vector<std::int32_t> integers;
		FbxFile::ReadArray(tree, element, budget, integers);
	}
	return 0;
}
