#include "Rows.h"

namespace
{

TEST(Check, SoundFilesHaveNoFindings)
{
	const VScratchFolder folder;
	ASSERT_EQ(folder
	              .Run({"create", "--fbx", Data("fbx/own_ns_yup_cm_b7400.fbx"), "--source", c_Performer, "--symmetry",
	                  "--position", "#0:#0", "--rotation", "#0:#0", "--prune-joints", "-o", "hero.qrr"})
	              .m_Status,
	    0);
	for (const std::string& rFile :
	    {c_Performer, std::string(RETARGET_SOURCE "/demo/performer.qrs"), std::string("hero.qrr")})
	{
		const VRun run = folder.Run({"check", rFile});
		EXPECT_EQ(run.m_Status, 0) << rFile;
		EXPECT_EQ(run.m_Out, "no findings\n") << rFile;
		EXPECT_EQ(run.m_Err, "") << rFile;
		EXPECT_EQ(RunJson({"check", rFile, "--json"}, folder), VJson::array());
	}
}

TEST(Check, DamagedFiles)
{
	const std::string version = Data("qrt/version-3.5.qrs");
	const VScratchFolder folder;
	folder.Write("matrix.qrs", Replaced(version, "COVARIANCE=\"7 0 0 0 8", "COVARIANCE=\"7 0 0 0 -8"));
	folder.Write("template.qrs", Replaced(version, "COVARIANCE=\"3 0 0 0 3", "COVARIANCE=\"3 1 0 0 3"));
	folder.Write("weight.qrs", Replaced(version, "WEIGHT=\"2\"", "WEIGHT=\"-2\""));
	folder.Write("normal.qrs", Replaced(version, "VIEW-NORMAL=\"0 0 1\"", "VIEW-NORMAL=\"0 0 2\""));
	folder.Write("state.qrs", Replaced(version, "POSITION=\"1*Scale 0 0\"", "POSITION=\"1*Scal 0 0\""));
	folder.Write("static.qrs", Replaced(version, "EXPRESSION=\"Height*2\"", "EXPRESSION=\"Heigh*2\""));
	folder.Write("static.qrx",
	    "{\"Version\":[1,0,1],\"Schema\":\"Retarget\"}\n{\"SubjectParametrised\":{\"StaticParameters\":[{\"Name\":"
	    "\"a\","
	    "\"DefaultExpression\":\"b\"}],\"Segments\":[{\"Name\":\"Hi\\nps\",\"TreeDepth\":2}]}}");
	RunRows(
	    {
	        {"one root too many", {"check", version}, 1,
	            "segment #6 \"Prop\": The parent segment of a child segment must be set.\n"
	            "    Put it below a segment that stands before it: only the first may have no parent.\n"
	            "1 finding\n",
	            ""},
	        {"a target", {"check", "normal.qrs"}, 1, "target #0 \"point\": Invalid target view normals\n", ""},
	        {"a segment", {"check", "matrix.qrs"}, 1,
	            "segment #1 \"Spine\": Invalid joint covariance matrix\n"
	            "    Give Covariance eigenvalues above 0, or set all its entries to 0.\n",
	            ""},
	        {"remedy of a template", {"check", "template.qrs"}, 1,
	            "    Make TemplateCovariance symmetric: each entry equal to its mirror, to 1e-12.\n2 findings\n", ""},
	        {"remedy of a weight", {"check", "weight.qrs"}, 1, "\n    Set Weight to 0 or more.\n", ""},
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
	        {"no file", {"check"}, 2, "", "FILE is missing"},
	    },
	    folder);

	const VRun many = folder.Run({"check", "static.qrs", "normal.qrs", c_Performer, "nothing.qrs"});
	EXPECT_EQ(many.m_Status, 3);
	EXPECT_NE(
	    many.m_Out.find(c_Performer + ":\nno findings\n4 files: 2 with findings, 2 unreadable\n"), std::string::npos)
	    << many.m_Out;

	const VRun run = folder.Run({"check", "--json", "normal.qrs"});
	EXPECT_EQ(run.m_Status, 1);
	const VJson list = VJson::parse(run.m_Out);
	ASSERT_EQ(list.size(), 2u);
	EXPECT_EQ(list[0],
	    VJson({{"file", "normal.qrs"}, {"kind", "target"}, {"index", 0}, {"name", "point"},
	        {"message", "Invalid target view normals"}, {"remedy", "Give each entry of ViewNormals the length 1 or 0."},
	        {"tolerated", false}}));
	EXPECT_EQ(list[1].at("kind"), "segment");
	EXPECT_EQ(list[1].at("index"), 6);
}

} // namespace
