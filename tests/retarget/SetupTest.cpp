#include "Rows.h"

#include "FileDigest/FileDigest.h"
#include "SetupIO/Limits.h"
#include "SetupIO/ReadSetup.h"
#include "SetupIO/WriteSetup.h"

#include <boost/filesystem/operations.hpp>

namespace
{

const std::string c_DemoFolder = RETARGET_SOURCE "/demo/";

TEST(Setup, TellsLineAndReasonOfWhatIsWrong)
{
	struct VWrong
	{
		std::string m_Text;
		std::size_t m_Line;
		std::string m_Reason;
	};
	const std::vector<VWrong> rows{
	    {"", 1, "no JSON"},
	    {"[]", 1, "an object in braces"},
	    {"{\n\"pairs\": [\n{\"source\": \"a\", \"target\": \"b\",}\n]}", 3, "no JSON: unexpected '}'"},
	    {"{\n\"pears\": []\n}", 2, "no field \"pears\"; there are pairs, edits, checks, comment, fbx"},
	    {"{\"fbx\": \"a\",\n\"fbx\": \"b\"}", 2, "\"fbx\" stands there twice, first in line 1"},
	    {"{\"fbx\":\n\n3}", 3, "\"fbx\" is to be a text"},
	    {"{\"root\": 1.5\n}", 1, "\"root\" is to be a count, not 1.5"},
	    {"{\"pairs\": [\n{\"source\": \"a\"}]}", 2, "a pair has no \"target\""},
	    {"{\"pairs\": [{\"source\": \"a\", \"target\": \"b\",\n\"position\": -1\n}]}", 2, "cannot be -1"},
	    {"{\"pairs\": [{\"source\": \"a\", \"target\": \"b\", \"rotation\": 1e400}]}", 1, "a number is larger"},
	    {"{\"edits\": [\n\n{\"align\": false}]}", 3, "true for an edit without a value"},
	    {"{\"edits\": [{\"scale\": 1,\n\"lift\": 2}]}", 2, "has \"scale\" and \"lift\""},
	    {"{\"checks\": {\"sounds\": true}}", 1, "no field \"sounds\""},
	    {"{\"root-height\": \"high\"}", 1, "\"keep\" or \"scale\""},
	    {"{\"comment\": \"\xFF\"}", 1, "no JSON"},
	    {"{\"pairs\": [{\"target\": \"b\"}]}", 1, "a pair has no \"source\""},
	    {"{\"pairs\": [{\"from\": \"a\"}]}", 1, "no field \"from\"; there are source, target"},
	    {"{\"edits\": [\n{\"comment\": \"c\"}]}", 2, "an edit has no name"},
	    {"{\"edits\": [{\"scale\": null}]}", 1, "\"scale\" is to be a text, a number, or true"},
	    {"{\"checks\": {\"comment\": \"c\", \"pose\": [\"knees\"]}}", 1, "called \"knees\"; there are facing, sides"},
	    {"{\"checks\": {\"targets\": 2e9}}", 1, "\"targets\" is to be a count, not 2"},
	    {std::string(std::size_t(SetupIO::Limits::c_FileBytes) + 1, ' '), 0, "it is larger than"},
	    {"{\"pairs\": " + std::string(40, '[') + "}", 1, "nested more than 16 deep"},
	};
	for (const VWrong& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_Text.substr(0, 80));
		SetupIO::VSetup setup;
		SetupIO::VFault fault;
		EXPECT_FALSE(SetupIO::ReadSetup(rRow.m_Text, setup, fault));
		EXPECT_EQ(fault.m_Line, rRow.m_Line);
		EXPECT_NE(fault.m_Reason.find(rRow.m_Reason), std::string::npos) << fault.m_Reason;
	}
	std::string many = "{\"comment\": [0";
	for (int i = 0; i < 500'000; ++i)
		many += ",0";
	SetupIO::VSetup setup;
	SetupIO::VFault fault;
	EXPECT_FALSE(SetupIO::ReadSetup(many + "]}", setup, fault));
	EXPECT_NE(fault.m_Reason.find("more than 500000 values"), std::string::npos) << fault.m_Reason;
}

constexpr const char* c_Recipe = R"({
	"comment": "The demo's character.",
	"fbx": "demo/character.fbx",
	"source": "demo/performer.qrs",
	"output": "out/hero.qrr",
	"root": 0,
	"root-height": "scale",
	"pairs": [{"source": "Pelvis", "target": "haunch", "position": 2, "comment": "heavy"}],
	"edits": [
		{"preset": "demo/mapping.json"}, {"prune-joints": true}, {"match-file-pose": true},
		{"align": true, "comment": "arms first"}, {"scale": 1.25}, {"update-targets": true}
	],
	"checks": {"sound": true, "segments": 39, "joints": 24, "targets": 34, "residual-mm": 0.001,
		"residual-degrees": 0.001, "pose": ["arms", "scale"]}
})";

