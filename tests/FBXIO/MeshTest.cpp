#include "../UtilsFileSystem/Log.h"

#include "FBXIO/FBXReader.h"

#include "Imported.h"
#include "MeshFile.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <numeric>
#include <optional>

using namespace FBXIO;
using namespace FbxTest;
using namespace std::string_literals;

namespace
{

using VMessages = std::vector<std::string>;

/// A square of two units: control points 0 to 3, counted round.
const VNumbers c_Square{0, 0, 0, 2, 0, 0, 2, 2, 0, 0, 2, 0};
const VNumbers c_Quad{0, 1, 2, -4};
const VNumbers c_TwoTriangles{0, 1, -3, 0, 2, -4};
/// One material for all.
const VTestLayer c_OneMaterial{"AllSame", "IndexToDirect", {}, {0}};
const VMessages c_NoMessages;

VTestScene OneMesh(std::vector<VTestNode> i_Bones = {})
{
	i_Bones.push_back({"body", "Mesh", -1, {}});
	return {std::move(i_Bones), {}, {}, {}};
}

/// The triangles of a part as numbers.
std::vector<std::uint32_t> Indices(const VMeshPart& i_rPart)
{
	std::vector<std::uint32_t> indices(i_rPart.m_Indices.size() / i_rPart.m_IndexSize);
	for (std::size_t i = 0; i < indices.size(); ++i)
		std::memcpy(&indices[i], i_rPart.m_Indices.data() + i * i_rPart.m_IndexSize, i_rPart.m_IndexSize);
	return indices;
}

/// What is told, but for the first line of each load.
VMessages Told(VTestLog& io_rLog)
{
	VMessages messages = io_rLog.Take();
	std::erase_if(messages, [](const std::string& i_rText) { return i_rText.starts_with("4 Loading file"); });
	return messages;
}

class Mesh : public testing::TestWithParam<VTestForm>
{
protected:
	/// The mesh of a scene with one, which may have materials and no skin.
	VBasicMesh Read(const VTestMesh& i_rMesh, const VMeshRules& i_rRules = {})
	{
		const std::string file = Write(GetParam(), OneMesh(), {i_rMesh});
		FBXReader reader;
		std::vector<VPlacedMesh> meshes;
		reader.SetMeshRules(i_rRules);
		EXPECT_TRUE(reader.LoadMemory(file, "PATH"));
		reader.ReadPlacedMeshes(meshes);
		EXPECT_EQ(meshes.size(), 1u);
		return meshes.empty() ? VBasicMesh() : std::move(meshes.front().m_Mesh);
	}

