#include "../UtilsFileSystem/Log.h"
#include "../fbxsdk/FbxFileBuilder.h"

#include "TakeIO/FbxCurve.h"
#include "TakeIO/FbxJoints.h"
#include "TakeIO/ReadTake.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/document/Document.h"

#include <gtest/gtest.h>

#include <bit>

using namespace FbxTest;
using namespace TakeIO;

namespace
{

constexpr double c_Second = 46186158000.0;

struct VCurveRow
{
	const char* m_pName;
	VIntegers m_Flags;
	/// Four for each key.
	VNumbers m_Data;
	/// Second and value.
	std::vector<std::pair<double, double>> m_Values;
};

void PrintTo(const VCurveRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

/// Keys of 0, 6, 8 and 8 at 0, 1, 3 and 4 seconds: the secants are 6, 1 and 0.
VTestRecord CurveRecord(std::int64_t i_Id, const VIntegers& i_rFlags, const VNumbers& i_rData)
{
	return Record("AnimationCurve", {i_Id, std::string("AnimCurve::"), std::string()},
	    {Record("KeyTime", {VNumbers{0, c_Second, 3 * c_Second, 4 * c_Second}}),
	        Record("KeyValueFloat", {VNumbers{0, 6, 8, 8}}), Record("KeyAttrFlags", {i_rFlags}),
	        Record("KeyAttrDataFloat", {i_rData}),
	        Record("KeyAttrRefCount", {VIntegers(i_rFlags.size(), std::int32_t(4 / i_rFlags.size()))})});
}

class FbxCurve : public testing::TestWithParam<VCurveRow>
{
};

TEST_P(FbxCurve, HasTheValuesComputedByHand)
{
	for (const VTestForm& rForm : {c_Forms[1], c_Forms[4]})
	{
		const std::string bytes = Write(rForm, {CurveRecord(1, GetParam().m_Flags, GetParam().m_Data)});
		FbxFormat::VElementTree tree;
		ASSERT_TRUE(tree.Read(bytes, FbxFormat::DetectFileKind(bytes)));
		FbxFormat::VDecodeBudget budget;
		VFbxCurve curve;
		ASSERT_TRUE(curve.Read(tree, tree.Find(0, "AnimationCurve"), budget));
		// From each time to each other one.
		for (const auto& [before, valueBefore] : GetParam().m_Values)
			for (const auto& [second, value] : GetParam().m_Values)
			{
				std::size_t next = 0;
				EXPECT_NEAR(curve.At(before * c_Second, next), valueBefore, 1e-6) << rForm.m_pName << " at " << before;
				EXPECT_NEAR(curve.At(second * c_Second, next), value, 1e-6)
				    << rForm.m_pName << " at " << second << " after " << before;
			}
	}
}

// A cubic way in its middle is (a + b) / 2 + (m - n) w / 8, with m and n the slopes at its ends and w the seconds.
INSTANTIATE_TEST_SUITE_P(Rows, FbxCurve,
    testing::Values(VCurveRow{"Constant", {0x2}, VNumbers(4), {{-1, 0}, {0, 0}, {0.9, 0}, {1, 6}, {2.9, 6}, {9, 8}}},
        VCurveRow{"ConstantNext", {0x102}, VNumbers(4), {{0.1, 6}, {1, 8}, {2, 8}}},
        VCurveRow{"Linear", {0x4}, VNumbers(4), {{-5, 0}, {0.5, 3}, {1, 6}, {2, 7}, {3.5, 8}, {5, 8}}},
        // Slopes 3 and 1: 3 + 2 / 8.
        VCurveRow{"User", {0x408, 0x408, 0x408, 0x408}, {3, 1, 0, 0, 2, -1, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0},
            {{0.5, 3.25}, {1, 6}, {2, 7.75}, {3.5, 8}}},
        // 8 / 3 and 2 / 3 at the keys within: 3 + (6 - 8/3) / 8, 7 + (8/3 - 2/3) 2 / 8.
        VCurveRow{"Auto", {0x108}, VNumbers(4), {{0.5, 3.4166666667}, {2, 7.5}}},
        // Of the parabola: (6 * 2 + 1 * 1) / 3 = 13/3, and (1 * 1 + 0 * 2) / 3 = 1/3.
        VCurveRow{"TimeIndependent", {0x2108}, VNumbers(4), {{0.5, 3.2083333333}, {2, 8}}},
        // 0 at both ends; 13/3 becomes 3 times the lesser secant, 1/3 becomes 0 beside a way that stands still.
        VCurveRow{"Progressive", {0x6108}, VNumbers(4), {{0.5, 2.625}, {2, 7.75}, {3.5, 8}}},
        VCurveRow{"Clamp", {0x1108}, VNumbers(4), {{2, 7.6666666667}, {3.5, 8}}},
        // Without tension, continuity and bias half the sum of the secants: 3.5 and 0.5; with tension 1 all are 0.
        VCurveRow{"Tcb", {0x208}, VNumbers(4), {{0.5, 3.3125}, {2, 7.75}}},
        VCurveRow{"TcbTense", {0x208}, {1, 0, 0, 0}, {{0.5, 3}, {2, 7}}},
        // Continuity 0.5: out of the second key 0.75 * 6 + 0.25 * 1 = 4.75, into the third 0.25 * 1 + 0.75 * 0.
        VCurveRow{"TcbBroken", {0x208}, {0, 0.5, 0, 0}, {{2, 8.125}}}),
    [](const auto& i_rInfo) { return std::string(i_rInfo.param.m_pName); });

/// Before version 7 letters tell what lies between the keys.
TEST(FbxCurve, OfOldFilesHasTheValuesComputedByHand)
{
	const std::tuple<std::string, std::string, std::string, std::vector<std::pair<double, double>>> rows[]{
	    {"L", "L", "L", {{0.5, 3}, {2, 7}, {5, 8}}}, {"C,s", "C,n", "C,s", {{0.9, 0}, {2, 8}}},
	    {"U,s,3,1,n", "U,b,2,-1,n", "L", {{0.5, 3.25}, {2, 7.75}}},
	    // The secants 6 and 1 by their times: 8 / 3 at the key within; straight at both ends.
	    {"U,a,n", "U,a,n", "U,a,n", {{0.5, 3.4166666667}, {2, 7.4166666667}}},
	    {"U,s,2,2,a,1,1", "L", "L", {{0.4375, 1.5}}},
	    // As in the later form, but that the last of three keys has one secant, 1: 7 + (3.5 - 1) 2 / 8.
	    {"U,t,0,0,0,n", "U,t,0,0,0,n", "U,t,0,0,0,n", {{0.5, 3.3125}, {2, 7.625}}},
	    // One side at a weight of 1/2, the other at 1/3: at s = 1/2 time is (1.5 + 1 + 1) / 8 or (1 + 1.5 + 2) / 8.
	    {"U,s,3,1,l,0.5", "L", "L", {{0.4375, 3.1875}}}, {"U,s,3,1,r,0.5", "L", "L", {{0.5625, 3.4375}}}};
	for (const auto& [first, second, third, values] : rows)
	{
		SCOPED_TRACE(first + ' ' + second);
		const std::string bytes = "; FBX 6.1.0 project file\nKey: 0,0," + first + ",46186158000,6," + second
		    + ",138558474000,8," + third + "\n";
		FbxFormat::VElementTree tree;
		ASSERT_TRUE(tree.Read(bytes, FbxFormat::DetectFileKind(bytes)));
		FbxFormat::VDecodeBudget budget;
		VFbxCurve curve;
		ASSERT_TRUE(curve.ReadKeys(tree, tree.Find(0, "Key"), budget));
		std::size_t next = 0;
		for (const auto& [time, value] : values)
			EXPECT_NEAR(curve.At(time * c_Second, next), value, 1e-6) << time;
	}
	for (const char* pKeys :
	    {"", "0", "0,0", "0,0,X", "0,0,U,z,n", "0,0,U,s,1,1", "0,0,U,s,1,1,z", "5,0,L,5,1,L", "0,nan,L", "0,1e10,L"})
	{
		const std::string bytes = std::string("; FBX 6.1.0 project file\nKey: ") + pKeys + "\n";
		FbxFormat::VElementTree tree;
		tree.Read(bytes, FbxFormat::DetectFileKind(bytes));
		FbxFormat::VDecodeBudget budget;
		EXPECT_FALSE(VFbxCurve().ReadKeys(tree, tree.Find(0, "Key"), budget)) << pKeys;
	}
}

/// Two keys at 0 and 0.8 seconds, which automatic slopes join by a straight line: 16.40997 and -37.80411 degrees about
/// z.
TEST(FbxTake, OfAnOldFileIsRead)
{
	VTake take;
	std::string error;
	ASSERT_TRUE(ReadTake(
	    RETARGET_TEST_DATA "/fbx/ufbx_max_transformed_skin_zup_b6100.fbx", {{}, {}, 30.0, "Take 001"}, take, error))
	    << error;
	ASSERT_EQ(take.m_Frames, 101u);
	EXPECT_EQ(take.m_Joints[1].m_Name, "Bone002");
	for (const auto& [frame, degrees] :
	    {std::pair(0u, 16.40997), {12u, -10.69707}, {24u, -37.80411}, {100u, -37.80411}})
	{
		const Rotation::VVector3 turn = Rotation::AngleAxisFromRotationMatrix(LocalPose(take, 1, frame).R);
		EXPECT_NEAR(turn[2], degrees * 3.14159265358979 / 180.0, 1e-6) << frame;
		EXPECT_NEAR(turn[0], 0.0, 1e-5);
	}
}

/// Weights of 1 are 9999, two in one number; as text its bits are printed as a whole number. There are none above 1.
TEST(FbxCurve, WeightedSlopesBendTime)
{
	for (const auto& [bText, weights] :
	    {std::pair(false, 0x270F270Fu), std::pair(true, 0x270F270Fu), std::pair(false, 0x4E204E20u)})
	{
		const double packed = bText ? double(weights) : double(std::bit_cast<float>(weights));
		const std::string bytes = Write(c_Forms[bText ? 4 : 1], {CurveRecord(1, {0x03000408}, {2, 2, packed, 0})});
		FbxFormat::VElementTree tree;
		ASSERT_TRUE(tree.Read(bytes, FbxFormat::DetectFileKind(bytes)));
		FbxFormat::VDecodeBudget budget;
		VFbxCurve curve;
		ASSERT_TRUE(curve.Read(tree, tree.Find(0, "AnimationCurve"), budget));
		std::size_t next = 0;
		// Here time all but stands still.
		EXPECT_NEAR(curve.At(0.5 * c_Second, next), 3.0, 1e-4);
		// Weights of 1: time is 3 s (1 - s)^2 + s^3, the value 0 + 6 s (1-s)^2 + 12 s^2 (1-s) + 6 s^3 at s = 0.25 is
		// 0.4375 seconds and 0.84375 + 0.5625 + 0.09375.
		EXPECT_NEAR(curve.At(0.4375 * c_Second, next), 1.5, 1e-9);
	}
}

using VTestProperties = std::vector<std::pair<std::string, VNumbers>>;

/// A layer above the base, with one curve node and no curve.
struct VTestLayer
{
	VTestProperties m_Properties;
	/// "T" of the hips, or "R" of the knee.
	std::string m_Kind;
	Rotation::VVector3 m_Values{};
};

/// Hips and a knee below, at scale 2 with Y up and centimetres; the hips walk along x, the knee turns about z.
std::string TakeFile(const VTestForm& i_rForm, const std::string& i_rLocalStop = {},
    const std::vector<VTestLayer>& i_rLayers = {}, const VTestProperties& i_rBase = {})
{
	VTestScene scene{{{"hips", "LimbNode", -1, {{"Lcl Translation", {0, 90, 0}}, {"Lcl Scaling", {2, 2, 2}}}},
	                     {"knee", "LimbNode", 0, {{"Lcl Translation", {0, -20, 0}}}}, {"mesh", "Mesh", -1, {}}},
	    {{"UpAxis", {1}}, {"UnitScaleFactor", {1}}, {"TimeMode", {10}}}, {}, {}};
	std::vector<VTestRecord> records = Records(i_rForm, scene);
	VTestRecord& rObjects = records[records.size() - 2];
	VTestRecord& rConnections = records.back();
	const auto object = [&](const char* i_pKind, std::int64_t i_Id, const char* i_pName,
	                        std::vector<VTestRecord> i_Children) {
		rObjects.m_Children.push_back(
		    Record(i_pKind, {i_Id, std::string(i_pName), std::string()}, std::move(i_Children)));
	};
	const auto connect = [&](std::int64_t i_Child, std::int64_t i_Parent, const std::string& i_rProperty)
	{
		VTestRecord& rRecord = rConnections.m_Children.emplace_back(
		    Record("C", {std::string(i_rProperty.empty() ? "OO" : "OP"), i_Child, i_Parent}));
		if (!i_rProperty.empty())
			rRecord.m_Values.push_back(i_rProperty);
	};
	std::vector<VTestRecord> span;
	if (!i_rLocalStop.empty())
		span.push_back(PropertyList(7400, {{"LocalStop", {std::stod(i_rLocalStop)}}}));
	object("AnimationStack", 100, "AnimStack::walk", span);
	object("AnimationStack", 101, "AnimStack::other", {});
	object("AnimationLayer", 102, "AnimLayer::base", {PropertyList(7400, i_rBase)});
	object("AnimationCurveNode", 103, "AnimCurveNode::T",
	    {PropertyList(7400, {{"d|X", {7}}, {"d|Y", {80}}, {"d|Z", {0}}})});
	object("AnimationCurveNode", 104, "AnimCurveNode::R", {PropertyList(7400, {{"d|Z", {0}}})});
	rObjects.m_Children.push_back(CurveRecord(105, {0x4}, VNumbers(4)));
	for (const auto& [child, parent, property] : {std::tuple(102, 100, ""), {103, 102, ""}, {104, 102, ""},
	         {103, 1, "Lcl Translation"}, {104, 2, "Lcl Rotation"}, {105, 103, "d|X"}, {105, 104, "d|Z"}})
		connect(child, parent, property);
	for (std::size_t i = 0; i < i_rLayers.size(); ++i)
	{
		const auto& [properties, kind, values] = i_rLayers[i];
		const auto layer = std::int64_t(200 + i);
		const auto node = std::int64_t(300 + i);
		object("AnimationLayer", layer, "AnimLayer::above", {PropertyList(7400, properties)});
		object("AnimationCurveNode", node, ("AnimCurveNode::" + kind).c_str(),
		    {PropertyList(7400, {{"d|X", {values[0]}}, {"d|Y", {values[1]}}, {"d|Z", {values[2]}}})});
		connect(layer, 100, "");
		connect(node, layer, "");
		connect(node, kind == "T" ? 1 : 2, kind == "T" ? "Lcl Translation" : "Lcl Rotation");
	}
	return Write(i_rForm, records);
}

TEST(FbxTake, PlacesJointsInOurAxes)
{
	for (const VTestForm& rForm : {c_Forms[1], c_Forms[2], c_Forms[4]})
	{
		SCOPED_TRACE(rForm.m_pName);
		VTestLog log("TakeIO");
		VTake take;
		std::string error;
		ASSERT_TRUE(ReadTakeFrom(TakeFile(rForm), {}, take, error)) << error;
		EXPECT_EQ(
		    log.Take(), std::vector<std::string>{"3 Of its 2 stacks the first is read, \"walk\". It has: walk, other"});
		ASSERT_EQ(take.m_Joints.size(), 2u) << "no mesh";
		EXPECT_EQ(take.m_Rate, 25.0);
		ASSERT_EQ(take.m_Frames, 101u);
		std::vector<VJointPose> poses;
		WorldRestPoses(take, poses);
		const auto expect = [&](std::size_t i_Joint, const Rotation::VVector3& i_rPlace)
		{
			for (std::size_t i = 0; i < 3; ++i)
				EXPECT_NEAR(poses[i_Joint].t[i], i_rPlace[i], 1e-9) << i_Joint;
		};
		expect(0, {0, 0, 900});
		expect(1, {0, 0, 500});
		// Half a second: 3 units along x; y stands at the curve node's own 80. The knee turns by 3 degrees about the
		// file's z, which is our -y.
		ASSERT_TRUE(ReadTakeFrom(TakeFile(rForm), {{}, {}, 4.0, "walk"}, take, error)) << error;
		ASSERT_EQ(take.m_Frames, 17u);
		WorldPoses(take, 2, poses);
		expect(0, {30, 0, 800});
		expect(1, {30, 0, 400});
		const Rotation::VVector3 turn = Rotation::AngleAxisFromRotationMatrix(poses[1].R);
		EXPECT_NEAR(turn[1], -3.0 * 3.14159265358979 / 180.0, 1e-12);
	}
}

/// At half a second the base has the hips at (3, 80, 0) and the knee at 3 degrees about z; at rest they stand at (0,
/// 90, 0).
TEST(FbxTake, LayersAddAndOverride)
{
	constexpr double c_Degree = 3.14159265358979 / 180.0;
	const auto turns = [](std::initializer_list<Rotation::VVector3> i_Degrees)
	{
		Rotation::VMatrix3 product = Rotation::c_Identity3;
		// The file's (x, y, z) is (x, -z, y) here.
		for (const auto& [x, y, z] : i_Degrees)
			product = Rotation::Product(
			    product, Rotation::RotationMatrixFromAngleAxis({x * c_Degree, -z * c_Degree, y * c_Degree}));
		return product;
	};
	struct VRow
	{
		const char* m_pName;
		std::vector<VTestLayer> m_Layers;
		VTestProperties m_Base;
		Rotation::VVector3 m_Hips;
		Rotation::VMatrix3 m_Knee;
		std::string m_Message;
	};
	const Rotation::VVector3 hips{30, 0, 800};
	const Rotation::VMatrix3 knee = turns({{0, 0, 3}});
	const std::string left = "3 Layers of the stack \"walk\" that are mute, or beside one that is solo: 1";
	const VRow rows[]{{"adds half", {{{{"Weight", {50}}}, "T", {10, 0, 4}}}, {}, {80, -20, 800}, knee, ""},
	    {"overrides", {{{{"BlendMode", {1}}}, "T", {1, 2, 3}}}, {}, {10, -30, 20}, knee, ""},
	    {"overrides by a quarter", {{{{"BlendMode", {1}}, {"Weight", {25}}}, "T", {1, 2, 3}}}, {}, {25, -7.5, 605},
	        knee, ""},
	    {"passes through", {{{{"BlendMode", {2}}}, "T", {1, 2, 3}}}, {}, hips, knee, ""},
	    {"mute", {{{{"Mute", {1}}}, "T", {1, 2, 3}}}, {}, hips, knee, left},
	    {"solo", {{{}, "T", {10, 0, 4}}}, {{"Solo", {1}}}, hips, knee, left},
	    {"base overrides", {}, {{"Weight", {10}}, {"BlendMode", {0}}}, hips, knee, ""},
	    {"turns", {{{}, "R", {90, 0, 0}}, {{}, "R", {0, 0, 90}}}, {}, hips, turns({{0, 0, 3}, {90, 0, 0}, {0, 0, 90}}),
	        ""},
	    {"turns by channel", {{{}, "R", {90, 0, 0}}, {{{"RotationAccumulationMode", {1}}}, "R", {0, 0, 90}}}, {}, hips,
	        turns({{0, 0, 93}, {90, 0, 0}}), ""},
	    {"turns half", {{{{"BlendMode", {1}}, {"Weight", {50}}}, "R", {0, 0, 43}}}, {}, hips, turns({{0, 0, 23}}), ""}};
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VTestLog log("TakeIO");
		VTake take;
		std::string error;
		ASSERT_TRUE(
		    ReadTakeFrom(TakeFile(c_Forms[1], {}, rRow.m_Layers, rRow.m_Base), {{}, {}, 4.0, "walk"}, take, error))
		    << error;
		const std::vector<std::string> messages = log.Take();
		EXPECT_EQ(messages, rRow.m_Message.empty() ? std::vector<std::string>{} : std::vector{rRow.m_Message});
		std::vector<VJointPose> poses;
		WorldPoses(take, 2, poses);
		for (std::size_t i = 0; i < 3; ++i)
			EXPECT_NEAR(poses[0].t[i], rRow.m_Hips[i], 1e-9) << i;
		for (std::size_t i = 0; i < 9; ++i)
			EXPECT_NEAR(poses[1].R[i], rRow.m_Knee[i], 1e-9) << i;
	}
}

/// With the first that reads so replaced; told if nothing does.
std::string With(std::string i_Text, const std::string& i_rFrom, const std::string& i_rTo)
{
	const std::size_t at = i_Text.find(i_rFrom);
	EXPECT_NE(at, std::string::npos) << i_rFrom;
	return at == std::string::npos ? i_Text : i_Text.replace(at, i_rFrom.size(), i_rTo);
}

/// Before version 7: x goes from 5 to 15 in a second, y stands at 90, z is not told of; what is unknown is passed over.
const std::string c_OldTake = R"(; FBX 6.1.0 project file
Objects: {
	Model: "Model::hips", "LimbNode" {
		Version: 232
	}
}
Connections: {
	Connect: "OO", "Model::hips", "Model::Scene"
}
Takes: {
	Current: "one"
	Take: "one" {
		Other: 1
		Model: "Model::nobody" {
			Version: 1.1
		}
		Model: "Model::hips" {
			Channel: "Visibility" {
				Default: 1
			}
			Channel: "Transform" {
				Channel: "T" {
					Channel: "X" {
						Default: 3
						Key: 0,5,L,46186158000,15,L
					}
					Channel: "Y" {
						Default: 90
					}
					Channel: "W" {
						Default: 4
					}
				}
				Channel: "Q" {
					Default: 4
				}
			}
		}
	}
}
)";

