#include "../UtilsFileSystem/Folder.h"
#include "../UtilsFileSystem/Log.h"

#include "FBXIO/FBXReader.h"

#include "MeshFile.h"

#include <QBuffer>
#include <QImage>

#include <gtest/gtest.h>

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
	void WritePicture(const std::string& i_rName, int i_Width) const
	{
		ASSERT_TRUE(QImage(i_Width, 1, QImage::Format_RGB32).save(QString::fromStdString(Path(i_rName)), "PNG"));
	}

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
		VMeshRules rules = i_rRules;
		rules.m_Pictures = m_Pictures;
		reader.SetMeshRules(rules);
		EXPECT_TRUE(reader.LoadFile(Path("hero.fbx")));
		VBasicMesh mesh;
		reader.ReadTopMesh(mesh);
		return mesh.m_Parts;
	}

	const VTestFolder m_Folder;
	EPictures m_Pictures = EPictures::All;
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
		EXPECT_EQ(pPart->m_Emissive, QVector4D(0.1f, 0.2f, 0.3f, 0.5f));
		EXPECT_EQ(pPart->m_Ambient, QVector4D(0.4f, 0.5f, 0.6f, 0.25f));
		EXPECT_EQ(pPart->m_Diffuse, QVector4D(0.7f, 0.8f, 0.9f, 0.75f));
		EXPECT_EQ(pPart->m_Transparent, QVector4D(1, 1, 1, 0.125f));
	}
	EXPECT_EQ(parts[0].m_Specular, QVector4D(0.2f, 0.4f, 0.6f, 2));
	EXPECT_EQ(parts[0].m_Shininess, 20.0f);
	EXPECT_EQ(parts[0].m_Reflection, QVector4D(0.3f, 0.6f, 0.9f, 0.375f));
	EXPECT_EQ(parts[1].m_Specular, QVector4D());
	EXPECT_EQ(parts[1].m_Shininess, 0.0f);
	EXPECT_EQ(parts[2].m_Diffuse, QVector4D(1.0f, 0.8f, 0.8f, 1.0f)) << "of a class that is not known: as it was";
	EXPECT_EQ(parts[2].m_Emissive, QVector4D());
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
		EXPECT_EQ(rPart.m_Diffuse, bTemplate ? QVector4D(0.8f, 0.8f, 0.8f, 0.5f) : QVector4D(0.4f, 0.4f, 0.4f, 0.5f));
		EXPECT_EQ(rPart.m_Reflection.w(), bTemplate ? 1.0f : 0.5f);
		EXPECT_EQ(rPart.m_Emissive, QVector4D(0, 1, 0, 1)) << "not in the template";
	}
}

TEST_P(Material, TexturesAreLookedForInTurn)
{
	WritePicture("maps/skin.png", 1);
	WritePicture("relative.png", 2);
	WritePicture("skin.png", 3);
	const std::string absolute = Path("maps/skin.png");
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
	    {"no picture", Path("hero.fbx"), "", 0, Path("hero.fbx")}, {"none", "", "", 0, ""}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const VTestMaterial material{"lambert", {}, rRow.m_FileName, rRow.m_RelativeName};
		const std::vector<VMeshPart> parts = Read({material, material});
		ASSERT_EQ(parts.size(), 2u);
		EXPECT_EQ(parts[0].m_pTexture ? parts[0].m_pTexture->width() : 0, rRow.m_Width);
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
	EXPECT_EQ(parts[0].m_pTexture->width(), 5);
	EXPECT_EQ(parts[0].m_TexturePath, "C:\\art\\skin.png");
	EXPECT_TRUE(m_Failed.Take().empty());
	// Of several videos of one file that which holds it, wherever it stands.
	const std::string picture = Get(Path("other.png"));
	for (const VMeshPart& rPart : Read({{"lambert", {}, "C:\\a.png", "", {}, true},
	         {"lambert", {}, "C:\\a.png", "", picture, true}, {"lambert", {}, "C:\\a.png", "", {}}}))
		EXPECT_EQ(rPart.m_pTexture ? rPart.m_pTexture->width() : 0, 5);
	EXPECT_TRUE(m_Failed.Take().empty());
	// One that is no picture: that beside the file.
	const std::vector<VMeshPart> broken = Read({{"lambert", {}, "skin.png", "", "no picture"}});
	ASSERT_NE(broken.at(0).m_pTexture, nullptr);
	EXPECT_EQ(broken[0].m_pTexture->width(), 3);
	EXPECT_EQ(m_Failed.Take(), std::vector<std::string>{"2 Failed to load skin.png (embedded)"});
}