	VTestLog m_Log{"FBXIO"};
};

INSTANTIATE_TEST_SUITE_P(
    Forms, Mesh, testing::ValuesIn(c_Forms), [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

TEST_P(Mesh, NormalsAreTheFilesOnlyByControlPoint)
{
	const std::array<float, 3> slanted{0, 0.6f, 0.8f};
	const std::array<float, 3> up{0, 0, 1};
	VNumbers normals;
	for (int i = 0; i < 4; ++i)
		normals.insert(normals.end(), {0, 0.6, 0.8});
	const std::pair<VTestLayer, std::array<float, 3>> rows[]{{{"ByVertice", "Direct", normals, {}}, slanted},
	    {{"ByVertex", "Direct", normals, {}}, slanted}, {{"ByPolygonVertex", "Direct", normals, {}}, up},
	    {{"AllSame", "Direct", {0, 0.6, 0.8}, {}}, up}, {{"ByVertice", "Direct", {0, 0.6, 0.8}, {}}, up}, {{}, up}};
	for (const auto& [layer, normal] : rows)
	{
		SCOPED_TRACE(layer.m_Mapping);
		const VBasicMesh mesh = Read({0, c_Square, c_Quad, layer, {}, c_OneMaterial, {}, {}});
		ASSERT_EQ(mesh.m_Vertices.size(), 4u);
		EXPECT_EQ(mesh.m_Vertices[2].m_Position, (std::array<float, 3>{20, 20, 0})) << "in millimetres";
		EXPECT_EQ(mesh.m_Vertices[2].m_Normal, normal);
		EXPECT_EQ(mesh.m_Vertices[2].m_TexCoord, (std::array<float, 2>{}));
	}
	EXPECT_EQ(Told(m_Log), c_NoMessages);
}

TEST_P(Mesh, NormalsAreMadeForControlPointsAlone)
{
	VImported file(Write(GetParam(), OneMesh(), {{0, c_Square, c_Quad, {}, {}, c_OneMaterial, {}, {}}}));
	FbxMesh* const pMesh = file.Root()->GetChild(0)->GetMesh();
	ASSERT_NE(pMesh, nullptr);
	EXPECT_FALSE(pMesh->GenerateNormals(true, false));
	EXPECT_FALSE(pMesh->GetElementNormal());
	EXPECT_TRUE(pMesh->GenerateNormals(false, true));
	EXPECT_FALSE(pMesh->GenerateNormals(false, true)) << "it has some now";
}

struct VTexCoordRow
{
	const char* m_pName;
	VTestLayer m_UV;
	/// X and y of the position, then the coordinate, of each vertex.
	std::vector<std::array<float, 4>> m_Vertices;
	std::vector<std::uint32_t> m_Indices;
	VMessages m_Messages;
	EVertexKey m_Key = EVertexKey::UVIndex;
};

const VTexCoordRow c_TexCoordRows[]{
    {"None", {}, {{0, 0, 0, 0}, {20, 0, 0, 0}, {20, 20, 0, 0}, {0, 20, 0, 0}}, {0, 1, 2, 0, 2, 3}, {}},
    {"ByControlPoint", {"ByVertice", "Direct", {0, 0.5, 1, 0.5, 1, 1, 0, 1}, {}},
        {{0, 0, 0, 0.5}, {20, 0, 1, 0.5}, {20, 20, 1, 1}, {0, 20, 0, 1}}, {0, 1, 2, 0, 2, 3}, {}},
    {"ByControlPointTheIndexIsNotLookedAt", {"ByVertice", "IndexToDirect", {0, 0.5, 1, 0.5}, {1, 1, 0, 0}},
        {{0, 0, 0, 0.5}, {20, 0, 1, 0.5}, {20, 20, 0, 0}, {0, 20, 0, 0}}, {0, 1, 2, 0, 2, 3}, {}},
    // The seam: control point 0 has two coordinates, and 2 one for both triangles.
    {"ByPolygonVertex", {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 1, 1, 0, 1, 0.25, 0.25}, {0, 1, 2, 4, 2, 3}},
        {{0, 0, 0, 0}, {20, 0, 1, 0}, {20, 20, 1, 1}, {0, 0, 0.25, 0.25}, {0, 20, 0, 1}}, {0, 1, 2, 3, 2, 4}, {}},
    {"AnIndexForTwoControlPointsMovesTheSecond",
        {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 1, 1}, {0, 1, 2, 0, 2, 1}},
        {{0, 0, 0, 0}, {20, 0, 1, 0}, {20, 20, 1, 1}}, {0, 1, 2, 0, 2, 1},
        {"3 1 polygon vertices of mesh body are moved to other control points that share their texture coordinate",
            "4 1 polygon vertices of PATH are moved in all: its meshes are not drawn as the file means them. Told "
            "apart by "
            "control point, too, the vertices stay"}},
    // One entry of a palette, and the seam at point 0.
    {"ByControlPointTooNothingMoves", {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 1, 1}, {0, 1, 1, 2, 1, 1}},
        {{0, 0, 0, 0}, {20, 0, 1, 0}, {20, 20, 1, 0}, {0, 0, 1, 1}, {0, 20, 1, 0}}, {0, 1, 2, 3, 2, 4}, {},
        EVertexKey::ControlPointAndUVIndex},
    {"WithoutIndexThePositionServes", {"ByPolygonVertex", "Direct", {0, 0, 1, 0, 1, 1, 0, 0.5, 1, 0.5, 0, 1}, {}},
        {{0, 0, 0, 0}, {20, 0, 1, 0}, {20, 20, 1, 1}, {0, 0, 0, 0.5}, {20, 20, 1, 0.5}, {0, 20, 0, 1}},
        {0, 1, 2, 3, 4, 5}, {}},
    {"IndicesOutOfRange", {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 1, 1}, {0, 1, 2, 0, 77, -1}},
        {{0, 0, 0, 0}, {20, 0, 1, 0}, {20, 20, 1, 1}, {20, 20, 0, 0}, {0, 20, 0, 0}}, {0, 1, 2, 0, 3, 4},
        {"3 2 vertices of mesh body have no texture coordinate"}},
    {"IndicesOutOfRangeByControlPointToo",
        {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 1, 1}, {0, 1, 2, 0, 77, -1}},
        {{0, 0, 0, 0}, {20, 0, 1, 0}, {20, 20, 1, 1}, {20, 20, 0, 0}, {0, 20, 0, 0}}, {0, 1, 2, 0, 3, 4},
        {"3 2 vertices of mesh body have no texture coordinate"}, EVertexKey::ControlPointAndUVIndex},
    {"OtherMappingsAreNone", {"ByPolygon", "Direct", {1, 1, 1, 1}, {}},
        {{0, 0, 0, 0}, {20, 0, 0, 0}, {20, 20, 0, 0}, {0, 20, 0, 0}}, {0, 1, 2, 0, 2, 3}, {}},
};

