#include "Rows.h"

#include "math/NumberText.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <optional>
#include <sstream>

namespace
{

void ExpectNear(const VJson& i_rActual, const std::vector<double>& i_rExpected, double i_Tolerance)
{
	ASSERT_EQ(i_rActual.size(), i_rExpected.size());
	for (std::size_t i = 0; i < i_rExpected.size(); ++i)
		EXPECT_NEAR(i_rActual[i].get<double>(), i_rExpected[i], i_Tolerance) << i;
}

TEST(Eval, Values)
{
	RunRows({
	    {"parameter", {"eval", "2*(Arm + 10)", "--static", "Arm=250"}, 0, "520\n", ""},
	    {"17 digits", {"eval", "1/3"}, 0, "0.33333333333333331\n", ""},
	    {"chain", {"eval", "sin(a)^2", "--static", "b=3", "--static", "a=b/2"}, 0, "0.99499624830022271\n", ""},
	    {"minus first", {"eval", "--static", "Arm=1", "--", "-Arm"}, 0, "-1\n", ""},
	    {"minus and digit", {"eval", "-2^2"}, 0, "4\n", ""},
	    {"not finite", {"eval", "-1/0"}, 0, "-inf\n", ""},
	    {"linear", {"eval", "--context", "linear", "12.5*GlobalScale", "--dynamic", "GlobalScale=0x2"}, 0, "25\n", ""},
	    {"full", {"eval", "--context=full", "a^d", "--static", "a=2", "--dynamic", "d=3"}, 0, "8\n", ""},
	    {"empty geometry", {"eval", "", "--context", "linear"}, 0, "0\n", ""},
	});
}

TEST(Eval, DiagnosticsStandAlone)
{
	struct VCase
	{
		std::vector<std::string> m_Arguments;
		const char* m_pMessage;
	};
	const VScratchFolder folder;
	for (const VCase& rCase : std::vector<VCase>{
	         {{""}, "Parse Error at column 1: Empty expression\n"},
	         {{"d+1", "--dynamic", "d=1"}, "Parse Error at column 2: ID \"d\" was referenced but never declared\n"},
	         {{"a^2", "--context", "linear", "--static", "a=1"},
	             "Parse Error at column 4: Power operator invalid for arguments\n"},
	         {{"1", "--static", "a=1", "--static", "a=2"},
	             "Cannot add StaticParameter 'a', a StaticParameter with that name already exists.\n"},
	         {{"1", "--static", "a=b", "--static", "b=2"},
	             "Validation of StaticParameter 'a' expression 'b' failed, Parse Error at column 2: ID \"b\" was "
	             "referenced but never declared.\n"},
	     })
	{
		std::vector<std::string> arguments = rCase.m_Arguments;
		arguments.insert(arguments.begin(), "eval");
		const VRun run = folder.Run(arguments);
		EXPECT_EQ(run.m_Status, 3);
		EXPECT_EQ(run.m_Out, "");
		EXPECT_EQ(run.m_Err, rCase.m_pMessage);
	}
}

/// What the reader finds, which is tested beside it, stands here under its names.
TEST(Fbx, ShowsWhatTheReaderFinds)
{
	const VScratchFolder folder;
	const VJson actual =
	    RunJson({"fbx", Data("fbx/ufbx_maya_transformed_skin_a6100.fbx"), "--meshes", "--skin"}, folder);
	const VJson expected = VJson::parse(Get(Data("fbx/reference/ufbx_maya_transformed_skin_a6100.json")));
	EXPECT_EQ(actual.at("upAxis"), expected.at("upAxis"));
	EXPECT_EQ(actual.at("unitScale"), expected.at("unitScale"));
	ASSERT_EQ(actual.at("bones").size(), expected.at("bones").size());
	for (std::size_t bone = 0; bone < expected["bones"].size(); ++bone)
	{
		const VJson& rActual = actual["bones"][bone];
		const VJson& rExpected = expected["bones"][bone];
		EXPECT_EQ(rActual.at("name"), rExpected.at("name"));
		EXPECT_EQ(rActual.at("parent"), rExpected.at("parent"));
		EXPECT_NEAR(rActual.at("accumulatedScale"), rExpected.at("accumulatedScale").get<double>(), 1e-4);
		for (const char* pKey : {"preRotation", "local", "global"})
			ExpectNear(rActual.at(pKey), rExpected.at(pKey), 1e-4);
	}
	ASSERT_EQ(actual.at("placedMeshes").size(), 1u);
	const VJson& rMesh = actual["placedMeshes"][0];
	const VJson& rExpected = expected.at("placedMeshes")[0];
	EXPECT_EQ(rMesh.at("name"), rExpected.at("name"));
	EXPECT_EQ(rMesh.at("vertexCount"), rExpected.at("uvs"));
	EXPECT_EQ(rMesh.at("parts").size(), 1u);
	EXPECT_EQ(rMesh["parts"][0].at("triangleCount"), rExpected.at("triangles"));
	ExpectNear(rMesh.at("bounds"), rExpected.at("bounds"), 0.01);
	EXPECT_EQ(actual.at("skin").at("skeleton").size(), 3u);
	ASSERT_EQ(actual["skin"].at("meshes").size(), 1u);
	const VJson& rSkin = actual["skin"]["meshes"][0];
	EXPECT_EQ(rSkin.at("vertexCount"), rMesh["vertexCount"]);
	EXPECT_EQ(rSkin.at("partCount"), 1u);
	EXPECT_EQ(rSkin.at("influences"), VJson({0, 0, 14, 18, 0}));
	// Control points that share a texture coordinate stay apart: 572 coordinates for 573 vertices.
	const VJson shared = RunJson({"fbx", Data("fbx/heaps_biped_zup_a7100.fbx"), "--skin"}, folder);
	EXPECT_EQ(shared.at("skin").at("meshes")[0].at("vertexCount"), 573u);
}

TEST(Take, ShowsWhatTheFileHolds)
{
	const std::string file = Data("motion/chest_yxz_120fps.bvh");
	RunRows({
	    {"table", {"take", file}, 0, "61 frames at 120 Hz (0.51 s), 23 joints, 72 channels; in the file y is up", ""},
	    {"tree", {"take", file}, 0, "    9                RightElbow     319.0  rotation ZXY\n", ""},
	    {"guess", {"take", file, "-v"}, 0, "a unit 10.000 mm\n", "information TakeIO: Taken as being in cm (10 mm)"},
	    {"rate", {"take", file, "--rate", "60"}, 0, "31 frames at 60 Hz", ""},
	    {"json", {"take", file, "--json", "--unit", "inch"}, 0,
	        "{\n \"frames\": 61,\n \"rate\": 120.0,\n \"channels\": 72,\n \"up\": \"y\",\n \"unit\": 25.4,", ""},
	    {"axes", {"take", file, "--json", "--up", "z", "--unit", "2"}, 0, "\"rest\": [0.0, 20.9447, -0.000778]", ""},
	    {"demo", {"take", RETARGET_SOURCE "/demo/walk.bvh"}, 0, "387 frames at 30 Hz (12.90 s), 25 joints", ""},
	    {"no unit", {"take", file, "--unit", "yard"}, 2, "", "\"yard\" is none of mm, cm, m, inch, and no number of"},
	    {"no axis", {"take", file, "--up", "x"}, 2, "", "x not in {y,z}"},
	    {"no rate", {"take", file, "--rate", "0"}, 2, "", "\"0\" is no number from 0.001 to 100000"},
	    {"no take", {"take", Data("motion/README.md")}, 3, "", "could not be read as a take. It is neither a BVH"},
	    {"missing", {"take", "nothing.bvh"}, 3, "", "\"nothing.bvh\" could not be read as a take."},
	});
}

TEST(Take, IsHandedOn)
{
	const VScratchFolder folder;
	const std::string bvh = Data("motion/chest_yxz_120fps.bvh"), text = Data("fbx/heaps_biped_zup_a7100.fbx");
	const std::string binary = Data("fbx/own_game_zup_m_b7400.fbx");
	const auto run = [&](const std::vector<std::string>& i_rArguments, int i_Status, const std::string& i_rError)
	{
		const VRun result = folder.Run(i_rArguments);
		EXPECT_EQ(result.m_Status, i_Status) << result.m_Err;
		EXPECT_NE(result.m_Err.find(i_rError), std::string::npos) << result.m_Err;
	};
	run({"take", bvh, "-o", "again.bvh"}, 0, "");
	EXPECT_EQ(RunJson({"take", "again.bvh", "--json"}, folder).at("frames"), 61u);
	run({"take", binary, "-o", "game.fbx"}, 0, "");
	run({"take", "game.fbx", "--stack", "own_game_zup_m_b7400"}, 0, "");
	run({"take", binary, "-o", "game.glb"}, 0, "");
	EXPECT_EQ(folder.Read("game.glb").substr(0, 4), "glTF");
	run({"take", text, "-o", "text.glb"}, 0, "Failed to load");
	const std::vector<std::string> names = folder.Names();
	run({"take", text, "-o", "strict.glb", "--strict"}, 1, "--strict");
	run({"take", text, "-o", "text.fbx"}, 4, "only binary files of version 7 take one more animation stack");
	run({"take", bvh, "-o", "chest.glb"}, 2, "that form holds the character, too: --fbx names its FBX file");
	run({"take", bvh, "-o", "-"}, 2, "give it a name");
	run({"take", bvh, "-o", "chest.txt"}, 2, "let the name of its file end in .bvh, .glb or .fbx");
	run({"take", bvh, "-o", "chest.glb", "--fbx", bvh}, 3, "could not be read as a character. It is no FBX file");
	run({"take", bvh, "-o", "chest.glb", "--fbx", text}, 4, "No bone has the name of a joint");
	run({"take", "game.fbx", "-o", "game.fbx"}, 2, "is an input that saving there would destroy");
	EXPECT_EQ(folder.Names(), names);
}

/// What "run" does first for somebody new.
TEST(Solve, TheDemoHasNoFindings)
{
	const VScratchFolder folder;
	const std::string demo = RETARGET_SOURCE "/demo/";
	const VRun made = folder.Run({"create", "--fbx", demo + "character.fbx", "--source", demo + "performer.qrs",
	    "--edits", demo + "mapping.json", "--prune-joints", "--root-height", "scale", "--align", "--scale", "fit",
	    "--update-targets", "-o", "kestrel.qrr", "--strict", "-q"});
	EXPECT_EQ(made.m_Status, 0) << made.m_Err;
	const VRun solved = folder.Run({"solve", "kestrel.qrr", "--take", demo + "walk.bvh", "--source",
	    demo + "performer.qrs", "--json", "--strict"});
	EXPECT_EQ(solved.m_Status, 0) << solved.m_Err;
	EXPECT_EQ(solved.m_Err, "");
	const VJson report = VJson::parse(solved.m_Out);
	EXPECT_EQ(report.at("findings"), VJson::array());
	for (const VJson& rFoot : report.at("feet"))
		EXPECT_NEAR(rFoot.at("performerLean").get<double>(), 0.0, 2.0);
}

/// A character that is set up for the performer of a take, in the words of its file.
TEST(Solve, PlaysATakeThroughASubject)
{
	const VScratchFolder folder;
	const std::string take = Data("motion/chest_yxz_120fps.bvh");
	EXPECT_EQ(RunJson({"performer", take, "-o", "p.qrs", "--json"}, folder).at("segments"), 23);
	RunRows({{"no finding", {"check", "p.qrs", "--strict"}, 0, "no findings", ""}}, folder);
	EXPECT_EQ(folder
	              .Run({"create", "--fbx", c_Fbx, "--source", "p.qrs", "--auto", "--prune-joints", "--match-file-pose",
	                  "--update-targets", "-o", "c.qrr", "-q"})
	              .m_Status,
	    0);
	const VJson solved = RunJson({"solve", "c.qrr", "--take", take, "--source", "p.qrs", "--json"}, folder);
	EXPECT_EQ(solved.at("frames"), 61);
	EXPECT_EQ(solved.at("notConverged"), VJson::array());
	EXPECT_NEAR(solved.at("scale").get<double>(), 1.0, 1e-6);
	EXPECT_EQ(solved.at("feet").size(), 2u);
	// The worst of a target, as the frames have it.
	const std::string csv = folder.Run({"solve", "c.qrr", "--take", take, "--source", "p.qrs", "--csv"}).m_Out;
	EXPECT_EQ(std::ranges::count(csv, '\n'), 62);
	double worst = 0.0;
	std::istringstream lines(csv);
	for (std::string line; std::getline(lines, line);)
		if (std::isdigit(line[0]))
		{
			std::string value;
			std::istringstream values(line);
			for (int i = 0; i < 5; ++i)
				std::getline(values, value, ',');
			double number = 0.0;
			ASSERT_TRUE(NumberText::ScanWholeReal(value, number)) << value;
			worst = std::max(worst, number);
		}
	EXPECT_NEAR(solved.at("targets")[0].at("max").get<double>(), worst, 1e-6);
	const std::vector<std::string> solve{"solve", "c.qrr", "--take", take, "--source", "p.qrs"};
	const auto with = [&](std::vector<std::string> i_More)
	{
		i_More.insert(i_More.begin(), solve.begin(), solve.end());
		return i_More;
	};
	folder.Write("joints.json", R"({"pairs": [{"source": "Hips", "target": "Hips"}]})");
	folder.Write("tail.json", R"({"pairs": [{"source": "Tail", "target": "Hips"}]})");
	folder.Write("weights.json", "{\n\"pairs\": [{\"source\": \"Hips\", \"target\": \"Hips\", \"rotation\": 1}]}");
	const std::vector<VRow> rows{
	    {"range", with({"--frames", "10:19", "-q"}), 0, "Frames 10 to 19 at 120 Hz", ""},
	    {"within", with({"--max-position", "1e6", "--max-rotation", "180", "-q"}), 0, "0 of 61 frames", ""},
	    {"beyond", with({"--max-position", "0", "-q"}), 1, "Targets, how far",
	        "Targets are off by more than they may: #"},
	    {"beyond the take", with({"--frames", "10:61"}), 2, "", "the take has the frames 0 to 60, not 10 to 61"},
	    {"no frames", with({"--frames", "ten"}), 2, "", "\"ten\" is not FIRST:LAST"},
	    {"no rest", with({"--rest-frame", "61"}), 2, "", "The take has no frame 61"},
	    {"no joint", with({"--joint", "Tail:Hips"}), 2, "", "The take has no joint \"Tail\""},
	    {"no pair", with({"--joint", "Hips"}), 2, "", "\"Hips\" is not JOINT:SEGMENT"},
	    {"joints", with({"--joints", "joints.json", "-q"}), 0, "0 of 61 frames", ""},
	    {"no joint of a file", with({"--joints", "tail.json"}), 2, "", "The take has no joint \"Tail\""},
	    {"weights of joints", with({"--joints", "weights.json"}), 3, "",
	        "weights.json:2: A joint drives a segment whole"},
	    {"no mapping", with({"--joints", take}), 3, "", "chest_yxz_120fps.bvh:1: "},
	    {"nobody's targets", {"solve", "c.qrr", "--take", RETARGET_SOURCE "/demo/walk.bvh"}, 3, "",
	        "No target can be solved with this performer. Target #0 is left out"},
	    {"no skin", with({"-o", "walk.glb", "--skins", "."}), 3, "", "--skins: there is no \""},
	    {"two results", with({"--csv", "--json"}), 2, "", "--csv and --json both print the result"},
	    {"no drawing", with({"--plot", "c.qrr"}), 2, "", "is an input that saving there would destroy"},
	    {"no character", with({"-o", "walk.glb"}), 2, "", "that form holds the character, too: --fbx names its"},
	    {"no performer", {"performer", take, "-o", "p.bvh"}, 2, "", "let the name of its file end in .qrs"},
	};
	RunRows(rows, folder);
	EXPECT_EQ(folder.Run(with({"--plot", "plot.svg"})).m_Status, 0);
	EXPECT_TRUE(folder.Read("plot.svg").starts_with("<svg "));
	// The same by the folder where the file lies.
	EXPECT_EQ(folder.Run(with({"-o", "named.glb", "--fbx", c_Fbx, "-q"})).m_Status, 0);
	const std::string skins = std::string(c_Fbx).substr(0, std::string(c_Fbx).rfind('/'));
	EXPECT_EQ(folder.Run(with({"-o", "found.glb", "--skins", skins, "-q"})).m_Status, 0);
	EXPECT_EQ(folder.Read("found.glb"), folder.Read("named.glb"));
	// What is handed on is the character's file with that motion, and reads as such.
	EXPECT_EQ(folder.Run(with({"-o", "walk.fbx", "--fbx", c_Fbx, "-q"})).m_Status, 0);
	const VJson motion =
	    RunJson({"take", "walk.fbx", "--stack", "chest_yxz_120fps", "--rate", "120", "--json", "-q"}, folder);
	EXPECT_EQ(motion.at("frames"), 61);
}

TEST(Dump, SpellsAsTheSchemaDoes)
{
	const VScratchFolder folder;
	const VJson whole = RunJson({"dump", c_Performer}, folder);
	const VJson& rSubject = whole.at("SubjectParametrised");
	EXPECT_EQ(rSubject.at("Name"), "Template");
	EXPECT_EQ(rSubject.at("SubjectId"), 0x0FFFFFFF);
	ASSERT_EQ(rSubject.at("Segments").size(), 31u);
	const VJson& rArm = rSubject["Segments"][2];
	EXPECT_EQ(rArm.at("Name"), "LeftUpLeg");
	EXPECT_EQ(rArm.at("ParentSegmentIndex"), 1);
	EXPECT_EQ(rArm.at("Joint").at("JointType"), "Ball");
	EXPECT_EQ(rSubject["Segments"][0]["ParentSegmentIndex"], 0xFFFFFFFF);
	EXPECT_EQ(whole.at("SubjectApplicationData").at("Segments")[1].at("Colour"), VJson({0, 128, 255, 255}));
	EXPECT_EQ(whole["SubjectApplicationData"]["Segments"][0]["DrawStyle"], "DrawStyleTetraStripe");

	const VJson evaluated = RunJson({"dump", "--evaluated", c_Performer}, folder);
	EXPECT_EQ(evaluated.size(), 1u);
	ExpectNear(evaluated.at("Subject").at("Segments")[2].at("PreTranslation"), {76.9372, -47.3733, -101.2969}, 1e-9);
	EXPECT_EQ(evaluated["Subject"]["Segments"][2]["Joint"]["JointType"], "Ball");
}

/// A root turned by 90 degrees about Z with a hinge about Z behind it: all poses are known without a computer.
TEST(Fk, PosesOfAHandMadeArm)
{
	const VScratchFolder folder;
	folder.Write(
	    "arm.qrs", R"(<KinematicModel VERSION="3.5"><Parameters><StaticParameter NAME="Arm" VALUE="100"/></Parameters>
<Skeleton><Segment NAME="root"><JointFree NAME="j0" PRE-ORIENTATION="0 0 0" PRE-POSITION="0 0 0">
<JointTemplate BIND-POSE="0 0 1.5707963267948966 10 20 1000" PRE-ORIENTATION="0 0 0" PRE-POSITION="0 0 0"/></JointFree>
<Segment NAME="arm"><JointHinge NAME="j1" AXIS="0 0 1" PRE-ORIENTATION="0 0 0" PRE-POSITION="100 0 0">
<JointTemplate BIND-POSE="1.5707963267948966" PRE-ORIENTATION="0 0 0" PRE-POSITION="Arm 0 0"/></JointHinge></Segment>
</Segment></Skeleton><MarkerSet><Markers><Marker NAME="loose"/><Marker NAME="flat"/><Marker NAME="tip"/><Marker NAME="lost"/>
</Markers></MarkerSet><TargetSet><Targets>
<TargetLocalPointToWorldPoint NAME="broken" MARKER="lost" SEGMENT="arm" POSITION="Leg 0 0" WEIGHT="1" HIDDEN="false">
<TargetLocalPointToWorldPointTemplate/></TargetLocalPointToWorldPoint>
<TargetLocalPlaneToWorldPoint MARKER="flat" SEGMENT="arm" ORIGIN="0 0 0" NORMAL="0 0 1" WEIGHT="1" HIDDEN="false">
<TargetLocalPlaneToWorldPointTemplate/></TargetLocalPlaneToWorldPoint>
<TargetLocalPointToWorldPoint MARKER="tip" SEGMENT="arm" POSITION="50 0 0" WEIGHT="1" HIDDEN="false">
<TargetLocalPointToWorldPointTemplate/></TargetLocalPointToWorldPoint>
<TargetLocalDirectionToWorldDirection NAME="gaze" SEGMENT="arm" DIRECTION="0 0 1" WEIGHT="1" HIDDEN="false"
DIRECTION-OBSERVATION="look"/>
<TargetLocalRotationToWorldRotation SEGMENT="arm" ROTATION="0 0 1.5707963267948966" WEIGHT="1" HIDDEN="false"
ROTATION-OBSERVATION="aim"/></Targets></TargetSet></KinematicModel>)");
	const VRun run = folder.Run({"fk", "arm.qrs"});
	const std::string reason = "Parse Error at column 4: ID \"Leg\" was referenced but never declared\n";
	EXPECT_EQ(run.m_Err,
	    "warning QRTIO: Target 'broken' has the invalid state expression 'Leg': " + reason
	        + "warning retarget: Target #0 \"broken\" is left out: its state does not evaluate: " + reason
	        + "warning retarget: Target #3 \"gaze\" is left out: it does not fit its type, or has one without "
	          "kinematics\n");
	const VJson bind = VJson::parse(run.m_Out);
	ASSERT_EQ(bind.at("segments").size(), 2u);
	EXPECT_EQ(bind["segments"][1].at("name"), "arm");
	ExpectNear(bind["segments"][0].at("rotation"), {0, -1, 0, 1, 0, 0, 0, 0, 1}, 1e-12);
	ExpectNear(bind["segments"][0].at("translation"), {10, 20, 1000}, 1e-12);
	ExpectNear(bind["segments"][1]["rotation"], {-1, 0, 0, 0, -1, 0, 0, 0, 1}, 1e-12);
	ExpectNear(bind["segments"][1]["translation"], {10, 120, 1000}, 1e-12);
	ASSERT_EQ(bind.at("markers").size(), 4u);
	EXPECT_EQ(bind["markers"][3].at("valid"), false) << "its target is left out";
	EXPECT_EQ(bind["markers"][0].at("name"), "loose");
	EXPECT_EQ(bind["markers"][0].at("valid"), false);
	EXPECT_EQ(bind["markers"][1].at("valid"), false) << "a plane is no place";
	EXPECT_EQ(bind["markers"][2].at("valid"), true);
	ExpectNear(bind["markers"][2].at("position"), {-40, 120, 1000}, 1e-12);
	ASSERT_EQ(bind.at("rotations").size(), 2u);
	EXPECT_EQ(bind["rotations"][0].at("name"), "look");
	EXPECT_EQ(bind["rotations"][0].at("valid"), false);
	EXPECT_EQ(bind["rotations"][0].at("rotation"), VJson({1.0, 0.0, 0.0, 0.0, 1.0, 0.0, 0.0, 0.0, 1.0}));
	EXPECT_EQ(bind["rotations"][1].at("valid"), true);
	ExpectNear(bind["rotations"][1].at("rotation"), {0, 1, 0, -1, 0, 0, 0, 0, 1}, 1e-12);

	const VJson own = RunJson({"fk", "arm.qrs", "--state", "0,0,0,0,0,0,-1.5707963267948966"}, folder);
	ExpectNear(own["segments"][1]["translation"], {100, 0, 0}, 1e-12);
	ExpectNear(own["markers"][2]["position"], {100, -50, 0}, 1e-12);

	const VRun rest = folder.Run({"fk", "arm.qrs", "--pose", "tpose"});
	EXPECT_EQ(rest.m_Status, 0);
	EXPECT_NE(rest.m_Err.find("\"arm.qrs\" holds no tpose pose: zeros take its place"), std::string::npos);
}

/// One target of each kind on two segments, of which the second is turned by 90 degrees about Z and holds its points
/// 9 mm off. All distances are known without a computer.
TEST(Targets, ResidualsOfEveryKind)
{
	const VScratchFolder folder;
	const std::string joint = R"(PRE-ORIENTATION="0 0 0" PRE-POSITION="0 0 0")";
	const std::string atRest = R"(<JointTemplate BIND-POSE="0 0 0 0 0 0" )" + joint + "/></JointFree>";
	const auto at = [&](const std::string& i_rName, const std::string& i_rPosition)
	{
		return "<Segment NAME=\"" + i_rName + "\"><JointDummy NAME=\"j" + i_rName
		    + R"(" PRE-ORIENTATION="0 0 0" PRE-POSITION=")" + i_rPosition
		    + R"("><JointTemplate PRE-ORIENTATION="0 0 0" PRE-POSITION=")" + i_rPosition
		    + "\"/></JointDummy></Segment>";
	};
	folder.Write("source.qrs",
	    R"(<KinematicModel VERSION="3.5"><Skeleton><Segment NAME="base"><JointFree NAME="j" )" + joint + ">" + atRest
	        + at("P", "30 40 100") + at("Q", "0 0 7") + at("R", "0 0 0")
	        + "</Segment></Skeleton><MarkerSet><Markers/></MarkerSet><TargetSet><Targets/></TargetSet></"
	          "KinematicModel>");
	folder.Write("kinds.qrr",
	    R"(<KinematicModel VERSION="3.5"><Skeleton><Segment NAME="root"><JointFree NAME="j0" )" + joint + ">" + atRest
	        + R"(<Segment NAME="bent"><JointDummy NAME="j1" PRE-ORIENTATION="0 0 1.5707963267948966" PRE-POSITION="0 0 0">
<JointTemplate PRE-ORIENTATION="0 0 1.5707963267948966" PRE-POSITION="0 0 0" INVERSE-POST-POSITION="0 0 -9"/>
</JointDummy></Segment></Segment></Skeleton><MarkerSet><Markers><Marker NAME="P"/><Marker NAME="Q"/><Marker NAME="R"/>
<Marker NAME="nowhere"/></Markers></MarkerSet><TargetSet><Targets>
<TargetLocalPlaneToWorldPoint MARKER="P" SEGMENT="root" ORIGIN="0 0 60" NORMAL="0 0 2" WEIGHT="1" HIDDEN="false">
<TargetLocalPlaneToWorldPointTemplate/></TargetLocalPlaneToWorldPoint>
<TargetLocalLineToWorldPoint MARKER="P" SEGMENT="root" ORIGIN="0 0 1" DIRECTION="0 0 3" WEIGHT="1" HIDDEN="false">
<TargetLocalLineToWorldPointTemplate/></TargetLocalLineToWorldPoint>
<TargetRigidBody SEGMENT="root" POSITION="0 0 -5" ORIENTATION="0 0 0" HIDDEN="false">
<RigidBodyMarker NAME="P" POSITION="30 40 105"/><RigidBodyMarker NAME="Q" POSITION="0 0 11"/>
<RigidBodyMarker NAME="R" POSITION="0 3 5"/></TargetRigidBody>
<TargetRigidBody SEGMENT="root" POSITION="0 0 0" ORIENTATION="0 0 0" HIDDEN="false">
<RigidBodyMarker NAME="P" POSITION="30 40 100"/><RigidBodyMarker NAME="Q" POSITION="0 0 7"/>
<RigidBodyMarker NAME="nowhere" POSITION="0 0 0"/></TargetRigidBody>
<TargetLocalRotationToWorldRotation SEGMENT="root" ROTATION="0 0 0.5" WEIGHT="1" ROTATION-OBSERVATION="base"
HIDDEN="false"/>
<TargetLocalDirectionToWorldDirection SEGMENT="root" DIRECTION="0 0 1" WEIGHT="1" DIRECTION-OBSERVATION="base"
HIDDEN="false"/>
<TargetLocalRotationToWorldRotation NAME="axis" SEGMENT="bent" ROTATION="0 0 0" AXIS="0 1 0" WEIGHT="1"
ROTATION-OBSERVATION="base" HIDDEN="false"/>
<TargetLocalPointToWorldPoint NAME="post" MARKER="Q" SEGMENT="bent" POSITION="3 0 -2" WEIGHT="1" HIDDEN="false">
<TargetLocalPointToWorldPointTemplate/></TargetLocalPointToWorldPoint>
<TargetLocalPlaneToWorldPoint NAME="flat" MARKER="P" SEGMENT="root" ORIGIN="0 0 60" NORMAL="0 0 0" WEIGHT="1"
HIDDEN="false"><TargetLocalPlaneToWorldPointTemplate/></TargetLocalPlaneToWorldPoint>
</Targets></TargetSet></KinematicModel>)");

	const VRun run = folder.Run({"targets", "kinds.qrr", "--source", "source.qrs", "--json"});
	EXPECT_EQ(run.m_Status, 0) << run.m_Err;
	const VJson targets = VJson::parse(run.m_Out, nullptr, false);
	ASSERT_EQ(targets.size(), 9u);
	struct VRow
	{
		const char* m_pName;
		std::optional<double> m_Distance;
		std::optional<double> m_Angle;
		std::optional<double> m_Target;
	};
	// The trace of a quarter turn about Z times the axes (-r, 0, r), (r, 0, r), (0, 1, 0) with r = 1 / sqrt 2 is r.
	const double behindAxis = std::acos((std::sqrt(0.5) - 1.0) / 2.0) * 180.0 / M_PI;
	std::size_t i = 0;
	for (const VRow& rRow :
	    {VRow{"plane", 40.0, {}, 40.0}, VRow{"line", 50.0, {}, 50.0}, VRow{"body: the worst marker", 3.0, {}, 3.0},
	        VRow{"body with an unknown marker", {}, {}, {}}, VRow{"rotation", {}, 90.0 / M_PI, 90.0 / M_PI},
	        VRow{"direction", {}, {}, {}}, VRow{"rotation with an axis", {}, 90.0, behindAxis},
	        VRow{"point behind a post pose", 3.0, {}, std::hypot(3.0, 18.0)},
	        VRow{"plane without a direction", {}, {}, {}}})
	{
		SCOPED_TRACE(rRow.m_pName);
		const VJson& rTarget = targets[i++];
		const auto expect = [&](const char* i_pKey, const std::optional<double>& i_rExpected)
		{
			ASSERT_EQ(rTarget.at(i_pKey).is_null(), !i_rExpected) << i_pKey << " " << rTarget.at(i_pKey);
			if (i_rExpected)
			{
				EXPECT_NEAR(rTarget.at(i_pKey).get<double>(), *i_rExpected, 1e-9) << i_pKey;
			}
		};
		expect("distance", rRow.m_Distance);
		expect("angle", rRow.m_Angle);
		expect("targetResidual", rRow.m_Target);
	}
	EXPECT_EQ(targets[2].at("source"), "P, Q, R");
	EXPECT_EQ(VJson::parse(run.m_Err),
	    VJson({{"level", "warning"}, {"category", "retarget"},
	        {"text",
	            "A solver sees targets elsewhere than their offsets say, at worst #6 \"axis\": 90.000 deg by the "
	            "offset, "
	            "98.421 deg by the target's kinematics; post poses of segments and orientations of rotation targets do "
	            "this"}}));
}

TEST(Convert, WritesAnyVersionAndTellsWhatItLoses)
{
	const VScratchFolder folder;
	const VRun old = folder.Run({"convert", c_Performer, "old.qrs", "--format-version", "2.6"});
	EXPECT_EQ(old.m_Status, 0);
	EXPECT_NE(old.m_Err.find("warning retarget: Version 2.6 of the format cannot hold: the model version, "),
	    std::string::npos)
	    << old.m_Err;
	EXPECT_NE(folder.Read("old.qrs").find("VERSION=\"2.6\""), std::string::npos);

	const VRun same = folder.Run({"convert", c_Performer, "same.qrs"});
	EXPECT_EQ(same.m_Status, 0);
	EXPECT_EQ(same.m_Err, "");
	EXPECT_EQ(RunJson({"dump", "same.qrs"}, folder), RunJson({"dump", c_Performer}, folder));
	const VRun text = folder.Run({"convert", "same.qrs", "-"});
	EXPECT_EQ(text.m_Out, folder.Read("same.qrs")) << "to standard output";
	EXPECT_EQ(folder.Run({"convert", "same.qrs", "same.qrs"}).m_Status, 0);
	EXPECT_EQ(text.m_Out, folder.Read("same.qrs")) << "onto itself";
	EXPECT_EQ(folder.Names(), (std::vector<std::string>{"old.qrs", "same.qrs"}));

	create_directory(folder / "new");
	const VRun many = folder.Run({"convert", "old.qrs", "nothing.qrs", "same.qrs", "new"});
	EXPECT_EQ(many.m_Status, 3) << many.m_Err;
	EXPECT_EQ(many.m_Out, "3 files: 2 converted, 1 not\n");
	EXPECT_EQ(folder.Read("new/same.qrs"), folder.Read("same.qrs"));
	folder.Write("new/old.qrs", "mine");
	RunRows(
	    {
	        {"strict", {"--strict", "convert", "same.qrs", "strict.qrs", "--format-version", "2.6"}, 1, "",
	            "\nerror retarget: --strict: "},
	        {"report", {"--json", "convert", c_Performer, "new"}, 0, "\"output\": \"new/performer.qrs\"", ""},
	        {"no folder", {"convert", "old.qrs", "same.qrs", "x.qrs"}, 2, "", "\"x.qrs\" is no folder"},
	        {"one place", {"convert", "same.qrs", "new/same.qrs", "new"}, 2, "", "two files would be written to"},
	        {"no output", {"convert", "same.qrs"}, 2, "", "OUT is missing"},
	        {"another's", {"convert", "old.qrs", "new"}, 4, "", "is not a skeleton file"},
	    },
	    folder);

	folder.Write("broken.qrx",
	    "{\"Version\":[1,0,1],\"Schema\":\"Retarget\"}\n"
	    "{\"SubjectParametrised\":{\"Segments\":[{\"Name\":\"a\",\"Bounds\":[\"x\",\"0\",\"0\",\"0\",\"0\",\"0\"]}]}}");
	const VRun refused = folder.Run({"convert", "broken.qrx", "broken.qrr"});
	EXPECT_EQ(refused.m_Status, 4);
	EXPECT_NE(
	    refused.m_Err.find("error retarget: \"broken.qrr\" is not written, since nobody could read it again (Parse "
	                       "Error at column 2: ID \"x\" was referenced but never declared): mend "),
	    std::string::npos)
	    << refused.m_Err;
	EXPECT_EQ(folder.Names().size(), 4u);
	const VRun forced = folder.Run({"convert", "broken.qrx", "broken.qrr", "--force"});
	EXPECT_EQ(forced.m_Status, 0);
	EXPECT_NE(forced.m_Err.find("warning retarget: Nobody can read \"broken.qrr\" again: Parse"), std::string::npos);
	EXPECT_EQ(folder.Run({"dump", "broken.qrr"}).m_Status, 3);
}

TEST(Schema, ToFileAndStandardOutput)
{
	const VScratchFolder folder;
	const VRun run = folder.Run({"schema"});
	EXPECT_EQ(run.m_Status, 0);
	EXPECT_NE(run.m_Out.find("<xsd:schema"), std::string::npos) << run.m_Out.substr(0, 300);
	EXPECT_EQ(folder.Run({"schema", "-o", "s.xsd"}).m_Status, 0);
	EXPECT_EQ(folder.Read("s.xsd"), run.m_Out);
	EXPECT_EQ(folder.Run({"schema", "-o", "-"}).m_Out, run.m_Out);

	// The help's example holds for the demo's files of these names.
	for (const char* const pName : {"performer.qrs", "mapping.json", "character.fbx"})
		folder.Write(pName, Get(std::string(RETARGET_SOURCE "/demo/") + pName));
	EXPECT_EQ(folder
	              .Run({"-q", "create", "--fbx", "character.fbx", "--source", "performer.qrs", "--edits",
	                  "mapping.json", "-o", "hero.qrr"})
	              .m_Status,
	    0);
	std::istringstream help(folder.Run({"schema", "--help"}).m_Out);
	std::string example;
	while (std::getline(help, example) && example.find("xmllint ") == std::string::npos)
		;
	EXPECT_EQ(std::system(("cd '" + folder.Path().string() + "' && PATH=\"$(dirname '" RETARGET_PROGRAM "'):$PATH\" && "
	              + example + " 2> messages")
	                          .c_str()),
	    0)
	    << example << folder.Read("messages");
}

} // namespace