TEST(Setup, WritesWhatItReads)
{
	SetupIO::VSetup setup;
	SetupIO::VFault fault;
	ASSERT_TRUE(SetupIO::ReadSetup(c_Recipe, setup, fault)) << fault.m_Reason;
	EXPECT_EQ(setup.m_Root, "#0");
	EXPECT_EQ(setup.m_Edits.at(4).m_Value, "1.25");
	EXPECT_EQ(setup.m_Edits.at(5).m_Line.m_Value, 11u);
	SetupIO::VSetup back;
	const std::string text = SetupIO::WriteSetup(setup);
	ASSERT_TRUE(SetupIO::ReadSetup(text, back, fault)) << fault.m_Reason << text;
	EXPECT_EQ(setup, back);
	EXPECT_EQ(SetupIO::WriteSetup(back), text);
}

class Recipe : public testing::Test
{
protected:
	Recipe()
	{
		boost::filesystem::create_directory_symlink(c_DemoFolder, m_Folder / "demo");
		boost::filesystem::create_directory(m_Folder / "out");
	}
	VRun Build(std::string i_Text, const std::vector<std::string>& i_rOptions = {"--json"})
	{
		m_Folder.Write("recipe.json", i_Text);
		std::vector<std::string> arguments{"build", "recipe.json"};
		arguments.insert(arguments.end(), i_rOptions.begin(), i_rOptions.end());
		return m_Folder.Run(arguments);
	}

	const VScratchFolder m_Folder;
};

TEST_F(Recipe, GivesTheBytesOfTheSameCommands)
{
	const VRun run = Build(c_Recipe);
	ASSERT_EQ(run.m_Status, 0) << run.m_Err;
	const VJson report = VJson::parse(run.m_Out);
	std::string error;
	EXPECT_EQ(report.at("inputs").at(1).at("file"), "demo/character.fbx");
	EXPECT_EQ(report.at("inputs").at(1).at("sha256"), FileDigest::Sha256(c_DemoFolder + "character.fbx", error));
	const VRun commands =
	    m_Folder.Run({"create", "--fbx", "demo/character.fbx", "--source", "demo/performer.qrs", "--root", "0",
	        "--root-height", "scale", "--position", "Pelvis:haunch", "--weight", "0=2", "--preset", "demo/mapping.json",
	        "--prune-joints", "--match-file-pose", "--align", "--scale", "1.25", "--update-targets", "-o", "same.qrr"});
	ASSERT_EQ(commands.m_Status, 0) << commands.m_Err;
	EXPECT_EQ(m_Folder.Read("out/hero.qrr"), m_Folder.Read("same.qrr"));
	// From another folder: paths are the recipe's.
	EXPECT_EQ(m_Folder.Run({"build", "./demo/../recipe.json", "-o", "again.qrr"}).m_Status, 3);
	m_Folder.Write("abc", "abc");
	EXPECT_EQ(FileDigest::Sha256(m_Folder / "abc", error),
	    "ba7816bf8f01cfea414140de5dae2223b00361a396177a9cb410ff61f20015ad");
	EXPECT_EQ(report.at("inputs").at(0).at("sha256"), FileDigest::Sha256OfBytes(m_Folder.Read("recipe.json")));
}

TEST_F(Recipe, WritesNothingWhereACheckDoesNotHoldOrNothingIsAskedFor)
{
	const auto with = [](const char* i_pFrom, const char* i_pTo)
	{
		std::string text = c_Recipe;
		return text.replace(text.find(i_pFrom), std::string(i_pFrom).size(), i_pTo);
	};
	struct VRow
	{
		std::string m_Text;
		std::vector<std::string> m_Options;
		int m_Status;
		std::string m_Err;
	};
	for (const VRow& rRow : {VRow{c_Recipe, {"--dry-run", "--json"}, 0, ""},
	         VRow{with("demo/performer.qrs", "none.qrs"), {}, 3, "recipe.json:4: \"none.qrs\" cannot be read"},
	         VRow{with("\"joints\": 24", "\"joints\": 25"), {}, 1, "there are 24 joints, not 25"},
	         VRow{with("\"scale\"]", "\"floor\", \"tail\"]"), {}, 3, "nothing of the pose is called \"tail\""},
	         VRow{with("{\"update-targets\": true}", "{\"pose\": \"upperArmLeft=0,0,1\"}"), {}, 1,
	             "of the checks do not hold"},
	         VRow{with("\"sound\": true", "\"no-warnings\": true"), {"-o", "out/hero.txt"}, 2, "end in .qrr"},
	         VRow{with("\"prune-joints\"", "\"prune-join\""), {}, 3,
	             "recipe.json:10: there is no edit \"--prune-join\""},
	         VRow{with("\"Pelvis\"", "\"Pelvos\""), {}, 2, "recipe.json:8: there is no source segment \"Pelvos\""},
	         VRow{with("\"root\": 0", "\"root\": \"nobody\""), {}, 2, "recipe.json:6: there is no bone \"nobody\""},
	         VRow{with("\"root\": 0", "\"root\": {}"), {}, 3, "recipe.json:6: \"root\" is to be"},
	         VRow{with("\"fbx\"", "\"subject\""), {}, 3, "recipe.json:6: \"root\" chooses a bone of an FBX file"},
	         VRow{with("\"fbx\": \"demo/character.fbx\",", ""), {}, 3, "either \"fbx\" or \"subject\""},
	         VRow{with("mapping.json", "recipe.json"), {}, 3, "demo/recipe.json"}})
	{
		SCOPED_TRACE(rRow.m_Err);
		const VRun run = Build(rRow.m_Text, rRow.m_Options);
		EXPECT_EQ(run.m_Status, rRow.m_Status) << run.m_Err;
		EXPECT_NE(run.m_Err.find(rRow.m_Err), std::string::npos) << run.m_Err;
		EXPECT_TRUE(boost::filesystem::is_empty(m_Folder / "out"));
	}
}

