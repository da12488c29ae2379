#include "../Matrices.h"
#include "../UtilsFileSystem/Log.h"

#include "FBXIO/FBXReader.h"

#include "MeshFile.h"

#include <gtest/gtest.h>

#include <cmath>

using namespace FBXIO;
using namespace FbxTest;
using namespace std::string_literals;

namespace
{

using VMessages = std::vector<std::string>;
using VBytes = std::array<std::uint8_t, 4>;

/// Three points and a triangle of them, in the node at this place.
VTestMesh Triangle(int i_Node, std::vector<VTestCluster> i_Clusters)
{
	return {i_Node, {0, 0, 0, 1, 0, 0, 0, 1, 0}, {0, 1, -3}, {}, {}, {"AllSame", "IndexToDirect", {}, {0}}, {},
	    std::move(i_Clusters)};
}

VNumbers Translation(double i_X, double i_Y, double i_Z)
{
	return {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, i_X, i_Y, i_Z, 1};
}

class Skin : public testing::TestWithParam<VTestForm>
{
protected:
	VSkin Read(const VTestScene& i_rScene, const std::vector<VTestMesh>& i_rMeshes)
	{
		const std::string file = Write(GetParam(), i_rScene, i_rMeshes);
		FBXReader reader;
		EXPECT_TRUE(reader.LoadMemory(file, "PATH"));
		VSkin skin;
		reader.ReadSkin(skin);
		m_pFull = reader.GetSkeleton();
		m_Messages = m_Log.Take();
		m_Messages.erase(m_Messages.begin());
		return skin;
	}

