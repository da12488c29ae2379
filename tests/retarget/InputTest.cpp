#include "Rows.h"

namespace
{

/// What a reader can meet at each entrance: the same files for every command that reads.
class Input : public testing::Test
{
protected:
	Input()
	{
		const std::string performer = Get(c_Performer);
		m_Folder.Write("empty", "");
		m_Folder.Write("wrong.qrs", "<Skeleton/>");
		m_Folder.Write("new.qrs", Replaced(c_Performer, "VERSION=\"3.5\"", "VERSION=\"3.6\""));
		m_Folder.Write("cut.qrs", performer.substr(0, performer.size() / 2));
		m_Folder.Write("text.qrs", "Once upon a time");
		m_Folder.Write("cut.fbx", Get(c_Fbx).substr(0, 70000));
		m_Folder.Write("new.qrx", "[[1,0,2],\"QRX\"]{}");
		m_Folder.Write("text.qrx", "Once upon a time");
	}

	VScratchFolder m_Folder;
};

TEST_F(Input, OfSkeletonFiles)
{
	struct VCase
	{
		const char* m_pFile;
		const char* m_pMessage;
	};
	const std::vector<VCase> cases{
	    {"nothing.qrs", "error QRTIO: Error opening file 'nothing.qrs' for reading"},
	    {".", "error QRTIO: Error opening file '.' for reading"},
	    {"empty", "error QRTIO: "},
	    {"wrong.qrs", "error QRTIO: "},
	    {"new.qrs", "error QRTIO: Cannot load QRT file with version 3.6, maximum supported version is 3.5"},
	    {"cut.qrs", "error QRTIO: Failed to read file"},
	    {"text.qrs", "error QRTIO: Failed to read file"},
	    {"nothing.qrx", "error RetargetSetup: "},
	    {"new.qrx", "error RetargetSetup: The legacy file 'new.qrx' is of a later version than 1.0.1"},
	    {"text.qrx", "error RetargetSetup: 'text.qrx' is not a legacy subject file, or is damaged"},
	};
	std::vector<VRow> rows;
	for (const VCase& rCase : cases)
	{
		const std::string file = rCase.m_pFile;
		rows.push_back({rCase.m_pFile, {"dump", file}, 3, "", rCase.m_pMessage});
		rows.push_back({rCase.m_pFile, {"check", file}, 3, "", rCase.m_pMessage});
		rows.push_back({rCase.m_pFile, {"fk", file}, 3, "", rCase.m_pMessage});
		rows.push_back({rCase.m_pFile, {"targets", file}, 3, "", rCase.m_pMessage});
		rows.push_back({rCase.m_pFile, {"convert", file, "x.qrs"}, 3, "", rCase.m_pMessage});
		rows.push_back({rCase.m_pFile, {"edit", file, "-o", "x.qrr"}, 3, "", rCase.m_pMessage});
	}
	rows.push_back({"as source", {"create", "--fbx", c_Fbx, "--source", "cut.qrs", "-o", "x.qrr"}, 3, "",
	    "error retarget: \"cut.qrs\" could not be read as a source skeleton"});
	RunRows(rows, m_Folder);
}

TEST_F(Input, OfFbxFiles)
{
	RunRows(
	    {
	        {"folder of skins", {"render", "x.qrr", "--skins", "nothing", "-o", "x.png"}, 3, "",
	            "error retarget: There is no folder \"nothing\" to look for skins in\n"},
	        {"missing", {"fbx", "nothing.fbx"}, 3, "", "error FBXIO: File nothing.fbx not found"},
	        {"folder", {"fbx", "."}, 3, "", "error FBXIO: File . not found"},
	        {"empty", {"fbx", "empty"}, 3, "", "error FBXIO: Call to KFbxImporter::Initialize() failed."},
	        {"other", {"fbx", "wrong.qrs"}, 3, "", "error FBXIO: Call to KFbxImporter::Initialize() failed."},
	        {"cut", {"fbx", "cut.fbx"}, 3, "\"upAxis\": 1",
	            "\"cut.fbx\" was read only in part; what was read is shown"},
	        {"create, missing", {"create", "--fbx", "nothing.fbx", "-o", "x.qrr"}, 3, "", "File nothing.fbx not found"},
	        {"create, cut", {"create", "--fbx", "cut.fbx", "-o", "x.qrr"}, 3, "",
	            "error retarget: \"cut.fbx\" could be read only in part"},
	        {"create, no bones", {"create", "--fbx", Data("fbx/ufbx_maya_pivot_offset_7700_ascii.fbx"), "-o", "x.qrr"},
	            3, "", "could not be read as FBX, or holds no skeleton"},
	    },
	    m_Folder);
}

TEST_F(Input, OutputThatCannotBeWritten)
{
	create_directory(m_Folder / "folder.xsd");
	RunRows(
	    {
	        {"no folder", {"create", "--fbx", c_Fbx, "-o", "no/x.qrr"}, 4, "",
	            "error QRTIO: Error opening file 'no/x.qrr' for writing"},
	        {"a folder", {"schema", "-o", "folder.xsd"}, 4, "", "Could not save 'folder.xsd': it is a folder"},
	        {"schema", {"schema", "-o", "no/x.xsd"}, 4, "",
	            "error retarget: Could not save 'no/x.xsd': there is no folder"},
	    },
	    m_Folder);
}

TEST_F(Input, FromStandardInput)
{
	const std::vector<std::string> create{"create", "--source", c_Performer, "--rotation", "Head:Head", "--fbx"};
	const auto with = [&](std::vector<std::string> i_Line, const std::vector<std::string>& i_rMore)
	{
		i_Line.insert(i_Line.end(), i_rMore.begin(), i_rMore.end());
		return i_Line;
	};
	ASSERT_EQ(m_Folder.Run(with(create, {c_Fbx, "-o", "x.qrr"})).m_Status, 0);
	struct VCase
	{
		std::vector<std::string> m_Line;
		std::string m_File;
	};
	for (const VCase& rCase : {VCase{{"dump"}, "x.qrr"}, {{"dump", "--evaluated"}, "x.qrr"}, {{"fk"}, "x.qrr"},
	         {{"segments"}, "x.qrr"}, {{"check"}, "x.qrr"}, {{"bones"}, c_Fbx}, {{"fbx", "--skin"}, c_Fbx},
	         {{"targets", "--source", c_Performer}, "x.qrr"}, {{"targets", "x.qrr", "--source"}, c_Performer},
	         {{"edit", "--scale", "2", "-o", "-"}, "x.qrr"}, {{"convert"}, "x.qrr"}})
	{
		SCOPED_TRACE(rCase.m_Line.front());
		const std::vector<std::string> behind =
		    rCase.m_Line.front() == "convert" ? std::vector<std::string>{"-"} : std::vector<std::string>();
		const VRun piped = m_Folder.Run(with(with(rCase.m_Line, {"-"}), behind), rCase.m_File);
		EXPECT_EQ(piped.m_Status, 0) << piped.m_Err;
		EXPECT_GT(piped.m_Out.size(), 10u);
		EXPECT_EQ(piped.m_Out, m_Folder.Run(with(with(rCase.m_Line, {rCase.m_File}), behind)).m_Out);
	}
	// The name of the descriptor goes into no subject.
	EXPECT_EQ(m_Folder.Run(with(create, {"-", "-o", "-"}), c_Fbx).m_Out,
	    Replaced((m_Folder / "x.qrr").string(), "<Skin NAME=\"own_ns_yup_cm_b7400\"/>", "<Skin/>"));
	EXPECT_EQ(m_Folder.Run({"create", "--fbx", c_Fbx, "--source", "-", "-o", "-"}, c_Performer).m_Out.find("TEMPLATE="),
	    std::string::npos);
	RunRows(
	    {
	        {"nothing", {"dump", "-"}, 3, "", "\"-\" could not be read as a skeleton file"},
	        {"no FBX", {"bones", "-"}, 3, "", "\"-\" could not be read as FBX", c_Performer},
	        {"twice", {"targets", "-", "--source", "-"}, 2, "", "standard input holds only one", "x.qrr"},
	        {"into a folder", {"convert", "-", "."}, 2, "", "standard input has no name under which", "x.qrr"},
	        {"edits", {"edit", "x.qrr", "--edits", "-", "-o", "x.qrr"}, 3, "", "-:1: there is no edit", c_Performer},
	        {"endless", {"dump", "-"}, 3, "", "it is larger than 33554432 bytes", "/dev/zero"},
	        {"endless edits", {"edit", "x.qrr", "--edits", "/dev/zero", "-o", "x.qrr"}, 3, "", "larger than 16777216"},
	    },
	    m_Folder);
}

/// An error that a library tells ends no command with 0, and lets nothing be written.
TEST_F(Input, ErrorsCount)
{
	m_Folder.Write(
	    "state.qrr", Replaced(Data("qrt/version-3.5.qrs"), "POSITION=\"1*Scale 0 0\"", "POSITION=\"1*Scal 0 0\""));
	m_Folder.Write("static.qrx",
	    "{\"Version\":[1,0,1],\"Schema\":\"Retarget\"}\n{\"SubjectParametrised\":{\"StaticParameters\":[{\"Name\":"
	    "\"a\",\"DefaultExpression\":\"b\"}],\"Segments\":[{\"Name\":\"Hips\"}]}}");
	const std::string end = "error retarget: Nothing is written after an error, and what is shown may be wrong: ";
	RunRows(
	    {
	        {"evaluated", {"dump", "--evaluated", "state.qrr"}, 3, "\"Subject\"", end},
	        {"segments", {"segments", "state.qrr"}, 3, "Hips", end},
	        {"targets", {"targets", "state.qrr"}, 3, "Position", end},
	        {"fk", {"fk", "static.qrx"}, 3, "Hips", end},
	        {"edit", {"edit", "state.qrr", "--weight", "1=2", "-o", "x.qrr"}, 3, "", end},
	        {"legacy", {"edit", "static.qrx", "-o", "x.qrr"}, 3, "", end},
	    },
	    m_Folder);
	const VRun mended = m_Folder.Run({"edit", "state.qrr", "--remove-target", "0", "-o", "x.qrr"});
	EXPECT_EQ(mended.m_Status, 0) << mended.m_Err;
	EXPECT_EQ(mended.m_Err.find("error"), std::string::npos) << mended.m_Err;
	// One file's error is not another's.
	EXPECT_EQ(m_Folder.Run({"convert", "static.qrx", "x.qrr", "."}).m_Out, "2 files: 1 converted, 1 not\n");
}

/// The file that is replaced is the one that was read, and a failure half-way leaves it.
TEST_F(Input, AFailedEditLeavesTheFileAlone)
{
	ASSERT_EQ(m_Folder.Run({"create", "--fbx", c_Fbx, "-o", "x.qrr"}).m_Status, 0);
	const std::string before = m_Folder.Read("x.qrr");
	EXPECT_EQ(m_Folder.Run({"edit", "x.qrr", "--scale", "2", "--pose", "No=1,2,3", "-o", "x.qrr"}).m_Status, 2);
	EXPECT_EQ(m_Folder.Read("x.qrr"), before);
	EXPECT_EQ(m_Folder.Run({"edit", "x.qrr", "--scale", "2", "-o", "x.qrr"}).m_Status, 0);
	EXPECT_NE(m_Folder.Read("x.qrr"), before);
	EXPECT_EQ(m_Folder.Run({"edit", "x.qrr", "--scale", "1", "-o", "x.qrr"}).m_Status, 0);
	EXPECT_EQ(m_Folder.Read("x.qrr"), before);
}

TEST(Output, StandardOutputThatIsFull)
{
	if (!boost::filesystem::exists("/dev/full"))
		GTEST_SKIP() << "no /dev/full here";
	const VScratchFolder folder;
	const std::string command =
	    std::string(RETARGET_PROGRAM) + " schema > /dev/full 2> '" + (folder / "err").string() + "'";
	EXPECT_EQ(std::system(command.c_str()) >> 8, 4);
	EXPECT_NE(folder.Read("err").find("error retarget: Error writing to standard output"), std::string::npos);
}

} // namespace
