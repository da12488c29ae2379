#include "../UtilsFileSystem/Folder.h"
#include "../UtilsFileSystem/Log.h"

#include "FBXIO/FBXReader.h"

#include "MeshFile.h"
#include "Pictures.h"

#include <gtest/gtest.h>

#include <sys/stat.h>

using namespace FBXIO;
using namespace FbxTest;

namespace
{

/// A folder for a file and its textures, and what is told of them.
class Material : public testing::TestWithParam<VTestForm>
{
protected:
	Material() { create_directory(m_Folder / "maps"); }

	std::string Path(const std::string& i_rName) const { return (m_Folder / i_rName).string(); }

	/// A picture of this width.
	void WritePicture(const std::string& i_rName, int i_Width) const { Put(Path(i_rName), PngOf(i_Width, 1)); }

	/// The parts of two triangles with these materials.
	std::vector<VMeshPart> Read(const std::vector<VTestMaterial>& i_rMaterials,
	    const VTestLayer& i_rLayer = {"AllSame", "IndexToDirect", {}, {0}}, const VTestLayer& i_rTextures = {},
	    const VMeshRules& i_rRules = {})
	{
		const VTestScene scene{{{"body", "Mesh", -1, {}}}, {}, {}, {}};
		Put(Path("hero.fbx"),
		    Write(GetParam(), scene,
		        {{0, {0, 0, 0, 1, 0, 0, 0, 1, 0}, {0, 1, -3, 0, 2, -2}, {}, {}, i_rLayer, i_rMaterials, {},
		            i_rTextures}}));
		FBXReader reader;
		reader.SetMeshRules(i_rRules);
		EXPECT_TRUE(reader.LoadFile(Path("hero.fbx")));
		VBasicMesh mesh;
		reader.ReadTopMesh(mesh);
		return mesh.m_Parts;
	}

