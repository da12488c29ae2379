#include "UtilsRapidXml/ReaderNode.h"
#include "UtilsRapidXml/Limits.h"

#include <gtest/gtest.h>

#include <pthread.h>

namespace
{

using namespace UtilsRapidXml;
using VTexts = std::vector<std::string>;

struct VResult
{
	VTexts m_Visited;
	VTexts m_Errors;
	VTexts m_Warnings;
};

using VFormat = std::function<void(INode& io_rNode, VTexts& io_rVisited)>;

/// Runs the format function over the root element, which is called "r".
VResult Walk(const std::string& i_rText, const VFormat& i_rFormat, bool i_bStrictOrder = false)
{
	VDocument document;
	std::string error;
	EXPECT_TRUE(document.Parse(i_rText, error)) << error;
	VResult result;
	std::shared_ptr<VReaderNode::VGlobalInfo> pInfo;
	{
		VReaderNode root(document, i_bStrictOrder);
		pInfo = root.GetGlobalInfo();
		root.DeclareElement("r", "", 0, c_Unbounded);
		root.ProcessElements([&](INode& io_rNode) { i_rFormat(io_rNode, result.m_Visited); });
	}
	result.m_Errors = pInfo->m_Errors.GetTexts();
	result.m_Warnings = pInfo->m_Warnings.GetTexts();
	EXPECT_EQ(pInfo->m_Errors.GetCount(), result.m_Errors.size());
	return result;
}

/// Visits children and notes their name and their attribute "n".
std::function<void(INode&)> Note(VTexts& io_rVisited)
{
	return [&](INode& io_rNode)
	{
		std::string_view text;
		io_rNode.ProcessAttribute("n", text, "", "xsd:string", false);
		io_rVisited.push_back(std::string(io_rNode.GetName()).append(text));
	};
}

struct VRow
{
	const char* m_pName;
	std::string m_Text;
	VFormat m_Format;
	VResult m_Expected;
	bool m_bStrictOrder = false;
};

VFormat Children(std::vector<std::tuple<std::string, std::uint32_t, std::uint32_t, VVersion, VVersion>> i_Declarations,
    bool i_bChoice = false, VVersion i_Version = {})
{
	return [=](INode& io_rNode, VTexts& io_rVisited)
	{
		io_rNode.SetVersion(i_Version);
		for (const auto& [rName, minimum, maximum, first, last] : i_Declarations)
			io_rNode.DeclareElement(rName, "", minimum, maximum, first, last);
		io_rNode.ProcessElements(Note(io_rVisited), i_bChoice);
	};
}

struct VGate
{
	std::string m_Type = "xsd:string";
	bool m_bRequired = false;
	VVersion m_Minimum = {};
	VVersion m_Maximum = {};
	VVersion m_Version = {};
};

/// Asks for the attribute "n" and notes its text.
VFormat Attribute(const VGate& i_rGate)
{
	return [=](INode& io_rNode, VTexts& io_rVisited)
	{
		io_rNode.SetVersion(i_rGate.m_Version);
		std::string_view text;
		if (io_rNode.ProcessAttribute(
		        "n", text, "", i_rGate.m_Type, i_rGate.m_bRequired, i_rGate.m_Minimum, i_rGate.m_Maximum))
			io_rVisited.emplace_back(text);
	};
}

constexpr VVersion c_None{};

TEST(ReaderNode, TellsWhatItFinds)
{
	const VRow c_Rows[] = {
	    {"Children in the order of the file", "<r><b n='1'/><a n='2'/><b n='3'/></r>",
	        Children({{"a", 0, c_Unbounded, c_None, c_None}, {"b", 0, c_Unbounded, c_None, c_None}}),
	        {{"b1", "a2", "b3"}, {}, {}}},
	    {"The order of declaration", "<r><b/><a/></r>",
	        Children({{"a", 0, 1, c_None, c_None}, {"b", 0, 1, c_None, c_None}}),
	        {{"a"}, {"//r/b element did not appear in correct element sequence"}, {}}, true},
	    {"Strict order kept", "<r><a/><a n='2'/><b/></r>",
	        Children({{"a", 0, 2, c_None, c_None}, {"b", 0, 1, c_None, c_None}}), {{"a", "a2", "b"}, {}, {}}, true},
	    {"More than one", "<r><a n='1'/><a n='2'/></r>", Children({{"a", 0, 1, c_None, c_None}}),
	        {{"a1"}, {"//r element must have a maximum of 1 a child elements"}, {}}},
	    {"One error for each that is too many", "<r><a n='1'/><a/><a/></r>", Children({{"a", 0, 1, c_None, c_None}}),
	        {{"a1"},
	            {"//r element must have a maximum of 1 a child elements",
	                "//r element must have a maximum of 1 a child elements"},
	            {}}},
	    {"A maximum of 0 is no limit", "<r><a n='1'/><a n='2'/></r>", Children({{"a", 0, 0, c_None, c_None}}),
	        {{"a1", "a2"}, {}, {}}},
	    {"Too few", "<r><a/></r>", Children({{"a", 2, 5, c_None, c_None}}),
	        {{"a"}, {"//r element must have a minimum of 2 a child elements"}, {}}},
	    {"Choice", "<r><b n='1'/></r>", Children({{"a", 1, 1, c_None, c_None}, {"b", 1, 1, c_None, c_None}}, true),
	        {{"b1"}, {}, {}}},
	    {"Choice of both", "<r><b/><a n='1'/></r>",
	        Children({{"a", 1, 1, c_None, c_None}, {"b", 1, 1, c_None, c_None}}, true),
	        {{"a1"}, {"//r element cannot have both a a and a b child element"}, {}}},
	    {"Choice of one twice", "<r><a n='1'/><a/></r>", Children({{"a", 1, 1, c_None, c_None}}, true),
	        {{"a1"}, {"//r element cannot have both a a and a a child element"}, {}}},
	    {"Choice of none", "<r/>", Children({{"a", 1, 1, c_None, c_None}, {"b", 1, 1, c_None, c_None}}, true),
	        {{}, {"//r element must have a one of the following child elements: a b"}, {}}},
	    {"Element of a later version", "<r><a/></r>", Children({{"a", 0, 1, {2, 0}, c_None}}, false, {1, 5}),
	        {{}, {}, {"Ignoring //r/a element. Not supported in files with version 1.5"}}},
	    {"Element of an earlier version", "<r><a/></r>", Children({{"a", 0, 1, c_None, {2, 6}}}, false, {3, 0}),
	        {{}, {}, {"Ignoring //r/a element. Not supported in files with version 3.0"}}},
	    {"An element out of range does not count", "<r><a/></r>",
	        Children({{"a", 1, 1, {2, 0}, c_None}}, false, {1, 5}),
	        {{}, {"//r element must have a minimum of 1 a child elements"},
	            {"Ignoring //r/a element. Not supported in files with version 1.5"}}},
	    {"Bounds belong to the range", "<r><a/></r>", Children({{"a", 0, 1, {2, 1}, {2, 1}}}, false, {2, 1}),
	        {{"a"}, {}, {}}},
	    {"An unset version has everything", "<r><a/></r>", Children({{"a", 0, 1, {2, 0}, {2, 6}}}), {{"a"}, {}, {}}},
	    {"Unknown elements, once for each name", "<r><x/><a/><y/><x/></r>", Children({{"a", 0, 1, c_None, c_None}}),
	        {{"a"}, {}, {"Ignoring unrecognised element type: //r/x", "Ignoring unrecognised element type: //r/y"}}},
	    {"Unknown attributes", "<r><a n='' y='' z=''/></r>", Children({{"a", 0, 1, c_None, c_None}}),
	        {{"a"}, {}, {"Ignoring unrecognised attribute: //r/a/y", "Ignoring unrecognised attribute: //r/a/z"}}},
	    {"An early return leaves all unrecognised", "<r n=''><a/></r>", [](INode&, VTexts&) {},
	        {{}, {}, {"Ignoring unrecognised element type: //r/a", "Ignoring unrecognised attribute: //r/n"}}},
	    {"Unknown root", "<r/><s/>", [](INode&, VTexts&) {}, {{}, {}, {"Ignoring unrecognised element type: //s"}}},
	    {"Attribute", "<r n='a &lt; b'/>", Attribute({}), {{"a < b"}, {}, {}}},
	    {"Empty attribute", "<r n=''/>", Attribute({"xsd:string", true}), {{""}, {}, {}}},
	    {"Required attribute", "<r/>", Attribute({"xsd:string", true}),
	        {{}, {"r element missing required attribute n"}, {}}},
	    {"Attribute of a later version", "<r n='1'/>", Attribute({"xsd:string", true, {3, 5}, c_None, {3, 4}}),
	        {{}, {}, {"Ignoring n attribute in r element. Not supported in files with version 3.4"}}},
	    {"Attribute of a later version that is not there", "<r/>",
	        Attribute({"xsd:string", true, {3, 5}, c_None, {3, 4}}), {{}, {}, {}}},
	    {"Attribute out of range of no version", "<r n='1'/>", Attribute({"xsd:string", false, {3, 5}, c_None}),
	        {{"1"}, {}, {}}},
	    {"Identifier twice", "<r n='x'/><r n='x'/>", Attribute({"xsd:ID"}),
	        {{"x", "x"}, {}, {"File contains duplicate ID : x "}}},
	    {"Reference without an identifier", "<r n='x'/>", Attribute({"xsd:IDREF"}),
	        {{"x"}, {}, {"File contains unknown IDREF : x "}}},
	};
	for (const VRow& rRow : c_Rows)
	{
		const VResult result = Walk(rRow.m_Text, rRow.m_Format, rRow.m_bStrictOrder);
		EXPECT_EQ(result.m_Visited, rRow.m_Expected.m_Visited) << rRow.m_pName;
		EXPECT_EQ(result.m_Errors, rRow.m_Expected.m_Errors) << rRow.m_pName;
		EXPECT_EQ(result.m_Warnings, rRow.m_Expected.m_Warnings) << rRow.m_pName;
	}
}

TEST(ReaderNode, KnowsIdentifiersReadSoFar)
{
	const VResult result = Walk("<r><a n='x'/><b n='x'/><b n='y'/><a n='y'/></r>",
	    [](INode& io_rNode, VTexts&)
	    {
		    io_rNode.DeclareElement("a", "", 0, c_Unbounded);
		    io_rNode.DeclareElement("b", "", 0, c_Unbounded);
		    io_rNode.ProcessElements(
		        [](INode& io_rChild)
		        {
			        std::string_view text;
			        io_rChild.ProcessAttribute(
			            "n", text, "", io_rChild.GetName() == "a" ? "xsd:ID" : "xsd:IDREF", true);
		        });
	    });
	EXPECT_EQ(result.m_Warnings, VTexts{"File contains unknown IDREF : y "});
}

TEST(ReaderNode, EmptiesItsDeclarations)
{
	const VResult result = Walk("<r><a/><b/></r>",
	    [](INode& io_rNode, VTexts& io_rVisited)
	    {
		    io_rNode.ProcessElements([](INode&) { FAIL() << "nothing is declared"; });
		    io_rNode.DeclareElement("b", "", 1, 1);
		    io_rNode.ProcessElements(Note(io_rVisited));
		    io_rNode.DeclareElement("a", "", 1, 1);
		    io_rNode.ProcessElements(Note(io_rVisited));
	    });
	EXPECT_EQ(result.m_Visited, (VTexts{"b", "a"}));
	EXPECT_TRUE(result.m_Errors.empty());
}

/// The depth that is allowed fits into the small stack of a worker thread.
TEST(ReaderNode, WalksTheDeepestFileOnASmallStack)
{
	std::string text;
	for (std::size_t i = 0; i < c_MaximumDepth; ++i)
		text += "<r n='1'>";
	for (std::size_t i = 0; i < c_MaximumDepth; ++i)
		text += "</r>";
	std::size_t visited = 0;
	pthread_attr_t attributes;
	pthread_attr_init(&attributes);
#ifdef NDEBUG
	pthread_attr_setstacksize(&attributes, 512 << 10);
#else
	// Frames that are not optimised, or watched by a sanitizer, take several times as much.
	pthread_attr_setstacksize(&attributes, 4096 << 10);
#endif
	std::function<void()> walk = [&]
	{
		VDocument document;
		std::string error;
		ASSERT_TRUE(document.Parse(text, error)) << error;
		VReaderNode root(document, true);
		std::function<void(INode&)> format = [&](INode& io_rNode)
		{
			++visited;
			io_rNode.DeclareElement("r", "", 0, 1);
			io_rNode.ProcessElements(format);
		};
		format(root);
	};
	pthread_t thread;
	ASSERT_EQ(pthread_create(
	              &thread, &attributes,
	              [](void* i_pWalk) -> void*
	              {
		              (*static_cast<std::function<void()>*>(i_pWalk))();
		              return nullptr;
	              },
	              &walk),
	    0);
	pthread_join(thread, nullptr);
	pthread_attr_destroy(&attributes);
	EXPECT_EQ(visited, c_MaximumDepth + 1);
}

/// A path is repeated by each unknown attribute below it: what is kept stays bounded, what is counted is complete.
TEST(ReaderNode, BoundsItsMessages)
{
	const std::string name(1000, 'n');
	std::string text;
	for (int i = 0; i < 100; ++i)
		text += '<' + name + '>';
	for (int i = 0; i < 2000; ++i)
		text += "<x" + std::to_string(i) + "/>";
	for (int i = 0; i < 100; ++i)
		text += "</" + name + '>';
	VDocument document;
	std::string error;
	ASSERT_TRUE(document.Parse(text, error)) << error;
	std::shared_ptr<VReaderNode::VGlobalInfo> pInfo;
	{
		VReaderNode root(document, false);
		pInfo = root.GetGlobalInfo();
		std::function<void(INode&)> format = [&](INode& io_rNode)
		{
			io_rNode.DeclareElement(name, "", 0, 1);
			io_rNode.ProcessElements(format);
		};
		format(root);
	}
	EXPECT_EQ(pInfo->m_Warnings.GetCount(), 2000u);
	std::size_t bytes = 0;
	for (const std::string& rText : pInfo->m_Warnings.GetTexts())
		bytes += rText.size();
	EXPECT_LT(bytes, c_MaximumMessageBytes + 200000);
	const VTexts texts = pInfo->m_Warnings.GetTexts();
	EXPECT_EQ(texts.back(), "and " + std::to_string(2000 - (texts.size() - 1)) + " more");
}

} // namespace
