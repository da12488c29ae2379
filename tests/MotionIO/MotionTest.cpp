#include "../FBXIO/MeshFile.h"
#include "../UtilsFileSystem/Folder.h"
#include "../UtilsFileSystem/Log.h"
#include "AssimpReader.h"
#include "GltfRules.h"

#include "FBXIO/FBXReader.h"
#include "MotionIO/PrintMotion.h"
#include "RetargetSetupCore/FilePose.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "TakeIO/ReadTake.h"
#include "UtilsFileSystem/Files.h"
#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/container/FileKind.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <numbers>

using namespace MotionIO;
using Rotation::VMatrix3;
using Rotation::VVector3;
using TakeIO::VJointPose;
using TakeIO::VTake;

namespace
{

constexpr std::size_t c_Frames = 12;

/// What can be done with a character.
enum class EFile
{
	Text,
	Binary,
	/// The other program leaves parts of the chain out: pivots of what moves, how scales are inherited, that rotations
	/// are inactive.
	OnlyOurs
};

struct VCharacterRow
{
	const char* m_pName;
	EFile m_File;
};

void PrintTo(const VCharacterRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

VCharacterFile Character(const std::string& i_rPath)
{
	VCharacterFile file{i_rPath, {}};
	std::string error;
	EXPECT_EQ(UtilsFileSystem::ReadWholeFile(file.m_Path, 1 << 30, file.m_Bytes, error), 0u) << error;
	return file;
}

/// From the axes of the file to Z up.
VMatrix3 Axes(int i_UpAxis)
{
	return i_UpAxis == 2 ? Rotation::c_Identity3 : VMatrix3{1, 0, 0, 0, 0, -1, 0, 1, 0};
}

double AngleBetween(const VMatrix3& i_rA, const VMatrix3& i_rB)
{
	const auto [x, y, z] = Rotation::AngleAxisFromRotationMatrix(Rotation::Product(Rotation::Transposed(i_rA), i_rB));
	return std::hypot(x, y, z) * 180.0 / std::numbers::pi;
}

/// A character that moves: the poses of its segments in the world, made of the file's pose by another way than the
/// writers'.
struct VMoving
{
	explicit VMoving(const VCharacterFile& i_rFile)
	{
		FBXIO::FBXReader reader;
		EXPECT_TRUE(reader.LoadFile(i_rFile.m_Path));
		const FBXIO::VSkinSkeleton bones = RetargetSetup::ExtractSubtree(*reader.GetSkeleton(), 0);
		m_Axes = Axes(reader.GetUpAxis());
		m_Unit = reader.GetUnitScale();
		Rotation::VMatrix4 axes;
		for (int i = 0; i < 9; ++i)
			axes(i / 3, i % 3) = float(m_Axes[std::size_t(i)]);
		m_Rest = RetargetSetup::PosesInFile(bones, axes, 1.0);
		m_Take.m_Rate = 24.0;
		m_Take.m_FileUp = TakeIO::EUp::Z;
		for (const FBXIO::VSkinBone& rBone : bones)
		{
			TakeIO::VJoint& rJoint = m_Take.m_Joints.emplace_back();
			rJoint.m_Name = RetargetSetup::StripNamespace(rBone.m_Name);
			rJoint.m_Parent = std::int32_t(rBone.m_ParentIndex);
			AddChannels(m_Take, m_Take.m_Joints.size() - 1, true);
			m_Names.push_back(rBone.m_Name);
			m_Parents.push_back(rBone.m_ParentIndex);
		}
		SetWorldRest(m_Take, m_Rest);
		for (std::size_t frame = 0; frame < c_Frames; ++frame)
			AddFrame(m_Take, m_Frames.emplace_back(Pose(double(frame))));
	}

	/// Turns of up to half a turn and more about all axes; a root that walks, one joint that is pulled out.
	std::vector<VJointPose> Pose(double i_Frame) const
	{
		std::vector<VJointPose> poses;
		for (std::size_t i = 0; i < m_Rest.size(); ++i)
		{
			VJointPose local = m_Parents[i] < 0 ? m_Rest[i] : Relative(m_Rest[std::size_t(m_Parents[i])], m_Rest[i]);
			const double phase = 0.7 * double(i) + 0.45 * i_Frame;
			const VVector3 turn{std::sin(phase), 0.8 * std::cos(1.3 * phase), (i == 0 ? 0.9 : 0.1) * i_Frame};
			local.R = Rotation::Product(local.R, Rotation::RotationMatrixFromAngleAxis(turn));
			local.t[0] += i == 0 ? 40.0 * i_Frame : i == 2 ? i_Frame : 0.0;
			poses.push_back(m_Parents[i] < 0 ? local : Compose(poses[std::size_t(m_Parents[i])], local));
		}
		return poses;
	}

	std::vector<std::string> m_Names;
	std::vector<std::int64_t> m_Parents;
	VMatrix3 m_Axes;
	double m_Unit = 0.0;
	std::vector<VJointPose> m_Rest;
	std::vector<std::vector<VJointPose>> m_Frames;
	VTake m_Take;
};

/// @param i_rAxes from those of the file that was read, of which a unit has so many millimetres
/// @param i_bSinceRest rotations are those since rest, in the file's axes
void ExpectSame(const VNodePoses& i_rRead, const VMoving& i_rMoving, const VMatrix3& i_rAxes, double i_Unit,
    double i_Scale = 1.0, bool i_bSinceRest = false)
{
	double distance = 0.0, angle = 0.0;
	for (std::size_t i = 0; i < i_rMoving.m_Names.size(); ++i)
	{
		// A program may take a namespace off, and BVH has no blanks.
		auto found = i_rRead.find(i_rMoving.m_Names[i]);
		if (found == i_rRead.end())
			found = i_rRead.find(std::string(RetargetSetup::StripNamespace(i_rMoving.m_Names[i])));
		std::string word = i_rMoving.m_Names[i];
		std::ranges::replace(word, ' ', '_');
		if (found == i_rRead.end())
			found = i_rRead.find(word);
		ASSERT_NE(found, i_rRead.end()) << word;
		ASSERT_EQ(found->second.size(), c_Frames);
		for (std::size_t frame = 0; frame < c_Frames; ++frame)
		{
			const VJointPose& rExpected = i_rMoving.m_Frames[frame][i];
			const VVector3 place = Rotation::Product(i_rAxes, found->second[frame].t);
			for (std::size_t axis = 0; axis < 3; ++axis)
				distance = std::max(distance, std::abs(i_Unit * i_Scale * place[axis] - rExpected.t[axis]));
			VMatrix3 turned = Rotation::Product(i_rAxes, found->second[frame].R);
			if (i_bSinceRest)
				turned =
				    Rotation::Product(turned, Rotation::Product(Rotation::Transposed(i_rAxes), i_rMoving.m_Rest[i].R));
			angle = std::max(angle, AngleBetween(turned, rExpected.R));
		}
	}
	EXPECT_LT(distance, 0.01) << "mm";
	EXPECT_LT(angle, 0.001) << "degrees";
}

/// As the other program reads it.
VNodePoses InFile(const VTake& i_rTake, const VMoving& i_rMoving)
{
	VNodePoses read;
	std::vector<VJointPose> poses;
	const VMatrix3 back = Rotation::Transposed(i_rMoving.m_Axes);
	for (std::size_t frame = 0; frame < i_rTake.m_Frames; ++frame)
	{
		WorldPoses(i_rTake, frame, poses);
		for (std::size_t i = 0; i < poses.size(); ++i)
		{
			VJointPose& rPose = read[i_rTake.m_Joints[i].m_Name].emplace_back();
			rPose.R = Rotation::Product(back, Rotation::Product(poses[i].R, i_rMoving.m_Axes));
			rPose.t = Rotation::Product(back, poses[i].t);
			for (double& rCoordinate : rPose.t)
				rCoordinate /= i_rMoving.m_Unit;
		}
	}
	return read;
}

/// Bones with all that may stand between a bone's own numbers and its place.
std::string Chain(bool i_bInherited)
{
	FbxTest::VTestScene scene;
	for (int i = 0; i < 6; ++i)
	{
		const double order = i, inherited = i_bInherited ? i % 3 : 1;
		scene.m_Nodes.push_back({"bone" + std::to_string(i), "LimbNode", i - 1,
		    {{"Lcl Translation", {10.5, 0.25, 3}}, {"Lcl Rotation", {10, 20, 30}}, {"PreRotation", {50, 6, 7}},
		        {"PostRotation", {5, -60, 17}}, {"RotationOffset", {1, 2, 3}}, {"RotationPivot", {-3, 2, 1}},
		        {"ScalingOffset", {2, 0, 1}}, {"ScalingPivot", {0, 1, 4}}, {"Lcl Scaling", {1.5, 1.5, 1.5}},
		        {"RotationOrder", {order}}, {"RotationActive", {1}}, {"InheritType", {inherited}}}});
	}
	scene.m_Template = {{"Lcl Scaling", {1, 1, 1}}};
	scene.m_Settings = {{"UpAxis", {1}}, {"UnitScaleFactor", {2.54}}};
	return FbxTest::Write(FbxTest::c_Forms[i_bInherited ? 2 : 1], scene);
}

class MotionFile : public testing::TestWithParam<VCharacterRow>
{
};

/// Records of the one that are in the other, in their order; the others are added ones.
void ExpectRecordsStay(const std::string& i_rBefore, const std::string& i_rAfter)
{
	using namespace FbxFormat;
	VElementTree before, after;
	ASSERT_TRUE(before.Read(i_rBefore, DetectFileKind(i_rBefore)));
	ASSERT_TRUE(after.Read(i_rAfter, DetectFileKind(i_rAfter))) << after.Error();
	std::vector<std::pair<VElementIndex, VElementIndex>> open{{VElementTree::c_Root, VElementTree::c_Root}};
	std::size_t added = 0;
	while (!open.empty())
	{
		const auto [old, now] = open.back();
		open.pop_back();
		ASSERT_EQ(before.Name(old), after.Name(now));
		ASSERT_EQ(before.Values(old), after.Values(now)) << before.Name(old);
		std::vector<VElementIndex> children;
		for (const VElementIndex child : after.Children(now))
			children.push_back(child);
		std::size_t at = 0;
		for (const VElementIndex child : before.Children(old))
		{
			ASSERT_LT(at, children.size());
			open.emplace_back(child, children[at++]);
		}
		added += children.size() - at;
		const std::string_view name = before.Name(old);
		EXPECT_TRUE(at == children.size() || name == "Objects" || name == "Connections" || name == "Takes") << name;
	}
	EXPECT_GT(added, 0u);
	// Files that tests write have nothing behind their records.
	if (i_rBefore.back() == 'Z')
		return;
	EXPECT_EQ(i_rAfter.size() % 16, i_rBefore.size() % 16) << "the end of the file lies elsewhere";
	EXPECT_EQ(i_rAfter.substr(i_rAfter.size() - 144), i_rBefore.substr(i_rBefore.size() - 144));
}

TEST_P(MotionFile, IsReadByAnotherProgramAsItWasMade)
{
	VTestLog log("MotionIO");
	const std::string name = GetParam().m_pName;
	const VTestFolder folder;
	for (const char* pBuilt : {"pivots", "inherited"})
		Put(folder / (std::string(pBuilt) + ".fbx"), Chain(pBuilt == std::string("inherited")));
	const VCharacterFile character = Character(name == "demo" ? RETARGET_SOURCE "/demo/character.fbx"
	        : exists(folder / (name + ".fbx"))                ? (folder / (name + ".fbx")).string()
	                                                          : RETARGET_TEST_DATA "/fbx/" + name + ".fbx");
	const VMoving moving(character);
	const VMotionSettings settings{"walk of a test", 1.0, {}};
	std::string bytes, error, again;
	{
		SCOPED_TRACE("glb");
		ASSERT_EQ(PrintMotion(moving.m_Take, EMotionForm::Gltf, &character, settings, bytes, error), EPrinted::Done)
		    << error;
		ExpectSame(ReadByAssimp(bytes, "glb", settings.m_Name, c_Frames), moving, Axes(1), 1000.0);
		EXPECT_EQ(BrokenGltfRule(bytes), "");
		EXPECT_EQ(BrokenGltfRule(bytes.substr(0, bytes.size() - 4)), "length of the file");
	}
	{
		SCOPED_TRACE("bvh");
		// At half the size.
		ASSERT_EQ(PrintMotion(moving.m_Take, EMotionForm::Bvh, &character, {"", 2.0, {}}, bytes, error), EPrinted::Done)
		    << error;
		ExpectSame(ReadByAssimp(bytes, "bvh", "Motion", c_Frames), moving, moving.m_Axes, moving.m_Unit, 2.0, true);
	}
	const EPrinted printed = PrintMotion(moving.m_Take, EMotionForm::Fbx, &character, settings, bytes, error);
	EXPECT_EQ(log.Take(), std::vector<std::string>());
	if (GetParam().m_File == EFile::Text)
	{
		EXPECT_EQ(printed, EPrinted::Refused);
		EXPECT_NE(error.find("only binary files of version 7"), std::string::npos) << error;
		return;
	}
	ASSERT_EQ(printed, EPrinted::Done) << error;
	ExpectRecordsStay(character.m_Bytes, bytes);
	VTake take;
	ASSERT_TRUE(TakeIO::ReadTakeFrom(bytes, {{}, {}, 24.0, settings.m_Name}, take, error)) << error;
	ASSERT_EQ(take.m_Frames, c_Frames);
	ExpectSame(InFile(take, moving), moving, moving.m_Axes, moving.m_Unit);
	SCOPED_TRACE("fbx");
	if (GetParam().m_File == EFile::Binary)
		ExpectSame(ReadByAssimp(bytes, "fbx", settings.m_Name, c_Frames), moving, moving.m_Axes, moving.m_Unit);
	// What was read is written again, beside the first.
	const VCharacterFile twice{character.m_Path, bytes};
	ASSERT_EQ(PrintMotion(take, EMotionForm::Fbx, &twice, settings, again, error), EPrinted::Done) << error;
	ASSERT_TRUE(TakeIO::ReadTakeFrom(again, {{}, {}, 24.0, settings.m_Name + " 2"}, take, error)) << error;
	ExpectSame(InFile(take, moving), moving, moving.m_Axes, moving.m_Unit);
	ASSERT_EQ(PrintMotion(moving.m_Take, EMotionForm::Fbx, &character, settings, again, error), EPrinted::Done);
	EXPECT_EQ(bytes, again) << "the same input gives other bytes";
}

INSTANTIATE_TEST_SUITE_P(Rows, MotionFile,
    testing::Values(VCharacterRow{"demo", EFile::Binary}, VCharacterRow{"heaps_biped_zup_a7100", EFile::Text},
        VCharacterRow{"kenney_medium_b7400", EFile::Binary}, VCharacterRow{"own_game_zup_m_b7400", EFile::Binary},
        VCharacterRow{"own_ns_yup_cm_a7400", EFile::Text}, VCharacterRow{"own_ns_yup_cm_b7400", EFile::Binary},
        VCharacterRow{"pab_arnaud_b7500", EFile::Binary},
        VCharacterRow{"ufbx_maya_human_ik_7400_binary", EFile::OnlyOurs},
        VCharacterRow{"ufbx_max_transformed_skin_zup_b6100", EFile::Text}, VCharacterRow{"pivots", EFile::OnlyOurs},
        VCharacterRow{"inherited", EFile::OnlyOurs}, VCharacterRow{"cases/rotation_orders", EFile::OnlyOurs},
        VCharacterRow{"cases/rotation_inactive", EFile::OnlyOurs}, VCharacterRow{"cases/metre_z_up", EFile::Binary}),
    [](const auto& i_rInfo)
    {
	    std::string name = i_rInfo.param.m_pName;
	    std::ranges::replace(name, '/', '_');
	    return name;
    });

/// In the pose of the file the skin lies where its mesh does.
TEST(MotionFiles, HoldTheSkin)
{
	for (const char* pPath :
	    {RETARGET_SOURCE "/demo/character.fbx", RETARGET_TEST_DATA "/fbx/own_game_zup_m_b7400.fbx"})
	{
		SCOPED_TRACE(pPath);
		const VCharacterFile character = Character(pPath);
		VMoving moving(character);
		moving.m_Take.m_Frames = 0;
		moving.m_Take.m_Values.clear();
		AddFrame(moving.m_Take, moving.m_Rest);
		std::string bytes, error;
		ASSERT_EQ(PrintMotion(moving.m_Take, EMotionForm::Gltf, &character, {}, bytes, error), EPrinted::Done);
		EXPECT_EQ(BrokenGltfRule(bytes), "");
		// Each is found once it is broken.
		for (const auto& [from, to] : {std::pair("\"JOINTS_0\":", "\"JOINTS_1\":"), {"\"VEC4\"", "\"VEC3\""},
		         {"\"children\":[1", "\"children\":[0"}, {"\"count\":", "\"count\":9"}, {"\"min\":[", "\"min\":[7"}})
		{
			std::string broken = bytes;
			const std::size_t at = broken.find(from);
			ASSERT_NE(at, std::string::npos) << from;
			broken.replace(at, std::strlen(to), to);
			EXPECT_NE(BrokenGltfRule(broken), "") << to;
		}
		FBXIO::FBXReader reader;
		reader.SetMeshRules(FBXIO::c_FaithfulMeshes);
		ASSERT_TRUE(reader.LoadFile(pPath));
		std::vector<FBXIO::VPlacedMesh> meshes;
		reader.ReadPlacedMeshes(meshes);
		// Least and greatest of each coordinate.
		VVector3 expected[]{{1e9, 1e9, 1e9}, {-1e9, -1e9, -1e9}}, actual[]{expected[0], expected[1]};
		const auto extend = [](VVector3(&io_rBounds)[2], const VVector3& i_rPoint)
		{
			for (std::size_t axis = 0; axis < 3; ++axis)
			{
				io_rBounds[0][axis] = std::min(io_rBounds[0][axis], i_rPoint[axis]);
				io_rBounds[1][axis] = std::max(io_rBounds[1][axis], i_rPoint[axis]);
			}
		};
		for (const FBXIO::VPlacedMesh& rMesh : meshes)
			for (const FBXIO::VBasicVertex& rVertex : rMesh.m_Mesh.m_Vertices)
			{
				const std::array<float, 3> point = rMesh.m_Transform.Map(rVertex.m_Position);
				extend(expected, Rotation::Product(moving.m_Axes, VVector3{point[0], point[1], point[2]}));
			}
		for (const VVector3& rPoint : SkinnedPoints(bytes, "glb"))
			extend(actual, Rotation::Product(Axes(1), rPoint));
		for (std::size_t axis = 0; axis < 6; ++axis)
			EXPECT_NEAR(1000.0 * actual[axis / 3][axis % 3], expected[axis / 3][axis % 3], 0.1) << "mm, axis " << axis;
	}
}

/// Pictures as they are, each once; a material for each look.
TEST(MotionFiles, HoldPicturesAndMaterials)
{
	using namespace FbxTest;
	VTestLog log("MotionIO");
	const VTestFolder folder;
	const auto path = [&](const char* i_pName) { return (folder / i_pName).string(); };
	Put(path("skin.png"), "\x89PNG\r\n\x1a\n" + std::string("\0\0\0\rIHDR\0\0\0\1\0\0\0\1\x08\2\0\0\0\0\0\0\0", 25));
	Put(path("coat.jpg"), std::string("\xff\xd8\xff\xc0\0\x11\x08\0\1\0\1", 11));
	Put(path("hat.ppm"), "P6 1 1 255\nabc");
	const VTestScene scene{
	    {{"hips", "LimbNode", -1, {}}, {"body", "Mesh", 0, {}}, {"suit", "Mesh", 0, {}}, {"prop", "Null", -1, {}}},
	    {{"UpAxis", {1}}, {"UnitScaleFactor", {1}}}, {}, {}};
	const VNumbers points{0, 0, 0, 1, 0, 0, 0, 1, 0}, polygons{0, 1, -3, 0, 1, -3, 0, 1, -3, 0, 1, -3};
	Put(path("hero.fbx"),
	    Write(c_Forms[1], scene,
	        {{1, points, polygons, {}, {}, {"ByPolygon", "IndexToDirect", {}, {0, 1, 2, 3}},
	             {{"lambert", {{"TransparentColor", {1, 1, 1}}, {"TransparencyFactor", {0.25}}}, "", "skin.png"},
	                 {"lambert", {{"EmissiveColor", {1, 1, 1}}}, "", "skin.png"}, {"lambert", {}, "", "coat.jpg"},
	                 {"lambert", {}, "", "hat.ppm"}},
	             {}},
	            {2, points, {0, 1, -3}, {}, {}, {}, {}, {{3, {0, 1, 2}, {1, 1, 1}, {}, {}}}}}));
	const VCharacterFile character = Character(path("hero.fbx"));
	const VMoving moving(character);
	std::string bytes, error;
	ASSERT_EQ(PrintMotion(moving.m_Take, EMotionForm::Gltf, &character, {}, bytes, error), EPrinted::Done) << error;
	EXPECT_EQ(BrokenGltfRule(bytes), "");
	EXPECT_EQ(log.Take(),
	    (std::vector<std::string>{"3 The character's skin is left out: no bone moves it",
	        "3 The picture " + path("hat.ppm") + " is left out: it is neither PNG nor JPEG"}));
	for (const auto& [text, count] : {std::pair("\"image/png\"", 1), {"\"image/jpeg\"", 1}, {"\"baseColorTexture\"", 3},
	         {"\"source\"", 2}, {"\"alphaMode\":\"BLEND\"", 1}, {"0.75]", 1}, {"\"emissiveFactor\":[1.0,1.0,1.0]", 1},
	         {"\"name\":\"body\"", 1}})
	{
		int found = 0;
		for (std::size_t at = bytes.find(text); at != std::string::npos; at = bytes.find(text, at + 1))
			++found;
		EXPECT_EQ(found, count) << text;
	}
}

TEST(MotionFiles, ThatCannotBeMadeAreRefused)
{
	const auto file = [](const std::vector<std::pair<std::string, FbxTest::VNumbers>>& i_rSettings)
	{
		return FbxTest::Write(
		    FbxTest::c_Forms[1], FbxTest::VTestScene{{{"bone", "LimbNode", -1, {}}}, i_rSettings, {}, {}});
	};
	const VCharacterFile sound{"hero.fbx", file({})}, none{"hero.fbx", "none"},
	    upX{"hero.fbx", file({{"UpAxis", {0}}})}, noUnit{"hero.fbx", file({{"UnitScaleFactor", {0}}})};
	constexpr EMotionForm c_Bvh = EMotionForm::Bvh, c_Gltf = EMotionForm::Gltf, c_Fbx = EMotionForm::Fbx;
	constexpr EPrinted c_Refused = EPrinted::Refused, c_Unreadable = EPrinted::CharacterUnreadable;
	const auto stop = [](double) { return false; };
	const struct
	{
		EMotionForm m_Form;
		const VCharacterFile* m_pCharacter;
		const char* m_pJoint;
		VMotionSettings m_Settings;
		EPrinted m_Printed;
		std::string m_Why;
	} rows[]{{c_Bvh, nullptr, nullptr, {}, c_Refused, "The motion has no frames"},
	    {c_Bvh, nullptr, "bone", {"", 0.0, {}}, c_Refused, "A scale must be above 0"},
	    {c_Gltf, nullptr, "bone", {}, c_Refused, "This form holds the character, too, whose FBX file is not given"},
	    {c_Bvh, &none, "bone", {}, c_Unreadable, "It is no FBX file of version 6 or 7"},
	    {c_Bvh, &upX, "bone", {}, c_Unreadable, "Its X axis points up, which is not read"},
	    {c_Fbx, &noUnit, "bone", {}, c_Unreadable, "Its unit is none"},
	    {c_Gltf, &sound, "other", {}, c_Refused, "No bone has the name of a joint of the motion"},
	    {c_Fbx, &sound, "other", {}, c_Refused, "No bone has the name of a joint of the motion"},
	    {c_Bvh, &sound, "bone", {"", 1.0, stop}, EPrinted::Cancelled, ""},
	    {c_Gltf, &sound, "bone", {"", 1.0, stop}, EPrinted::Cancelled, ""},
	    {c_Fbx, &sound, "bone", {"", 1.0, stop}, EPrinted::Cancelled, ""}};
	for (const auto& rRow : rows)
	{
		VTake take;
		if (rRow.m_pJoint)
		{
			take.m_Joints.emplace_back().m_Name = rRow.m_pJoint;
			AddChannels(take, 0, true);
			AddFrame(take, std::vector<VJointPose>(1));
		}
		std::string bytes = "as it was", why;
		EXPECT_EQ(PrintMotion(take, rRow.m_Form, rRow.m_pCharacter, rRow.m_Settings, bytes, why), rRow.m_Printed)
		    << rRow.m_Why;
		EXPECT_EQ(why, rRow.m_Why);
		EXPECT_EQ(bytes, "as it was");
	}
	EXPECT_EQ(MotionFormOf(".bvh"), c_Bvh);
	EXPECT_EQ(MotionFormOf(".glb"), c_Gltf);
	EXPECT_EQ(MotionFormOf(".fbx"), c_Fbx);
	EXPECT_EQ(MotionFormOf(".qrr"), std::nullopt);
}

/// Of a motion at twice the size, with a joint that the character has not.
TEST(MotionFiles, LeaveOutWhatHasNoBoneAndKeepEnds)
{
	VTestLog log("MotionIO");
	const VCharacterFile character{"hero.fbx",
	    FbxTest::Write(FbxTest::c_Forms[1],
	        FbxTest::VTestScene{
	            {{"bone", "LimbNode", -1, {}}}, {{"UpAxis", {2}}, {"UnitScaleFactor", {0.1}}}, {}, {}})};
	VTake take, read;
	take.m_Rate = 30.0;
	take.m_FileUp = TakeIO::EUp::Z;
	for (const char* pName : {"bone", "tail"})
		take.m_Joints.emplace_back().m_Name = pName;
	take.m_Joints[1].m_Parent = 0;
	take.m_Joints[1].m_Ends = {{0, 0, 30}};
	for (const std::size_t joint : {0, 1})
		AddChannels(take, joint, joint == 0);
	AddFrame(take, std::vector<VJointPose>(2));
	std::string bytes, error;
	ASSERT_EQ(PrintMotion(take, EMotionForm::Gltf, &character, {}, bytes, error), EPrinted::Done) << error;
	EXPECT_EQ(log.Take(),
	    std::vector<std::string>{"3 Joints of the motion that are left out, as the character has no bone of that name: "
	                             "1, such as \"tail\""});
	ASSERT_EQ(PrintMotion(take, EMotionForm::Bvh, &character, {"", 2.0, {}}, bytes, error), EPrinted::Done) << error;
	ASSERT_TRUE(TakeIO::ReadTakeFrom(bytes, {TakeIO::EUp::Z, 1.0, {}}, read, error)) << error;
	ASSERT_EQ(read.m_Joints[1].m_Ends.size(), 1u);
	EXPECT_NEAR(read.m_Joints[1].m_Ends[0][2], 15.0, 1e-9);
}

TEST(MotionFiles, DriveTheBoneOfTheWholeName)
{
	const VCharacterFile character{"hero.fbx",
	    FbxTest::Write(FbxTest::c_Forms[1],
	        FbxTest::VTestScene{{{"x:bone", "LimbNode", -1, {}}, {"bone", "LimbNode", -1, {}}},
	            {{"UpAxis", {2}}, {"UnitScaleFactor", {0.1}}}, {}, {}})};
	VTake take;
	take.m_Rate = 30.0;
	take.m_FileUp = TakeIO::EUp::Z;
	take.m_Joints.emplace_back().m_Name = "bone";
	AddChannels(take, 0, true);
	AddFrame(take, std::vector<VJointPose>(1));
	std::string bytes, error;
	ASSERT_EQ(PrintMotion(take, EMotionForm::Gltf, &character, {}, bytes, error), EPrinted::Done) << error;
	EXPECT_EQ(AnimatedNodes(bytes), std::set<std::string>{"bone"});
}

} // namespace