TEST(FbxTake, ChannelsOfOldFilesMove)
{
	VTake take;
	std::string error;
	ASSERT_TRUE(ReadTakeFrom(c_OldTake, {EUp::Z, 1.0, 2.0, {}}, take, error)) << error;
	ASSERT_EQ(take.m_Frames, 3u);
	for (const auto& [frame, x] : {std::pair(0u, 5.0), {1u, 10.0}, {2u, 15.0}})
		for (std::size_t axis = 0; axis < 3; ++axis)
			EXPECT_NEAR(LocalPose(take, 0, frame).t[axis], axis == 0 ? x : axis == 1 ? 90.0 : 0.0, 1e-9) << frame;
	EXPECT_FALSE(ReadTakeFrom(With(c_OldTake, "15,L", "15,X"), {}, take, error));
	EXPECT_EQ(error, "A curve of its stack \"one\" is damaged or too large");
	EXPECT_FALSE(ReadTakeFrom(With(c_OldTake, "Take:", "Cake:"), {}, take, error));
	EXPECT_EQ(error, "It holds no animation stack");
}

/// Without a word about how its keys are joined a curve is straight; any other gap makes it unreadable.
TEST(FbxTake, CurvesThatAreDamagedAreRefused)
{
	const std::string file = TakeFile(c_Forms[4]);
	const std::pair<const char*, const char*> rows[]{{"KeyTime: *4", "KeyTime: *5"}, {"KeyTime:", "NoTime:"},
	    {"KeyValueFloat: *4", "KeyValueFloat: *3"}, {"KeyValueFloat:", "NoValueFloat:"},
	    {"KeyAttrFlags: *1", "KeyAttrFlags: *2"}, {"KeyAttrFlags:", "NoAttrFlags:"},
	    {"KeyAttrDataFloat: *4", "KeyAttrDataFloat: *5"}, {"KeyAttrDataFloat:", "NoAttrDataFloat:"},
	    {"KeyAttrRefCount: *1", "KeyAttrRefCount: *2"}, {"KeyAttrRefCount:", "NoAttrRefCount:"},
	    {"0,6,8,8", "0,6,8,1e10"}, {"138558474000", "46186158000"}};
	for (const auto& [pFrom, pTo] : rows)
	{
		VTake take;
		std::string error;
		EXPECT_FALSE(ReadTakeFrom(With(file, pFrom, pTo), {{}, {}, {}, "walk"}, take, error)) << pTo;
		EXPECT_EQ(error, "A curve of its stack \"walk\" is damaged or too large");
	}
	std::string straight = With(file, "a: 4\n", "a: 2\n");
	for (const char* pName : {"KeyAttrFlags", "KeyAttrDataFloat", "KeyAttrRefCount"})
		straight = With(straight, pName, "Nothing");
	VTake take;
	std::string error;
	ASSERT_TRUE(ReadTakeFrom(straight, {{}, {}, 4.0, "walk"}, take, error)) << error;
	EXPECT_NEAR(LocalPose(take, 0, 2).t[0], 30.0, 1e-9);
}