TEST_P(Mesh, TextureCoordinates)
{
	for (const VTexCoordRow& rRow : c_TexCoordRows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const VBasicMesh mesh = Read({0, c_Square, c_TwoTriangles, {}, rRow.m_UV, c_OneMaterial, {}, {}}, {rRow.m_Key});
		std::vector<std::array<float, 4>> vertices;
		for (const VBasicVertex& rVertex : mesh.m_Vertices)
			vertices.push_back(
			    {rVertex.m_Position[0], rVertex.m_Position[1], rVertex.m_TexCoord[0], rVertex.m_TexCoord[1]});
		EXPECT_EQ(vertices, rRow.m_Vertices);
		ASSERT_EQ(mesh.m_Parts.size(), 1u);
		EXPECT_EQ(Indices(mesh.m_Parts[0]), rRow.m_Indices);
		EXPECT_EQ(Told(m_Log), rRow.m_Messages);
	}
}

TEST_P(Mesh, TextureCoordinatesAreThoseOfTheFirstLayer)
{
	VTestMesh from{
	    0, c_Square, c_Quad, {}, {"ByVertice", "Direct", {0, 0.5, 1, 0.5, 1, 1, 0, 1}, {}}, c_OneMaterial, {}, {}};
	from.m_SecondUV = {"ByVertice", "Direct", VNumbers(8, 0.25), {}};
	EXPECT_EQ(Read(from).m_Vertices.at(1).m_TexCoord, (std::array<float, 2>{1, 0.5f}));
}

struct VPartsRow
{
	const char* m_pName;
	VTestLayer m_Layer;
	std::size_t m_Materials;
	/// For a quad, a line and a triangle.
	std::vector<std::vector<std::uint32_t>> m_Parts;
	VMessages m_Messages;
};

TEST_P(Mesh, PartsByMaterial)
{
	const std::string owner = GetParam().m_Version >= 7000 ? "bodyShape" : "body";
	const VMessages missing{"3 Missing material for mesh " + owner};
	const std::vector<std::uint32_t> quad{0, 1, 2, 0, 2, 3};
	const std::vector<std::uint32_t> triangle{3, 2, 0};
	const std::vector<std::uint32_t> both{0, 1, 2, 0, 2, 3, 3, 2, 0};
	const VPartsRow rows[]{
	    {"ByPolygon", {"ByPolygon", "IndexToDirect", {}, {1, 0, 0}}, 2, {triangle, quad}, {}},
	    {"BeyondThePartsIsDropped", {"ByPolygon", "IndexToDirect", {}, {7, 0, 1}}, 2, {{}, triangle},
	        {"3 1 polygons of PATH are left out because their material is beyond the list of their node"}},
	    {"BelowZeroIsTheFirst", {"ByPolygon", "IndexToDirect", {}, {1, 0, -3}}, 2, {triangle, quad}, {}},
	    {"AllSame", {"AllSame", "IndexToDirect", {}, {1}}, 2, {both, {}}, {}},
	    {"AnotherLengthIsNoList", {"ByPolygon", "IndexToDirect", {}, {1, 1}}, 2, {both, {}}, {}},
	    {"NoMaterial", c_OneMaterial, 0, {both}, {}},
	    {"NoElement", {}, 2, {both, {}}, missing},
	    {"NeitherElementNorMaterial", {}, 0, {both}, missing},
	};
	for (const VPartsRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const VBasicMesh mesh = Read({0, c_Square, {0, 1, 2, -4, 0, -2, 3, 2, -1}, {}, {}, rRow.m_Layer,
		    std::vector<VTestMaterial>(rRow.m_Materials, {"lambert", {}, "", ""}), {}});
		std::vector<std::vector<std::uint32_t>> parts;
		for (const VMeshPart& rPart : mesh.m_Parts)
		{
			parts.push_back(Indices(rPart));
			EXPECT_EQ(rPart.m_IndexSize, 2u);
		}
		EXPECT_EQ(parts, rRow.m_Parts);
		EXPECT_EQ(Told(m_Log), rRow.m_Messages);
	}
}