TEST_P(Material, NothingIsPrintedOfDamagedPictures)
{
	WritePicture("skin.png", 3);
	const std::string png = Get(Path("skin.png"));
	testing::internal::CaptureStderr();
	for (std::size_t at = 0; at < png.size(); ++at)
	{
		std::string damaged = png;
		damaged[at] = char(damaged[at] ^ 0x55);
		for (const std::string& rContent : {damaged, png.substr(0, at)})
		{
			Put(Path("skin.png"), rContent);
			const bool bRead = Read({{"lambert", {}, Path("skin.png"), ""}}).at(0).m_pTexture != nullptr;
			EXPECT_EQ(m_Failed.Take().empty(), bRead) << at;
		}
	}
	EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}

TEST_P(Material, OfPicturesTheHeadsMayBeEnough)
{
	WritePicture("skin.png", 3);
	Put(Path("cut.png"), Get(Path("skin.png")).substr(0, 66));
	Put(Path("none.png"), "no picture");
	for (const auto& [what, bRead] : {std::pair(EPictures::All, false), {EPictures::Heads, true}})
	{
		m_Pictures = what;
		const VMeshPart whole = Read({{"lambert", {}, Path("skin.png"), ""}}).at(0);
		EXPECT_EQ(whole.m_TextureSize, QSize(3, 1));
		EXPECT_EQ(whole.m_pTexture == nullptr, bRead);
		EXPECT_EQ(!Read({{"lambert", {}, Path("cut.png"), ""}}).at(0).m_TextureSize.isEmpty(), bRead);
		EXPECT_TRUE(Read({{"lambert", {}, Path("none.png"), ""}}).at(0).m_TextureSize.isEmpty());
		EXPECT_EQ(m_Failed.Take().size(), bRead ? 1u : 2u);
	}
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
	QBuffer buffer;
	QImage(3, 1, QImage::Format_RGB32).save(&buffer, "JPG");
	for (const int scans : {0, 100})
	{
		Put(Path("scans.jpg"), (buffer.data() + QByteArray("\xff\xda").repeated(scans)).toStdString());
		EXPECT_EQ(Read({{"lambert", {}, Path("scans.jpg"), ""}}).at(0).m_pTexture == nullptr, scans > 0);
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
			EXPECT_EQ(parts[i].m_pTexture ? parts[i].m_pTexture->width() : 0, rRow.m_Widths[i]) << i;
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
		EXPECT_EQ(mesh.m_Parts[0].m_pTexture->width(), width);
	}
}

TEST_P(Material, OfAnUnknownClassHasNoTexture)
{
	WritePicture("skin.png", 3);
	const std::vector<VMeshPart> parts =
	    Read({{"blinn", {}, Path("skin.png"), ""}, {"phong", {}, Path("skin.png"), ""}});
	ASSERT_EQ(parts.size(), 2u);
	EXPECT_EQ(parts[0].m_pTexture, nullptr);
	ASSERT_NE(parts[1].m_pTexture, nullptr);
	EXPECT_EQ(parts[1].m_pTexture->width(), 3);
	EXPECT_TRUE(m_Failed.Take().empty());
}

TEST_P(Material, OfAnUnknownClassMayShowItsBaseColour)
{
	WritePicture("skin.png", 3);
	const QVector4D white(1, 1, 1, 1);
	const struct
	{
		std::vector<std::pair<std::string, VNumbers>> m_Properties;
		QVector4D m_Diffuse;
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
