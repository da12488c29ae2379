#include "Rows.h"
#include "retarget/Program.h"
#include "retarget/text/Completion.h"

#include <boost/algorithm/string/replace.hpp>
#include <boost/algorithm/string/split.hpp>

#include <algorithm>
#include <cstdlib>
#include <future>
#include <sstream>
#include <sys/wait.h>

namespace
{

std::vector<std::string> Create(std::vector<std::string> i_Edits)
{
	std::vector<std::string> arguments{"create", "--fbx", c_Fbx, "--source", c_Performer, "-o", "x.qrr"};
	arguments.insert(arguments.end(), i_Edits.begin(), i_Edits.end());
	return arguments;
}

TEST(Usage, HelpAndVersion)
{
	RunRows({
	    {"help", {"--help"}, 0, "retarget create --fbx hero.fbx --source performer.qrs", ""},
	    {"help of a command", {"create", "--help"}, 0, "--match-file-pose", ""},
	    {"help as a word", {"help", "fk"}, 0, "bind|mean|tpose", ""},
	    {"version", {"--version"}, 0, "retarget 0.", ""},
	    {"nothing", {}, 2, "", "Usage: retarget COMMAND"},
	    {"every help has examples", {"schema", "-h"}, 0, "Examples:\n  retarget schema", ""},
	});
}

TEST(Usage, WrongWords)
{
	RunRows({
	    {"unknown command", {"creat", "--fbx", "x"}, 2, "",
	        "error retarget: there is no command \"creat\"; did you mean \"create\"?; see \"retarget --help\"\n"},
	    {"nothing like a command", {"fkx1"}, 2, "", "there is no command \"fkx1\"; see"},
	    {"help of an unknown command", {"-q", "creat", "--help"}, 2, "", "there is no command \"creat\"; did you mean"},
	    {"help of the same as a word", {"help", "creat"}, 2, "", "there is no command \"creat\"; did you mean"},
	    {"unknown option", {"dump", "--evaluatd", "x"}, 2, "",
	        "error retarget: there is no option \"--evaluatd\"; did you mean \"--evaluated\"?"},
	    {"option of another command", {"edit", "x", "--match-file-pose", "-o", "y"}, 2, "", "--match-file-pose"},
	    {"not offered", {"paint", "x"}, 2, "", "error retarget: there is no command \"paint\"; see"},
	    {"too many", {"dump", "x", "y"}, 2, "", "error retarget: \"y\" is one argument too many; see"},
	    {"missing file", {"dump"}, 2, "", "error retarget: FILE is missing; see \"retarget dump --help\""},
	    {"missing output", {"create", "--fbx", c_Fbx}, 2, "", "error retarget: --output is missing; see"},
	    {"missing value", {"create", "--fbx"}, 2, "", "error retarget: --fbx needs a value: FILE; see"},
	    {"level", {"--log", "FBXIO=loud", "schema"}, 2, "", "\"FBXIO=loud\" is not CATEGORY=LEVEL"},
	    {"level behind -v", {"-v", "QRTIO=none", "schema"}, 2, "", "--log: \"QRTIO=none\" is not CATEGORY=LEVEL"},
	    {"category", {"schema", "--log", "QRTI=error"}, 2, "",
	        "there is no category \"QRTI\"; did you mean \"QRTIO\"?; the categories are Command, CoreGraphics, "},
	    {"log file", {"schema", "--log-file", "x.qrr"}, 2, "", "--log-file: \"x.qrr\" does not end in .log"},
	    {"log file without a name", {"schema", "--log-file="}, 2, "", "--log-file"},
	    {"log file in no folder", {"schema", "--log-file", "none/x.log"}, 4, "",
	        "\"none/x.log\" cannot be written: No such file or directory"},
	    {"report and file", {"schema", "--json"}, 2, "",
	        R"({"level":"error","category":"retarget","text":"--json reports on standard output, where -o - puts the )"},
	    {"what a terminal would obey", {"eval", "1+\x1b[31m"}, 3, "", "Unexpected token \" \""},
	    {"context", {"eval", "1", "--context", "cubic"}, 2, "",
	        "--context: there is no \"cubic\"; give static, linear or full; see"},
	    {"pose", {"fk", c_Performer, "--pose", "rest"}, 2, "", "there is no \"rest\""},
	    {"version", {"convert", c_Performer, "x.qrs", "--format-version", "3.6"}, 2, "",
	        "the format has no version \"3.6\", only 1.0 1.5 2.0"},
	    {"size", {"render", "x.qrr", "-o", "x.png", "--size", "64x9"}, 2, "",
	        "--size: \"64x9\" is not WIDTHxHEIGHT with 16 to 4096 pixels each"},
	    {"size in words", {"render", "x.qrr", "-o", "x.png", "--size", "64x64x"}, 2, "", "is not WIDTHxHEIGHT"},
	    {"take without a frame", {"render", "x.qrr", "-o", "x.png", "--take", "x.bvh"}, 2, "",
	        "--take goes with --frame"},
	    {"take without a performer", {"render", "x.qrr", "-o", "x.png", "--take", "x.bvh", "--frame", "1"}, 2, "",
	        "--take needs --source"},
	    {"strip", {"render", "x.qrr", "-o", "x.png", "--frames", "0:64:1"}, 2, "", "makes no strip of 1 to 64 frames"},
	    {"strip of the last number",
	        {"render", "x.qrr", "-o", "x.png", "--frames", "18446744073709551615:18446744073709551615:1"}, 2, "",
	        "--take goes with --frame"},
	    {"strip in words", {"render", "x.qrr", "-o", "x.png", "--frames", "0:9"}, 2, "", "is not FIRST:LAST:STEP"},
	    {"view", {"render", "x.qrr", "-o", "x.png", "--view", "side"}, 2, "", "--view: there is no \"side\"; "},
	    {"one file to compare", {"diff", c_Performer}, 2, "", "Give two files to compare, the earlier one first"},
	    {"two files to describe", {"diff", "--describe", "a.qrr", "b.qrr"}, 2, "", "--describe tells what one file"},
	    {"nothing to compare with", {"-q", "diff", c_Performer, "none.qrs"}, 3, "", "\"none.qrs\" could not be read"},
	    {"empty name", {"targets", "x.qrr", "--source", ""}, 2, "", "--source: the text is empty: give a name, or"},
	    {"state", {"fk", c_Performer, "--state", "1,2"}, 2, "", "take 67 numbers, not 2"},
	});
}

TEST(Usage, OutputsThatWouldDestroy)
{
	const VScratchFolder folder;
	folder.Write("hero.fbx", Get(c_Fbx));
	for (const char* pName : {"performer.qrs", "other.qrs", "hero.qrr", "subject.xsd", "subject.png"})
		folder.Write(pName, Get(c_Performer));
	for (const char* pName : {"other.fbx", "fbx.qrr"})
		folder.Write(pName, "Kaydara FBX Binary  ");
	folder.Write("empty.xsd", "");
	// A file that nobody can read from its beginning, whoever runs the test.
	boost::filesystem::create_symlink("/proc/self/mem", folder / "closed.qrr");
	folder.Write("COMMENTED.QRR", "\xEF\xBB\xBF<?xml version=\"1.0\"?>\n<!-- <Skeleton> -->\n<KinematicModel/>");
	const auto before = folder.Snapshot();
	RunRows(
	    {
	        {"the character", {"create", "--fbx", "hero.fbx", "-o", "./hero.fbx"}, 2, "",
	            "\"./hero.fbx\" is an input that saving there would destroy"},
	        {"the performer", {"create", "--fbx", "hero.fbx", "--source", "performer.qrs", "-o", "performer.qrs"}, 2,
	            "", "\"performer.qrs\" is an input"},
	        {"another character", {"create", "--fbx", "hero.fbx", "-o", "other.fbx"}, 2, "",
	            "error retarget: \"other.fbx\": what is written is a retarget subject; let the name of its file end in "
	            ".qrr\n"},
	        {"another performer", {"edit", "hero.qrr", "-o", "other.qrs", "--force"}, 2, "", "file end in .qrr"},
	        {"no extension", {"edit", "hero.qrr", "-o", ".qrr/hero"}, 2, "", "file end in .qrr"},
	        {"legacy name", {"convert", "performer.qrs", "x.qrx"}, 2, "", "file end in .qrt, .qrk, .qrs or .qrr"},
	        {"a character by convert", {"convert", "performer.qrs", "hero.fbx"}, 2, "", "file end in .qrt"},
	        {"a subject by its schema", {"schema", "-o", "hero.qrr"}, 2, "", "an XML schema; let the name of its file"},
	        {"a picture", {"render", "hero.qrr", "-o", "x.jpg"}, 2, "", "\"x.jpg\": what is written is a PNG picture"},
	        {"misnamed, create", {"create", "--fbx", "hero.fbx", "-o", "fbx.qrr"}, 4, "",
	            "error retarget: \"fbx.qrr\" is there, and is not a retarget subject: give another name, or --force to "
	            "replace it\n"},
	        {"misnamed, edit", {"edit", "hero.qrr", "-o", "fbx.qrr"}, 4, "", "is not a retarget subject"},
	        {"misnamed, schema", {"schema", "-o", "subject.xsd"}, 4, "", "is not an XML schema"},
	        {"misnamed, render", {"render", "hero.qrr", "-o", "subject.png"}, 4, "", "is not a PNG picture"},
	        {"misnamed, convert", {"convert", "performer.qrs", "fbx.qrr"}, 4, "", "is not a skeleton file"},
	        {"unreadable", {"edit", "hero.qrr", "-o", "closed.qrr"}, 4, "",
	            "\"closed.qrr\" is there but cannot be read, so that it may be anything; --force replaces it"},
	        {"another kind", {"convert", "performer.qrs", "hero.qrr"}, 4, "",
	            "\"hero.qrr\" is there, and is of another kind than \"performer.qrs\""},
	    },
	    folder);
	EXPECT_EQ(folder.Snapshot(), before);
	for (const std::vector<std::string>& rArguments : std::vector<std::vector<std::string>>{
	         {"schema", "-o", "empty.xsd"},
	         {"schema", "-o", "subject.xsd", "--force"},
	         {"schema", "-o", "subject.xsd"},
	         {"convert", "performer.qrs", "hero.qrr", "--force"},
	         {"create", "--fbx", "hero.fbx", "-o", "fbx.qrr", "--force"},
	         {"create", "--fbx", "hero.fbx", "-o", "COMMENTED.QRR"},
	     })
		EXPECT_EQ(folder.Run(rArguments).m_Status, 0) << rArguments[2];
	EXPECT_EQ(folder.Read("fbx.qrr"), folder.Read("COMMENTED.QRR"));
}

TEST(Usage, EditsThatNameWhatIsNotThere)
{
	RunRows({
	    {"source name", Create({"--position", "Hisp:Hips"}), 2, "",
	        "error retarget: there is no source segment \"Hisp\"; did you mean \"Hips\", "},
	    {"target name", Create({"--rotation", "Hips:pelvis"}), 2, "",
	        "there is no target segment \"pelvis\"; did you mean "},
	    {"second edit", Create({"--rotation", "Hips:Hips", "--rotation", "Head:Haed"}), 2, "",
	        "there is no target segment \"Haed\"; did you mean \"Head\", "},
	    {"index", Create({"--position", "#31:#0"}), 2, "",
	        "there is no source segment #31; they go from #0 to #30, the last is \"RThumb\""},
	    {"no pair", Create({"--position", "Hips"}), 2, "", "\"Hips\" is not SOURCE:TARGET"},
	    {"no source", {"create", "--fbx", c_Fbx, "-o", "x.qrr", "--position", "Hips:Hips"}, 2, "",
	        "--position needs the performer's skeleton: give it with --source FILE.qrs"},
	    {"no source to update", {"create", "--fbx", c_Fbx, "-o", "x.qrr", "--update-targets"}, 2, "",
	        "--update-targets needs the performer's skeleton"},
	    {"no targets", Create({"--remove-target", "0"}), 2, "", "there is no target #0; there is no target at all"},
	    {"target index", Create({"--position", "Hips:Hips", "--weight", "1=2"}), 2, "",
	        "there is no target #1; they go from #0 to #0"},
	    {"root name", Create({"--root", "Hip"}), 2, "", "there is no bone \"Hip\"; did you mean \"Hips\""},
	    {"root index", Create({"--root", "34"}), 2, "", "there is no bone #34; they go from #0 to #33"},
	    {"empty root", Create({"--root", ""}), 2, "", "there is no bone \"\""},
	});
}

TEST(Usage, EditsWithUnfitValues)
{
	RunRows({
	    {"scale 0", Create({"--scale", "0"}), 2, "", "--scale: a scale must be above 0: 0"},
	    {"scale -1", Create({"--scale", "-1"}), 2, "", "--scale: a scale must be above 0: -1"},
	    {"scale nan", Create({"--scale", "nan"}), 2, "", "--scale: \"nan\" is not a finite number"},
	    {"scale overflow", Create({"--scale", "1e999"}), 2, "", "--scale: \"1e999\" is not a finite number"},
	    {"scale word", Create({"--scale", "big"}), 2, "", "--scale: \"big\" is not a finite number"},
	    {"scale in German", Create({"--scale", "1,5"}), 2, "", "--scale: \"1,5\" is not a finite number"},
	    {"weight", Create({"--position", "Hips:Hips", "--weight", "0=-1"}), 2, "", "a weight cannot be negative: -1"},
	    {"weight form", Create({"--position", "Hips:Hips", "--weight", "0"}), 2, "", "\"0\" is not TARGET=WEIGHT"},
	    {"state count", Create({"--position", "Hips:Hips", "--state", "0=1,2"}), 2, "",
	        "--state: \"1,2\" is not three numbers"},
	    {"state word", Create({"--position", "Hips:Hips", "--state", "0=1,2,x"}), 2, "",
	        "--state: \"x\" is not a finite number"},
	    {"pose count", Create({"--pose", "LeftArm=1,2"}), 2, "", "the joint of \"LeftArm\" takes 3 numbers, not 2"},
	    {"pose of the root", Create({"--pose", "Hips=1,2,3,4"}), 2, "", "takes 3 or 6 numbers, not 4"},
	    {"pose without joint", Create({"--prune-joints", "--pose", "LeftArm=1,2,3"}), 2, "",
	        "--pose: \"LeftArm\" has no joint that could move"},
	    {"pose of nothing", Create({"--pose", "Lefty=1,2,3"}), 2, "", "there is no target segment \"Lefty\""},
	});
}

TEST(Usage, LevelsOfMessages)
{
	const VScratchFolder folder;
	const auto messages = [&](std::vector<std::string> i_Options)
	{
		std::vector<std::string> arguments{"create", "--fbx", Data("fbx/kenney_medium_b7400.fbx"), "-o", "x.qrr"};
		arguments.insert(arguments.begin(), i_Options.begin(), i_Options.end());
		return folder.Run(arguments).m_Err;
	};
	const std::string warning = "warning RetargetSetup: The file has 3 root bones";
	EXPECT_EQ(messages({}).rfind(warning, 0), 0u);
	EXPECT_EQ(messages({"-q"}), "");
	EXPECT_NE(messages({"-v"}).find("information FBXIO: Loading file"), std::string::npos);
	EXPECT_EQ(messages({"-v", "RetargetSetup=error"}), "");
	EXPECT_EQ(messages({"--log=RetargetSetup=error", "-v"}).rfind("information FBXIO", 0), 0u);
}

TEST(Usage, ManyAtOnceDoNotMeet)
{
	const VScratchFolder folder;
	const auto make = [&](std::size_t i_Index)
	{
		return folder.Run({"create", "--fbx", Data("fbx/kenney_medium_b7400.fbx"), "-v", "--log-file", "all.log", "-o",
		    std::to_string(i_Index) + ".qrr"});
	};
	std::vector<std::future<VRun>> runs;
	for (std::size_t i = 0; i < 8; ++i)
		runs.push_back(std::async(std::launch::async, make, i));
	std::vector<std::string> told, lines;
	for (std::size_t i = 0; i < runs.size(); ++i)
	{
		const VRun run = runs[i].get();
		EXPECT_EQ(run.m_Status, 0) << run.m_Err;
		boost::split(lines, run.m_Err, [](char i_Byte) { return i_Byte == '\n'; });
		told.insert(told.end(), lines.begin(), lines.end() - 1);
		EXPECT_EQ(folder.Read(std::to_string(i) + ".qrr"), folder.Read("0.qrr"));
	}
	boost::split(lines, folder.Read("all.log"), [](char i_Byte) { return i_Byte == '\n'; });
	lines.pop_back();
	EXPECT_GE(lines.size(), 16u);
	EXPECT_TRUE(std::ranges::is_permutation(lines, told)) << folder.Read("all.log");
}

TEST(Usage, WarningsAreErrorsWhereAsked)
{
	const VScratchFolder folder;
	const std::vector<std::string> create{
	    "create", "--fbx", Data("fbx/pab_arnaud_b7500.fbx"), "-o", "x.qrr", "--strict"};
	const auto with = [&](std::vector<std::string> i_Options)
	{
		i_Options.insert(i_Options.begin(), create.begin(), create.end());
		return i_Options;
	};
	RunRows(
	    {
	        {"a warning", with({}), 1, "", "error retarget: --strict: 2 warnings count as errors\n"},
	        {"a quiet one", with({"-q"}), 1, "", "error retarget: --strict: 2 warnings count as errors\n"},
	        {"as JSON", with({"-q", "--json"}), 1, "",
	            R"({"level":"error","category":"retarget","text":"--strict: 2 warnings count as errors","status":1})"},
	    },
	    folder);
	EXPECT_EQ(RunJson(with({"--match-file-pose", "--json"}), folder),
	    VJson({{"output", "x.qrr"}, {"segments", 54}, {"joints", 54}, {"targets", 0}}));
	// What only a save finds.
	folder.Write("x.qrr", Replaced((folder / "x.qrr").string(), "OPACITY=\"255\"", "OPACITY=\"0\""));
	folder.Write("x.qrr", Replaced((folder / "x.qrr").string(), "RGB=\"255 0 255\"", "RGB=\"0 0 0\""));
	RunRows({{"a save", {"edit", "x.qrr", "-o", "y.qrr", "--strict"}, 1, "", "--strict: 2 warnings count as errors"}},
	    folder);
}

TEST(Usage, FitsItsTerminal)
{
	if (std::system("command -v script > /dev/null") != 0)
		GTEST_SKIP() << "script is not installed, which makes terminals";
	const VScratchFolder folder;
	const auto run = [&](const char* i_pTerm, const char* i_pLine)
	{
		const std::string out = (folder / "out").string();
		const int status =
		    std::system((std::string("TERM=") + i_pTerm + " script -qec \"stty cols 60; '" RETARGET_PROGRAM "' "
		        + i_pLine + "\" /dev/null < /dev/null > '" + out + "'")
		                    .c_str());
		EXPECT_TRUE(WIFEXITED(status)) << i_pLine;
		return boost::algorithm::replace_all_copy(folder.Read("out"), "\r", "");
	};
	std::size_t widest = 0;
	std::istringstream help(run("xterm", "create --help"));
	for (std::string line; std::getline(help, line);)
		widest = std::max(widest, line.size());
	EXPECT_EQ(widest, 60u);
	const bool bColours = !std::getenv("NO_COLOR");
	for (const char* const pTerm : {"xterm", "dumb"})
		EXPECT_EQ(run(pTerm, "dump nothing").find("\033[") != std::string::npos, bColours && *pTerm == 'x') << pTerm;
}

TEST(Usage, ReasonsOfErrors)
{
	const VScratchFolder folder;
	folder.Write("cut.qrs", "<KinematicModel");
	const std::string read = "error QRTIO: Failed to read file\n"
	                         "error retarget: \"cut.qrs\" could not be read as a skeleton file\n";
	const std::string reason = "warning QRTIO: line 1: tag of element KinematicModel does not end\n";
	EXPECT_EQ(folder.Run({"dump", "cut.qrs"}).m_Err, reason + read);
	EXPECT_EQ(folder.Run({"dump", "cut.qrs", "-q"}).m_Err, reason + read);
	EXPECT_EQ(folder.Run({"dump", "cut.qrs", "--log", "QRTIO=error"}).m_Err, read) << "as asked";
	const VRun other = folder.Run({"-q", "create", "--fbx", Data("fbx/kenney_medium_b7400.fbx"), "-o", "no/x.qrr"});
	EXPECT_EQ(other.m_Status, 4);
	EXPECT_EQ(other.m_Err.find("root bones"), std::string::npos) << "is no reason: " << other.m_Err;
}

TEST(Usage, CompletionOffersWhatMayStandThere)
{
	const VScratchFolder folder;
	const auto copy = [&](const char* i_pName, const std::string& i_rFile) { folder.Write(i_pName, Get(i_rFile)); };
	copy("a b.qrs", c_Performer);
	copy("hero.fbx", Data("fbx/heaps_biped_zup_a7100.fbx"));
	ASSERT_EQ(folder.Run({"create", "--fbx", "hero.fbx", "--source", "a b.qrs", "--rotation", "Head:#0", "-o", "x.qrr"})
	              .m_Status,
	    0);
	const std::string create = "retarget create --fbx hero.fbx --source 'a b.qrs' --position ";
	const std::pair<std::string, const char*> rows[] = {
	    {"retarget cr", "create"},
	    {"retarget -q ed", "edit"},
	    {"retarget help conv", "convert"},
	    {"retarget --log QRTIO=detail cr", "create"},
	    {"retarget --log QR", "<-o nospace>QRTIO="},
	    {"retarget fk --log QRTIO=d", "detail"},
	    {"retarget create --up", "--update-targets"},
	    {"retarget fk x --pose m", "mean"},
	    {"retarget fk x --pose=t", "tpose"},
	    {"retarget render x --view bo", "bottom"},
	    {"retarget eval 1 --context l", "linear"},
	    {"retarget create --root-height ", "keep scale"},
	    {"retarget convert a b --format-version 3.5", "3.5"},
	    {"retarget render --skins f", "<-o dirnames>"},
	    {"retarget create --fbx h", "<-o default>"},
	    {"retarget dump ", "<-o default>"},
	    {"retarget dump x ", ""},
	    {"retarget create --fbx hero.fbx --root 'Bip001 L Ca", "Bip001 L Calf"},
	    {"retarget create --fbx hero.fbx --root Bip001\\ L\\ Ca", "Bip001\\ L\\ Calf"},
	    {create + "Hi", "<-o nospace>Hips:"},
	    {create + "Hips:Bip001\\ Pe", "Bip001\\ Pelvis"},
	    {create + "'Hips:Bip001 Pe", "Hips:Bip001 Pelvis"},
	    {create + "Nobody:", ""},
	    {"retarget edit x.qrr --weight ", "<-o nospace>0="},
	    {"retarget edit x.qrr --pose 'Bip001 L Ca", "<-o nospace>Bip001 L Calf="},
	    {"retarget edit nothing.qrr --pose B", ""},
	    {"retarget nothing --q", "--quiet"},
	};
	std::string script = folder.Run({"documentation", "bash"}).m_Out + "compopt() { printf '<%s>' \"$*\"; }\ncd '"
	    + folder.Path().string() + "'\nask() { COMP_LINE=\"$1 rest\"; COMP_POINT=${#1}; _retarget '" RETARGET_PROGRAM
	    + "'; echo \"${COMPREPLY[*]}\"; }\n";
	std::string expected;
	for (const auto& [rLine, pReply] : rows)
	{
		script += "ask \"" + boost::algorithm::replace_all_copy(rLine, "\\", "\\\\") + "\"\n";
		expected += std::string(pReply) + "\n";
	}
	folder.Write("script", script);
	EXPECT_EQ(
	    std::system(("bash '" + (folder / "script").string() + "' > '" + (folder / "out").string() + "' 2>&1").c_str()),
	    0);
	EXPECT_EQ(folder.Read("out"), expected);

	// The other shells' scripts ask the same; where a shell is there, it takes its own.
	EXPECT_EQ(folder.Run({"complete", "words", "fk", "x", "--pose", "m"}).m_Out, "mean\n");
	EXPECT_EQ(folder.Run({"complete", "words", ""}).m_Out.rfind("create\tBuild a target subject ", 0), 0u);
	EXPECT_EQ(folder.Run({"complete", "words"}).m_Out, "");
	for (const std::string shell : {"zsh", "fish"})
	{
		const VRun run = folder.Run({"documentation", shell});
		EXPECT_NE(run.m_Out.find(" complete words "), std::string::npos) << shell;
		folder.Write(shell, run.m_Out);
		EXPECT_EQ(std::system(
		              ("! command -v " + shell + " > /dev/null || " + shell + " -n '" + (folder / shell).string() + "'")
		                  .c_str()),
		    0);
	}
}

/// A value that completion does not know by its name in the help would silently offer nothing.
TEST(Usage, CompletionKnowsAllValues)
{
	const CommandLine::VProgram program = CommandLine::MakeProgram();
	std::vector<const CLI::App*> apps{program.m_pApp.get()};
	for (const CommandLine::VCommand& rCommand : program.m_Commands)
		apps.push_back(rCommand.m_pApp);
	for (const CLI::App* const pApp : apps)
		for (const CLI::Option* const pOption : pApp->get_options())
			EXPECT_TRUE(CommandLine::IsKnownValue(CommandLine::ValueName(*pOption)))
			    << pApp->get_name() << " " << CommandLine::ValueName(*pOption);
}

TEST(Usage, ManualTellsAllCommands)
{
	const VScratchFolder folder;
	const VRun manual = folder.Run({"documentation", "man"});
	ASSERT_EQ(manual.m_Status, 0);
	EXPECT_EQ(manual.m_Out.rfind(".TH RETARGET 1", 0), 0u);
	for (const char* pText : {".SS retarget create\n", ".SS retarget eval\n", "\\-\\-match\\-file\\-pose\n"})
		EXPECT_NE(manual.m_Out.find(pText), std::string::npos) << pText;
	EXPECT_EQ(manual.m_Out.find("documentation"), std::string::npos) << "a hidden command";
}

} // namespace
