#include "Rows.h"
#include "retarget/report/Page.h"

#include <boost/algorithm/string/replace.hpp>

namespace
{

TEST(Report, NamesNeverReachThePageRaw)
{
	for (const auto& [pText, pEscaped] : std::vector<std::pair<const char*, const char*>>{
	         {"<b title=\"x\">&'</b>", "&lt;b title=&quot;x&quot;&gt;&amp;&#39;&lt;/b&gt;"},
	         {"a\nb\x7F", "a[U+0A]b[U+7F]"},
	         {"\xE2\x80\xAEgpj\xE2\x80\x8B\xEF\xBB\xBF", "[U+202E]gpj[U+200B][U+FEFF]"},
	         {"\xD8\xA7\xD9\x84 \xE6\x97\xA5 \xF0\x9F\xA6\xB4", "\xD8\xA7\xD9\x84 \xE6\x97\xA5 \xF0\x9F\xA6\xB4"},
	         {"\xFFx\xC0\xAF\xED\xA0\x80\xE2\x80", "[0xFF]x[0xC0][0xAF][0xED][0xA0][0x80][0xE2][0x80]"},
	     })
		EXPECT_EQ(CommandLine::EscapedForHtml(pText), pEscaped);
}

/// With a segment, a performer's segment and a file whose names are hostile.
TEST(Report, TellsTheSetUp)
{
	const VScratchFolder folder;
	ASSERT_EQ(folder
	              .Run({"-q", "create", "--fbx", c_Fbx, "--source", c_Performer, "--position", "Hips:Hips",
	                  "--rotation", "LeftArm:LeftArm", "--state", "0=3,4,0", "-o", "x.qrr"})
	              .m_Status,
	    0);
	const std::string file = "<i>&#10;.qrr";
	folder.Write(file, boost::replace_all_copy(folder.Read("x.qrr"), "\"LeftArm\"", "\"&lt;script&gt;&#x202E;\""));
	const std::vector<std::string> report{
	    "-q", "report", file, "--source", c_Performer, "--fbx", c_Fbx, "--no-pictures", "-o", "-"};
	const std::string page = folder.Run(report).m_Out;
	for (const char* const pRaw : {"<script", "<i>", "\xE2\x80\xAE", "<img"})
		EXPECT_EQ(page.find(pRaw), std::string::npos) << pRaw;
	for (const char* const pShown : {"&lt;script&gt;[U+202E]", "Retarget subject &lt;i&gt;&amp;#10;.qrr",
	         "<bdi>Position</bdi></td><td><bdi>Hips</bdi>",
	         "<bdi>Hips</bdi></td><td class=\"n\"><bdi>1</bdi></td><td class=\"n\"><bdi>3.0, 4.0, 0.0 mm</bdi>",
	         "<bdi>upper arm</bdi></td><td class=\"n\"><bdi>2</bdi></td><td class=\"n\"><bdi>0</bdi></td>"
	         "<td class=\"n\"><bdi>1</bdi></td><td><bdi>RightArm</bdi>",
	         "<bdi>LeftHandThumb2</bdi></td><td><bdi>go</bdi>", "No range of motion: no target follows a segment",
	         "Pictures were not asked for"})
		EXPECT_NE(page.find(pShown), std::string::npos) << pShown;
	EXPECT_EQ(folder.Run(report).m_Out, page);

	// Nor does any of it reach a terminal.
	for (const std::vector<std::string>& rCommand : std::vector<std::vector<std::string>>{{"segments", file},
	         {"targets", file, "--source", c_Performer}, {"check", file}, {"dump", file}, {"fk", file, "--json"},
	         {"diff", "x.qrr", file, "-vv"}, {"edit", file, "--weight", "7=1", "-o", file}})
	{
		const VRun run = folder.Run(rCommand);
		for (const std::string& rText : {run.m_Out, run.m_Err})
			EXPECT_EQ(rText.find("\xE2\x80\xAE"), std::string::npos) << rCommand.front() << ": " << rText;
	}
}

TEST(Report, PlotsATake)
{
	const VScratchFolder folder;
	const std::string demo = RETARGET_SOURCE "/demo/";
	const VRun create = folder.Run({"-q", "create", "--fbx", demo + "character.fbx", "--source", demo + "performer.qrs",
	    "--position", "Pelvis:haunch", "-o", "x.qrr"});
	ASSERT_EQ(create.m_Status, 0) << create.m_Err;
	folder.Write("x.qrr", boost::replace_all_copy(folder.Read("x.qrr"), "haunch", "&lt;script&gt;"));
	const VRun report = folder.Run({"-q", "report", "x.qrr", "--source", demo + "performer.qrs", "--take",
	    demo + "walk.bvh", "--no-pictures", "-o", "-"});
	ASSERT_EQ(report.m_Status, 0) << report.m_Err;
	EXPECT_EQ(report.m_Out.find("<script"), std::string::npos);
	for (const char* const pShown : {"With the take walk.bvh", "<figure class=\"wide\"><svg ", "<polyline ",
	         "#0 Pelvis to &lt;script&gt;</text>", "<bdi>Pelvis to &lt;script&gt;</bdi>"})
		EXPECT_NE(report.m_Out.find(pShown), std::string::npos) << pShown;
}

TEST(Report, WrongInput)
{
	const VScratchFolder folder;
	ASSERT_EQ(folder.Run({"-q", "create", "--fbx", c_Fbx, "-o", "x.qrr"}).m_Status, 0);
	folder.Write("other.html", "no page of ours");
	RunRows(
	    {
	        {"no subject", {"-q", "report", "none.qrr", "-o", "x.html"}, 3, "", "\"none.qrr\" could not be read"},
	        {"no performer", {"-q", "report", "x.qrr", "--source", "x.fbx", "-o", "x.html"}, 3, "", "source skeleton"},
	        {"no character", {"-q", "report", "x.qrr", "--fbx", "x.qrr", "--no-pictures", "-o", "x.html"}, 3, "",
	            "could not be read whole as FBX"},
	        {"no page", {"report", "x.qrr", "-o", "x.pdf"}, 2, "",
	            "an HTML page; let the name of its file end in .html"},
	        {"another page", {"report", "x.qrr", "-o", "other.html"}, 4, "", "is there, and is not an HTML page"},
	        {"no take", {"-q", "report", "x.qrr", "--take", "none.bvh", "--no-pictures", "-o", "x.html"}, 3, "",
	            "none.bvh"},
	        {"no folder", {"-q", "report", "x.qrr", "--no-pictures", "-o", "none/x.html"}, 4, "", "none"},
	    },
	    folder);
}

} // namespace
