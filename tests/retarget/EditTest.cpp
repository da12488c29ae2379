#include "Rows.h"

#include <cmath>

namespace
{

using VNames = std::vector<std::string>;

/// Creates x.qrr with these edits.
class Edit : public testing::Test
{
protected:
	VRun Create(std::vector<std::string> i_Edits, const std::string& i_rFbx = c_Fbx)
	{
		std::vector<std::string> arguments{"create", "--fbx", i_rFbx, "--source", c_Performer, "-o", "x.qrr"};
		arguments.insert(arguments.end(), i_Edits.begin(), i_Edits.end());
		VRun run = m_Folder.Run(arguments);
		EXPECT_EQ(run.m_Status, 0) << run.m_Err;
		return run;
	}

	VJson Targets() { return RunJson({"targets", "x.qrr", "--source", c_Performer, "--json"}, m_Folder); }
	VJson Subject() { return RunJson({"dump", "x.qrr"}, m_Folder).at("SubjectParametrised"); }

	std::vector<std::string> Names()
	{
		std::vector<std::string> names;
		for (const VJson& rTarget : Targets())
			names.push_back(rTarget.at("name"));
		return names;
	}

	VScratchFolder m_Folder;
};

TEST_F(Edit, RunInTheOrderOfTheLine)
{
	Create({"--rotation", "LeftArm:LeftArm", "--symmetry", "--position", "LeftFoot:LeftFoot", "--no-symmetry",
	    "--rotation", "LeftLeg:LeftLeg", "--position", "#0:#0"});
	EXPECT_EQ(Names(),
	    (VNames{"LeftArm}LeftArm", "LeftFoot>LeftFoot", "RightFoot>RightFoot", "LeftLeg}LeftLeg", "Hips>Hips"}));
	Create({"--position", "Hips:Hips", "--rotation", "Head:Head", "--remove-target", "0", "--weight", "0=2.5",
	    "--position", "Neck:Neck"});
	EXPECT_EQ(Names(), (VNames{"Head}Head", "Neck>Neck"}));
	EXPECT_EQ(Targets()[0].at("weight"), 2.5);

	// The performer's hips stand 20 mm from the character's; lengths are stored over the scale of the moment.
	Create({"--position", "Hips:Hips", "--scale", "2"});
	EXPECT_EQ(
	    Targets()[0].at("state"), VJson({"0.000000*GlobalScale", "20.000000*GlobalScale", "0.000043*GlobalScale"}));
	EXPECT_NEAR(Targets()[0].at("distance"), 20.0, 1e-3) << "twice the offset";
	Create({"--scale", "2", "--position", "Hips:Hips"});
	EXPECT_EQ(
	    Targets()[0].at("state"), VJson({"0.000000*GlobalScale", "10.000000*GlobalScale", "0.000021*GlobalScale"}));
	EXPECT_NEAR(Targets()[0].at("distance"), 0.0, 1e-5);
}

TEST_F(Edit, ComeFromAFile)
{
	m_Folder.Write("one", "# arms\r\n--rotation LeftArm:LeftArm\r\n\n  --symmetry  \n--position=LeftFoot:LeftFoot");
	Create({"--edits", "one", "--position", "LeftHand:LeftHand"});
	EXPECT_EQ(Names(),
	    (VNames{"LeftArm}LeftArm", "LeftFoot>LeftFoot", "RightFoot>RightFoot", "LeftHand>LeftHand",
	        "RightHand>RightHand"}));
	// Names with blanks need no quotes.
	m_Folder.Write("blanks", "--rotation LeftHand:Bip001 L Hand\n");
	Create({"--edits", "blanks"}, Data("fbx/heaps_biped_zup_a7100.fbx"));
	EXPECT_EQ(Names(), (VNames{"LeftHand}Bip001 L Hand"}));
	m_Folder.Write("slip", "\n--rotatoin a:b");
	m_Folder.Write("value", "--prune-joints all");
	m_Folder.Write("none", "--rotation");
	m_Folder.Write("name", "--no-symmetry\n--rotation Hips:hip");
	const auto with = [](const char* i_pFile) {
		return std::vector<std::string>{"edit", "x.qrr", "--source", c_Performer, "-o", "x.qrr", "--edits", i_pFile};
	};
	RunRows(
	    {
	        {"slip", with("slip"), 3, "", "slip:2: there is no edit \"--rotatoin\"; did you mean \"--rotation\"?"},
	        {"value", with("value"), 3, "", "value:1: --prune-joints takes no value"},
	        {"none", with("none"), 3, "", "none:1: --rotation needs a value: SRC:TGT"},
	        {"name", with("name"), 2, "", "name:2: there is no target segment \"hip\"; did you mean "},
	        {"no file", with("nothing"), 3, "", "\"nothing\" could not be read as a file of edits"},
	        {"folder", with("."), 3, "", "\".\" could not be read as a file of edits"},
	    },
	    m_Folder);
}

TEST_F(Edit, SymmetryNeedsAPartner)
{
	const std::vector<std::string> common{
	    "--match-file-pose", "--symmetry", "--rotation", "RightHand:RightHand_prop", "--position", "LeftFoot:LeftFoot"};
	const auto with = [&](std::vector<std::string> i_Options)
	{
		i_Options.insert(i_Options.end(), common.begin(), common.end());
		return i_Options;
	};
	std::vector<std::string> line{"create", "--fbx", c_Fbx, "--source", c_Performer, "-o", "x.qrr"};
	line.insert(line.end(), common.begin(), common.end());
	RunRows({{"no partner", line, 1, "",
	            "error retarget: --rotation RightHand:RightHand_prop: the target segment \"RightHand_prop\" has no "
	            "partner on the other side\nerror retarget: --symmetry found no partner for 1 of the targets: "}},
	    m_Folder);
	Create(with({"--pair", "RightHand_prop:LeftHandIndex1"}));
	const VNames all{"RightHand}RightHand_prop", "LeftHand}LeftHandIndex1", "LeftFoot>LeftFoot", "RightFoot>RightFoot"};
	EXPECT_EQ(Names(), all);
	EXPECT_NE(Create(with({"--allow-partial"})).m_Err.find("warning retarget: --rotation RightHand:RightHand_prop: "),
	    std::string::npos);
	EXPECT_EQ(Names(), (VNames{all[0], all[2], all[3]}));
	// The plain rule for names finds neither of these.
	Create({"--symmetry", "--rotation", "LeftHand:Lefthand"}, Data("fbx/pab_arnaud_b7500.fbx"));
	EXPECT_EQ(Names(), (VNames{"LeftHand}Lefthand", "RightHand}RightHand"}));
	RunRows({
	    {"pair by index", {"create", "--fbx", c_Fbx, "-o", "x.qrr", "--pair", "#1:#2"}, 2, "",
	        "--pair #1:#2: segments are given by name"},
	    {"pair of nothing", {"create", "--fbx", c_Fbx, "-o", "x.qrr", "--pair", "LeftArm:RigthArm"}, 2, "",
	        "there is no target segment \"RigthArm\"; did you mean \"RightArm\""},
	});
}

TEST_F(Edit, StatesAreTakenAtThePresentScale)
{
	Create({"--scale", "4", "--position", "Hips:Hips", "--rotation", "Hips:Hips", "--state", "0=4,-8,1e1", "--state",
	    "1=0.5,0,-1"});
	const VJson targets = Targets();
	EXPECT_EQ(targets[0].at("state"), VJson({"1.000000*GlobalScale", "-2.000000*GlobalScale", "2.500000*GlobalScale"}));
	EXPECT_EQ(targets[1].at("state"), VJson({"0.5", "0", "-1"}));
	EXPECT_EQ(targets[1].at("type"), "LocalRotationToWorldRotation");
	EXPECT_EQ(targets[1].at("source"), "Hips");
	EXPECT_TRUE(targets[1].at("distance").is_null());
}

TEST_F(Edit, TheRootsHeightIsKeptOrScaled)
{
	const auto height = [&] { return Subject().at("Segments")[0].at("Joint").at("BindPose")[5].get<double>(); };
	Create({});
	const double before = height();
	const std::string told = Create({"--scale", "0.5"}).m_Err;
	EXPECT_NE(told.find("warning RetargetSetup: At scale 0.5 the lowest segment, "), std::string::npos) << told;
	EXPECT_EQ(height(), before);
	EXPECT_EQ(Create({"--scale", "0.5", "--root-height", "scale"}).m_Err.find("lowest segment"), std::string::npos);
	EXPECT_NEAR(height(), 0.5 * before, 1e-6);
	EXPECT_EQ(m_Folder.Run({"edit", "x.qrr", "--root-height", "scale", "--scale", "2", "-o", "x.qrr"}).m_Status, 0);
	EXPECT_NEAR(height(), 2.0 * before, 1e-5);
}

TEST_F(Edit, ResidualsFollowThePoseUntilTheTargetsAreUpdated)
{
	Create({"--rotation", "Spine:Spine", "--position", "Head:Head"});
	const VJson pose = Subject().at("Segments")[1].at("Joint").at("BindPose");
	ASSERT_EQ(pose, VJson({0.0, 0.0, 0.0})) << "a bone at rest";
	const std::vector<std::string> edit{
	    "edit", "x.qrr", "--source", c_Performer, "--pose", "Spine=0.5,0,0", "-o", "x.qrr"};
	EXPECT_EQ(m_Folder.Run(edit).m_Status, 0);
	EXPECT_NEAR(Targets()[0].at("angle"), 0.5 * 180.0 / M_PI, 1e-9);
	EXPECT_GT(Targets()[1].at("distance"), 50.0);
	const VJson joint = Subject().at("Segments")[1].at("Joint");
	EXPECT_EQ(joint.at("BindPose"), VJson({0.5, 0.0, 0.0}));
	EXPECT_EQ(joint.at("Mean"), joint.at("BindPose"));
	EXPECT_EQ(m_Folder.Run({"edit", "x.qrr", "--source", c_Performer, "--update-targets", "-o", "x.qrr"}).m_Status, 0);
	EXPECT_NEAR(Targets()[0].at("angle"), 0.0, 1e-9);
	EXPECT_NEAR(Targets()[1].at("distance"), 0.0, 1e-5);
}

TEST_F(Edit, APoseOfTheRootsRotationLeavesItsPlace)
{
	Create({});
	const VJson before = Subject().at("Segments")[0].at("Joint").at("BindPose");
	Create({"--pose", "Hips=0.1,0.2,0.3"});
	const VJson after = Subject().at("Segments")[0].at("Joint").at("BindPose");
	EXPECT_EQ(VJson({after[0], after[1], after[2]}), VJson({0.1, 0.2, 0.3}));
	EXPECT_EQ(VJson({after[3], after[4], after[5]}), VJson({before[3], before[4], before[5]}));
}

TEST_F(Edit, PruningAndCreatingJoints)
{
	const auto types = [&]
	{
		std::map<std::string, int> counts;
		const VJson subject = Subject();
		for (const VJson& rSegment : subject.at("Segments"))
			++counts[rSegment.at("Joint").at("JointType").get<std::string>()];
		return counts;
	};
	Create({"--rotation", "Head:Head", "--prune-joints"});
	EXPECT_EQ(types(), (std::map<std::string, int>{{"Free", 1}, {"Ball", 1}, {"Dummy", 32}}));
	Create({"--prune-joints", "--create-joints"});
	EXPECT_EQ(types(), (std::map<std::string, int>{{"Free", 1}, {"Ball", 33}}));
}

TEST_F(Edit, WhatSurprisesIsTold)
{
	EXPECT_EQ(Create({"--symmetry", "--rotation", "Spine:Spine", "--rotation", "Head:LeftArm"}).m_Err, "");
	EXPECT_NE(Create({"--match-file-pose", "--prune-joints"}).m_Err.find("pruning moves what was matched"),
	    std::string::npos);
	const std::string arnaud = Data("fbx/pab_arnaud_b7500.fbx");
	const VRun built = Create({}, arnaud);
	EXPECT_NE(built.m_Err.find("Root bone 'Hips' has a pre-rotation"), std::string::npos) << built.m_Err;
	EXPECT_NE(built.m_Err.find("warning retarget: The bind pose as built differs from the pose in the file, at worst "
	                           "\"Head\" by 2333.4 mm and 90.0 degrees; --match-file-pose mends it\n"),
	    std::string::npos)
	    << built.m_Err;
	EXPECT_EQ(Create({"--match-file-pose"}, arnaud).m_Err.find("as built"), std::string::npos);
	const VRun mistyped = m_Folder.Run({"create", "--fbx", arnaud, "--pose", "Nobody=1,2,3", "-o", "y.qrr"});
	EXPECT_EQ(mistyped.m_Err.find("as built"), std::string::npos) << "nothing is";
	EXPECT_EQ(m_Folder.Run({"dump", "x.qrr"}).m_Err, "") << "of what was written here";
	EXPECT_EQ(m_Folder.Run({"edit", "x.qrr", "-o", "y.qrr"}).m_Err, "");

	Create({"--position", "Hips:Hips"});
	const std::string scale = "<Parameter NAME=\"GlobalScale\" ";
	const std::string path = (m_Folder / "x.qrr").string();
	m_Folder.Write("x.qrr", Replaced(path, scale, "<Parameter NAME=\"Age\" VALUE=\"1\"/>" + scale));
	m_Folder.Write("x.qrr", Replaced(path, "\" POSITION=\"0.000000*GlobalScale", "\" POSITION=\"Age"));
	RunRows(
	    {{"a scale that would lose a parameter", {"edit", "x.qrr", "--scale", "2", "-o", "z.qrr"}, 2, "",
	        "error retarget: --scale: the scale stays: another one takes the place of the dynamic parameters 'Age', "
	        "which the target subject needs\n"}},
	    m_Folder);

	const VRun other = m_Folder.Run({"edit", "x.qrr", "--source", Data("../../demo/performer.qrs"), "-o", "y.qrr"});
	EXPECT_EQ(other.m_Err.find("made for the source"), std::string::npos) << "of the same name";
	m_Folder.Write("other.qrs", Get(c_Performer));
	EXPECT_NE(m_Folder.Run({"targets", "x.qrr", "--source", "other.qrs"})
	              .m_Err.find("The retarget subject was made for the source \"performer\", not for \"other\""),
	    std::string::npos);
}

TEST_F(Edit, ToStandardOutput)
{
	Create({"--rotation", "Head:Head"});
	const VRun run = m_Folder.Run({"edit", "x.qrr", "-o", "-"});
	EXPECT_EQ(run.m_Status, 0);
	EXPECT_EQ(run.m_Out, m_Folder.Read("x.qrr"));
	EXPECT_EQ(m_Folder.Run({"-q", "targets", "x.qrr"}).m_Out,
	    "INDEX  TYPE      SOURCE  TARGET  WEIGHT\n    0  Rotation  Head    Head         1\n");
	const VRun table = m_Folder.Run({"-q", "targets", "x.qrr", "--states"});
	EXPECT_EQ(
	    table.m_Out.rfind("INDEX  TYPE      SOURCE  TARGET  WEIGHT  NAME       STATE\n    0  Rotation  Head    Head  "
	                      "       1  Head}Head  ",
	        0),
	    0u)
	    << table.m_Out;
	const VRun segments = m_Folder.Run({"-q", "segments", "x.qrr"});
	EXPECT_EQ(segments.m_Out.rfind("INDEX  NAME ", 0), 0u);
	EXPECT_NE(segments.m_Out.find("\n    1    Spine "), std::string::npos) << segments.m_Out;
	const VJson json = RunJson({"segments", "x.qrr", "--json"}, m_Folder);
	const VJson bones = RunJson({"bones", c_Fbx, "--json"}, m_Folder);
	ASSERT_EQ(json.size(), bones.size());
	std::size_t followers = 0;
	for (std::size_t i = 0; i < json.size(); ++i)
	{
		const std::string name = json[i]["name"];
		EXPECT_EQ(json[i]["side"],
		    name.starts_with("Left")        ? "left"
		        : name.starts_with("Right") ? "right"
		                                    : "")
		    << name;
		for (const char* pKey : {"index", "parent", "side"})
			EXPECT_EQ(json[i].at(pKey), bones[i].at(pKey)) << i;
		EXPECT_NEAR(json[i].at("length"), bones[i].at("length"), 1e-3) << i;
		EXPECT_EQ(json[i].at("joint"), i == 0 ? "Free" : "Ball");
		followers += json[i].at("follows") == VJson({"Head"});
	}
	EXPECT_EQ(followers, 1u);
}

/// After --match-file-pose every segment stands where an independent reader found its bone, turned to Z up, with
/// distances from the root times the scale.
TEST_F(Edit, MatchFilePoseOnRealCharacters)
{
	struct VCharacter
	{
		const char* m_pFile;
		const char* m_pRoot;
		std::size_t m_First;
		const char* m_pScale;
	};
	for (const VCharacter& rCharacter : {VCharacter{"heaps_biped_zup_a7100", "Bip001", 0, "1.0"},
	         VCharacter{"kenney_medium_b7400", "HipsCtrl", 18, "1.0"},
	         VCharacter{"own_game_zup_m_b7400", "pelvis", 0, "1.0"},
	         VCharacter{"own_ns_yup_cm_a7400", "Hips", 0, "1.0"}, VCharacter{"own_ns_yup_cm_b7400", "#1", 1, "0.5"},
	         VCharacter{"pab_arnaud_b7500", "Hips", 0, "1.0"}, VCharacter{"pab_arnaud_b7500", "Hips", 0, "1.7"},
	         VCharacter{"ufbx_maya_human_ik_7400_binary", "0", 0, "1.0"}})
	{
		SCOPED_TRACE(rCharacter.m_pFile);
		Create({"--root", rCharacter.m_pRoot, "--scale", rCharacter.m_pScale, "--rotation", "Head:#3", "--prune-joints",
		           "--match-file-pose"},
		    Data(std::string("fbx/") + rCharacter.m_pFile + ".fbx"));
		const VJson segments = RunJson({"fk", "x.qrr"}, m_Folder).at("segments");
		const VJson reference = VJson::parse(Get(Data(std::string("fbx/reference/") + rCharacter.m_pFile + ".json")));
		const double scale = rCharacter.m_pScale[0] - '0' + (rCharacter.m_pScale[2] - '0') / 10.0;
		const bool bYUp = reference.at("upAxis") == 1;

		// Rows of the bone's matrix in the Z-up space: y becomes z, and z becomes -y.
		const auto row = [&](const VJson& i_rMatrix, int i_Row, int i_Column) -> double
		{
			if (!bYUp || i_Row == 0)
				return i_rMatrix[i_Row * 4 + i_Column];
			return i_Row == 2 ? i_rMatrix[4 + i_Column].get<double>() : -i_rMatrix[8 + i_Column].get<double>();
		};
		const VJson& rRoot = reference.at("bones")[rCharacter.m_First].at("global");
		ASSERT_GT(segments.size(), 20u);
		for (std::size_t i = 0; i < segments.size(); ++i)
		{
			const VJson& rBone = reference["bones"][rCharacter.m_First + i];
			SCOPED_TRACE(rBone.at("name"));
			const VJson& rMatrix = rBone.at("global");
			double lengths[3];
			for (int column = 0; column < 3; ++column)
				lengths[column] = std::hypot(row(rMatrix, 0, column), row(rMatrix, 1, column), row(rMatrix, 2, column));
			for (int r = 0; r < 3; ++r)
			{
				const double position = row(rRoot, r, 3) + scale * (row(rMatrix, r, 3) - row(rRoot, r, 3));
				EXPECT_NEAR(segments[i].at("translation")[r], position, 0.15) << r;
				// Two columns: the third tells a mirrored bone, which no segment can be.
				for (int column = 0; column < 2; ++column)
					EXPECT_NEAR(
					    segments[i].at("rotation")[r * 3 + column], row(rMatrix, r, column) / lengths[column], 1e-4)
					    << r << column;
			}
		}
	}
}

} // namespace
