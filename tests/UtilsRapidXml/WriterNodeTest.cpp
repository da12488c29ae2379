#include "UtilsRapidXml/WriterNode.h"
#include "UtilsRapidXml/Limits.h"
#include "UtilsRapidXml/ReaderNode.h"

#include <gtest/gtest.h>

namespace
{

using namespace UtilsRapidXml;

TEST(WriterNode, LeavesOutWhatTheVersionDoesNotHave)
{
	std::string text;
	VWriterNode root(text);
	root.SetVersion({2, 5});
	const auto fail = [](VWriterNode&) { FAIL() << "out of range"; };
	EXPECT_TRUE(root.WriteElement("a",
	    [&](VWriterNode& io_rNode)
	    {
		    EXPECT_TRUE(io_rNode.WriteAttribute("always", "1"));
		    EXPECT_TRUE(io_rNode.WriteAttribute("now", "2", {2, 5}, {2, 5}));
		    EXPECT_FALSE(io_rNode.WriteAttribute("later", "3", {2, 6}));
		    EXPECT_FALSE(io_rNode.WriteAttribute("before", "4", {}, {2, 4}));
		    EXPECT_FALSE(io_rNode.WriteElement("later", fail, {3, 0}));
		    EXPECT_FALSE(io_rNode.WriteElement("before", fail, {}, {1, 9}));
		    EXPECT_TRUE(io_rNode.WriteElement("b", [](VWriterNode&) {}));
		    EXPECT_TRUE(io_rNode.WriteAttribute("afterwards", "5"));
		    EXPECT_TRUE(io_rNode.WriteElement(
		        "c", [](VWriterNode& io_rChild) { io_rChild.WriteAttribute("empty", ""); }, {2, 0}));
	    }));
	EXPECT_EQ(text,
	    "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"no\"?>\n"
	    "<a always=\"1\" now=\"2\" afterwards=\"5\">\n\t<b/>\n\t<c empty=\"\"/>\n</a>\n");
	EXPECT_EQ(root.GetGlobalInfo()->m_Errors.GetCount(), 0u);
}

TEST(WriterNode, RefusesBytesThatXmlCannotHold)
{
	std::string text;
	VWriterNode root(text);
	root.WriteElement("a",
	    [&](VWriterNode& io_rNode)
	    {
		    EXPECT_FALSE(io_rNode.WriteAttribute("control", "\x02"));
		    EXPECT_FALSE(io_rNode.WriteAttribute("latin", "\xE4"));
		    EXPECT_FALSE(io_rNode.WriteAttribute("zero", std::string_view("a\0b", 3)));
	    });
	EXPECT_EQ(root.GetGlobalInfo()->m_Errors.GetTexts(),
	    (std::vector<std::string>{"a node's control attribute has bytes that XML cannot hold.",
	        "a node's latin attribute has bytes that XML cannot hold.",
	        "a node's zero attribute has bytes that XML cannot hold."}));
	EXPECT_NE(text.find("<a/>"), std::string::npos);
}

/// Writes i_Depth elements into each other; what the writer accepts the parser takes.
TEST(WriterNode, StopsWhereTheReaderWould)
{
	for (const std::size_t depth : {c_MaximumDepth, c_MaximumDepth + 1})
	{
		std::string written;
		VWriterNode root(written);
		std::size_t left = depth;
		bool bWritten = true;
		std::function<void(VWriterNode&)> write = [&](VWriterNode& io_rNode)
		{
			if (left-- > 0)
				bWritten = io_rNode.WriteElement("a", write) && bWritten;
		};
		write(root);
		EXPECT_EQ(bWritten, depth == c_MaximumDepth);
		VDocument again;
		std::string error;
		EXPECT_TRUE(again.Parse(written, error)) << error;
		EXPECT_EQ(root.GetGlobalInfo()->m_Errors.GetTexts(),
		    bWritten
		        ? std::vector<std::string>{}
		        : std::vector<std::string>{"a element is nested deeper than 512 levels and could not be read back."});
	}
}

TEST(WriterNode, GivesBackEveryText)
{
	for (const std::string text :
	    {"", " ", "a\tb\nc\r\nd\r", "<a b=\"c\" d='e'>&amp;&#10;", "'", "\"", "'\"", "\xF0\x9F\x98\x80", "]]>"})
	{
		std::string written;
		VWriterNode root(written);
		root.WriteElement("a", [&](VWriterNode& io_rNode) { EXPECT_TRUE(io_rNode.WriteAttribute("n", text)); });
		VDocument again;
		std::string error;
		ASSERT_TRUE(again.Parse(written, error)) << error;
		VReaderNode reader(again, true);
		std::string_view read = "nothing";
		reader.DeclareElement("a", "", 1, 1);
		reader.ProcessElements(
		    [&](INode& io_rNode) { EXPECT_TRUE(io_rNode.ProcessAttribute("n", read, "", "xsd:string", true)); });
		EXPECT_EQ(read, text);
	}
}

} // namespace
