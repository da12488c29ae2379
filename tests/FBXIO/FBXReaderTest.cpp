#include "../UtilsFileSystem/Folder.h"
#include "../UtilsFileSystem/Log.h"

#include "FBXIO/FBXReader.h"

#include "FbxFileBuilder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

using namespace FBXIO;
using namespace FbxTest;
using namespace std::string_literals;

namespace
{

using VMessages = std::vector<std::string>;

/// What a load tells of the file "PATH".
struct VLoaded
{
	explicit VLoaded(const std::string& i_rBytes) : m_Bytes(i_rBytes)
	{
		VTestLog log("FBXIO");
		m_bLoaded = m_Reader.LoadMemory(m_Bytes, "PATH");
		m_Messages = log.Take();
		// The first one is always the same.
		EXPECT_EQ(m_Messages.front(), "4 Loading file PATH");
		m_Messages.erase(m_Messages.begin());
	}

	const std::string m_Bytes;
	FBXReader m_Reader;
	bool m_bLoaded;
	VMessages m_Messages;
};

VTestScene Bones(std::vector<VTestNode> i_Nodes, std::vector<std::pair<std::string, VNumbers>> i_Settings = {})
{
	return {std::move(i_Nodes), std::move(i_Settings), {}, {}};
}

class Reader : public testing::TestWithParam<VTestForm>
{
};

INSTANTIATE_TEST_SUITE_P(
    Forms, Reader, testing::ValuesIn(c_Forms), [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

/// Forms that few exporters write: values on the line after a name, a value of one byte, models at the top.
TEST(Reader, OddFormsAreRead)
{
	for (const char* pFile : {"ufbx_blender_279_default_a6100", "ufbx_maya_audio_b7500", "ufbx_max_cube_b5000"})
	{
		SCOPED_TRACE(pFile);
		VLoaded file(Get(RETARGET_TEST_DATA "/fbx/"s + pFile + ".fbx"));
		EXPECT_TRUE(file.m_Reader.IsComplete());
		std::vector<VPlacedMesh> cube;
		file.m_Reader.ReadPlacedMeshes(cube);
		ASSERT_EQ(cube.size(), 1u);
		EXPECT_EQ(cube[0].m_Mesh.m_Parts.at(0).m_Indices.size(), 12u * 3 * 2);
	}
}

TEST_P(Reader, RotationSpaceMayBeForLimitsOnly)
{
	using VProperties = std::vector<std::pair<std::string, VNumbers>>;
	const VProperties plain{{"Lcl Rotation", {10, 20, 30}}};
	VProperties space = plain;
	space.insert(space.end(),
	    {{"RotationActive", {1}}, {"RotationOrder", {4}}, {"PreRotation", {0, 90, 0}}, {"PostRotation", {45, 0, 0}}});
	VProperties limits = space;
	space.push_back({"RotationSpaceForLimitOnly", {0}});
	limits.push_back({"RotationSpaceForLimitOnly", {1}});
	const VLoaded file(Write(GetParam(),
	    Bones(
	        {{"plain", "LimbNode", -1, plain}, {"space", "LimbNode", -1, space}, {"limits", "LimbNode", -1, limits}})));
	const VSkinSkeleton& rBones = *file.m_Reader.GetSkeleton();
	ASSERT_EQ(rBones.size(), 3u);
	EXPECT_NE(rBones[1].m_Global, rBones[0].m_Global);
	EXPECT_NE(rBones[1].m_PreRotation, Rotation::VMatrix4());
	EXPECT_EQ(rBones[2].m_Global, rBones[0].m_Global);
	EXPECT_EQ(rBones[2].m_Local, rBones[0].m_Local);
	EXPECT_EQ(rBones[2].m_PreRotation, Rotation::VMatrix4());
}

TEST(Reader, WhatIsNoPlainFileIsNotFound)
{
	for (const std::string& rPath :
	    {RETARGET_TEST_DATA "/fbx"s, RETARGET_TEST_DATA "/no such file.fbx"s, ""s, "/dev/null"s})
	{
		VTestLog log("FBXIO");
		FBXReader reader;
		EXPECT_FALSE(reader.LoadFile(rPath));
		EXPECT_FALSE(reader.IsComplete());
		EXPECT_FALSE(reader.HasSkeleton());
		EXPECT_EQ(reader.GetSkeleton(), nullptr);
		EXPECT_EQ(log.Take(), VMessages{"2 File " + rPath + " not found"});
	}
}

TEST(Reader, WhatIsNotFbxIsRefused)
{
	const std::string magic("Kaydara FBX Binary  \0\x1a", 22);
	const std::pair<std::string, const char*> rows[]{{"", "File is empty"},
	    {"just some text", "File is not an FBX file"},
	    {"<?xml version=\"1.0\"?><KinematicModel/>", "File is not an FBX file"},
	    {magic, "File is corrupted: its first bytes are damaged"},
	    {magic + "\1\0\0\x1c\xe8"s, "File is written in big-endian byte order, which is not read"}};
	for (const auto& [bytes, text] : rows)
	{
		const VLoaded loaded(bytes);
		EXPECT_FALSE(loaded.m_bLoaded);
		EXPECT_EQ(loaded.m_Messages,
		    (VMessages{"2 Call to KFbxImporter::Initialize() failed.", "2 Error returned: "s + text}));
	}
	// It takes no room.
	const VTestFolder folder;
	const boost::filesystem::path large = folder / "large.fbx";
	Put(large, "");
	boost::filesystem::resize_file(large, (std::uint64_t(2) << 30) + 1);
	VTestLog log("FBXIO");
	FBXReader reader;
	EXPECT_FALSE(reader.LoadFile(large.string()));
	const VMessages told = log.Take();
	EXPECT_EQ(std::ranges::count(told, "2 Error returned: File is larger than 2 GiB"), 1);
}

TEST(Reader, OtherVersionsAreRefusedWithTheirNumbers)
{
	const std::pair<VTestForm, const char*> rows[]{{{"", EForm::Binary, 3000}, "3.0.0"},
	    {{"", EForm::Text, 4900}, "4.9.0"}, {{"", EForm::Binary, 8010}, "8.0.1"}, {{"", EForm::Text, 8000}, "8.0.0"}};
	for (const auto& [form, version] : rows)
	{
		const VLoaded loaded(Write(form, Bones({})));
		EXPECT_FALSE(loaded.m_bLoaded);
		EXPECT_EQ(loaded.m_Messages,
		    (VMessages{"2 Call to KFbxImporter::Initialize() failed.",
		        "2 Error returned: File version is not one of 5.0 to 7.9",
		        "2 FBX file import error: File version is old or too new.\n",
		        "2 FBX version number for file PATH is "s + version + "\n\n", "2 Current FBX version is 2020.0.1\n"}));
	}
}

TEST_P(Reader, TellsOfAPassword)
{
	VTestScene scene = Bones({{"hips", "LimbNode", -1, {}}});
	scene.m_EncryptionType = 1;
	const VLoaded loaded(Write(GetParam(), scene));
	EXPECT_TRUE(loaded.m_bLoaded);
	EXPECT_FALSE(loaded.m_Reader.IsComplete());
	EXPECT_FALSE(loaded.m_Reader.HasSkeleton());
	EXPECT_EQ(loaded.m_Messages, (VMessages{"2 FBX Importer: password Required"}));
}

TEST_P(Reader, KeepsWhatWasReadOfADamagedFile)
{
	std::vector<VTestRecord> records = Records(GetParam(), Bones({{"hips", "LimbNode", -1, {}}}, {{"UpAxis", {0}}}));
	records.push_back({"Extras", {}, {{"Last", {1.0}, {}}}});
	std::string bytes = Write(GetParam(), records);
	const std::size_t at = bytes.rfind("Last");
	bytes[at + 4] = '?';
	const VLoaded loaded(bytes);
	EXPECT_TRUE(loaded.m_bLoaded);
	EXPECT_FALSE(loaded.m_Reader.IsComplete());
	EXPECT_EQ(loaded.m_Reader.GetUpAxis(), 0);
	ASSERT_TRUE(loaded.m_Reader.HasSkeleton());
	EXPECT_EQ(loaded.m_Reader.GetSkeleton()->front().m_Name, "hips");
	const bool bBinary = GetParam().m_Form == EForm::Binary;
	const std::string what = bBinary ? "the values of a record are damaged" : "the name of a record is missing";
	EXPECT_EQ(loaded.m_Messages,
	    VMessages{"2 Error returned: File is corrupted: " + what + " (byte " + std::to_string(at) + ")"});
}

TEST_P(Reader, AxesThatAreNoneAreX)
{
	for (const double axis : {3, -1})
		EXPECT_EQ(VLoaded(Write(GetParam(), Bones({}, {{"UpAxis", {axis}}}))).m_Reader.GetUpAxis(), 0);
	EXPECT_EQ(VLoaded(Write(GetParam(), Bones({}))).m_Reader.GetUpAxis(), 1) << "without settings";
}

TEST(Reader, APlainNodeStandsForTheBoneOfItsName)
{
	const VLoaded loaded(
	    Write(c_Forms[1], Bones({{"a", "LimbNode", -1, {}}, {"a", "Null", -1, {}}, {"b", "LimbNode", 1, {}}})));
	EXPECT_EQ(loaded.m_Reader.GetSkeleton()->back().m_ParentIndex, 0);
}

TEST_P(Reader, TransformsThatAreNotFiniteBecomeTheIdentity)
{
	const double nan = std::nan("");
	const VTestScene scene = Bones({{"a", "LimbNode", -1, {{"Lcl Translation", {1, nan, 0}}}},
	    {"b", "LimbNode", 0, {{"Lcl Translation", {5, 0, 0}}}},
	    {"c", "LimbNode", -1, {{"RotationActive", {1}}, {"PreRotation", {INFINITY, 0, 0}}}},
	    {"d", "LimbNode", -1, {{"Lcl Translation", {1e300, 0, 0}}}}});
	const VLoaded loaded(Write(GetParam(), scene));
	const auto invalid = [](const char* i_pName)
	{ return "2 Invalid transform for: "s + i_pName + "; setting to identity"; };
	// The pre-rotation, the local and the global matrix in turn.
	EXPECT_EQ(loaded.m_Messages,
	    (VMessages{invalid("a"), invalid("a"), invalid("b"), invalid("c"), invalid("c"), invalid("c"), invalid("d"),
	        invalid("d")}));
	const VSkinSkeleton& rBones = *loaded.m_Reader.GetSkeleton();
	EXPECT_EQ(rBones[0].m_Global, Rotation::VMatrix4());
	EXPECT_EQ(rBones[1].m_Local(0, 3), 50.0f);
	EXPECT_EQ(rBones[2].m_PreRotation, Rotation::VMatrix4());
	EXPECT_EQ(rBones[3].m_Global, Rotation::VMatrix4());
}

TEST_P(Reader, ProgressRisesAndCanEndTheImport)
{
	const VTestFolder folder;
	const std::string path = (folder / "file.fbx").string();
	Put(path, Write(GetParam(), Bones({{"hips", "LimbNode", -1, {}}})));
	std::vector<float> told;
	// The call that ends it; the last time none does.
	for (std::size_t end = 0;; ++end)
	{
		told.clear();
		VTestLog log("FBXIO");
		FBXReader reader;
		reader.SetProgress(
		    [&](float i_Part)
		    {
			    told.push_back(i_Part);
			    return told.size() != end + 1;
		    });
		EXPECT_TRUE(reader.LoadFile(path));
		const bool bEnded = told.size() == end + 1;
		EXPECT_EQ(reader.IsComplete(), !bEnded);
		EXPECT_EQ(reader.HasSkeleton(), !bEnded);
		EXPECT_EQ(log.Take().back() == "2 Error returned: Import was cancelled", bEnded);
		if (!bEnded)
			break;
	}
	EXPECT_GE(told.size(), 3u);
	EXPECT_TRUE(std::is_sorted(told.begin(), told.end()));
	EXPECT_EQ(told.back(), 1.0f);
}

} // namespace
