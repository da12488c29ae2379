#include "../UtilsFileSystem/Log.h"

#include "FBXIO/FBXReader.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <sstream>

using namespace FBXIO;

namespace
{

/// The cells of each row of the page's table: file, form, bones, meshes, triangles, warnings, remarks.
std::vector<std::vector<std::string>> Rows()
{
	std::vector<std::vector<std::string>> rows;
	std::ifstream page(RETARGET_SOURCE "/docs/fbx-files.md");
	for (std::string line; std::getline(page, line);)
	{
		if (!line.starts_with("| `"))
			continue;
		std::istringstream cells(line.substr(1));
		std::vector<std::string>& rRow = rows.emplace_back();
		for (std::string cell; std::getline(cells, cell, '|');)
		{
			std::erase(cell, '`');
			const std::size_t first = cell.find_first_not_of(' ');
			rRow.push_back(
			    first == std::string::npos ? "" : cell.substr(first, cell.find_last_not_of(' ') + 1 - first));
		}
	}
	return rows;
}

TEST(OtherFiles, AreReadAsTheTableTells)
{
	const std::filesystem::path folder = "/usr/share/assimp/models/FBX";
	if (!std::filesystem::is_directory(folder))
		GTEST_SKIP() << "the package assimp-testmodels is not installed";
	const auto rows = Rows();
	std::size_t files = 0;
	for (const auto& rEntry : std::filesystem::recursive_directory_iterator(folder))
		files += rEntry.is_regular_file() && rEntry.path().extension().string().size() == 4;
	EXPECT_EQ(rows.size(), files) << "every file has its row";
	for (const std::vector<std::string>& rRow : rows)
	{
		ASSERT_EQ(rRow.size(), 7u) << rRow[0];
		SCOPED_TRACE(rRow[0]);
		VTestLog log("FBXIO");
		FBXReader reader;
		reader.SetMeshRules(c_FaithfulMeshes);
		const bool bLoaded = reader.LoadFile((folder / rRow[0]).string());
		EXPECT_EQ(bLoaded, !rRow[6].starts_with("refused"));
		if (!bLoaded)
		{
			const std::string reason = log.Take().back().substr(std::string("2 Error returned: ").size());
			EXPECT_NE(rRow[6].find('"' + reason + '"'), std::string::npos) << reason;
			continue;
		}
		EXPECT_TRUE(reader.IsComplete());
		std::vector<VPlacedMesh> meshes;
		reader.ReadPlacedMeshes(meshes);
		std::size_t triangles = 0;
		for (const VPlacedMesh& rMesh : meshes)
			for (const VMeshPart& rPart : rMesh.m_Mesh.m_Parts)
				triangles += rPart.m_Indices.size() / (3 * rPart.m_IndexSize);
		const std::vector<std::string> told = log.Take();
		const auto warnings =
		    std::count_if(told.begin(), told.end(), [](const std::string& i_rText) { return i_rText[0] <= '3'; });
		EXPECT_EQ(std::to_string(reader.HasSkeleton() ? reader.GetSkeleton()->size() : 0), rRow[2]);
		EXPECT_EQ(std::to_string(meshes.size()), rRow[3]);
		EXPECT_EQ(std::to_string(triangles), rRow[4]);
		EXPECT_EQ(std::to_string(warnings), rRow[5]);
		VSkin skin;
		reader.ReadSkin(skin);
	}
}

} // namespace
