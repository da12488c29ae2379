#include "../UtilsFileSystem/Log.h"

#include "TakeIO/BvhWriter.h"
#include "TakeIO/Limits.h"
#include "TakeIO/ReadTake.h"
#include "math/NumberText.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <numbers>

using namespace TakeIO;
using namespace std::string_literals;

namespace
{

using VTexts = std::vector<std::string>;

const std::string c_ChestFile = RETARGET_TEST_DATA "/motion/chest_yxz_120fps.bvh";

const VTakeSettings c_YUpCentimetres{EUp::Y, 10.0, {}};

std::string Replaced(std::string i_Text, const std::string& i_rFrom, const std::string& i_rTo)
{
	for (std::size_t at = i_Text.find(i_rFrom); !i_rFrom.empty() && at != std::string::npos;
	     at = i_Text.find(i_rFrom, at + i_rTo.size()))
		i_Text.replace(at, i_rFrom.size(), i_rTo);
	return i_Text;
}

void ExpectNear(const Rotation::VVector3& i_rActual, const Rotation::VVector3& i_rExpected, double i_Within)
{
	for (int i = 0; i < 3; ++i)
		EXPECT_NEAR(i_rActual[i], i_rExpected[i], i_Within) << "axis " << i;
}

/// The hips turn by 90 degrees about Z at (1, 2, 3), so that the leg (0, -5, 0) reaches to (6, 2, 3). There it turns
/// about its X and then its Y, by 90 degrees each: what ends at (0, 0, 4) is at (4, 0, 0) in its parent, and at (6, 6,
/// 3) in the world.
const std::string c_Small = "HIERARCHY\n"
                            "ROOT Hips\n"
                            "{\n"
                            "\tOFFSET 7 8 9\n"
                            "\tCHANNELS 6 Xposition Yposition Zposition Zrotation Yrotation Xrotation\n"
                            "\tJOINT Left Leg\n"
                            "\t{\n"
                            "\t\tOFFSET 0 -5 0\n"
                            "\t\tCHANNELS 2 Xrotation Yrotation\n"
                            "\t\tEnd Site\n"
                            "\t\t{\n"
                            "\t\t\tOFFSET 0 0 4\n"
                            "\t\t}\n"
                            "\t}\n"
                            "}\n"
                            "MOTION\n"
                            "Frames: 2\n"
                            "Frame Time: .0083333\n"
                            "0 0 0 0 0 0 0 0\n"
                            "1 2 3 90 0 0 90 90\n";

struct VReadRow
{
	const char* m_pName;
	std::string m_Text;
	VTexts m_Told;
	std::size_t m_Frames = 2;
	std::string m_JointName = "Left Leg";
};

void PrintTo(const VReadRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

class Bvh : public testing::TestWithParam<VReadRow>
{
};

TEST_P(Bvh, IsReadHoweverItIsWritten)
{
	VTestLog log("TakeIO");
	VTake take;
	std::string error;
	ASSERT_TRUE(ReadTakeFrom(GetParam().m_Text, c_YUpCentimetres, take, error)) << error;
	EXPECT_EQ(log.Take(), GetParam().m_Told);
	ASSERT_EQ(take.m_Joints.size(), 2u);
	EXPECT_EQ(take.m_Joints[1].m_Name, GetParam().m_JointName);
	EXPECT_EQ(take.m_Rate, 120.0);
	ASSERT_EQ(take.m_Frames, GetParam().m_Frames);
	std::vector<VJointPose> poses;
	WorldPoses(take, take.m_Frames - 1, poses);
	ExpectNear(poses[0].t, {10, -30, 20}, 1e-12);
	ExpectNear(poses[1].t, {60, -30, 20}, 1e-12);
	ASSERT_EQ(take.m_Joints[1].m_Ends.size(), 1u);
	ExpectNear(Rotation::Apply(poses[1], take.m_Joints[1].m_Ends[0]), {60, -30, 60}, 1e-12);
	WorldRestPoses(take, poses);
	ExpectNear(poses[1].t, {70, -90, 30}, 1e-12);
}

INSTANTIATE_TEST_SUITE_P(Rows, Bvh,
    testing::Values(VReadRow{"AsItIs", c_Small, {}}, VReadRow{"LinesOfTwoBytes", Replaced(c_Small, "\n", "\r\n"), {}},
        VReadRow{"LinesOfOldMacs", Replaced(c_Small, "\n", "\r"), {}},
        VReadRow{"MixedLines", Replaced(c_Small, "}\n", " }\r\n\r\n"), {}},
        VReadRow{"SeveralBlanks", Replaced(Replaced(c_Small, " ", "  "), "Left  Leg", "Left Leg \t"), {}},
        VReadRow{"Tabs", Replaced(Replaced(c_Small, " ", "\t "), "Left\t Leg", "Left Leg"), {}},
        VReadRow{"Namespace", Replaced(c_Small, "Left Leg", "Actor 1:Left Leg"), {}, 2, "Actor 1:Left Leg"},
        VReadRow{"BraceBehindName", Replaced(c_Small, "Leg\n\t{", "Leg {"), {}},
        VReadRow{"ByteOrderMark", "\xEF\xBB\xBF" + c_Small, {}},
        VReadRow{
            "SmallLetters", Replaced(Replaced(Replaced(c_Small, "JOINT", "joint"), "Xrot", "XROT"), "MOT", "Mot"), {}},
        VReadRow{"PositionsOfAJoint",
            Replaced(Replaced(Replaced(c_Small, "2 Xrot", "4 Yposition Xposition Xrot"), "0 90 90", "0 -5 0 90 90"),
                "0 0 0 0 0 0 0 0", "0 0 0 0 0 0 0 0 0 0"),
            {}},
        VReadRow{
            "SignsAndExponents", Replaced(Replaced(c_Small, "1 2 3 90", "+1 0.2E+1 .3e1 +9e+1"), "-5 0", "-5. -0"), {}},
        VReadRow{"NoLastLineEnd", c_Small.substr(0, c_Small.size() - 1), {}},
        VReadRow{"ColonApart", Replaced(c_Small, "Frames:", "Frames :"), {}},
        VReadRow{"MoreFramesThanTold", c_Small + "1 2 3 90 0 0 90 90\n",
            {"3 It says that it has 2 frames, and has 3, which are read"}, 3},
        VReadRow{"FewerFramesThanTold", Replaced(c_Small, "Frames: 2", "Frames: 400000000"),
            {"3 It says that it has 400000000 frames, and has 2, which are read"}},
        VReadRow{"LastLineCutOff", Replaced(c_Small, "Frames: 2", "Frames: 3") + "1 2 3 9",
            {"3 Its last line (21) is cut off and left out",
                "3 It says that it has 3 frames, and has 2, which are read"}}),
    [](const auto& i_rInfo) { return std::string(i_rInfo.param.m_pName); });

TEST(BvhFile, GivesThePosesThatAnotherProgramComputes)
{
	VTestLog log("TakeIO");
	VTake take;
	std::string error;
	ASSERT_TRUE(ReadTake(c_ChestFile, {}, take, error)) << error;
	EXPECT_EQ(log.Take(), VTexts{"4 Taken as being in cm (10 mm): its hips stand 96.47 of them high"});
	ASSERT_EQ(take.m_Joints.size(), 23u);
	EXPECT_EQ(take.m_Frames, 61u);
	EXPECT_EQ(take.m_Rate, 120.0);
	std::vector<VJointPose> poses;
	WorldPoses(take, 60, poses);
	// By a script that multiplies matrices of 4x4 in the file's axes. Place, and the first row of the rotation.
	const std::tuple<std::size_t, const char*, Rotation::VVector3, Rotation::VVector3> rows[]{
	    {0, "Hips", {1487.23081, 163.67066, 955.57372}, {-0.930793756, -0.323640054, -0.169941458}},
	    {6, "Head", {1567.83238, 182.745151, 1595.22756}, {-0.776721494, -0.265487335, 0.571156892}},
	    {14, "LeftWrist", {1224.50247, 236.927481, 909.39601}, {-0.780773491, -0.622722751, 0.0510796507}},
	    {18, "RightToe", {1575.64768, 185.87466, 16.3796122}, {-0.693457235, -0.720389005, -0.0125197518}}};
	for (const auto& [joint, pName, place, row] : rows)
	{
		SCOPED_TRACE(pName);
		EXPECT_EQ(take.m_Joints[joint].m_Name, pName);
		ExpectNear(poses[joint].t, place, 1e-5);
		ExpectNear({poses[joint].R[0], poses[joint].R[1], poses[joint].R[2]}, row, 1e-8);
	}
}

TEST(BvhFile, WrittenReadsBackAsItIs)
{
	VTake take, small, again;
	std::string error;
	ASSERT_TRUE(ReadTake(c_ChestFile, {}, take, error)) << error;
	ASSERT_TRUE(ReadTakeFrom(c_Small, {EUp::Z, 25.4, {}}, small, error)) << error;
	// A rest rotation that no channel gives.
	small.m_Joints[1].m_Channels.clear();
	small.m_Joints[1].m_Rest.R = Rotation::RotationMatrixFromEuler({0.5, -0.25, 1.0}, Rotation::EXYZ);
	small.m_Joints[1].m_Name = "two\nlines";
	for (const VTake* pTake : {&take, &small})
	{
		ASSERT_TRUE(ReadTakeFrom(PrintBvh(*pTake), {pTake->m_FileUp, pTake->m_FileUnit, {}}, again, error)) << error;
		EXPECT_EQ(again.m_Rate, pTake->m_Rate);
		ASSERT_EQ(again.m_Frames, pTake->m_Frames);
		ASSERT_EQ(again.m_Joints.size(), pTake->m_Joints.size());
		std::vector<VJointPose> expected, actual;
		for (std::size_t frame = 0; frame < again.m_Frames; ++frame)
		{
			WorldPoses(*pTake, frame, expected);
			WorldPoses(again, frame, actual);
			for (std::size_t i = 0; i < actual.size(); ++i)
			{
				ExpectNear(actual[i].t, expected[i].t, 1e-8);
				for (std::size_t k = 0; k < 9; ++k)
					EXPECT_NEAR(actual[i].R[k], expected[i].R[k], 1e-11) << i;
			}
		}
		EXPECT_EQ(again.m_Joints.back().m_Ends.size(), pTake->m_Joints.back().m_Ends.size());
	}
	EXPECT_EQ(again.m_Joints[1].m_Name, "two lines");
}

TEST(BvhFile, ThatIsDamagedIsRefusedWithTheLine)
{
	const std::tuple<std::string, std::string, std::string> rows[]{
	    {"HIERARCHY", "hello", "It is neither a BVH file nor an FBX file"}, {c_Small, "", "It is empty"},
	    {c_Small, "HIERARCHY", "Line 1: It ends before its MOTION"},
	    {c_Small, "HIERARCHY MOTION", "Line 1: It has no joints"},
	    {"JOINT Left Leg", "JOINT ", "Line 6: A joint without a name"},
	    {"JOINT Left Leg", "JOINT " + std::string(1025, 'x'), "Line 6: A name has more than 1024 bytes"},
	    {"Leg\n\t{", "Leg", "Line 7: A brace is missing"},
	    {"\t}\n}\n", "\t}\n", "Line 15: MOTION stands inside the braces of \"Hips\""},
	    {"\t}\n}\n", "\t}\n}\n}\n", "Line 16: A brace closes nothing"},
	    {"JOINT", "ROOT", "Line 6: \"ROOT\" does not belong here"},
	    {"JOINT", std::string(41, 'x'), "Line 6: \"" + std::string(40, 'x') + "...\" does not belong here"},
	    {"Yrotation\n\t\tEnd", "Yrotation\nCHANNELS 1 Xrotation\n\t\tEnd",
	        "Line 10: A second CHANNELS of \"Left Leg\""},
	    {"\tCHANNELS 6", "JOINT a\n{\nCHANNELS 1 Xrotation\n}\nCHANNELS 6",
	        "Line 9: CHANNELS must stand before the joints below \"Hips\""},
	    {"CHANNELS 2", "CHANNELS -2", "Line 9: CHANNELS needs a count up to 12"},
	    {"CHANNELS 2", "CHANNELS 1.5", "Line 9: CHANNELS needs a count up to 12"},
	    {"Frames: 2", "Frames: x", "Line 17: A number is missing behind \"Frames\""},
	    {"Frames: 2", "Frames : x", "Line 17: A number is missing behind \"Frames\""},
	    {"-5 0", "-5", "Line 9: OFFSET needs three numbers, not \"CHANNELS\""},
	    {"0 0 4", "0 0 nan", "Line 12: OFFSET needs three numbers, not \"nan\""},
	    {"CHANNELS 2", "CHANNELS 13", "Line 9: CHANNELS needs a count up to 12"},
	    {"CHANNELS 2 X", "CHANNELS 2 W",
	        "Line 9: \"Wrotation\" is no channel: of X, Y and Z there are position and rotation"},
	    {"Frames:", "Pictures:", "Line 17: \"Pictures\" stands where \"Frames:\" and \"Frame Time:\" are expected"},
	    {"Time: .0083333", "Time:", "Line 19: \"0\" stands behind the frame time"},
	    {"1 2 3 90", "1 2 3 90,5", "Line 20: \"90,5\" is no number, or beyond any stage"},
	    {"1 2 3 90", "1 2 3 1e10", "Line 20: \"1e10\" is no number, or beyond any stage"},
	    {"90 90\n", "90 90 90\n", "Line 20: It has more values than the 8 channels"},
	    {"0 0 0 0 0 0 0 0\n", "0 0 0\n", "Line 19: It has fewer values than the 8 channels"}};
	for (const auto& [from, to, message] : rows)
	{
		SCOPED_TRACE(message);
		VTake take;
		take.m_Rate = 7.0;
		std::string error;
		EXPECT_FALSE(ReadTakeFrom(Replaced(c_Small, from, to), c_YUpCentimetres, take, error));
		EXPECT_EQ(error, message);
		EXPECT_EQ(take.m_Rate, 7.0) << "what was there is lost";
	}
	VTake take;
	std::string error;
	EXPECT_FALSE(ReadTake("/nowhere/none.bvh", {}, take, error));
	EXPECT_NE(error, "");
	std::string many = c_Small;
	for (int i = 0; i < 1000; ++i)
		many += "1 2 3 90 0 0 90 90\n";
	EXPECT_FALSE(ReadTakeFrom(many, {EUp::Y, 10.0, {}, {}, [](double i_Done) { return i_Done < 0.5; }}, take, error));
	EXPECT_EQ(error.substr(error.find(": ") + 2), "The reading was ended");
}

/// A chain of more joints than are read, each inside the one before.
TEST(BvhFile, LimitsAreTold)
{
	std::string text = "HIERARCHY ROOT a\n{";
	for (std::size_t i = 1; i < Limits::c_Joints; ++i)
		text += "JOINT a\n{";
	VTake take;
	std::string error;
	VTestLog log("TakeIO");
	const std::string rest = std::string(Limits::c_Joints, '}') + "MOTION Frames: 0 Frame Time: 0";
	EXPECT_TRUE(ReadTakeFrom(text + rest, c_YUpCentimetres, take, error)) << error;
	EXPECT_EQ(take.m_Rate, 30.0);
	EXPECT_EQ(log.Take(),
	    (VTexts{"3 Its time between frames is none (0 s): played at 30 frames a second",
	        "3 Joints whose name another joint has, too: 9999, such as \"a\""}));
	EXPECT_EQ(std::ranges::count(PrintBvh(take), '{'), std::ptrdiff_t(Limits::c_Joints));
	EXPECT_FALSE(ReadTakeFrom(text + "JOINT a\n{}" + rest, c_YUpCentimetres, take, error));
	EXPECT_NE(error.find("It has more than 10000 joints"), std::string::npos) << error;
}

/// What a file does not tell: from the height of the hips over the lowest point, and from which way it is longer.
TEST(Guess, FindsUnitAndUpAxis)
{
	const std::tuple<const char*, EUp, double> rows[]{{"0 -93 0", EUp::Y, 10.0}, {"0 0 -93", EUp::Z, 10.0},
	    {"0 -930 0", EUp::Y, 1.0}, {"0 -0.93 0", EUp::Y, 1000.0}, {"0 -36 0", EUp::Y, 25.4},
	    {"0 -16 0", EUp::Y, 25.4 / 0.45}, {"0 5 0", EUp::Y, 10.0}};
	for (const auto& [pLeg, up, unit] : rows)
	{
		VTestLog log("TakeIO");
		VTake take;
		std::string error;
		const std::string text = Replaced(Replaced(c_Small, "0 -5 0", pLeg), "0 0 4", "0 0 0");
		ASSERT_TRUE(ReadTakeFrom(text, {}, take, error)) << error;
		EXPECT_EQ(take.m_FileUp, up) << pLeg;
		EXPECT_EQ(take.m_FileUnit, unit) << pLeg;
		EXPECT_EQ(log.Take().size(), up == EUp::Z ? 2u : 1u) << pLeg;
	}
}

TEST(Rate, IsTheOneThatWasMeant)
{
	const std::pair<const char*, double> rows[]{{"0.0083333", 120.0}, {"0.008333", 120.0},
	    {"0.033367", 30000.0 / 1001.0}, {"0.0333333", 30.0}, {"0.04", 25.0}, {"0.016683", 60000.0 / 1001.0},
	    {"0.3", 1.0 / 0.3}, {"2", 0.5}};
	for (const auto& [pTime, rate] : rows)
	{
		VTake take;
		std::string error;
		ASSERT_TRUE(ReadTakeFrom(Replaced(c_Small, ".0083333", pTime), c_YUpCentimetres, take, error)) << error;
		EXPECT_DOUBLE_EQ(take.m_Rate, rate) << pTime;
	}
}

/// 170 to -170 degrees are 20 degrees apart; places go along lines.
TEST(Resampling, GoesTheShortWay)
{
	const std::string text = Replaced(
	    Replaced(Replaced(c_Small, ".0083333", "1"), "0 0 0 0 0 0 0 0", "0 0 0 170 0 0 0 0"), "3 90 0", "3 -170 0");
	for (const auto& [rate, frames] : {std::pair(4.0, 5u), {2.0 / 3.0, 1u}, {1.0, 2u}})
	{
		VTake take;
		std::string error;
		ASSERT_TRUE(ReadTakeFrom(text, {EUp::Z, 1.0, rate}, take, error)) << error;
		EXPECT_EQ(take.m_Rate, rate);
		ASSERT_EQ(take.m_Frames, frames);
		if (frames != 5)
			continue;
		const VJointPose pose = LocalPose(take, 0, 1);
		ExpectNear(pose.t, {0.25, 0.5, 0.75}, 1e-12);
		ExpectNear(Rotation::AngleAxisFromRotationMatrix(pose.R), {0, 0, 175.0 * std::numbers::pi / 180.0}, 1e-12);
	}
	VTake take;
	std::string error;
	EXPECT_FALSE(ReadTakeFrom(Replaced(text, "Time: 1", "Time: 1000"), {EUp::Z, 1.0, 1e5}, take, error));
	EXPECT_EQ(error, "At that rate it has more than 100000000 values");
}

} // namespace
