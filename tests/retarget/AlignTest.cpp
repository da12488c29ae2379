#include "retarget/subject/Mapping.h"

#include "Rows.h"

#include "SetupProposal/Alignment.h"
#include "numerics/Rotation.h"

#include <cmath>

namespace
{

const std::vector<std::string> c_Characters{RETARGET_SOURCE "/demo/character.fbx",
    Data("fbx/heaps_biped_zup_a7100.fbx"), Data("fbx/kenney_medium_b7400.fbx"), Data("fbx/own_game_zup_m_b7400.fbx"),
    Data("fbx/own_ns_yup_cm_b7400.fbx"), Data("fbx/pab_arnaud_b7500.fbx"),
    Data("fbx/ufbx_maya_human_ik_7400_binary.fbx")};

const std::string c_DemoPerformer = RETARGET_SOURCE "/demo/performer.qrs";

VJson Create(const VScratchFolder& i_rFolder, const std::vector<std::string>& i_rEdits, const std::string& i_rOut,
    const std::string& i_rFbx = c_Characters[0], const std::string& i_rSource = c_DemoPerformer)
{
	std::vector<std::string> arguments{
	    "create", "--fbx", i_rFbx, "--source", i_rSource, "-o", i_rOut, "--json", "-q", "--auto"};
	arguments.insert(arguments.end(), i_rEdits.begin(), i_rEdits.end());
	return RunJson(arguments, i_rFolder);
}

TEST(Align, BringsEveryCharacterToThePoseOfThePerformer)
{
	const VScratchFolder folder;
	for (const std::string& rFbx : c_Characters)
		for (const std::string& rSource : {c_Performer, c_DemoPerformer})
		{
			SCOPED_TRACE(rFbx + ", " + rSource);
			const VJson report = Create(folder, {"--align"}, "x.qrr", rFbx, rSource);
			double before = 0.0;
			for (const VJson& rJoint : report.at("aligned").at("joints"))
			{
				EXPECT_LT(rJoint.at("afterDegrees").get<double>(), 0.01) << rJoint;
				before += rJoint.at("beforeDegrees").get<double>();
			}
			EXPECT_GT(before, 10.0);
			EXPECT_TRUE(report.at("aligned").at("refused").empty());
			const VJson& rPose = report.at("pose");
			EXPECT_EQ(rPose[4].at("fine"), true) << "told of what comes of all edits";
			// One file has no skin.
			ASSERT_EQ(rPose.size(), rFbx == c_Characters.back() ? 6u : 7u);
			for (std::size_t i = 5; i < rPose.size(); ++i)
				EXPECT_EQ(rPose[i].at("fine"), true) << rPose[i];
			if (rPose.size() == 7)
			{
				EXPECT_NEAR(rPose[5].at("numbers").at("lowestMm").get<double>(), 0.0, 0.01) << "it stands on its skin";
			}
			// In the other order the scale is that of the file's pose, which the alignment begins with.
			const VJson scaledFirst = Create(folder,
			    {"--root-height", "scale", "--scale", "fit", "--align", "--update-targets"}, "y.qrr", rFbx, rSource);
			EXPECT_EQ(scaledFirst.at("aligned").at("joints").size(), report.at("aligned").at("joints").size());
			// Legs that turn bring the hips a little up or down, feet that a stride has lifted more.
			EXPECT_NEAR(scaledFirst.at("pose")[4].at("numbers").at("scale").get<double>(), 1.0,
			    rFbx == c_Characters[1] ? 0.2 : 0.1);
			// Of the subject as it was saved.
			const VJson map = RunJson({"map", "x.qrr", "--source", rSource, "--json", "-q"}, folder);
			EXPECT_EQ(map.at("pose").size(), 6u);
			const VJson withSkin =
			    RunJson({"map", "x.qrr", "--fbx", rFbx, "--source", rSource, "--json", "-q"}, folder);
			EXPECT_EQ(withSkin.at("pose"), rPose);
			for (const VJson& rFinding : map.at("pose"))
				EXPECT_TRUE(rFinding.at("fine").get<bool>()) << rFinding;
			// Aligned once more it stays, and no offset is left to be measured.
			const VJson again =
			    RunJson({"edit", "x.qrr", "--source", rSource, "--align", "-o", "y.qrr", "--json", "-q"}, folder);
			for (const VJson& rJoint : again.at("aligned").at("joints"))
				EXPECT_LT(rJoint.at("beforeDegrees").get<double>(), 0.01) << rJoint;
			EXPECT_NEAR(again.at("aligned").at("liftMm").get<double>(), 0.0, 0.01);
			const VJson& rMove = again.at("aligned").at("moveMm");
			EXPECT_LT(std::hypot(rMove[0].get<double>(), rMove[1].get<double>()), 0.01) << rMove;
		}
}

Rotation::VPose<double> PoseOf(const VJson& i_rFk, const std::string& i_rName)
{
	Rotation::VPose<double> pose;
	for (const VJson& rSegment : i_rFk.at("segments"))
		if (rSegment.at("name") == i_rName)
		{
			rSegment.at("rotation").get_to(pose.R);
			rSegment.at("translation").get_to(pose.t);
		}
	return pose;
}

TEST(Align, TurnsTheChainsThatAreAskedForByTheSmallestAngle)
{
	const VScratchFolder folder;
	Create(folder, {"--match-file-pose"}, "before.qrr", c_Characters[0], c_Performer);
	Create(folder, {"--chain", "arms", "--lock", "palmRight", "--align"}, "after.qrr", c_Characters[0], c_Performer);
	const VJson before = RunJson({"fk", "before.qrr"}, folder);
	const VJson after = RunJson({"fk", "after.qrr"}, folder);
	for (const char* const pName : {"haunch", "ribs", "collarLeft", "thighLeft", "clawRight", "skull"})
		EXPECT_EQ(PoseOf(before, pName).R, PoseOf(after, pName).R) << pName;
	const auto was = PoseOf(before, "upperArmLeft");
	const auto is = PoseOf(after, "upperArmLeft");
	const auto turn = Rotation::AngleAxisFromRotationMatrix(Rotation::Product(is.R, Rotation::Transposed(was.R)));
	const auto elbow = PoseOf(before, "foreArmLeft");
	// About an axis across the bone: 38.4 degrees from a lowered arm to a level one, and no twist.
	EXPECT_NEAR(std::hypot(turn[0], turn[1], turn[2]) * 180.0 / std::acos(-1.0), 38.4, 0.1);
	EXPECT_NEAR(
	    turn[0] * (elbow.t[0] - was.t[0]) + turn[1] * (elbow.t[1] - was.t[1]) + turn[2] * (elbow.t[2] - was.t[2]), 0.0,
	    1e-3);
	const auto local = [](const VJson& i_rFk)
	{ return Rotation::Product(Rotation::Transposed(PoseOf(i_rFk, "foreArmRight").R), PoseOf(i_rFk, "palmRight").R); };
	for (std::size_t i = 0; i < 9; ++i)
		EXPECT_NEAR(local(before)[i], local(after)[i], 1e-9);
}

/// The performer's legs are splayed by 20 degrees in its bind pose, those of the character hardly.
TEST(Align, FeetStandWhereThePerformersDoAndLeanAsTheShinsDo)
{
	const VScratchFolder folder;
	Create(folder, {"--feet", "level", "--align"}, "level.qrr", c_Characters[3], c_Performer);
	Create(folder, {"--feet", "shins", "--align"}, "shins.qrr", c_Characters[3], c_Performer);
	const VJson performer = RunJson({"fk", c_Performer}, folder);
	const VJson level = RunJson({"fk", "level.qrr"}, folder);
	const VJson shins = RunJson({"fk", "shins.qrr"}, folder);
	for (std::size_t axis = 0; axis < 2; ++axis)
		EXPECT_NEAR(PoseOf(level, "foot_l").t[axis] + PoseOf(level, "foot_r").t[axis],
		    PoseOf(performer, "LeftFoot").t[axis] + PoseOf(performer, "RightFoot").t[axis], 1e-6);
	for (const char* const pName : {"calf_l", "foot_l"})
		EXPECT_NEAR(PoseOf(level, pName).t[2], PoseOf(shins, pName).t[2], 10.0) << pName;
	for (const auto& [rFoot, side] : {std::pair(std::string("foot_l"), 1.0), {std::string("foot_r"), -1.0}})
	{
		const auto lean = Rotation::AngleAxisFromRotationMatrix(
		    Rotation::Product(PoseOf(shins, rFoot).R, Rotation::Transposed(PoseOf(level, rFoot).R)));
		// Ahead is -Y: the sole of the left foot, which is at +X, shows to the left.
		EXPECT_NEAR(lean[1], -side * std::atan2(137.7, 378.0), 0.01) << rFoot;
		EXPECT_NEAR(lean[0], 0.0, 0.05) << rFoot;
		EXPECT_NEAR(lean[2], 0.0, 1e-6) << rFoot;
	}
	const VRun wrong = folder.Run({"edit", "level.qrr", "--feet", "flat", "-o", "x.qrr"});
	EXPECT_EQ(wrong.m_Status, 2) << wrong.m_Err;
}

/// Its file shows a stride; its skin was bound with the X axes of both feet straight down.
TEST(Align, AStrideStandsAsItsSkinWasBound)
{
	const VScratchFolder folder;
	const VJson stride = RunJson({"map", "--fbx", c_Characters[1], "--source", c_Performer, "--json", "-q"}, folder);
	const VJson& rSoles = stride.at("pose").back();
	EXPECT_EQ(rSoles.at("id"), "soles");
	EXPECT_FALSE(rSoles.at("fine").get<bool>());
	Create(folder, {"--match-file-pose"}, "stride.qrr", c_Characters[1], c_Performer);
	for (const auto& [rFeet, shown] : {std::pair(std::string("level"), true), {"shins", false}})
	{
		Create(folder, {"--feet", rFeet, "--align"}, "x.qrr", c_Characters[1], c_Performer);
		const VJson before = RunJson({"fk", "stride.qrr"}, folder);
		const VJson after = RunJson({"fk", "x.qrr"}, folder);
		for (const auto& [rFoot, pNumber] :
		    {std::pair(std::string("Bip001 L Foot"), "leftDegrees"), {"Bip001 R Foot", "rightDegrees"}})
		{
			EXPECT_NEAR(std::acos(-PoseOf(before, rFoot).R[6]) * 180.0 / std::acos(-1.0),
			    rSoles.at("numbers").at(pNumber).get<double>(), 0.01)
			    << rFoot;
			EXPECT_EQ(PoseOf(after, rFoot).R[6] < -1.0 + 1e-6, shown) << rFoot << PoseOf(after, rFoot).R[6];
		}
	}
}

TEST(Align, MeasuresTheOffsetsAgainAndRefusesWhatGetsWorse)
{
	const VScratchFolder folder;
	Create(folder, {"--align"}, "a.qrr");
	Create(folder, {"--align", "--update-targets"}, "b.qrr");
	EXPECT_EQ(folder.Read("a.qrr"), folder.Read("b.qrr"));
	const auto edit = [&](std::vector<std::string> i_Edits)
	{
		std::vector<std::string> arguments{"create", "--fbx", c_Characters[0], "--source", c_Performer, "-o", "c.qrr"};
		arguments.insert(arguments.end(), i_Edits.begin(), i_Edits.end());
		return folder.Run(arguments);
	};
	const VRun swapped =
	    edit({"--rotation", "LeftArm:upperArmRight", "--rotation", "LeftForeArm:foreArmRight", "--align"});
	EXPECT_NE(swapped.m_Err.find("the left arm stays as it is: \"upperArmRight\" would have to turn by 14"),
	    std::string::npos)
	    << swapped.m_Err;
	EXPECT_NE(swapped.m_Out.find("refused"), std::string::npos) << swapped.m_Out;
	EXPECT_NE(edit({"--align"}).m_Err.find("Add targets first"), std::string::npos);
	EXPECT_EQ(edit({"--chain", "tail", "--auto", "--align"}).m_Status, 2);
}

/// An operator who leaves it open gets what the pose check suggests, and is told; a text says all that it wants.
TEST(Align, FitsTheScaleWhereNothingTellsOfIt)
{
	const VScratchFolder folder;
	const VJson aligned = Create(folder, {"--align"}, "open.qrr").at("aligned");
	const double scale = aligned.at("scaledBy").get<double>();
	EXPECT_NEAR(scale, 1.264, 1e-9);
	struct VRow
	{
		std::vector<std::string> m_Edits;
		bool m_bFits;
	};
	for (const VRow& rRow :
	    {VRow{{"--root-height", "scale", "--scale", "1.264", "--align"}, true}, {{"--align", "--scale", "keep"}, false},
	        {{"--root-height", "keep", "--align"}, false}, {{"--switch-root-height", "scale", "--align"}, false}})
	{
		const VJson told = Create(folder, rRow.m_Edits, "told.qrr").at("aligned");
		EXPECT_FALSE(told.contains("scaledBy"));
		EXPECT_EQ(folder.Read("told.qrr") == folder.Read("open.qrr"), rRow.m_bFits) << rRow.m_Edits[1];
	}
	const std::string begin = R"({"fbx": ")" + c_Characters[0] + R"(", "source": ")" + c_DemoPerformer + '"';
	const std::string edits = R"("edits": [{"auto": true}, {"align": true}]})";
	for (const bool bFits : {false, true})
	{
		folder.Write("r.json",
		    begin
		        + (bFits ? R"(, "root-height": "scale", "edits": [{"scale": 1.264}, {"auto": true}, {"align": true}]})"
		                 : ", " + edits));
		RunJson({"build", "r.json", "-o", "built.qrr", "--json", "-q", "--force"}, folder);
		EXPECT_EQ(folder.Read("built.qrr") == folder.Read("open.qrr"), bFits);
	}
	// Offsets that nobody gave follow a scale behind them.
	Create(folder, {"--scale", "0.9"}, "behind.qrr");
	Create(folder, {"--scale", "0.9", "--update-targets"}, "measured.qrr");
	EXPECT_EQ(folder.Read("behind.qrr"), folder.Read("measured.qrr"));
	Create(folder, {"--state", "0=1,2,3", "--scale", "0.9"}, "given.qrr");
	EXPECT_NE(folder.Read("given.qrr"), folder.Read("measured.qrr"));
}

