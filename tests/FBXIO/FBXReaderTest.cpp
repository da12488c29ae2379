#include "FBXIO/FBXReader.h"

#include "FbxFileBuilder.h"
#include "TestFile.h"
#include "TestLog.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

using namespace FBXIO;
using namespace FbxTest;
using namespace std::string_literals;

namespace
{

/// What a load tells, with the file's path as "PATH".
struct VLoaded
{
	explicit VLoaded(const std::string& i_rBytes)
	{
		VTestLog log;
		const VTestFile file(i_rBytes);
		m_bLoaded = m_Reader.LoadFile(file.Path());
		m_Messages = log.m_Messages;
		for (auto& [level, text] : m_Messages)
			if (const std::size_t at = text.find(file.Path()); at != std::string::npos)
				text.replace(at, file.Path().size(), "PATH");
		// The first one is always the same.
		EXPECT_EQ(m_Messages.front(), (VMessages::value_type{4, "Loading file PATH"}));
		m_Messages.erase(m_Messages.begin());
	}

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

TEST(Reader, WhatIsNoPlainFileIsNotFound)
{
	for (const std::string& rPath :
	    {RETARGET_TEST_DATA "/fbx"s, RETARGET_TEST_DATA "/no such file.fbx"s, ""s, "/dev/null"s})
	{
		VTestLog log;
		FBXReader reader;
		EXPECT_FALSE(reader.LoadFile(rPath));
		EXPECT_FALSE(reader.IsComplete());
		EXPECT_FALSE(reader.HasSkeleton());
		EXPECT_EQ(reader.GetSkeleton(), nullptr);
		EXPECT_EQ(log.m_Messages, (VMessages{{2, "File " + rPath + " not found"}}));
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
		    (VMessages{{2, "Call to KFbxImporter::Initialize() failed."}, {2, "Error returned: "s + text}}));
	}
}

TEST(Reader, OtherVersionsAreRefusedWithTheirNumbers)
{
	const std::pair<VTestForm, const char*> rows[]{{{"", EForm::Binary, 5800}, "5.8.0"},
	    {{"", EForm::Text, 5000}, "5.0.0"}, {{"", EForm::Binary, 8010}, "8.0.1"}, {{"", EForm::Text, 8000}, "8.0.0"}};
	for (const auto& [form, version] : rows)
	{
		const VLoaded loaded(Write(form, Bones({})));
		EXPECT_FALSE(loaded.m_bLoaded);
		EXPECT_EQ(loaded.m_Messages,
		    (VMessages{{2, "Call to KFbxImporter::Initialize() failed."},
		        {2, "Error returned: File version is not one of 6.0 to 7.9"},
		        {2, "FBX file import error: File version is old or too new.\n"},
		        {2, "FBX version number for file PATH is "s + version + "\n\n"},
		        {2, "Current FBX version is 2020.0.1\n"}}));
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
	EXPECT_EQ(loaded.m_Messages, (VMessages{{2, "FBX Importer: password Required"}}));
}

TEST_P(Reader, KeepsWhatWasReadOfADamagedFile)
{
	std::vector<VTestRecord> records = Records(GetParam(), Bones({{"hips", "LimbNode", -1, {}}}, {{"UpAxis", {0}}}));
	records.push_back({"Takes", {}, {{"Take", {1.0}, {}}}});
	std::string bytes = Write(GetParam(), records);
	const std::size_t at = bytes.rfind("Take");
	bytes[at + 4] = '?';
	const VLoaded loaded(bytes);
	EXPECT_TRUE(loaded.m_bLoaded);
	EXPECT_FALSE(loaded.m_Reader.IsComplete());
	EXPECT_EQ(loaded.m_Reader.GetUpAxis(), 0);
	ASSERT_TRUE(loaded.m_Reader.HasSkeleton());
	EXPECT_EQ(loaded.m_Reader.GetSkeleton()->front().m_Name, "hips");
	ASSERT_EQ(loaded.m_Messages.size(), 1u);
	EXPECT_EQ(loaded.m_Messages[0].first, 2);
	const bool bBinary = GetParam().m_Form == EForm::Binary;
	const std::string what = bBinary ? "the values of a record are damaged" : "the name of a record is missing";
	EXPECT_EQ(loaded.m_Messages[0].second,
	    "Error returned: File is corrupted: " + what + " (byte " + std::to_string(at) + ")");
}

TEST_P(Reader, FileWithoutBonesLoads)
{
	const VLoaded loaded(Write(GetParam(), Bones({{"a", "Null", -1, {}}, {"b", "Mesh", 0, {}}}, {{"UpAxis", {2}}})));
	EXPECT_TRUE(loaded.m_bLoaded);
	EXPECT_TRUE(loaded.m_Reader.IsComplete());
	EXPECT_FALSE(loaded.m_Reader.HasSkeleton());
	EXPECT_EQ(loaded.m_Reader.GetSkeleton(), nullptr);
	EXPECT_EQ(loaded.m_Reader.GetUpAxis(), 2);
	EXPECT_TRUE(loaded.m_Messages.empty());
}

TEST_P(Reader, UnitsAndAxes)
{
	const std::pair<VNumbers, int> axes[]{{{0}, 0}, {{1}, 1}, {{2}, 2}, {{3}, 0}, {{-1}, 0}};
	for (const auto& [file, axis] : axes)
		EXPECT_EQ(VLoaded(Write(GetParam(), Bones({}, {{"UpAxis", file}}))).m_Reader.GetUpAxis(), axis);
	EXPECT_EQ(VLoaded(Write(GetParam(), Bones({}))).m_Reader.GetUpAxis(), 1);
	const std::pair<double, float> units[]{{1.0, 10.0f}, {100.0, 1000.0f}, {2.54, 25.4f}, {0.1, 1.0f}};
	for (const auto& [factor, scale] : units)
		EXPECT_EQ(
		    VLoaded(Write(GetParam(), Bones({}, {{"UnitScaleFactor", {factor}}}))).m_Reader.GetUnitScale(), scale);
}

TEST_P(Reader, ParentsAreFoundByName)
{
	const auto skeleton = VLoaded(
	    Write({"", GetParam().m_Form, 7400},
	        Bones({{"plain", "Null", -1, {}}, {"a", "LimbNode", 0, {}}, {"x", "LimbNode", 1, {}}, {"b", "Limb", 2, {}},
	            {"x", "LimbNode", 1, {}}, {"c", "LimbNode", 2, {}}, {"d", "LimbNode", 4, {}}, {"root", "Root", 6, {}},
	            {"e", "Effector", 7, {}}, {"d", "Null", -1, {}}, {"f", "LimbNode", 9, {}}})))
	                          .m_Reader.GetSkeleton();
	// In pre-order; both bones called x stand before the children of the second; f finds the bone that is called like
	// the plain node above it.
	const std::pair<const char*, int> expected[]{
	    {"a", -1}, {"x", 0}, {"b", 1}, {"c", 1}, {"x", 0}, {"d", 4}, {"root", -1}, {"e", 6}, {"f", 5}};
	ASSERT_EQ(skeleton->size(), std::size(expected));
	for (std::size_t i = 0; i < std::size(expected); ++i)
	{
		EXPECT_EQ((*skeleton)[i].m_Name, expected[i].first) << i;
		EXPECT_EQ((*skeleton)[i].m_ParentIndex, expected[i].second) << i;
	}
}

TEST_P(Reader, ScaleIsAccumulatedAndLeftOutOfTranslations)
{
	const VTestScene scene =
	    Bones({{"top", "Null", -1, {{"Lcl Scaling", {3, 1, 1}}}},
	              {"a", "LimbNode", 0, {{"Lcl Scaling", {2, 5, 7}}, {"Lcl Translation", {1, 0, 0}}}},
	              {"b", "LimbNode", 1, {{"Lcl Translation", {0, 1, 0}}}},
	              {"c", "LimbNode", -1, {{"Lcl Translation", {0, 0, 1}}}}},
	        {{"UnitScaleFactor", {100}}});
	const VLoaded loaded(Write(GetParam(), scene));
	const VSkinSkeleton& rBones = *loaded.m_Reader.GetSkeleton();
	ASSERT_EQ(rBones.size(), 3u);
	EXPECT_EQ(rBones[0].m_AccumulatedScale, 6.0f);
	EXPECT_EQ(rBones[1].m_AccumulatedScale, 6.0f);
	EXPECT_EQ(rBones[2].m_AccumulatedScale, 1.0f);
	EXPECT_EQ(rBones[0].m_Local(0, 3), 1000.0f);
	EXPECT_EQ(rBones[1].m_Local(1, 3), 1000.0f);
	EXPECT_EQ(rBones[0].m_Global(0, 3), 3000.0f);
	EXPECT_EQ(rBones[1].m_Global(1, 3), 5000.0f);
	EXPECT_EQ(rBones[2].m_Global(2, 3), 1000.0f);
}

TEST_P(Reader, LocalMatrixHasThePreRotationTakenOutOnTheRight)
{
	const VTestScene scene = Bones({{"a", "LimbNode", -1,
	    {{"RotationActive", {1}}, {"PreRotation", {0, 0, 90}}, {"Lcl Rotation", {90, 0, 0}},
	        {"Lcl Translation", {1, 2, 3}}}}});
	const VLoaded loaded(Write(GetParam(), scene));
	const VSkinBone& rBone = loaded.m_Reader.GetSkeleton()->front();
	// A quarter turn about z, and that times a quarter turn about x times its inverse: a quarter turn about y.
	const QMatrix4x4 pre(0, -1, 0, 0, 1, 0, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1);
	const QMatrix4x4 local(0, 0, 1, 10, 0, 1, 0, 20, -1, 0, 0, 30, 0, 0, 0, 1);
	for (int i = 0; i < 16; ++i)
	{
		EXPECT_NEAR(rBone.m_PreRotation(i / 4, i % 4), pre(i / 4, i % 4), 1e-6);
		EXPECT_NEAR(rBone.m_Local(i / 4, i % 4), local(i / 4, i % 4), 1e-6);
		EXPECT_NEAR(rBone.m_Global(i / 4, i % 4), (local * pre)(i / 4, i % 4), 1e-5);
	}
}

TEST_P(Reader, TransformsThatAreNotFiniteBecomeTheIdentity)
{
	const double nan = std::nan("");
	const VTestScene scene = Bones({{"a", "LimbNode", -1, {{"Lcl Translation", {1, nan, 0}}}},
	    {"b", "LimbNode", 0, {{"Lcl Translation", {5, 0, 0}}}},
	    {"c", "LimbNode", -1, {{"RotationActive", {1}}, {"PreRotation", {INFINITY, 0, 0}}}},
	    {"d", "LimbNode", -1, {{"Lcl Translation", {1e300, 0, 0}}}}});
	const VLoaded loaded(Write(GetParam(), scene));
	const auto invalid = [](const char* i_pName) -> VMessages::value_type {
		return {2, "Invalid transform for: "s + i_pName + "; setting to identity"};
	};
	// The pre-rotation, the local and the global matrix in turn.
	EXPECT_EQ(loaded.m_Messages,
	    (VMessages{invalid("a"), invalid("a"), invalid("b"), invalid("c"), invalid("c"), invalid("c"), invalid("d"),
	        invalid("d")}));
	const VSkinSkeleton& rBones = *loaded.m_Reader.GetSkeleton();
	EXPECT_TRUE(rBones[0].m_Global.isIdentity());
	EXPECT_EQ(rBones[1].m_Local(0, 3), 50.0f);
	EXPECT_TRUE(rBones[2].m_PreRotation.isIdentity());
	EXPECT_TRUE(rBones[3].m_Global.isIdentity());
}

TEST_P(Reader, MemoryIsReadLikeAFile)
{
	const std::string bytes = Write(GetParam(), Bones({{"hips", "LimbNode", -1, {}}}, {{"UpAxis", {2}}}));
	FBXReader reader;
	ASSERT_TRUE(reader.LoadMemory(bytes, "hero.fbx"));
	EXPECT_TRUE(reader.IsComplete());
	EXPECT_EQ(reader.GetUpAxis(), 2);
	EXPECT_EQ(reader.GetSkeleton()->front().m_Name, "hips");
	VTestLog log;
	FBXReader other;
	EXPECT_FALSE(other.LoadMemory("just some text", "hero.fbx"));
	EXPECT_EQ(log.m_Messages.back().second, "Error returned: File is not an FBX file");
}

TEST_P(Reader, ProgressRisesAndCanEndTheImport)
{
	const VTestFile file(Write(GetParam(), Bones({{"hips", "LimbNode", -1, {}}})));
	std::vector<float> told;
	// The call that ends it; the last time none does.
	for (std::size_t end = 0;; ++end)
	{
		told.clear();
		VTestLog log;
		FBXReader reader;
		reader.SetProgress(
		    [&](float i_Part)
		    {
			    told.push_back(i_Part);
			    return told.size() != end + 1;
		    });
		EXPECT_TRUE(reader.LoadFile(file.Path()));
		const bool bEnded = told.size() == end + 1;
		EXPECT_EQ(reader.IsComplete(), !bEnded);
		EXPECT_EQ(reader.HasSkeleton(), !bEnded);
		EXPECT_EQ(log.m_Messages.back().second == "Error returned: Import was cancelled", bEnded);
		if (!bEnded)
			break;
	}
	EXPECT_GE(told.size(), 3u);
	EXPECT_TRUE(std::is_sorted(told.begin(), told.end()));
	EXPECT_EQ(told.back(), 1.0f);
}

TEST(Reader, NamesAreUtf8)
{
	const std::pair<std::string, std::string> names[]{{"Character1:Hips", "Character1:Hips"},
	    {"H\xFC"
	     "fte",
	        "H\xC3\xBC"
	        "fte"},
	    {"\xE8\x85\xB0", "\xE8\x85\xB0"}};
	for (const VTestForm& rForm : c_Forms)
		for (const auto& [bytes, name] : names)
		{
			const VLoaded loaded(Write(rForm, Bones({{bytes, "LimbNode", -1, {}}})));
			EXPECT_EQ(loaded.m_Reader.GetSkeleton()->front().m_Name, name) << rForm.m_pName;
		}
	const VLoaded escaped(Write(c_Forms[4], Bones({{"a&quot;b", "LimbNode", -1, {}}})));
	EXPECT_EQ(escaped.m_Reader.GetSkeleton()->front().m_Name, "a\"b");
}

} // namespace