	VTestLog m_Log{"FBXIO"};
	VMessages m_Messages;
	std::shared_ptr<const VSkinSkeleton> m_pFull;
};

INSTANTIATE_TEST_SUITE_P(
    Forms, Skin, testing::ValuesIn(c_Forms), [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

struct VWeightsRow
{
	const char* m_pName;
	/// Of the first point: weights by bone, from bone 1 on; the other two are bound to bone 0.
	VNumbers m_Weights;
	VBytes m_Indices;
	VBytes m_Bytes;
	VMessages m_Messages;
};

const VMessages c_Unweighted{"3 1 unweighted vertices in mesh body"};

const VWeightsRow c_WeightsRows[]{
    {"One", {0.3}, {1, 0, 0, 0}, {255, 0, 0, 0}, {}},
    {"TwoEqualLoseOne", {0.5, 0.5}, {1, 2, 0, 0}, {127, 127, 0, 0}, {}},
    {"TheLargestFirst", {0.25, 0.75}, {2, 1, 0, 0}, {191, 63, 0, 0}, {}},
    {"FourFit", {0.125, 0.25, 0.5, 0.125}, {3, 2, 1, 4}, {127, 63, 31, 31}, {}},
    {"SixKeepFour", {0.4, 0.3, 0.1, 0.1, 0.05, 0.05}, {1, 2, 3, 4}, {113, 85, 28, 28},
        {"6 Too many bones on 1 vertices, with maximum contribution of 5%"}},
    {"AnySumCountsAsAll", {6, 2}, {1, 2, 0, 0}, {191, 63, 0, 0}, {}},
    {"NoCluster", {}, {0, 0, 0, 0}, {0, 0, 0, 0}, c_Unweighted},
    {"NoWeight", {0, 0}, {1, 2, 0, 0}, {0, 0, 0, 0}, c_Unweighted},
    {"BelowZero", {1, -2}, {1, 2, 0, 0}, {0, 0, 0, 0}, c_Unweighted},
    {"NotANumber", {std::nan(""), 1}, {2, 0, 0, 0}, {255, 0, 0, 0},
        {"3 1 weights of mesh body left out because they are no numbers or name control points that do not exist"}},
};

TEST_P(Skin, WeightsAreCutToFourBytes)
{
	for (const VWeightsRow& rRow : c_WeightsRows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VTestScene scene{{{"root", "LimbNode", -1, {}}}, {}, {}, {}};
		std::vector<VTestCluster> clusters{{0, {1, 2}, {1, 1}, {}, {}}};
		for (std::size_t i = 0; i < rRow.m_Weights.size(); ++i)
		{
			scene.m_Nodes.push_back({"bone" + std::to_string(i), "LimbNode", 0, {}});
			clusters.push_back({int(i) + 1, {0}, {rRow.m_Weights[i]}, {}, {}});
		}
		scene.m_Nodes.push_back({"body", "Mesh", -1, {}});
		const VSkin skin = Read(scene, {Triangle(int(scene.m_Nodes.size()) - 1, clusters)});
		ASSERT_EQ(skin.m_Meshes.size(), 1u);
		ASSERT_EQ(skin.m_Meshes[0].m_Vertices.size(), 3u);
		EXPECT_EQ(skin.m_Meshes[0].m_Vertices[0].m_BoneIndices, rRow.m_Indices);
		EXPECT_EQ(skin.m_Meshes[0].m_Vertices[0].m_BoneWeights, rRow.m_Bytes);
		EXPECT_EQ(skin.m_Meshes[0].m_Vertices[2].m_BoneWeights, (VBytes{255, 0, 0, 0}));
		EXPECT_EQ(m_Messages, rRow.m_Messages);
	}
}

TEST_P(Skin, TheLargestDroppedWeightIsTold)
{
	VTestScene scene{{{"body", "Mesh", -1, {}}}, {}, {}, {}};
	std::vector<VTestCluster> clusters;
	for (int i = 1; i <= 5; ++i)
	{
		scene.m_Nodes.push_back({"bone" + std::to_string(i), "LimbNode", -1, {}});
		// The fifth weights are 0.1, 0.125 and 0.0625.
		clusters.push_back(
		    {i, {0, 1, 2}, {i == 3 ? 0.1 : 0.225, i == 1 ? 0.125 : 0.25, i == 5 ? 0.0625 : 0.3}, {}, {}});
	}
	Read(scene, {Triangle(0, clusters)});
	EXPECT_EQ(m_Messages, (VMessages{"6 Too many bones on 3 vertices, with maximum contribution of 12.5%"}));
}

TEST_P(Skin, VerticesOfTextureCoordinatesKeepTheirBones)
{
	const VTestScene scene{
	    {{"root", "LimbNode", -1, {}}, {"tip", "LimbNode", 0, {}}, {"body", "Mesh", -1, {}}}, {}, {}, {}};
	VTestMesh mesh = Triangle(2, {{0, {0, 1}, {1, 1}, {}, {}}, {1, {2}, {1}, {}, {}}});
	mesh.m_Polygons = {0, 1, -3, 2, 1, -1};
	mesh.m_UV = {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 0, 1, 1, 1}, {0, 1, 2, 3, 1, 0}};
	const VSkin skin = Read(scene, {mesh});
	std::vector<int> bones;
	for (const VSkinVertex& rVertex : skin.m_Meshes.at(0).m_Vertices)
		bones.push_back(rVertex.m_BoneIndices[0]);
	EXPECT_EQ(bones, (std::vector<int>{0, 0, 1, 1}));
}

TEST_P(Skin, MissingBonesPullToTheFirst)
{
	// The plain node is no bone.
	const VTestScene scene{
	    {{"root", "LimbNode", -1, {}}, {"plain", "Null", -1, {}}, {"tip", "LimbNode", 0, {}}, {"body", "Mesh", -1, {}}},
	    {}, {}, {}};
	const VSkin skin = Read(scene,
	    {Triangle(
	        3, {{2, {0, 1}, {1, 1}, {}, {}}, {1, {2}, {0.5}, {}, {}}, {-1, {2}, {0.5}, {}, {}}, {2, {}, {}, {}, {}}})});
	const std::string missing = "2 Missing bone plain for cluster body cluster1";
	EXPECT_EQ(m_Messages, (VMessages{missing, missing})) << "once for the skeleton and once for the weights";
	ASSERT_EQ(skin.m_Meshes.size(), 1u);
	EXPECT_EQ(skin.m_Meshes[0].m_Vertices[0].m_BoneIndices, (VBytes{1, 0, 0, 0}));
	EXPECT_EQ(skin.m_Meshes[0].m_Vertices[2].m_BoneIndices, (VBytes{0, 0, 0, 0}));
	EXPECT_EQ(skin.m_Meshes[0].m_Vertices[2].m_BoneWeights, (VBytes{255, 0, 0, 0}))
	    << "nothing of the linkless cluster";
}

TEST_P(Skin, SkeletonIsOfUsedBonesWithAllAboveAndBelow)
{
	const VTestScene scene{{{"prop", "LimbNode", -1, {}}, {"grip", "LimbNode", 0, {}}, {"hips", "LimbNode", -1, {}},
	                           {"spine", "LimbNode", 2, {}}, {"head", "LimbNode", 3, {}}, {"end", "LimbNode", 4, {}},
	                           {"body", "Mesh", -1, {}}, {"hat", "Mesh", -1, {}}},
	    {}, {}, {}};
	// The file holds the mesh relative to the bone; the second mesh's cluster comes later and stays.
	const VSkin skin = Read(scene,
	    {Triangle(6, {{3, {0, 1, 2}, {1, 1, 1}, Translation(0, -4, 0), Translation(0, 4, 0)}}),
	        Triangle(7, {{3, {0, 1, 2}, {1, 1, 1}, Translation(0, -5, 2), Translation(0, 5, 0)}})});
	EXPECT_EQ(m_Messages,
	    (VMessages{"3 1 bones of PATH are bound differently by several meshes; each moves all of them as the last one "
	               "binds it"}));
	ASSERT_NE(skin.m_pSkeleton, nullptr);
	const std::pair<const char*, int> expected[]{{"hips", -1}, {"spine", 0}, {"head", 1}, {"end", 2}};
	ASSERT_EQ(skin.m_pSkeleton->size(), std::size(expected));
	for (std::size_t i = 0; i < std::size(expected); ++i)
	{
		EXPECT_EQ((*skin.m_pSkeleton)[i].m_Name, expected[i].first);
		EXPECT_EQ((*skin.m_pSkeleton)[i].m_ParentIndex, expected[i].second);
		EXPECT_EQ((*skin.m_pSkeleton)[i].m_InverseBind == Rotation::VMatrix4(), i != 1);
	}
	Rotation::VMatrix4 bind;
	Move(bind, 0, -50, 20);
	EXPECT_EQ((*skin.m_pSkeleton)[1].m_InverseBind, bind) << "in millimetres";
	EXPECT_EQ(skin.m_Meshes.size(), 2u);
	EXPECT_EQ(skin.m_Meshes[0].m_Vertices[0].m_BoneIndices[0], 1);
	ASSERT_EQ(m_pFull->size(), 6u) << "the reader's own skeleton stays";
	EXPECT_EQ((*m_pFull)[3].m_InverseBind, Rotation::VMatrix4());
}

TEST_P(Skin, ClustersOfUnevenListsKeepThePairs)
{
	const VTestScene scene{{{"root", "LimbNode", -1, {}}, {"body", "Mesh", -1, {}}}, {}, {}, {}};
	const VSkin skin = Read(scene, {Triangle(1, {{0, {0, 1, 2}, {1, 1}, {}, {}}})});
	EXPECT_EQ(m_Messages,
	    (VMessages{"3 Cluster body cluster0 has 3 indices and 2 weights; the rest is left out", c_Unweighted[0]}));
	EXPECT_EQ(skin.m_Meshes.at(0).m_Vertices[1].m_BoneWeights, (VBytes{255, 0, 0, 0}));
}

TEST_P(Skin, WhatIsFoundOfAMeshIsToldOnce)
{
	const VTestScene scene{{{"root", "LimbNode", -1, {}}, {"body", "Mesh", -1, {}}}, {}, {}, {}};
	VTestMesh mesh = Triangle(1, {{0, {0, 1, 2}, {1, 1, 1}, {}, {}}});
	mesh.m_MaterialLayer = {};
	mesh.m_Points[4] = std::nan("");
	mesh.m_UV = {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0}, {0, 0, 7}};
	const std::string file = Write(GetParam(), scene, {mesh});
	FBXReader reader;
	ASSERT_TRUE(reader.LoadMemory(file, "PATH"));
	std::vector<VPlacedMesh> placed;
	reader.ReadPlacedMeshes(placed);
	EXPECT_EQ(m_Log.Take().size(), 6u)
	    << "the load, a number, a moved vertex, for all as well, an unmapped one, no material";
	VSkin skin;
	reader.ReadSkin(skin);
	EXPECT_EQ(skin.m_Meshes.size(), 1u);
	EXPECT_EQ(m_Log.Take().size(), 0u);
}

TEST_P(Skin, MeshesWithoutSkinAreNoPartOfIt)
{
	const VTestScene scene{{{"root", "LimbNode", -1, {}}, {"body", "Mesh", -1, {}}}, {}, {}, {}};
	const VSkin skin = Read(scene, {Triangle(1, {})});
	EXPECT_TRUE(skin.m_Meshes.empty());
	ASSERT_NE(skin.m_pSkeleton, nullptr);
	EXPECT_TRUE(skin.m_pSkeleton->empty());
}

} // namespace
