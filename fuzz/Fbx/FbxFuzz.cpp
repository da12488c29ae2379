#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXReader.h"
#include "FBXIO/Mesh.h"
#include "fbxsdk/container/Arrays.h"
#include "fbxsdk/container/FileKind.h"

#include <boost/filesystem/operations.hpp>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
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

namespace
{

template <typename TVertex>
void RequireWhole(const FBXIO::VMesh<TVertex>& i_rMesh)
{
	for (const FBXIO::VMeshPart& rPart : i_rMesh.m_Parts)
	{
		Require(rPart.m_Indices.size() % (3 * rPart.m_IndexSize) == 0);
		for (std::size_t at = 0; at < rPart.m_Indices.size(); at += rPart.m_IndexSize)
		{
			std::uint32_t index = 0;
			std::memcpy(&index, rPart.m_Indices.data() + at, rPart.m_IndexSize);
			Require(index < i_rMesh.m_Vertices.size());
		}
	}
}

void ReadMeshes(FBXIO::FBXReader& io_rReader)
{
	std::vector<FBXIO::VPlacedMesh> placed;
	io_rReader.ReadPlacedMeshes(placed);
	for (const FBXIO::VPlacedMesh& rMesh : placed)
		RequireWhole(rMesh.m_Mesh);
	FBXIO::VSkin skin;
	io_rReader.ReadSkin(skin);
	for (const FBXIO::VSkinMesh& rMesh : skin.m_Meshes)
		RequireWhole(rMesh);
}

} // namespace

/// The whole road from a file to its bones, meshes and skin, and every array in it.
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

	if (bLoaded)
		ReadMeshes(reader);

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