TEST(FbxTake, RatesOfTheFileAreBounded)
{
	const std::tuple<double, double, double> rows[]{{11, 0, 24}, {14, 12.5, 12.5}, {14, 1e-3, 1e-3}, {14, 9e-4, 30},
	    {14, 1e5, 1e5}, {14, 1.1e5, 30}, {14, 0, 30}, {19, 50, 50}, {-1, 50, 50}};
	for (const auto& [mode, custom, rate] : rows)
	{
		const std::string bytes =
		    Write(c_Forms[1], VTestScene{{}, {{"TimeMode", {mode}}, {"CustomFrameRate", {custom}}}, {}, {}});
		FbxFormat::VElementTree tree;
		ASSERT_TRUE(tree.Read(bytes, FbxFormat::DetectFileKind(bytes)));
		EXPECT_EQ(ReadFbxSettings(FbxFormat::VDocument(tree)).m_Rate, rate) << mode << ' ' << custom;
	}
}

TEST(FbxTake, ThatCannotBeReadIsRefused)
{
	const auto stop = [](double) { return false; };
	const std::tuple<std::string, VTakeSettings, std::string> rows[]{
	    {TakeFile(c_Forms[1]), {{}, {}, {}, "run"}, "It has no such stack. It has: walk, other"},
	    {TakeFile(c_Forms[1]), {{}, {}, {}, "other"}, "Nothing moves in its stack \"other\""},
	    {TakeFile(c_Forms[1], "1e18"), {}, "Its stack \"walk\" lasts longer than such a file is read"},
	    {Write(c_Forms[0], VTestScene{}), {}, "It has no joints"},
	    {"; FBX 5.8.0 project file\n", {}, "It is no FBX file of version 6 or 7"},
	    {Write(c_Forms[1], VTestScene{}), {}, "It has no joints"},
	    {Write(c_Forms[1], VTestScene{std::vector<VTestNode>(10'001, {"joint", "LimbNode", -1, {}}), {}, {}, {}}), {},
	        "It has more than 10000 joints"},
	    {Write(c_Forms[1], VTestScene{{{"hips", "LimbNode", -1, {}}}, {{"UpAxis", {0}}}, {}, {}}), {},
	        "Its X axis points up, which is not read"},
	    {TakeFile(c_Forms[1]), {{}, 0.0, {}, "walk"}, "Its unit is none"},
	    {TakeFile(c_Forms[1]), {{}, 1e14, {}, "walk"}, "Its joints are beyond any stage"},
	    {TakeFile(c_Forms[1]), {{}, {}, 2000.0, "walk", stop}, "The reading was ended"},
	    {TakeFile(c_Forms[1]).substr(0, 900), {},
	        "The FBX file is damaged: a record reaches beyond what holds it (byte"}};
	for (const auto& [bytes, settings, message] : rows)
	{
		VTestLog log("TakeIO");
		VTake take;
		std::string error;
		EXPECT_FALSE(ReadTakeFrom(bytes, settings, take, error)) << message;
		EXPECT_EQ(error.substr(0, message.size()), message);
		EXPECT_TRUE(take.m_Joints.empty());
	}
}

} // namespace