TEST(Align, LeavesAChainThatItWouldMakeWorse)
{
	CommandLine::VSession session;
	session.LoadSource(c_DemoPerformer);
	session.LoadFbx(c_Characters[0]);
	const SetupProposal::VRestSkeleton source = CommandLine::ProposeForFile(session).m_Target;
	SetupProposal::VRestSkeleton target = source;
	SetupProposal::VAlignmentRequest request;
	std::size_t elbow = 0;
	for (std::size_t i = 0; i < source.size(); ++i)
	{
		request.m_Pairs.push_back({i, i});
		if (source[i].m_Name == "foreArmLeft")
			elbow = i;
		// The upper arm points elsewhere, and what hangs on it where it should.
		if (elbow
		    && (i == elbow
		        || target[std::size_t(source[i].m_Parent)].m_Place != source[std::size_t(source[i].m_Parent)].m_Place))
			target[i].m_Place[2] += 100.0;
		if (source[i].m_Name == "foreArmLeft" || source[i].m_Name == "palmLeft")
			request.m_Held.emplace(i, "is locked");
	}
	const auto refused = SetupProposal::Align(source, target, request);
	ASSERT_EQ(refused.m_Refused.size(), 1u);
	EXPECT_EQ(refused.m_Refused[0].m_Chain, "left arm");
	EXPECT_NE(refused.m_Refused[0].m_Reason.find("which is locked"), std::string::npos)
	    << refused.m_Refused[0].m_Reason;
	for (std::size_t i = 0; i < target.size(); ++i)
		EXPECT_NEAR(refused.m_Places[i][2], target[i].m_Place[2] + refused.m_MoveMm[2], 1e-9) << target[i].m_Name;
	// With the elbow free it gets better.
	request.m_Held.clear();
	const auto aligned = SetupProposal::Align(source, target, request);
	EXPECT_TRUE(aligned.m_Refused.empty());
	for (const auto& rJoint : aligned.m_Joints)
		EXPECT_NEAR(rJoint.m_After, 0.0, 1e-6) << target[rJoint.m_Target].m_Name;
}

} // namespace