	const VTestFolder m_Folder;
	VTestLog m_Failed{"Import"};
};

INSTANTIATE_TEST_SUITE_P(
    Forms, Material, testing::ValuesIn(c_Forms), [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

TEST_P(Material, ColoursByClass)
{
	const std::vector<std::pair<std::string, VNumbers>> all{{"EmissiveColor", {0.1, 0.2, 0.3}},
	    {"EmissiveFactor", {0.5}}, {"AmbientColor", {0.4, 0.5, 0.6}}, {"AmbientFactor", {0.25}},
	    {"DiffuseColor", {0.7, 0.8, 0.9}}, {"DiffuseFactor", {0.75}}, {"TransparentColor", {1, 1, 1}},
	    {"TransparencyFactor", {0.125}}, {"SpecularColor", {0.2, 0.4, 0.6}}, {"SpecularFactor", {2}},
	    {"ShininessExponent", {20}}, {"ReflectionColor", {0.3, 0.6, 0.9}}, {"ReflectionFactor", {0.375}}};
	const std::vector<VMeshPart> parts =
	    Read({{"phong", all, "", ""}, {"Lambert", all, "", ""}, {"blinn", all, "", ""}});
	ASSERT_EQ(parts.size(), 3u);
	for (const VMeshPart* const pPart : {&parts[0], &parts[1]})
	{
		EXPECT_EQ(pPart->m_Emissive, (VColourAndFactor{0.1f, 0.2f, 0.3f, 0.5f}));
		EXPECT_EQ(pPart->m_Ambient, (VColourAndFactor{0.4f, 0.5f, 0.6f, 0.25f}));
		EXPECT_EQ(pPart->m_Diffuse, (VColourAndFactor{0.7f, 0.8f, 0.9f, 0.75f}));
		EXPECT_EQ(pPart->m_Transparent, (VColourAndFactor{1, 1, 1, 0.125f}));
	}
	EXPECT_EQ(parts[0].m_Specular, (VColourAndFactor{0.2f, 0.4f, 0.6f, 2}));
	EXPECT_EQ(parts[0].m_Shininess, 20.0f);
	EXPECT_EQ(parts[0].m_Reflection, (VColourAndFactor{0.3f, 0.6f, 0.9f, 0.375f}));
	EXPECT_EQ(parts[1].m_Specular, VColourAndFactor{});
	EXPECT_EQ(parts[1].m_Shininess, 0.0f);
	EXPECT_EQ(parts[2].m_Diffuse, (VColourAndFactor{1.0f, 0.8f, 0.8f, 1.0f}))
	    << "of a class that is not known: as it was";
	EXPECT_EQ(parts[2].m_Emissive, VColourAndFactor{});
}

/// What the SDK writes for old readers is a colour times its factor.
TEST_P(Material, NamesForOldReadersCountAfterTheTemplate)
{
	if (GetParam().m_Version < 7000)
		return;
	VTestScene scene{{{"body", "Mesh", -1, {}}}, {}, {}, {}};
	for (const bool bTemplate : {false, true})
	{
		if (bTemplate)
			scene.m_MaterialTemplate = {{"DiffuseColor", {0.8, 0.8, 0.8}}, {"ReflectionFactor", {1}}};
		const VNumbers points{0, 0, 0, 1, 0, 0, 0, 1, 0};
		const VTestMaterial material{"phong",
		    {{"Diffuse", {0.4, 0.4, 0.4}}, {"Reflectivity", {0.5}}, {"Emissive", {0, 1, 0}}, {"DiffuseFactor", {0.5}}},
		    "", ""};
		FBXReader reader;
		EXPECT_TRUE(
		    reader.LoadMemory(Write(GetParam(), scene, {{0, points, {0, 1, -3}, {}, {}, {}, {material}, {}}}), "PATH"));
		VBasicMesh mesh;
		reader.ReadTopMesh(mesh);
		const VMeshPart& rPart = mesh.m_Parts.at(0);
		const float diffuse = bTemplate ? 0.8f : 0.4f;
		EXPECT_EQ(rPart.m_Diffuse, (VColourAndFactor{diffuse, diffuse, diffuse, 0.5f}));
		EXPECT_EQ(rPart.m_Reflection[3], bTemplate ? 1.0f : 0.5f);
		EXPECT_EQ(rPart.m_Emissive, (VColourAndFactor{0, 1, 0, 1})) << "not in the template";
	}
}

TEST_P(Material, TexturesAreLookedForInTurn)
{
	WritePicture("maps/skin.png", 1);
	WritePicture("relative.png", 2);
	WritePicture("skin.png", 3);
	ASSERT_EQ(::mkfifo(Path("pipe.png").c_str(), 0600), 0);
	boost::filesystem::create_symlink("/dev/zero", Path("link.png"));
	const std::string absolute = Path("maps/skin.png");
	const std::string upwards = "../../../../../../../../etc/passwd";
	const struct
	{
		const char* m_pName;
		std::string m_FileName;
		std::string m_RelativeName;
		/// Which picture, 0 for none; where it was looked for last.
		int m_Width;
		std::string m_Path;
	} rows[]{{"as it stands", absolute, "relative.png", 1, absolute},
	    {"relative", "/nowhere/skin.png", "relative.png", 2, Path("relative.png")},
	    {"relative, into a folder", "/nowhere/other.png", "maps\\skin.png", 1, Path("maps/skin.png")},
	    {"beside the file", "/nowhere/skin.png", "gone.png", 3, Path("skin.png")},
	    {"of another system", "C:\\art\\skin.png", "", 3, Path("skin.png")},
	    {"nowhere", "/nowhere/lost.png", "gone.png", 0, Path("lost.png")},
	    {"no picture", Path("hero.fbx"), "", 0, Path("hero.fbx")}, {"none", "", "", 0, ""},
	    {"of a server", R"(\\server\share\skin.png)", "", 3, Path("skin.png")},
	    {"upwards", "/nowhere/x.png", upwards, 0, Path(upwards)}, {"a folder", Path("maps"), "", 0, Path("maps")},
	    {"a pipe", Path("pipe.png"), "", 0, Path("pipe.png")}, {"a device", "/dev/zero", "", 0, "/dev/zero"},
	    {"a link to one", "", "link.png", 0, Path("link.png")}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const VTestMaterial material{"lambert", {}, rRow.m_FileName, rRow.m_RelativeName};
		const std::vector<VMeshPart> parts = Read({material, material});
		ASSERT_EQ(parts.size(), 2u);
		EXPECT_EQ(parts[0].m_pTexture ? parts[0].m_pTexture->m_Width : 0, rRow.m_Width);
		EXPECT_EQ(parts[0].m_TexturePath, rRow.m_Path);
		EXPECT_EQ(parts[0].m_pTexture, parts[1].m_pTexture) << "one image for both";
		std::vector<std::string> failed;
		if (rRow.m_Width == 0 && !rRow.m_Path.empty())
			failed = {"2 Failed to load " + rRow.m_Path};
		EXPECT_EQ(m_Failed.Take(), failed);
	}
}

TEST_P(Material, PicturesInTheFileComeFirst)
{
	WritePicture("skin.png", 3);
	WritePicture("other.png", 5);
	const std::vector<VMeshPart> parts = Read({{"lambert", {}, "C:\\art\\skin.png", "", Get(Path("other.png"))}});
	ASSERT_EQ(parts.size(), 1u);
	ASSERT_NE(parts[0].m_pTexture, nullptr);
	EXPECT_EQ(parts[0].m_pTexture->m_Width, 5);
	EXPECT_EQ(parts[0].m_TexturePath, "C:\\art\\skin.png");
	EXPECT_TRUE(m_Failed.Take().empty());
	// Of several videos of one file that which holds it, wherever it stands.
	const std::string picture = Get(Path("other.png"));
	for (const VMeshPart& rPart : Read({{"lambert", {}, "C:\\a.png", "", {}, true},
	         {"lambert", {}, "C:\\a.png", "", picture, true}, {"lambert", {}, "C:\\a.png", "", {}}}))
		EXPECT_EQ(rPart.m_pTexture ? rPart.m_pTexture->m_Width : 0, 5);
	EXPECT_TRUE(m_Failed.Take().empty());
	// The texture's own, which is called otherwise; before version 7 the first texture is that of all materials.
	const VTestMaterial own{"lambert", {}, "C:\a.png", "b.png", picture, true};
	const VTestMaterial empty{"lambert", {}, "C:\a.png", "", {}, true};
	const VMeshPart last = Read(GetParam().m_Version < 7000 ? std::vector{own} : std::vector{empty, own}).back();
	EXPECT_EQ(last.m_pTexture ? last.m_pTexture->m_Width : 0, 5);
	m_Failed.Take();
	// One that is no picture: that beside the file.
	const std::vector<VMeshPart> broken = Read({{"lambert", {}, "skin.png", "", "no picture"}});
	ASSERT_NE(broken.at(0).m_pTexture, nullptr);
	EXPECT_EQ(broken[0].m_pTexture->m_Width, 3);
	EXPECT_EQ(m_Failed.Take(), std::vector<std::string>{"2 Failed to load skin.png (embedded)"});
}

/// A head that promises more than a picture may have.
TEST_P(Material, PicturesAreBounded)
{
	Put(Path("huge.ppm"), "P6 20000 20000 255\n");
	EXPECT_EQ(Read({{"lambert", {}, Path("huge.ppm"), ""}}).at(0).m_pTexture, nullptr);
	EXPECT_EQ(m_Failed.Take(),
	    (std::vector<std::string>{"2 Failed to load " + Path("huge.ppm")
	        + ": its 20000 by 20000 points, or all pictures of the FBX file together, are too large"}));
	// Scans that cost as much as the picture, however small they are.
	for (const int scans : {1, 101})
	{
		std::string jpeg("\xff\xd8\xff\xc0\0\x0b\x08\0\1\0\3\1\1\x11\0", 15);
		for (int i = 0; i < scans; ++i)
			jpeg += "\xff\xda";
		Put(Path("scans.jpg"), jpeg);
		EXPECT_EQ(Read({{"lambert", {}, Path("scans.jpg"), ""}}).at(0).m_pTexture == nullptr, scans > 100);
	}
	// Together: two that are allowed, and a third that is not. Before version 7 the first is that of all materials.
	std::vector<VTestMaterial> materials;
	for (const char* pName : {"a", "b", "c"})
		materials.push_back({"lambert", {}, pName, "", "P6 4000 4000 255\n"});
	m_Failed.Take();
	Read(materials);
	const std::vector<std::string> failed = m_Failed.Take();
	EXPECT_EQ(std::count_if(failed.begin(), failed.end(),
	              [](const std::string& i_rText) { return i_rText.find("too large") != std::string::npos; }),
	    GetParam().m_Version < 7000 ? 0 : 1);
}

TEST_P(Material, TexturesOfLayersGoToTheMaterialsOfTheirPolygons)
{
	if (GetParam().m_Version >= 7000)
		return;
	WritePicture("a.png", 1);
	WritePicture("b.png", 2);
	const std::string several =
	    "3 Polygons of one material of body have several textures; each material gets the first of its own";
	const struct
	{
		const char* m_pName;
		VTestLayer m_Materials;
		VTestLayer m_Textures;
		/// Of the two parts, 0 for none.
		int m_Widths[2];
		std::string m_Message;
	} rows[]{{"no layer", {"ByPolygon", "IndexToDirect", {}, {0, 1}}, {}, {1, 1}, {}},
	    {"by polygon", {"ByPolygon", "IndexToDirect", {}, {0, 1}}, {"ByPolygon", "IndexToDirect", {}, {1, 0}}, {2, 1},
	        {}},
	    {"all the same", {"ByPolygon", "IndexToDirect", {}, {0, 1}}, {"AllSame", "IndexToDirect", {}, {1}}, {2, 2}, {}},
	    {"none", {"ByPolygon", "IndexToDirect", {}, {1, 0}}, {"ByPolygon", "IndexToDirect", {}, {-1, 1}}, {2, 0}, {}},
	    {"beyond", {"ByPolygon", "IndexToDirect", {}, {1, 0}}, {"ByPolygon", "IndexToDirect", {}, {9, 1}}, {2, 0}, {}},
	    {"several", {"AllSame", "IndexToDirect", {}, {1}}, {"ByPolygon", "IndexToDirect", {}, {1, 0}}, {0, 2},
	        several}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VTestLog log("FBXIO");
		const std::vector<VMeshPart> parts = Read(
		    {{"lambert", {}, Path("a.png"), ""}, {"phong", {}, Path("b.png"), ""}}, rRow.m_Materials, rRow.m_Textures);
		ASSERT_EQ(parts.size(), 2u);
		for (int i = 0; i < 2; ++i)
			EXPECT_EQ(parts[i].m_pTexture ? parts[i].m_pTexture->m_Width : 0, rRow.m_Widths[i]) << i;
		const std::vector<std::string> messages = log.Take();
		ASSERT_EQ(messages.size(), rRow.m_Message.empty() ? 1u : 2u);
		EXPECT_TRUE(rRow.m_Message.empty() || messages[1] == rRow.m_Message);
	}
}

TEST_P(Material, TexturesOfOtherLayersAreNotDiffuse)
{
	if (GetParam().m_Version >= 7000)
		return;
	WritePicture("a.png", 1);
	WritePicture("b.png", 2);
	const VTestScene scene{{{"body", "Mesh", -1, {}}}, {}, {}, {}};
	for (const auto& [emissive, width] : {std::pair<double, int>{-1, 1}, {0, 2}, {1, 1}})
	{
		VTestMesh from{0, {0, 0, 0, 1, 0, 0, 0, 1, 0}, {0, 1, -3}, {}, {}, {"AllSame", "IndexToDirect", {}, {0}},
		    {{"lambert", {}, Path("a.png"), ""}, {"lambert", {}, Path("b.png"), ""}}, {}};
		from.m_EmissiveTextureLayer = {"AllSame", "IndexToDirect", {}, {emissive}};
		FBXReader reader;
		EXPECT_TRUE(reader.LoadMemory(Write(GetParam(), scene, {from}), "PATH"));
		VBasicMesh mesh;
		reader.ReadTopMesh(mesh);
		ASSERT_NE(mesh.m_Parts.at(0).m_pTexture, nullptr);
		EXPECT_EQ(mesh.m_Parts[0].m_pTexture->m_Width, width);
	}
}

TEST_P(Material, OfAnUnknownClassHasNoTexture)
{
	WritePicture("skin.png", 3);
	const std::vector<VMeshPart> parts = Read({{"blinn", {}, Path("skin.png"), ""}, {"phong", {}, Path("skin.png"), ""},
	    {"phong", {}, Path("skin.png"), "", {}, false, "NormalMap"}});
	ASSERT_EQ(parts.size(), 3u);
	EXPECT_EQ(parts[0].m_pTexture, nullptr);
	ASSERT_NE(parts[1].m_pTexture, nullptr);
	EXPECT_EQ(parts[1].m_pTexture->m_Width, 3);
	EXPECT_EQ(parts[2].m_pTexture != nullptr, GetParam().m_Version < 7000) << "no colour";
	EXPECT_TRUE(m_Failed.Take().empty());
}

TEST_P(Material, OfAnUnknownClassMayShowItsBaseColour)
{
	WritePicture("skin.png", 3);
	const VColourAndFactor white{1, 1, 1, 1};
	const struct
	{
		std::vector<std::pair<std::string, VNumbers>> m_Properties;
		VColourAndFactor m_Diffuse;
		const char* m_pTextured = "";
	} rows[]{{{{"Maya|baseColor", {0.25, 0.5, 1}}}, {0.25f, 0.5f, 1, 1}},
	    {{{"DiffuseColor", {1, 0, 0}}, {"3dsMax|main|basecolor", {0, 0.5, 1, 1}}, {"Diffuse", {0, 0, 1}}},
	        {0, 0.5f, 1, 1}},
	    {{{"3dsMax|Parameters|base_color", {0, 0.5, 1}}}, white, "3dsMax|main|base_color_map"},
	    {{}, white, "Maya|TEX_color_map"},
	    {{{"Maya|baseColorWeight", {0, 0, 0}}}, {1.0f, 0.8f, 0.8f, 1.0f}, "Maya|normalCamera"}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pTextured);
		if (*rRow.m_pTextured && GetParam().m_Version < 7000)
			continue;
		VTestLog log("FBXIO");
		const std::vector<VMeshPart> parts =
		    Read({{"unknown", rRow.m_Properties, *rRow.m_pTextured ? Path("skin.png") : "", "", {}, false,
		             rRow.m_pTextured}},
		        {"AllSame", "IndexToDirect", {}, {0}}, {}, c_FaithfulMeshes);
		ASSERT_EQ(parts.size(), 1u);
		EXPECT_EQ(parts[0].m_Diffuse, rRow.m_Diffuse);
		EXPECT_EQ(parts[0].m_pTexture != nullptr, rRow.m_Diffuse == white);
		EXPECT_NE(log.Take().back().find(
		              &rRow == &rows[4] ? "are drawn in the default colour" : "; their base colour and its texture"),
		    std::string::npos);
	}
}

} // namespace