TEST_F(Recipe, IsDescribedByASchemaThatNamesEveryEdit)
{
	const VJson schema = VJson::parse(m_Folder.Run({"schema", "setup"}).m_Out);
	const VJson& rEdits = schema.at("properties").at("edits").at("items").at("properties");
	EXPECT_EQ(rEdits.at("align").at("const"), true);
	EXPECT_TRUE(rEdits.contains("match-file-pose"));
	const VJson recipe = VJson::parse(c_Recipe);
	for (const auto& [rName, rValue] : recipe.items())
		EXPECT_TRUE(schema.at("properties").contains(rName)) << rName;
}

TEST_F(Recipe, PresetsFitByNamesAndByProposal)
{
	ASSERT_EQ(Build(c_Recipe).m_Status, 0);
	const VJson saved = RunJson({"preset", "save", "out/hero.qrr", "-o", "preset.json", "--json"}, m_Folder);
	EXPECT_EQ(saved.at("pairs"), 24);
	EXPECT_EQ(VJson::parse(m_Folder.Read("preset.json")).at("pairs")[0],
	    VJson::parse(R"({"source": "Pelvis", "target": "haunch", "position": 2.0, "rotation": 1.0})"));
	// On the same character by names, on another one by proposal: what has no peer is listed.
	const auto apply = [&](const std::string& i_rFbx)
	{
		return RunJson({"create", "--fbx", i_rFbx, "--source", "demo/performer.qrs", "--preset", "preset.json", "-o",
		                   "x.qrr", "--json", "-q"},
		    m_Folder);
	};
	const VJson same = apply("demo/character.fbx");
	EXPECT_EQ(same.at("targets"), 34);
	EXPECT_TRUE(same.at("preset").at("proposed").empty());
	const VJson other = apply(Data("fbx/kenney_medium_b7400.fbx")).at("preset");
	EXPECT_EQ(other.at("pairs").get<std::size_t>() + other.at("missing").size(), 24u);
	EXPECT_GE(other.at("pairs"), 20);
	EXPECT_EQ(other.at("proposed")[0].at("foundTarget"), "Hips");
	RunJson({"create", "--fbx", c_Fbx, "-o", "bare.qrr", "--json", "-q"}, m_Folder);
	m_Folder.Write("empty.json", "{\"comment\": \"\",\n\"pairs\": []}");
	m_Folder.Write("root.json", "{\"root\": [], \"pairs\": []}");
	RunRows(
	    {{"a recipe", {"edit", "x.qrr", "--source", "demo/performer.qrs", "--preset", "recipe.json", "-o", "x.qrr"}, 3,
	         "", "recipe.json:3: \"fbx\" does not belong into a preset"},
	        {"no pairs", {"edit", "x.qrr", "--source", "demo/performer.qrs", "--preset", "empty.json", "-o", "x.qrr"},
	            3, "", "empty.json:2: a preset needs pairs"},
	        {"no joints", {"solve", "x.qrr", "--take", "demo/walk.bvh", "--joints", "empty.json"}, 3, "",
	            "empty.json:2: a mapping of joints needs pairs"},
	        {"a rubbish root",
	            {"edit", "x.qrr", "--source", "demo/performer.qrs", "--preset", "root.json", "-o", "x.qrr"}, 3, "",
	            "root.json:1: \"root\" is to be"},
	        {"another file", {"preset", "save", "x.qrr", "-o", "demo.qrr"}, 2, "", "end in .json"},
	        {"no target", {"preset", "save", "bare.qrr", "-o", "y.json"}, 1, "", "no position or rotation target"}},
	    m_Folder);
}

} // namespace
