#include "../UtilsFileSystem/Folder.h"
#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/HelpFormatter.h"
#include "CommandLineText/Messages.h"
#include "CommandLineText/ProgressBar.h"
#include "CommandLineText/Suggest.h"
#include "retarget/subject/Elements.h"
#include "retarget/text/Output.h"
#include "retarget/text/Table.h"

#include "SetupProposal/Side.h"

#include <gtest/gtest.h>

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cstdlib>
#include <fcntl.h>
#include <limits>
#include <map>
#include <regex>
#include <set>
#include <unistd.h>

using namespace CommandLine;

namespace
{

template <typename TCall>
std::string RefusalOf(TCall&& i_rCall)
{
	try
	{
		i_rCall();
	}
	catch (const VCommandError& rError)
	{
		EXPECT_EQ(rError.Status(), EWrongUsage);
		return rError.what();
	}
	return "accepted";
}

TEST(Suggest, CountsEdits)
{
	EXPECT_EQ(EditDistance("kitten", "sitting"), 3u);
	EXPECT_EQ(EditDistance("LeftArm", "letfarm"), 1u) << "neighbours swapped, case ignored";
	EXPECT_EQ(EditDistance("", "abc"), 3u);
	EXPECT_EQ(EditDistance("ca", "abc"), 3u) << "no part is edited twice";
}

TEST(Suggest, NamesTheClosestFirst)
{
	const std::vector<std::string> names{"Hips", "LeftArm", "RightArm", "LeftForeArm", "Head", "LeftArm"};
	EXPECT_EQ(Closest("LeftAmr", names), (std::vector<std::string>{"LeftArm", "RightArm", "LeftForeArm"}));
	EXPECT_EQ(Closest("Character1:Hips", names, 1), (std::vector<std::string>{"Hips"}));
	EXPECT_EQ(DidYouMean("hed", {"Head", "Hips"}), "; did you mean \"Head\" or \"Hips\"?");
	EXPECT_EQ(DidYouMean("hed", {}), "");
}

/// Calls the function with what the first group of the expression takes in each source of these folders.
template <typename TCall>
void ForEachInSources(const std::vector<std::string>& i_rFolders, const std::regex& i_rExpression, TCall&& i_rCall)
{
	for (const std::string& rFolder : i_rFolders)
		for (const auto& rEntry : boost::filesystem::recursive_directory_iterator(RETARGET_SOURCE "/" + rFolder))
			if (rEntry.path().extension() == ".cpp" || rEntry.path().extension() == ".h")
			{
				const std::string text = Get(rEntry.path());
				for (std::sregex_iterator it(text.begin(), text.end(), i_rExpression); it != std::sregex_iterator();
				     ++it)
					i_rCall((*it)[1].str());
			}
}

/// On a terminal. Its line is ended where a signal ends the program, and is gone where something else is told.
TEST(ProgressBar, LeavesTheLine)
{
	const int master = posix_openpt(O_RDWR | O_NOCTTY);
	ASSERT_TRUE(master >= 0 && grantpt(master) == 0 && unlockpt(master) == 0);
	const int terminal = open(ptsname(master), O_RDWR | O_NOCTTY);
	const int before = dup(STDERR_FILENO);
	dup2(terminal, STDERR_FILENO);
	setenv("TERM", "xterm", 1);
	AllowProgress();
	{
		VProgressBar bar("Reading");
		bar.Show(0.5);
		bar.Show(0.501);
		LeaveProgress();
		LeaveProgress();
		bar.Show(0.501);
	}
	dup2(before, STDERR_FILENO);
	close(before);
	close(terminal);
	// It comes in pieces, and ends where nobody has the terminal any more.
	std::string text;
	char piece[1000];
	for (ssize_t count = 0; (count = read(master, piece, sizeof piece)) > 0;)
		text.append(piece, std::size_t(count));
	close(master);
	const std::string bar = "\rReading " + std::string(20, '#') + std::string(20, '.') + "  50 %";
	EXPECT_EQ(text, bar + "\r\n" + bar + "\r\x1b[K");
}

/// A category that is not listed could not be given a level.
TEST(Messages, AllCategoriesAreKnown)
{
	std::set<std::string> found;
	ForEachInSources({"src", "apps"},
	    std::regex(R"x((?:NVX_LOG\(\s*|c_p?(?:Log)?Category = |GlobalLog::Category\()"([^"/]+)")x"),
	    [&](const std::string& i_rName) { found.insert(i_rName); });
	EXPECT_EQ(found, std::set<std::string>(std::begin(c_Categories), std::end(c_Categories)));
	const std::string page = Get(RETARGET_SOURCE "/docs/pipeline.md");
	for (const std::string& rName : found)
		EXPECT_NE(page.find("\n| `" + rName + "` | "), std::string::npos) << rName << " in docs/pipeline.md";
}

/// Each warning that a batch may meet has its row with cause and cure, and no row is of a warning that is gone.
TEST(Messages, AllWarningsAreExplained)
{
	std::string page = Get(RETARGET_SOURCE "/docs/pipeline.md");
	page.erase(0, page.find("## Every warning"));
	std::map<std::string, std::size_t> rows;
	const std::regex row("\n\\| `([^`]+)` \\| [^|]+ \\| [^|]+ \\|");
	for (std::sregex_iterator it(page.begin(), page.end(), row); it != std::sregex_iterator(); ++it)
		rows[(*it)[1]] = 0;
	ForEachInSources({"apps/retarget", "src/formats", "src/plugin/RetargetSetupCore", "src/scene/OrlexGraphics/skins",
	                     "src/base/FileSystemWatcher"},
	    std::regex(
	        R"x((?:NVX::ELogWarning,\s*|(?:Warnings\.(?:Add|push_back)|AddWarning)\([^";]*)((?:"(?:[^"\\]|\\.)*"\s*)+))x"),
	    [&](const std::string& i_rLiterals)
	    {
		    const std::string text = std::regex_replace(i_rLiterals, std::regex("\"\\s*\""), "");
		    if (text.starts_with("\"%1%\""))
			    return;
		    bool bExplained = false;
		    for (auto& [rPart, rUses] : rows)
			    if (text.find(rPart) != std::string::npos)
			    {
				    ++rUses;
				    bExplained = true;
			    }
		    EXPECT_TRUE(bExplained) << text << " is not in docs/pipeline.md";
	    });
	for (const auto& [rPart, uses] : rows)
		EXPECT_GT(uses, 0u) << rPart << " is told nowhere";
}

TEST(Side, StandsInAWordOfItsOwn)
{
	using enum SetupProposal::ESide;
	for (const auto& [pName, side] : {std::pair{"LeftArm", Left}, {"upperArmRight", Right}, {"RThumb", Right},
	         {"lThigh", Left}, {"thumb_01_l", Left}, {"Bip01 L UpperArm", Left}, {"Character1_RightArm", Right},
	         {"Lefthand", Left}, {"RIGHT_ARM", Right}, {"toe.R.001", Right}, {"Left:Spine", None}, {"Spine", None},
	         {"collar", None}, {"bright", None}, {"LR", None}, {"l_to_r", None}, {"Rigleft:Hips", None},
	         {"UpperLeg", None}, {"Neck_lower", None}, {"l", Left}, {"arm.L", Left}, {"LeftRightMid", None}, {"", None},
	         {"bras_gauche", Left}, {"Hand_rechts", Right}, {"右腕", Right}})
		EXPECT_EQ(SetupProposal::SideOfName(pName), side) << pName;
}

TEST(Elements, FindsByNameAndIndex)
{
	const VElements elements{"segment", {"Hips", "Arm", "Spine", "Arm", "a:b", "#x"}};
	EXPECT_EQ(FindElement("Spine", elements), 2u);
	EXPECT_EQ(FindElement("#3", elements), 3u);
	EXPECT_EQ(FindElement("#x", elements), 5u) << "only digits make an index";
	EXPECT_EQ(RefusalOf([&] { FindElement("Arm", elements); }),
	    "more than one segment is called \"Arm\": name one by its index (#1, #3)");
	EXPECT_EQ(RefusalOf([&] { FindElement("#6", elements); }),
	    "there is no segment #6; they go from #0 to #5, the last is \"#x\"");
	EXPECT_EQ(RefusalOf([&] { FindElement("#99999999999999999999", elements); }),
	    "there is no segment #99999999999999999999; they go from #0 to #5, the last is \"#x\"");
	EXPECT_EQ(RefusalOf([&] { FindElement("Spin", elements); }),
	    "there is no segment \"Spin\"; did you mean \"Spine\", \"Hips\" or \"Arm\"?");
	EXPECT_EQ(RefusalOf(
	              [&] {
		              FindElement("#0", {"segment", {}});
	              }),
	    "there is no segment #0; there is no segment at all");
}

TEST(Elements, SplitsWhereBothNamesExist)
{
	const VElements source{"source segment", {"Hips", "a", "a:b"}};
	const VElements target{"target segment", {"pelvis", "b:c", "c", "d"}};
	using VPair = std::pair<std::size_t, std::size_t>;
	EXPECT_EQ(FindPair("Hips:pelvis", source, target), VPair(0, 0));
	EXPECT_EQ(FindPair("a:b:d", source, target), VPair(2, 3));
	EXPECT_EQ(FindPair("#1:b:c", source, target), VPair(1, 1));
	EXPECT_EQ(FindPair("#2:#3", source, target), VPair(2, 3));
	EXPECT_EQ(RefusalOf([&] { FindPair("a:b:c", source, target); }),
	    "\"a:b:c\" can be split in more than one way: name a segment by its index, as #3");
	EXPECT_EQ(RefusalOf([&] { FindPair("Hips", source, target); }), "\"Hips\" is not SOURCE:TARGET");
	EXPECT_EQ(RefusalOf([&] { FindPair("Hips:pelvsi", source, target); }),
	    "there is no target segment \"pelvsi\"; did you mean \"pelvis\", \"b:c\" or \"c\"?");
	EXPECT_EQ(RefusalOf([&] { FindPair("hops:pelvis", source, target); }),
	    "there is no source segment \"hops\"; did you mean \"Hips\", \"a\" or \"a:b\"?");
	EXPECT_EQ(RefusalOf([&] { FindPair("Hips:#4", source, target); }),
	    "there is no target segment #4; they go from #0 to #3, the last is \"d\"");
}

TEST(Elements, ReadsNumbersThatAreFiniteOnly)
{
	EXPECT_EQ(ParseList("1,-2.5e1, 3", "pose"), (std::vector<double>{1, -25, 3}));
	for (const char* pWord : {"", "1,", "1,,2", "1;2", "nan", "inf", "1e999", "0,5,x", "1 "})
		EXPECT_NE(RefusalOf([&] { ParseList(pWord, "pose"); }), "accepted") << pWord;
	EXPECT_EQ(RefusalOf([] { ParseFinite("1,5", "weight"); }), "weight: \"1,5\" is not a finite number");
	EXPECT_EQ(SplitAssignment("a=b=1", "N=W"), (std::pair<std::string, std::string>("a=b", "1")));
	EXPECT_EQ(RefusalOf([] { SplitAssignment("=1", "N=W"); }), "\"=1\" is not N=W");
	EXPECT_EQ(ParseIndex("#2", "target", 3), 2u);
	for (const char* pWord : {"3", "#3"})
		EXPECT_EQ(RefusalOf([&] { ParseIndex(pWord, "target", 3); }), "there is no target #3; they go from #0 to #2");
	EXPECT_EQ(RefusalOf([] { ParseIndex("-1", "target", 3); }), "\"-1\" is not the index of a target");
}

TEST(Output, JsonHoldsWhatTextAndNumbersMayBe)
{
	CommandLine::VJson json = CommandLine::VJson::object();
	json["list"] = {1.5, std::numeric_limits<double>::quiet_NaN(), -std::numeric_limits<double>::infinity()};
	json["text"] = "a\xFF\"b";
	json["empty"] = CommandLine::VJson::array();
	EXPECT_EQ(
	    JsonText(json), "{\n \"list\": [1.5, null, null],\n \"text\": \"a\xEF\xBF\xBD\\\"b\",\n \"empty\": []\n}");
}

TEST(Table, FitsTheTerminal)
{
	VTable table;
	table.AddColumn("INDEX", VTable::ERight);
	table.AddColumn("NAME", VTable::ELeft);
	table.AddColumn("LENGTH", VTable::ERight);
	table.AddColumn("FOLLOWS", VTable::ELeft);
	table.AddRow({"0",
	    "H\xC3\xBC"
	    "fte",
	    "1.5", "Pelvis, Sacrum, Hip"});
	table.AddRow({"1", "  Spine", "10.0", ""});
	const std::string wide = "INDEX  NAME     LENGTH  FOLLOWS\n"
	                         "    0  H\xC3\xBC"
	                         "fte       1.5  Pelvis, Sacrum, Hip\n"
	                         "    1    Spine    10.0\n";
	EXPECT_EQ(table.Text(false), wide);
	EXPECT_EQ(table.Text(false, 43), wide);
	EXPECT_EQ(table.Text(false, 42),
	    "INDEX  NAME     LENGTH  FOLLOWS\n"
	    "    0  H\xC3\xBC"
	    "fte       1.5  Pelvis, Sacrum,\n"
	    "                        Hip\n"
	    "    1    Spine    10.0\n");
	EXPECT_EQ(table.Text(false, 24),
	    "INDEX  NAME     LENGTH\n       FOLLOWS\n"
	    "    0  H\xC3\xBC"
	    "fte       1.5\n       Pelvis, Sacrum,\n       Hip\n"
	    "    1    Spine    10.0\n");
	EXPECT_EQ(table.Text(true, 14).rfind("\033[1mINDEX  NAME\n       LENGTH\n       FOLLOWS\033[0m\n", 0), 0u);
}

TEST(HelpFormatter, FitsLines)
{
	EXPECT_EQ(FitLine("one two three", 7), "one two\nthree");
	EXPECT_EQ(FitLine("  fbx x    the bones of it", 20), "  fbx x\n      the bones of\n      it");
	EXPECT_EQ(FitLine("  fbx --root 'a b c d e' -o x", 20), "  fbx --root \\\n      'a b c d e' \\\n      -o x");
	EXPECT_EQ(FitLine("  short", 20), "  short");
}

TEST(HelpFormatter, WrapsAtBlanks)
{
	EXPECT_EQ(Wrap("one two three", 7, 2), "one two\n  three");
	EXPECT_EQ(Wrap("unbreakable", 4, 2), "unbreakable");
	EXPECT_EQ(Wrap("a\nb c", 10, 1), "a\n b c");
}

} // namespace
