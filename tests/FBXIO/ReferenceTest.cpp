#include "../UtilsFileSystem/Log.h"

#include "FBXIO/FBXReader.h"

#include "Imported.h"
#include "SmallFiles.h"

#include <nlohmann/json.hpp>

#include <array>
#include <cmath>
#include <filesystem>
#include <limits>
#include <map>
#include <set>

using namespace FBXIO;

namespace
{

const std::string c_Folder = RETARGET_TEST_DATA "/fbx/";
const std::string c_Demo = "../../../demo/character";

/// What other programs found in each file: those of exporters, and small ones about one matter each.
nlohmann::json Reference(const std::string& i_rName)
{
	return nlohmann::json::parse(
	    Get(c_Folder + (i_rName.starts_with("cases/") ? "" : "reference/") + i_rName + ".json"));
}

std::vector<std::string> Files()
{
	std::vector<std::string> files;
	for (const auto& [pFolder, pPrefix] : {std::pair("reference", ""), {"cases", "cases/"}})
		for (const auto& rEntry : std::filesystem::directory_iterator(c_Folder + pFolder))
			if (rEntry.path().extension() == ".json")
				files.push_back(pPrefix + rEntry.path().stem().string());
	std::sort(files.begin(), files.end());
	return files;
}

class ReferenceFile : public testing::TestWithParam<std::string>
{
protected:
	/// Rotations and scalings to 1e-4, translations to 0.01 mm or 1e-5 of their size; of the small files, whose numbers
	/// are exact, to a hundredth of that.
	void ExpectMatrix(
	    const Rotation::VMatrix4& i_rMatrix, const nlohmann::json& i_rExpected, const std::string& i_rWhat)
	{
		const double part = GetParam().starts_with("cases/") ? 0.01 : 1.0;
		for (int i = 0; i < 16; ++i)
		{
			const double expected = i_rExpected[i];
			const double most = i % 4 == 3 ? std::max(0.01, 1e-5 * std::abs(expected)) : 1e-4;
			EXPECT_NEAR(i_rMatrix(i / 4, i % 4), expected, part * most) << i_rWhat << ' ' << i;
		}
	}
};

TEST(ReferenceFiles, AreAllThere)
{
	EXPECT_EQ(Files().size(), 32u);
}

TEST_P(ReferenceFile, BonesAgree)
{
	const nlohmann::json reference = Reference(GetParam());
	FBXReader reader;
	ASSERT_TRUE(reader.LoadFile(c_Folder + GetParam() + ".fbx"));
	EXPECT_TRUE(reader.IsComplete());
	EXPECT_EQ(reader.GetUpAxis(), reference["upAxis"]);
	EXPECT_EQ(reader.GetUnitScale(), float(reference["unitScale"]));
	const nlohmann::json& rBones = reference["bones"];
	EXPECT_EQ(reader.HasSkeleton(), !rBones.empty());
	if (rBones.empty())
		return;
	const VSkinSkeleton& rSkeleton = *reader.GetSkeleton();
	ASSERT_EQ(rSkeleton.size(), rBones.size());
	for (std::size_t i = 0; i < rBones.size(); ++i)
	{
		const VSkinBone& rBone = rSkeleton[i];
		EXPECT_EQ(rBone.m_Name, rBones[i]["name"]);
		EXPECT_EQ(rBone.m_ParentIndex, rBones[i]["parent"]) << rBone.m_Name;
		EXPECT_NEAR(rBone.m_AccumulatedScale, double(rBones[i]["accumulatedScale"]), 1e-4) << rBone.m_Name;
		ExpectMatrix(rBone.m_PreRotation, rBones[i]["preRotation"], rBone.m_Name + " pre-rotation");
		ExpectMatrix(rBone.m_Local, rBones[i]["local"], rBone.m_Name + " local");
		ExpectMatrix(rBone.m_Global, rBones[i]["global"], rBone.m_Name + " global");
		EXPECT_EQ(rBone.m_InverseBind, Rotation::VMatrix4());
	}
}

/// Triangles, and the bounds of all vertices in place: these are those of the control points where the texture
/// coordinates leave every control point in use.
TEST_P(ReferenceFile, PlacedMeshesAgree)
{
	const nlohmann::json meshes = Reference(GetParam())["placedMeshes"];
	FBXReader reader;
	ASSERT_TRUE(reader.LoadFile(c_Folder + GetParam() + ".fbx"));
	VTestLog log("FBXIO");
	std::vector<VPlacedMesh> placed;
	reader.ReadPlacedMeshes(placed);
	ASSERT_EQ(placed.size(), meshes.size());
	// The only mesh whose texture coordinates move anything.
	const std::string moved =
	    "3 4 polygon vertices of mesh Skeleton01 are moved to other control points that share their "
	    "texture coordinate";
	const std::vector<std::string> told = log.Take();
	for (const std::string& rText : told)
		EXPECT_TRUE(rText == moved || rText.starts_with("4 4 polygon vertices of ")
		    || rText.starts_with("3 Missing material") || rText.find("geometric transform") != std::string::npos
		    || rText.find("neither Phong nor Lambert") != std::string::npos)
		    << rText;
	EXPECT_EQ(std::count(told.begin(), told.end(), moved), GetParam() == "heaps_biped_zup_a7100");
	for (std::size_t i = 0; i < placed.size(); ++i)
	{
		const nlohmann::json& rExpected = meshes[i];
		const VBasicMesh& rMesh = placed[i].m_Mesh;
		EXPECT_EQ(placed[i].m_Name, rExpected["name"]);
		EXPECT_EQ(rMesh.m_Parts.size(), std::max(rExpected["materials"].get<std::size_t>(), std::size_t(1)));
		EXPECT_EQ(rMesh.m_Vertices.size(), rExpected["uvs"]);
		std::size_t triangles = 0;
		for (const VMeshPart& rPart : rMesh.m_Parts)
			triangles += rPart.m_Indices.size() / (3 * rPart.m_IndexSize);
		EXPECT_EQ(triangles, rExpected["triangles"]);
		constexpr float inf = std::numeric_limits<float>::infinity();
		float bounds[6]{inf, inf, inf, -inf, -inf, -inf};
		for (const VBasicVertex& rVertex : rMesh.m_Vertices)
		{
			const std::array<float, 3> point = placed[i].m_Transform.Map(rVertex.m_Position);
			for (int axis = 0; axis < 3; ++axis)
			{
				bounds[axis] = std::min(bounds[axis], point[axis]);
				bounds[axis + 3] = std::max(bounds[axis + 3], point[axis]);
			}
		}
		for (int k = 0; k < 6; ++k)
		{
			const double expected = rExpected["bounds"][k];
			EXPECT_NEAR(bounds[k], expected, std::max(0.01, 1e-5 * std::abs(expected))) << placed[i].m_Name << ' ' << k;
		}
	}
}

/// Of each mesh below the node.
void CountClusters(FbxNode& i_rNode, std::map<std::string, int>& io_rCounts)
{
	FbxMesh* const pMesh = i_rNode.GetMesh();
	for (int i = 0; FbxDeformer* const pSkin = pMesh ? pMesh->GetDeformer(i, FbxDeformer::eSkin) : nullptr; ++i)
		io_rCounts[i_rNode.GetName()] += static_cast<FbxSkin*>(pSkin)->GetClusterCount();
	for (int i = 0; i < i_rNode.GetChildCount(); ++i)
		CountClusters(*i_rNode.GetChild(i), io_rCounts);
}

TEST_P(ReferenceFile, ClustersAgree)
{
	const nlohmann::json reference = Reference(GetParam());
	FbxTest::VImported file(Get(c_Folder + GetParam() + ".fbx"));
	ASSERT_TRUE(file.m_bImported);
	std::map<std::string, int> counts;
	CountClusters(*file.Root(), counts);
	int sum = 0;
	for (const auto& [rName, rCount] : counts)
		sum += rCount;
	EXPECT_EQ(sum, reference["clusters"]);
	for (const nlohmann::json& rMesh : reference["placedMeshes"])
		EXPECT_EQ(counts[rMesh["name"]], rMesh["skinClusters"]) << rMesh["name"];
}

/// Of what a bone carries, the point that is farthest down one of its axes, against vertices as they are drawn: not
/// above those that it surely carries, nor below those that it may carry.
void ExpectCarried(const VSkinBone& i_rBone, double i_Surely, double i_Maybe)
{
	double lowest = std::numeric_limits<double>::max();
	if (i_rBone.m_Skin->m_pCarried)
		for (const auto& rPoint : *i_rBone.m_Skin->m_pCarried)
			lowest = std::min(lowest, double(rPoint[2]));
	EXPECT_LE(lowest, i_Surely + 0.1) << i_rBone.m_Name;
	EXPECT_GE(lowest, i_Maybe - 0.1) << i_rBone.m_Name;
}

/// What bones move, against the vertices as they are drawn, whose weights are rounded.
void ExpectBoneSkins(const VSkin& i_rSkin)
{
	std::vector<std::array<double, 4>> sums(i_rSkin.m_pSkeleton->size());
	constexpr double c_None = std::numeric_limits<double>::max();
	std::vector<std::array<double, 2>> lowest(sums.size(), {c_None, c_None});
	double whole = 0.0;
	for (const VSkinMesh& rMesh : i_rSkin.m_Meshes)
	{
		// A vertex at a seam stands there several times.
		std::set<std::array<float, 3>> seen;
		for (const VSkinVertex& rVertex : rMesh.m_Vertices)
			for (std::size_t i = 0; i < 4 && (i > 0 || seen.insert(rVertex.m_Position).second); ++i)
			{
				const Rotation::VMatrix4& rBind = (*i_rSkin.m_pSkeleton)[rVertex.m_BoneIndices[i]].m_InverseBind;
				auto& rSum = sums[rVertex.m_BoneIndices[i]];
				const double weight = rVertex.m_BoneWeights[i];
				whole += weight;
				rSum[3] += weight;
				for (int row = 0; row < 3; ++row)
				{
					double place = rBind(row, 3);
					double scale = 0.0;
					for (int column = 0; column < 3; ++column)
					{
						place += rBind(row, column) * rVertex.m_Position[std::size_t(column)];
						scale += rBind(row, column) * rBind(row, column);
					}
					place /= std::sqrt(scale);
					rSum[std::size_t(row)] += weight * place;
					for (const int maybe : {0, 1})
						if (double& rLowest = lowest[rVertex.m_BoneIndices[i]][std::size_t(maybe)];
						    row == 2 && weight >= (maybe ? 118.0 : 138.0))
							rLowest = std::min(rLowest, place);
				}
			}
	}
	for (std::size_t i = 0; i < sums.size(); ++i)
	{
		const auto& rBone = (*i_rSkin.m_pSkeleton)[i];
		ASSERT_TRUE(rBone.m_Skin) << rBone.m_Name;
		EXPECT_NEAR(rBone.m_Skin->m_Share, sums[i][3] / whole, 0.02) << rBone.m_Name;
		// The drawn vertices are in the scale of the bones, what is compared in that of the world.
		const bool bOfWorldScale = std::abs(rBone.m_AccumulatedScale - 1.0f) < 0.01f;
		if (bOfWorldScale)
			ExpectCarried(rBone, lowest[i][0], lowest[i][1]);
		for (std::size_t axis = 0; axis < 3 && bOfWorldScale && rBone.m_Skin->m_Share > 0.005; ++axis)
			EXPECT_NEAR(rBone.m_Skin->m_Centre[axis], sums[i][axis] / sums[i][3], 0.25 * rBone.m_Skin->m_Spread + 1.0)
			    << rBone.m_Name;
	}
}

TEST_P(ReferenceFile, SkinsAgree)
{
	const nlohmann::json reference = Reference(GetParam());
	FBXReader reader;
	ASSERT_TRUE(reader.LoadFile(c_Folder + GetParam() + ".fbx"));
	reader.ReadBoneSkins();
	VSkin skin;
	reader.ReadSkin(skin);
	EXPECT_EQ(skin.m_Meshes.size(), reference["skins"]);
	if (skin.m_Meshes.empty())
		return;
	ExpectBoneSkins(skin);
	std::size_t bound = 0;
	for (std::size_t i = 0; i < skin.m_pSkeleton->size(); ++i)
	{
		EXPECT_LT((*skin.m_pSkeleton)[i].m_ParentIndex, std::int64_t(i));
		bound += (*skin.m_pSkeleton)[i].m_InverseBind == Rotation::VMatrix4() ? 0 : 1;
	}
	EXPECT_LE(bound, reference["clusters"]);
	// Clusters without control points bind nothing: the file has 32 lists of them for its 45 clusters.
	const std::size_t empty = GetParam() == "kenney_medium_b7400" ? 13 : 0;
	EXPECT_GE(bound + empty + 1, reference["clusters"]) << "one bone at most is bound where the mesh is";
	for (const VSkinMesh& rMesh : skin.m_Meshes)
		for (const VSkinVertex& rVertex : rMesh.m_Vertices)
		{
			const auto& [a, b, c, d] = rVertex.m_BoneWeights;
			EXPECT_GE(a + b + c + d, 252);
			EXPECT_LE(a + b + c + d, 255);
			EXPECT_TRUE(a >= b && b >= c && c >= d);
			for (const std::uint8_t bone : rVertex.m_BoneIndices)
				EXPECT_LT(bone, skin.m_pSkeleton->size());
		}
}

INSTANTIATE_TEST_SUITE_P(Files, ReferenceFile, testing::ValuesIn(Files()),
    [](const auto& i_rInfo) { return i_rInfo.param.substr(i_rInfo.param.find('/') + 1); });

bool AreNear(const Rotation::VMatrix4& i_rA, const Rotation::VMatrix4& i_rB)
{
	float most = 0.0f;
	for (int i = 0; i < 16; ++i)
		most = std::max(most, std::abs(i_rA(i / 4, i % 4) - i_rB(i / 4, i % 4)));
	return most < 0.001f;
}

void ExpectEqual(const VSkin (&i_rSkins)[2])
{
	ASSERT_EQ(i_rSkins[0].m_Meshes.size(), i_rSkins[1].m_Meshes.size());
	ASSERT_EQ(i_rSkins[0].m_pSkeleton->size(), i_rSkins[1].m_pSkeleton->size());
	for (std::size_t i = 0; i < i_rSkins[0].m_pSkeleton->size(); ++i)
	{
		const VSkinBone& rA = (*i_rSkins[0].m_pSkeleton)[i];
		const VSkinBone& rB = (*i_rSkins[1].m_pSkeleton)[i];
		EXPECT_EQ(rA.m_Name, rB.m_Name);
		EXPECT_EQ(rA.m_ParentIndex, rB.m_ParentIndex);
		for (const auto member :
		    {&VSkinBone::m_PreRotation, &VSkinBone::m_InverseBind, &VSkinBone::m_Local, &VSkinBone::m_Global})
			EXPECT_TRUE(AreNear(rA.*member, rB.*member)) << rA.m_Name;
	}
	for (std::size_t i = 0; i < i_rSkins[0].m_Meshes.size(); ++i)
	{
		const VSkinMesh& rA = i_rSkins[0].m_Meshes[i];
		const VSkinMesh& rB = i_rSkins[1].m_Meshes[i];
		ASSERT_EQ(rA.m_Parts.size(), rB.m_Parts.size());
		for (std::size_t part = 0; part < rA.m_Parts.size(); ++part)
		{
			EXPECT_EQ(rA.m_Parts[part].m_Indices, rB.m_Parts[part].m_Indices);
			for (const auto pColour : {&VMeshPart::m_Diffuse, &VMeshPart::m_Transparent})
				for (int k = 0; k < 4; ++k)
					EXPECT_FLOAT_EQ((rA.m_Parts[part].*pColour)[k], (rB.m_Parts[part].*pColour)[k]);
		}
		ASSERT_EQ(rA.m_Vertices.size(), rB.m_Vertices.size());
		for (std::size_t vertex = 0; vertex < rA.m_Vertices.size(); ++vertex)
		{
			const VSkinVertex& rP = rA.m_Vertices[vertex];
			const VSkinVertex& rQ = rB.m_Vertices[vertex];
			EXPECT_EQ(rP.m_BoneIndices, rQ.m_BoneIndices) << vertex;
			for (int k = 0; k < 4; ++k)
				EXPECT_LE(std::abs(rP.m_BoneWeights[k] - rQ.m_BoneWeights[k]), 1);
			for (int axis = 0; axis < 3; ++axis)
			{
				EXPECT_NEAR(rP.m_Position[axis], rQ.m_Position[axis], 0.001f);
				EXPECT_NEAR(rP.m_Normal[axis], rQ.m_Normal[axis], 1e-4f);
			}
			EXPECT_NEAR(rP.m_TexCoord[0], rQ.m_TexCoord[0], 1e-5f);
			EXPECT_NEAR(rP.m_TexCoord[1], rQ.m_TexCoord[1], 1e-5f);
		}
	}
}

/// What one exporter wrote of one character in binary and as text, which has fewer digits: closer to each other than to
/// what other programs find.
TEST(ReferenceTwins, ReadToTheSameValues)
{
	VSkin skins[2];
	for (const int i : {0, 1})
	{
		FBXReader reader;
		ASSERT_TRUE(reader.LoadFile(c_Folder + (i == 0 ? "own_ns_yup_cm_a7400.fbx" : "own_ns_yup_cm_b7400.fbx")));
		reader.ReadSkin(skins[i]);
	}
	ExpectEqual(skins);
}

TEST(ReferenceTwins, OfOldVersionsReadToTheSameValues)
{
	std::vector<VPlacedMesh> meshes[2];
	for (const int i : {0, 1})
	{
		FBXReader reader;
		ASSERT_TRUE(reader.LoadFile(c_Folder + (i == 0 ? "ufbx_max_blob_a5800.fbx" : "ufbx_max_blob_b5800.fbx")));
		EXPECT_TRUE(reader.IsComplete());
		reader.ReadPlacedMeshes(meshes[i]);
	}
	ASSERT_EQ(meshes[0].size(), 17u);
	ASSERT_EQ(meshes[1].size(), 17u);
	for (std::size_t i = 0; i < meshes[0].size(); ++i)
	{
		const VPlacedMesh& rA = meshes[0][i];
		const VPlacedMesh& rB = meshes[1][i];
		EXPECT_TRUE(AreNear(rA.m_Transform, rB.m_Transform)) << i;
		ASSERT_EQ(rA.m_Mesh.m_Vertices.size(), rB.m_Mesh.m_Vertices.size());
		for (std::size_t vertex = 0; vertex < rA.m_Mesh.m_Vertices.size(); ++vertex)
			for (int axis = 0; axis < 3; ++axis)
				EXPECT_NEAR(rA.m_Mesh.m_Vertices[vertex].m_Position[axis],
				    rB.m_Mesh.m_Vertices[vertex].m_Position[axis], 1e-3f);
		ASSERT_EQ(rA.m_Mesh.m_Parts.size(), i == 0 ? 7u : 1u);
		for (std::size_t part = 0; part < rA.m_Mesh.m_Parts.size(); ++part)
			EXPECT_EQ(rA.m_Mesh.m_Parts[part].m_Indices, rB.m_Mesh.m_Parts[part].m_Indices);
	}
}

/// The same content as version 6.1 and as version 5 has it.
TEST(OldVersions, SkinsAreThoseOfNewerFiles)
{
	using namespace FbxTest;
	for (const EForm form : {EForm::Binary, EForm::Text})
	{
		SCOPED_TRACE(int(form));
		VSkin skins[2];
		for (const int i : {0, 1})
		{
			const VSmallFile file{"", {"", form, i == 0 ? 6100u : 5800u}};
			const std::string bytes = Write(file.m_Form, SmallRecords(file));
			FBXReader reader;
			ASSERT_TRUE(reader.LoadMemory(bytes, "PATH"));
			EXPECT_TRUE(reader.IsComplete());
			reader.ReadSkin(skins[i]);
		}
		ASSERT_EQ(skins[0].m_Meshes.size(), 1u);
		ExpectEqual(skins);
	}
}

/// The others were saved with bones or meshes moved since they were bound.
class FileInItsBindPose : public testing::TestWithParam<std::string>
{
};

TEST_P(FileInItsBindPose, SkinnedPointsLieWhereTheMeshLies)
{
	FBXReader reader;
	ASSERT_TRUE(reader.LoadFile(c_Folder + GetParam() + ".fbx"));
	std::vector<VPlacedMesh> placed;
	reader.ReadPlacedMeshes(placed);
	VSkin skin;
	reader.ReadSkin(skin);
	ASSERT_EQ(skin.m_Meshes.size(), 1u);
	ASSERT_EQ(placed.size(), 1u);
	const std::vector<VSkinVertex>& rVertices = skin.m_Meshes[0].m_Vertices;
	ASSERT_EQ(placed[0].m_Mesh.m_Vertices.size(), rVertices.size());
	float worst = 0;
	for (const VSkinVertex& rVertex : rVertices)
	{
		std::array<float, 3> skinned{};
		float sum = 0;
		for (int k = 0; k < 4; ++k)
		{
			const VSkinBone& rBone = (*skin.m_pSkeleton)[rVertex.m_BoneIndices[k]];
			const auto point = (rBone.m_Global * rBone.m_InverseBind).Map(rVertex.m_Position);
			for (int axis = 0; axis < 3; ++axis)
				skinned[axis] += rVertex.m_BoneWeights[k] * point[axis];
			sum += rVertex.m_BoneWeights[k];
		}
		const auto [x, y, z] = placed[0].m_Transform.Map(rVertex.m_Position);
		worst = std::max(worst, std::hypot(skinned[0] / sum - x, skinned[1] / sum - y, skinned[2] / sum - z));
	}
	EXPECT_LT(worst, 0.01f);
}

INSTANTIATE_TEST_SUITE_P(Files, FileInItsBindPose,
    testing::Values("own_game_zup_m_b7400", "own_ns_yup_cm_a7400", "own_ns_yup_cm_b7400", "pab_arnaud_b7500", c_Demo),
    [](const auto& i_rInfo) { return i_rInfo.param.substr(i_rInfo.param.rfind('/') + 1); });

/// Every vertex has weights that fit, every polygon its corners and its material; 39 bones are bound.
TEST(DemoCharacter, IsReadWithoutAWarning)
{
	VTestLog log("FBXIO");
	FBXReader reader;
	ASSERT_TRUE(reader.LoadFile(c_Folder + c_Demo + ".fbx"));
	std::vector<VPlacedMesh> placed;
	reader.ReadPlacedMeshes(placed);
	VSkin skin;
	reader.ReadSkin(skin);
	EXPECT_EQ(log.Take(), std::vector<std::string>{"4 Loading file " + c_Folder + c_Demo + ".fbx"});
	ASSERT_EQ(skin.m_pSkeleton->size(), 39u);
	for (const VSkinBone& rBone : *skin.m_pSkeleton)
		EXPECT_NE(rBone.m_InverseBind, Rotation::VMatrix4()) << rBone.m_Name;
}

} // namespace