TEST_P(Mesh, PolygonsBecomeFansOfTheirFirstVertex)
{
	const VBasicMesh mesh = Read(
	    {0, {0, 0, 0, 1, 0, 0, 2, 1, 0, 1, 2, 0, 0, 2, 0}, {3, 4, 0, 1, -3, -1, 1, -2}, {}, {}, c_OneMaterial, {}, {}});
	EXPECT_EQ(Indices(mesh.m_Parts.at(0)), (std::vector<std::uint32_t>{3, 4, 0, 3, 0, 1, 3, 1, 2}));
}

TEST_P(Mesh, DamageIsToldAndLeftOut)
{
	const double nan = std::nan("");
	VNumbers points = c_Square;
	points[4] = nan;
	const VBasicMesh mesh = Read({0, points, {0, 1, -3, 0, 9, -4, 0, 2}, {}, {}, c_OneMaterial, {}, {}});
	EXPECT_EQ(mesh.m_Vertices.at(1).m_Position, (std::array<float, 3>{20, 0, 0}));
	EXPECT_EQ(Indices(mesh.m_Parts.at(0)), (std::vector<std::uint32_t>{0, 1, 2}));
	const std::string owner = GetParam().m_Version >= 7000 ? "bodyShape" : "body";
	EXPECT_EQ(Told(m_Log),
	    (VMessages{"3 Polygons left out of mesh " + owner
	            + " because they have no end or name control points that do not exist: 2",
	        "3 1 control points of mesh body have coordinates or normals that are no numbers; setting these to "
	        "zero"}));
}

TEST(MeshMessages, NameTheNodeOfANamelessGeometry)
{
	const VTestForm& rText = c_Forms[4];
	std::string file = Write(rText, {{{"body", "Mesh", -1, {}}}, {}, {}, {}},
	    {VTestMesh{0, c_Square, {0, 9, -3}, {}, {}, c_OneMaterial, {}, {}}});
	const std::string name = "bodyShape";
	file.erase(file.find(name), name.size());
	VTestLog log("FBXIO");
	FBXReader reader;
	EXPECT_TRUE(reader.LoadMemory(file, "PATH"));
	VBasicMesh mesh;
	reader.ReadTopMesh(mesh);
	EXPECT_EQ(Told(log),
	    VMessages{
	        "3 Polygons left out of mesh body because they have no end or name control points that do not exist: 1"});
}

/// A strip of triangles over this many control points, of which the last is the last corner.
VTestMesh Strip(std::size_t i_Points)
{
	VTestMesh mesh{0, {}, {}, {}, {}, c_OneMaterial, {}, {}};
	for (std::size_t i = 0; i < i_Points; ++i)
		mesh.m_Points.insert(mesh.m_Points.end(), {double(i / 2), double(i % 2), 0});
	for (std::size_t i = 0; i + 2 < i_Points; i += 100)
		mesh.m_Polygons.insert(mesh.m_Polygons.end(), {double(i), double(i + 1), -double(i + 2) - 1});
	const double last = double(i_Points - 1);
	mesh.m_Polygons.insert(mesh.m_Polygons.end(), {0, 1, -last - 1});
	return mesh;
}

TEST(MeshIndices, TakeFourBytesFromTheVertexCountOn)
{
	const std::pair<std::size_t, std::uint32_t> rows[]{{65535, 2}, {65536, 4}, {70000, 4}};
	for (const bool bByPolygonVertex : {false, true})
		for (const auto& [count, size] : rows)
		{
			SCOPED_TRACE(count);
			VTestMesh strip = Strip(bByPolygonVertex ? 5 : count);
			if (bByPolygonVertex)
			{
				// Few control points, and one vertex for each coordinate: corners until there are enough.
				strip.m_Polygons.clear();
				for (std::size_t i = 0; i < count; ++i)
					strip.m_Polygons.push_back(i + 1 == count || i % 3 == 2 ? -1.0 - double(i % 5) : double(i % 5));
				strip.m_UV = {"ByPolygonVertex", "Direct", VNumbers(2 * count, 0.5), {}};
			}
			const std::string file = Write(c_Forms[1], OneMesh(), {strip});
			FBXReader reader;
			ASSERT_TRUE(reader.LoadMemory(file, "PATH"));
			VBasicMesh mesh;
			reader.ReadTopMesh(mesh);
			ASSERT_EQ(mesh.m_Vertices.size(), count);
			ASSERT_EQ(mesh.m_Parts.size(), 1u);
			EXPECT_EQ(mesh.m_Parts[0].m_IndexSize, size);
			const std::vector<std::uint32_t> indices = Indices(mesh.m_Parts[0]);
			EXPECT_EQ(
			    *std::max_element(indices.begin(), indices.end()), count - 1 - (bByPolygonVertex ? count % 3 : 0));
			EXPECT_EQ(indices.size() % 3, 0u);
		}
}

