#include "UtilsRapidXml/Document.h"
#include "UtilsRapidXml/Characters.h"
#include "UtilsRapidXml/Limits.h"
#include "UtilsRapidXml/Printer.h"

#include <gtest/gtest.h>

#include <boost/algorithm/string/replace.hpp>
#include <rapidxml/rapidxml.hpp>
#include <rapidxml/rapidxml_print.hpp>

#include <random>

namespace
{

using namespace UtilsRapidXml;
using namespace std::string_literals;

std::string Nested(std::size_t i_Depth)
{
	std::string text;
	for (std::size_t i = 0; i < i_Depth; ++i)
		text += "<a>";
	for (std::size_t i = 0; i < i_Depth; ++i)
		text += "</a>";
	return text;
}

std::string Children(std::size_t i_Count)
{
	std::string text = "<a>";
	for (std::size_t i = 0; i < i_Count; ++i)
		text += "<b/>";
	return text + "</a>";
}

std::string Attributes(std::size_t i_Count, const std::string& i_rLast)
{
	std::string text = "<a";
	for (std::size_t i = 0; i < i_Count; ++i)
		text += " n" + std::to_string(i) + "=''";
	return text + ' ' + i_rLast + "=''/>";
}

struct VDocumentRow
{
	const char* m_pName;
	std::string m_Text;
	/// Empty if the text is fine.
	std::string m_Error;
};

TEST(Document, TellsWhatIsNoXml)
{
	const VDocumentRow c_Rows[] = {
	    {"Declaration, comment, instruction", "<?xml version='1.0'?><!-- <b> --><?p <?><a><!--&#0;--></a>", ""},
	    {"Byte order mark", "\xEF\xBB\xBF<a/>", ""},
	    {"All of XML's characters", "<a b='\xC3\xA4\xE2\x82\xAC\xF0\x9F\x98\x80&#9;&#x10FFFF;&#228;'/>", ""},
	    {"Character data", "<a><![CDATA[<b>]] ]]></a>", ""},
	    {"Text within elements", "<a> text &amp; <b/> more </a>", ""},
	    {"Document type by name", "<!DOCTYPE a SYSTEM 'a.dtd'><a/>", ""},
	    {"Document type with what ends it in its identifiers", "<!DOCTYPE a PUBLIC \"[>'\" 'a>\n[b\">.dtd' ><a/>", ""},
	    {"Unknown entity stays", "<a b='&x; & &'/>", ""},
	    {"Blanks in tags", "<a\n\tb = '1'\r\n/><b ></b >", ""},
	    {"As deep as it goes", Nested(c_MaximumDepth), ""},
	    {"Many attributes", Attributes(1000, "last"), ""},
	    {"Empty", "", ""},
	    {"One level deeper", Nested(c_MaximumDepth + 1), "line 1: elements are nested deeper than 512"},
	    {"Deep enough to kill the parser", Nested(200000), "line 1: elements are nested deeper than 512"},
	    {"Depth hidden by closing tags in comments",
	        []
	        {
		        std::string text;
		        for (int i = 0; i < 5000; ++i)
			        text += "<a><!-- </a> --><?p </a> ?><![CDATA[</a>]]>";
		        return text;
	        }(),
	        "line 1: elements are nested deeper than 512"},
	    {"More elements than memory", Children(1100000), "line 1: too many elements and attributes"},
	    {"Larger than memory", std::string(c_MaximumDocumentBytes + 1, ' '),
	        "text of 100663297 bytes is larger than 100663296"},
	    {"Not XML", "hello", "line 1: text outside of any element"},
	    {"Text after the root", "<a/>\n\nx", "line 3: text outside of any element"},
	    {"Zero byte", "<a>\n\0</a>"s, "line 2: zero byte"},
	    {"Zero byte as a reference", "<a b='&#0;'/>", "line 1: broken character reference"},
	    {"Reference to a surrogate", "<a b='&#xD800;'/>", "line 1: broken character reference"},
	    {"Reference too large", "<a b='&#99999999999999;'/>", "line 1: broken character reference"},
	    {"Reference without an end", "<a>&#65</a>", "line 1: broken character reference"},
	    {"Reference without digits", "<a>&#x;</a>", "line 1: broken character reference"},
	    {"Negative reference", "<a>&#-1;</a>", "line 1: broken character reference"},
	    {"Hexadecimal digits in a decimal reference", "<a>&#1A;</a>", "line 1: broken character reference"},
	    {"Overlong UTF-8", "<a b='\xC0\xAF'/>", "line 1: byte that is no valid UTF-8 or no character of XML"},
	    {"Surrogate in UTF-8", "\n<a b='\xED\xA0\x80'/>", "line 2: byte that is no valid UTF-8 or no character of XML"},
	    {"Beyond Unicode", "<a b='\xF4\x90\x80\x80'/>", "line 1: byte that is no valid UTF-8 or no character of XML"},
	    {"Cut UTF-8", "<a/>\xE2\x82", "line 1: byte that is no valid UTF-8 or no character of XML"},
	    {"Latin-1", "<a b='\xE4rm'/>", "line 1: byte that is no valid UTF-8 or no character of XML"},
	    {"Control character", "<a b='12345678\x01'/>", "line 1: byte that is no valid UTF-8 or no character of XML"},
	    {"Attribute twice", "<a>\n<b c='1' d='2'\n c='3'/></a>", "line 3: attribute c stands twice"},
	    {"Attribute twice after a value of two lines", "<a c='\n' b='' \n b=''/>", "line 3: attribute b stands twice"},
	    {"Attribute twice among many", Attributes(1000, "n500"), "line 1: attribute n500 stands twice"},
	    {"Wrong closing tag", "<a>\n<b></a>", "line 2: closing tag a does not match"},
	    {"Closing tag too many", "<a/></a>", "line 1: closing tag a does not match"},
	    {"Closing tag of two names", "<a></a b>", "line 1: closing tag a does not end"},
	    {"Not closed", "<a><b/>", "line 1: element a is not closed"},
	    {"Cut in a tag", "<a b='1'", "line 1: tag of element a does not end"},
	    {"Cut after a slash", "<a /", "line 1: tag of element a does not end"},
	    {"Cut in a value", "<a b='1", "line 1: value of attribute b does not end"},
	    {"Value of lines that does not end", "<a c='\r\n' \nb='1\n2\n", "line 3: value of attribute b does not end"},
	    {"Cut before a value", "<a b=", "line 1: value of attribute b is not quoted"},
	    {"Cut in a name", "<", "line 1: element without a name"},
	    {"Value without quotes", "<a b=1/>", "line 1: value of attribute b is not quoted"},
	    {"Attribute without a value", "<a b/>", "line 1: attribute b has no value"},
	    {"Attribute without a name", "<a ='1'/>", "line 1: attribute without a name"},
	    {"Name that begins with a digit", "<1/>", "line 1: element without a name"},
	    {"Comment without an end", "<a><!-- ->", "line 1: comment does not end"},
	    {"Comment of three dashes", "<!-->", "line 1: comment does not end"},
	    {"Instruction without an end", "<?>", "line 1: processing instruction does not end"},
	    {"Character data without an end", "<a><![CDATA[", "line 1: character data does not end"},
	    {"Document type with entities", "<!DOCTYPE a [<!ENTITY x 'y'>]><a/>",
	        "line 1: document type that is broken or has an internal subset"},
	    {"Document type whose identifier does not end", "\n<!DOCTYPE a SYSTEM 'a>\n<a/>",
	        "line 2: document type that is broken or has an internal subset"},
	    {"Attribute twice after values of shortened line ends", "<a c='\r\n\r\n' b='' \n b=''/>",
	        "line 4: attribute b stands twice"},
	    {"Other declaration", "<!x><a/>", "line 1: element without a name"},
	};
	for (const VDocumentRow& rRow : c_Rows)
	{
		VDocument document;
		std::string error;
		EXPECT_EQ(document.Parse(rRow.m_Text, error), rRow.m_Error.empty()) << rRow.m_pName;
		EXPECT_EQ(error, rRow.m_Error) << rRow.m_pName;
	}
}

/// Prints what was parsed: the five entities, references, raw line ends as blanks and written ones as references.
TEST(Document, KeepsAttributeTextsThroughParseAndPrint)
{
	VDocument document;
	std::string error;
	ASSERT_TRUE(
	    document.Parse("<a b='1\r\n2\t&#10;&#9;&#13;&lt;&gt;&amp;&quot;&apos;&x;'><c d='\"' e=\"'\"/></a>", error));
	VDocument again;
	ASSERT_TRUE(again.Parse(document.Print(), error)) << error;
	EXPECT_EQ(again.Print(), "<a b='1 2 &#10;&#9;&#13;&lt;&gt;&amp;\"&apos;&amp;x;'>\n\t<c d='\"' e=\"'\"/>\n</a>\n\n");
}

/// rapidxml's own printer is the measure for everything but line ends and tabs of attributes.
TEST(Document, PrintsAsRapidXmlDoes)
{
	std::mt19937 generator(32);
	const std::string alphabet = "ab<>&\"' \xC3\xA4";
	const auto text = [&]
	{
		std::string result;
		for (auto length = generator() % 6; length > 0; --length)
			result += alphabet.substr(generator() % 8, 1);
		return generator() % 4 ? result : result + "\xC3\xA4";
	};
	for (int round = 0; round < 200; ++round)
	{
		VDocument document;
		document.AppendDeclaration();
		document.AppendProcessingInstruction("target", "a=\"<&>\"");
		std::vector<VXmlNode*> elements = {document.AppendElement(document.GetRoot(), "root")};
		for (auto count = generator() % 20; count > 0; --count)
		{
			VXmlNode* const pElement = document.AppendElement(elements[generator() % elements.size()], "e");
			for (unsigned attributes = generator() % 4; attributes > 0; --attributes)
				document.AppendAttribute(pElement, "n", text());
			elements.push_back(pElement);
		}
		for (VXmlNode* pElement : elements)
			if (!pElement->first_node())
				document.SetText(pElement, text());
		std::string expected;
		rapidxml::print(std::back_inserter(expected), *document.GetRoot());
		ASSERT_EQ(document.Print(), expected);
	}
}

TEST(Document, WritesLineEndsAndTabsAsReferences)
{
	const std::string text = "\tone\r\ntwo <&> \"three\" 'four' \xC3\xA4";
	VDocument document;
	document.AppendDeclaration();
	document.AppendAttribute(document.AppendElement(document.GetRoot(), "a"), "b", text);
	EXPECT_EQ(document.Print(),
	    "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"no\"?>\n"
	    "<a b='&#9;one&#13;&#10;two &lt;&amp;&gt; \"three\" &apos;four&apos; \xC3\xA4'/>\n\n");
}

/// Whatever happens to a file's bytes, it parses or gives an error with a line; under the sanitizers this also shows
/// that the parser never leaves its buffer.
TEST(Document, SurvivesDamage)
{
	const std::string whole = "<?xml version='1.0'?>\n<!-- c --><a b='&#65;&amp;' c=\"1 2\">\n\t<d e=''/>t<![CDATA[x]]>"
	                          "<?p q?><f\xC3\xA4></f\xC3\xA4></a>\n";
	const std::string bytes = "<>/='\"&#;!?-[] \n\0\x80\xC3x"s;
	std::mt19937 generator(31);
	int fine = 0;
	for (int round = 0; round < 50000; ++round)
	{
		std::string text = whole;
		for (unsigned changes = 1 + generator() % 4; changes > 0 && !text.empty(); --changes)
			switch (const std::size_t at = generator() % text.size(); generator() % 4)
			{
			case 0: text.resize(at + 1); break;
			case 1: text.erase(at, 1 + generator() % 8); break;
			case 2: text.insert(at, 1, bytes[generator() % bytes.size()]); break;
			default: text[at] = bytes[generator() % bytes.size()];
			}
		VDocument document;
		std::string error;
		if (!document.Parse(text, error))
		{
			ASSERT_TRUE(error.starts_with("line ")) << error << '\n' << text;
			continue;
		}
		++fine;
		// rapidxml's own parser is the measure, but for line ends in values.
		rapidxml::xml_document<char> peer;
		std::string copy = text;
		peer.parse<rapidxml::parse_no_data_nodes | rapidxml::parse_no_element_values>(copy.data());
		const auto asBlanks = [](std::string i_Text)
		{
			boost::replace_all(i_Text, "&#10;", " ");
			return i_Text;
		};
		ASSERT_EQ(asBlanks(document.Print()), asBlanks(Print(peer))) << text;
	}
	EXPECT_GT(fine, 1000);
	EXPECT_LT(fine, 40000);
}

TEST(Characters, FindsTheFirstBrokenByteWhereverItStands)
{
	for (std::size_t size = 1; size < 150; size += 1 + size / 16)
		for (std::size_t at = 0; at < size; ++at)
		{
			std::string text(size, '~');
			EXPECT_EQ(FindBrokenCharacter(text), std::string::npos);
			for (const char byte : {'\x00', '\x1F', '\x80', '\xFF', '\xC3'})
			{
				text[at] = byte;
				EXPECT_EQ(FindBrokenCharacter(text), at);
			}
		}
}

} // namespace
