#include "Rows.h"

#include <nlohmann/json.hpp>

namespace
{

using VJson = nlohmann::json;

/// The file's text with a part of it replaced, which must be there.
std::string Damaged(const std::string& i_rPath, const std::string& i_rFrom, const std::string& i_rTo)
{
	const VScratchFolder folder;
	std::filesystem::copy(i_rPath, folder / "copy");
	std::string text = folder.Read("copy");
	const std::size_t at = text.find(i_rFrom);
	EXPECT_NE(at, std::string::npos) << i_rFrom;
	return at == std::string::npos ? text : text.replace(at, i_rFrom.size(), i_rTo);
}

TEST(Check, SoundFilesHaveNoFindings)
{
	const VScratchFolder folder;
	ASSERT_EQ(
	    RunRetarget({"create", "--fbx", Data("fbx/own_ns_yup_cm_b7400.fbx"), "--source", c_Performer, "--symmetry",
	                    "--position", "#0:#0", "--rotation", "#0:#0", "--prune-joints", "-o", "hero.qrr"},
	        folder.Path())
	        .m_Status,
	    0);
	for (const std::string& rFile :
	    {c_Performer, std::string(RETARGET_SOURCE "/demo/performer.qrs"), std::string("hero.qrr")})
	{
		const VRun run = RunRetarget({"check", rFile}, folder.Path());
		EXPECT_EQ(run.m_Status, 0) << rFile;
		EXPECT_EQ(run.m_Out, "no findings\n") << rFile;
		EXPECT_EQ(RunRetarget({"check", rFile, "--json"}, folder.Path()).m_Out, "[]\n") << rFile;
	}
}

/// The kept files of all versions have a prop without a parent beside the body, and nothing else to find.
TEST(Check, FilesOfAllVersionsHaveOneRootTooMany)
{
	const VScratchFolder folder;
	std::size_t count = 0;
	for (const auto& rEntry : std::filesystem::directory_iterator(Data("qrt")))
	{
		if (!rEntry.path().filename().string().starts_with("version-"))
			continue;
		++count;
		const VRun run = RunRetarget({"check", rEntry.path().string()}, folder.Path());
		EXPECT_EQ(run.m_Status, 1) << rEntry.path();
		EXPECT_EQ(run.m_Out,
		    "segment #6 \"Prop\": The parent segment of a child segment must be set.\n"
		    "    Put it below a segment that stands before it: only the first may have no parent.\n"
		    "1 finding\n")
		    << rEntry.path();
	}
	EXPECT_GE(count, 10u);
}

TEST(Check, DamagedFiles)
{
	const std::string version = Data("qrt/version-3.5.qrs");
	const VScratchFolder folder;
	folder.Write("matrix.qrs", Damaged(version, "COVARIANCE=\"7 0 0 0 8", "COVARIANCE=\"7 0 0 0 -8"));
	folder.Write("template.qrs", Damaged(version, "COVARIANCE=\"3 0 0 0 3", "COVARIANCE=\"3 1 0 0 3"));
	folder.Write("weight.qrs", Damaged(version, "WEIGHT=\"2\"", "WEIGHT=\"-2\""));
	folder.Write("normal.qrs", Damaged(version, "VIEW-NORMAL=\"0 0 1\"", "VIEW-NORMAL=\"0 0 2\""));
	folder.Write("state.qrs", Damaged(version, "POSITION=\"1*Scale 0 0\"", "POSITION=\"1*Scal 0 0\""));
	folder.Write("static.qrs", Damaged(version, "EXPRESSION=\"Height*2\"", "EXPRESSION=\"Heigh*2\""));
	folder.Write("static.qrx",
	    "{\"Version\":[1,0,1],\"Schema\":\"Retarget\"}\n{\"SubjectParametrised\":{\"StaticParameters\":[{\"Name\":"
	    "\"a\","
	    "\"DefaultExpression\":\"b\"}],\"Segments\":[{\"Name\":\"Hi\\nps\",\"TreeDepth\":2}]}}");
	RunRows(
	    {
	        {"covariance", {"check", "matrix.qrs"}, 1,
	            "segment #1 \"Spine\": Invalid joint covariance matrix\n"
	            "    Give Covariance eigenvalues above 0, or set all its entries to 0.\n",
	            ""},
	        {"template", {"check", "template.qrs"}, 1,
	            "segment #1 \"Spine\": Invalid joint template covariance matrix\n"
	            "    Make TemplateCovariance symmetric: each entry equal to its mirror, to 1e-12.\n2 findings\n",
	            ""},
	        {"weight", {"check", "weight.qrs"}, 1,
	            "target #0 \"point\": Target 0, invalid weights or template values\n    Set Weight to 0 or more.\n",
	            ""},
	        {"normal", {"check", "normal.qrs"}, 1, "target #0 \"point\": Invalid target view normals\n", ""},
	        {"told at load", {"check", "state.qrs"}, 1,
	            "target #0 \"point\": Target 0, state component 0, invalid expresssion: Parse Error at column 7: ID "
	            "\"Scal\" was referenced but never declared\n    Correct \"1*Scal\": ",
	            "warning QRTIO: Target 'point' has the invalid state expression '1*Scal'"},
	        {"refused at load", {"check", "static.qrs"}, 3,
	            "static parameter #1 \"Total\": Validation of StaticParameter 'Total' expression 'Heigh*2' failed, ",
	            "could not be read as a skeleton file; only its static parameters were checked"},
	        {"legacy", {"check", "static.qrx"}, 1,
	            "segment #0 \"Hi ps\": The tree depth of the root must be equal to 0.\n    Set TreeDepth to 0.\n"
	            "static parameter #0 \"a\": Validation of StaticParameter 'a' expression 'b' failed, Parse Error at "
	            "column 2",
	            "error SubjectUtils: Error parsing subject static parameter expressions"},
	        {"no file", {"check"}, 2, "", "FILE is required"},
	    },
	    folder);

	const VRun run = RunRetarget({"check", "--json", "normal.qrs"}, folder.Path());
	EXPECT_EQ(run.m_Status, 1);
	const VJson list = VJson::parse(run.m_Out);
	ASSERT_EQ(list.size(), 2u);
	EXPECT_EQ(list[0],
	    VJson({{"kind", "target"}, {"index", 0}, {"name", "point"}, {"message", "Invalid target view normals"},
	        {"remedy", "Give each entry of ViewNormals the length 1 or 0."}, {"tolerated", false}}));
	EXPECT_EQ(list[1].at("kind"), "segment");
	EXPECT_EQ(list[1].at("index"), 6);
}

} // namespace