TEST_P(Mesh, TopMeshIsTheLastThatHasNoneAbove)
{
	const VTestScene scene{{{"first", "Mesh", -1, {{"Lcl Translation", {5, 0, 0}}}}, {"inner", "Mesh", 0, {}},
	                           {"group", "Null", -1, {}}, {"last", "Mesh", 2, {{"Lcl Translation", {0, 5, 0}}}}},
	    {}, {}, {}};
	std::vector<VTestMesh> meshes;
	for (const auto& [node, x] : {std::pair<int, double>{0, 1}, {1, 2}, {3, 3}})
		meshes.push_back({node, {x, 0, 0, 0, 1, 0, 0, 0, 1}, {0, 1, -3}, {}, {}, c_OneMaterial, {}, {}});
	const std::string file = Write(GetParam(), scene, meshes);
	FBXReader reader;
	VBasicMesh top;
	reader.ReadTopMesh(top);
	EXPECT_TRUE(top.m_Vertices.empty()) << "before the file is loaded";
	ASSERT_TRUE(reader.LoadMemory(file, "PATH"));
	reader.ReadTopMesh(top);
	EXPECT_EQ(top.m_Vertices.at(0).m_Position[0], 30.0f) << "without its node's transform";
	std::vector<VPlacedMesh> placed;
	reader.ReadPlacedMeshes(placed);
	ASSERT_EQ(placed.size(), 3u);
	EXPECT_EQ(placed[1].m_Name, "inner");
	EXPECT_EQ(placed[1].m_Transform(0, 3), 50.0f);
	EXPECT_EQ(placed[2].m_Transform(1, 3), 50.0f);
	VSkin skin;
	reader.ReadSkin(skin);
	EXPECT_EQ(skin.m_pSkeleton, nullptr) << "a file without bones has no skin";
	EXPECT_TRUE(skin.m_Meshes.empty());
}

TEST_P(Mesh, GeometricTransformsAreTold)
{
	VTestScene scene = OneMesh();
	const std::vector<std::pair<std::string, VNumbers>> rows[]{
	    {{"Lcl Scaling", {2, 2, 2}}, {"GeometricTranslation", {0, 0, 3}}, {"GeometricRotation", {0, 0, 90}}},
	    {{"GeometricTranslation", {0, 0, 0.009}}}};
	for (const auto& rRow : rows)
	{
		scene.m_Nodes[0].m_Properties = rRow;
		const VTestLayer beyond{"ByPolygon", "IndexToDirect", {}, {7}};
		const std::string file = Write(GetParam(), scene,
		    {{0, c_Square, c_Quad, {}, {}, beyond, std::vector<VTestMaterial>(2, {"lambert", {}, "", ""}), {}}});
		FBXReader reader;
		ASSERT_TRUE(reader.LoadMemory(file, "PATH"));
		VMessages messages{"3 1 polygons of PATH are left out because their material is beyond the list of their node"};
		if (&rRow == rows)
			messages.push_back(
			    "3 1 meshes of PATH are drawn without their geometric transform, which would move them by up to 100.0 "
			    "mm. Apply it in the program that wrote the file");
		for (const bool bFirst : {true, false})
		{
			std::vector<VPlacedMesh> placed;
			reader.ReadPlacedMeshes(placed);
			ASSERT_EQ(placed.size(), 1u);
			EXPECT_EQ(placed[0].m_Mesh.m_Vertices.at(2).m_Position, (std::array<float, 3>{20, 20, 0}));
			// Twice as large: the far corner goes from (40, 40, 0) to (-40, 40, 60).
			EXPECT_EQ(Told(m_Log), bFirst ? messages : VMessages());
		}
	}
}

TEST_P(Mesh, PlaceThatIsNotFiniteIsTheIdentity)
{
	VTestScene scene = OneMesh();
	scene.m_Nodes[0].m_Properties = {{"Lcl Translation", {1, std::nan(""), 3}}};
	const std::string file = Write(GetParam(), scene, {{0, c_Square, c_Quad, {}, {}, c_OneMaterial, {}, {}}});
	FBXReader reader;
	ASSERT_TRUE(reader.LoadMemory(file, "PATH"));
	std::vector<VPlacedMesh> placed;
	reader.ReadPlacedMeshes(placed);
	ASSERT_EQ(placed.size(), 1u);
	EXPECT_EQ(placed[0].m_Transform, Rotation::VMatrix4());
	EXPECT_EQ(Told(m_Log), (VMessages{"2 Invalid transform for: body; setting to identity"}));
}

} // namespace
