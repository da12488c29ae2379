#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/container/Values.h"
#include "math/NumberText.h"

#include "FbxFileBuilder.h"

#include <gtest/gtest.h>

using namespace FbxFormat;
using namespace FbxTest;
using namespace std::string_literals;

namespace
{

/// "Name(1,2.5,'text',[array]){...}", with the records of a list behind one another.
std::string Dump(const VElementTree& i_rTree, VElementIndex i_Parent)
{
	std::string dump;
	for (const VElementIndex element : i_rTree.Children(i_Parent))
	{
		dump += dump.empty() ? "" : " ";
		dump += i_rTree.Name(element);
		dump += '(';
		VValueCursor cursor(i_rTree, element);
		std::uint32_t count = 0;
		for (VValue value = cursor.Next(); value.m_Kind != EValueKind::None; value = cursor.Next(), ++count)
		{
			dump += count > 0 ? "," : "";
			switch (value.m_Kind)
			{
			case EValueKind::Integer: dump += std::to_string(value.m_Integer); break;
			case EValueKind::Real: dump += NumberText::PrintG17(value.m_Real); break;
			case EValueKind::Text: dump.append("'").append(value.m_Text).append("'"); break;
			case EValueKind::Word: dump += std::string(value.m_Text); break;
			default: dump += "[]"; break;
			}
		}
		dump += ')';
		EXPECT_TRUE(count == i_rTree[element].m_ValueCount || i_rTree[element].m_Form == EValueForm::TextArray);
		if (const std::string children = Dump(i_rTree, element); !children.empty())
			dump += '{' + children + '}';
	}
	return dump;
}

std::string Read(const std::string& i_rBytes, std::string* o_pError = nullptr)
{
	VElementTree tree;
	const bool bSound = tree.Read(i_rBytes, DetectFileKind(i_rBytes));
	EXPECT_EQ(bSound, tree.Error().empty());
	if (o_pError)
		*o_pError = tree.Error();
	else
		EXPECT_EQ(tree.Error(), "");
	return Dump(tree, VElementTree::c_Root);
}

TEST(Records, AreTheSameInEveryForm)
{
	const std::vector<VTestRecord> records{{"Header", {std::int64_t(7), -2.5, "some text"s},
	                                           {{"Deep", {}, {{"Deeper", {std::int64_t(-3)}, {}}}}, {"Last", {}, {}}}},
	    {"Empty", {}, {}}, {"Text", {""s, "two\nlines; { not a comment"s}, {}}};
	for (const VTestForm& rForm : c_Forms)
		EXPECT_EQ(Read(Write(rForm, records)),
		    "Header(7,-2.5,'some text'){Deep(){Deeper(-3)} Last()} Empty() "
		    "Text('','two\nlines; { not a comment')")
		    << rForm.m_pName;
}

/// Behind what moves stands what does not; damage in it is not seen, but when all is read.
TEST(Records, OfWhatMovesAreLeftOutUnlessAskedFor)
{
	const std::vector<VTestRecord> keys{{"KeyTime", {VNumbers(100, 0.5)}, {}}, {"Note", {"a } brace; {{ {"s}, {}}};
	const std::vector<VTestRecord> records{{"Pose", {}, {{"Kept", {1}, {}}}},
	    {"Objects", {},
	        {{"AnimationCurve", {7, "x"s}, keys}, {"Model", {8, "m"s}, {{"Pose", {2}, {}}}},
	            {"Constraint", {9, "c"s}, {{"Bad?", {3}, {}}}}, {"Pose", {10, "p"s}, {}}, {"Model", {11, "n"s}, {}}}},
	    {"Takes", {}, {{"Take", {"t"s}, keys}}}, {"End", {4}, {}}};
	for (const VTestForm& rForm : c_Forms)
	{
		std::string bytes = Write(rForm, records);
		std::string error;
		EXPECT_NE(Read(bytes).find("Take('t')"), std::string::npos) << rForm.m_pName;
		// No type of the binary form, no name of the text form.
		bytes[bytes.find("Bad?") + 4] = rForm.m_Form == EForm::Binary ? '?' : '"';
		if (rForm.m_Form == EForm::Text)
			bytes.insert(bytes.find("Bad?") + 5, "\"");
		Read(bytes, &error);
		EXPECT_NE(error, "") << rForm.m_pName;
		VElementTree tree;
		EXPECT_TRUE(tree.Read(bytes, DetectFileKind(bytes), EContent::WithoutMotion)) << tree.Error();
		EXPECT_EQ(
		    Dump(tree, VElementTree::c_Root), "Pose(){Kept(1)} Objects(){Model(8,'m'){Pose(2)} Model(11,'n')} End(4)")
		    << rForm.m_pName;
	}
}

TEST(Records, BinaryHasValuesOfEveryType)
{
	const VTestRecord record{"R",
	    {VRaw{Bytes('C', '\1')}, VRaw{Bytes('B', '\xff')}, VRaw{Bytes('Z', '\2')}, VRaw{Bytes('Y', std::int16_t(-2))},
	        VRaw{Bytes('I', -70000)}, VRaw{Bytes('F', 0.5f)}, VRaw{Bytes('R', 2u, "\0x"s)},
	        VRaw{Bytes('i', 1u, 0u, 4u, 5)}},
	    {}};
	for (const VTestForm& rForm : {c_Forms[1], c_Forms[2]})
		EXPECT_EQ(Read(Write(rForm, {record})), "R(1,-1,2,-2,-70000,0.5,'\0x',[])"s);
}

struct VTextRow
{
	const char* m_pName;
	const char* m_pText;
	const char* m_pDump;
	const char* m_pError = "";
};

void PrintTo(const VTextRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

class TextRecords : public testing::TestWithParam<VTextRow>
{
};

TEST_P(TextRecords, Read)
{
	std::string error;
	EXPECT_EQ(Read("; FBX 7.4.0\n"s + GetParam().m_pText, &error), GetParam().m_pDump);
	EXPECT_EQ(error.substr(0, error.find(" (byte ")), GetParam().m_pError);
}

INSTANTIATE_TEST_SUITE_P(Rows, TextRecords,
    testing::Values(VTextRow{"CommaAtLineEnd", "A: 1,2,\n3 , 4\nB: 5", "A(1,2,3,4) B(5)"},
        VTextRow{"CommaAtLineStart", "A: 1,2\n ,3\r\n,4\nB: 5", "A(1,2,3,4) B(5)"},
        VTextRow{"CommentInList", "A: 1, ; one\n2 ; two\n, 3", "A(1,2,3)"},
        VTextRow{"LeadingComma", "Content: ,\n\"QUJD\", \"REVG\"\nB: 1", "Content('QUJD','REVG') B(1)"},
        VTextRow{"Words", "Shading: T\nKey: 0,1.5,U,s,n", "Shading(T) Key(0,1.5,U,s,n)"},
        VTextRow{"NoValues", "A:\nB: 1\nC:{ D: }", "A() B(1) C(){D()}"},
        VTextRow{"ValuesOnNextLine",
            "Key: \n\t1,-2.5,L\nB:\n; none\nC: {\nD:\r\n\"x\",\n\"y\"\nE:\n}\nF:\n*1 {\na: 1\n}",
            "Key(1,-2.5,L) B() C(){D('x','y') E()} F([])"},
        VTextRow{"BraceOnNextLine", "A: \"x\"\n{\nB: 1\n}", "A('x'){B(1)}"},
        VTextRow{"OneLine", "A: { B: 1 C: 2 } D: 3", "A(){B(1) C(2)} D(3)"},
        VTextRow{"Numbers", "A: +1,-0,1e3,1.#INF,-1.#INF,0x10,9223372036854775808",
            "A(1,0,1000,1.#INF,-1.#INF,16,9.2233720368547758e+18)"},
        VTextRow{"NotFinite",
            "A: nan,-nan,nan(ind),-nan(ind),NaN(snan),inf,-inf,INF,infinity,1.#QNAN,-1.#IND00,nan(,nano",
            "A(1.#IND,-1.#IND,1.#IND,-1.#IND,1.#IND,1.#INF,-1.#INF,1.#INF,1.#INF,1.#IND,1.#IND,nan(,nano)"},
        VTextRow{"Array", "A: *3 {\n a: 1,2,3\n} B: 1", "A([]) B(1)"},
        VTextRow{"EmptyArray", "A: *0 { } B: 1", "A() B(1)"},
        VTextRow{"UnclosedRecord", "A: { B: 1", "A(){B(1)}", "it ends inside a record"},
        VTextRow{"NothingAfterName", "A: 1\nB: ", "A(1) B()", "it ends inside a record"},
        VTextRow{"UnclosedQuote", "A: 1 B: \"x", "A(1)", "a quote is not closed"},
        VTextRow{"UnclosedArray", "A: *2 { a: 1,2", "A()", "it ends inside an array"},
        VTextRow{"StrayBrace", "A: 1 }\nB: 2", "A(1) B(2)", "a brace closes no record"},
        VTextRow{"NoName", "A: 1\n = 5\nB: 2", "A(1) B(2)", "the name of a record is missing"},
        VTextRow{"NoColon", "A: 1\nhello world\nB: 2", "A(1) B(2)", "the name of a record is missing"},
        VTextRow{"ArrayWithoutCount", "A: *x { a: 1 }\nB: 2", "A() B(2)", "the count of an array is damaged"},
        VTextRow{
            "ArrayOfFourBillion", "A: *4294967295 { a: 1,2 }\nB: 2", "A() B(2)", "the numbers of an array are missing"},
        VTextRow{"ArrayWithoutNumbers", "A: *2 { b: 1,2 }\nB: 2", "A() B(2)", "the numbers of an array are missing"}),
    [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

TEST(Records, LieSixtyFourDeepAtMost)
{
	for (const VTestForm& rForm : c_Forms)
		for (const int depth : {65, 66})
		{
			VTestRecord record{"D", {}, {}};
			for (int i = 1; i < depth; ++i)
				record = {"D", {}, {record}};
			std::string error;
			Read(Write(rForm, {record}), &error);
			EXPECT_EQ(error.substr(0, error.find(" (byte ")),
			    depth > 65 ? "its records lie more than 64 deep in one another" : "")
			    << rForm.m_pName << ' ' << depth;
		}
}

struct VBinaryRow
{
	const char* m_pName;
	/// Where in the file of one record "R" with the child "C" and the record "S" behind it, and what stands there then.
	std::size_t m_Place;
	std::string m_Bytes;
	const char* m_pDump;
	const char* m_pError;
};

void PrintTo(const VBinaryRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

class DamagedBinary : public testing::TestWithParam<VBinaryRow>
{
};

/// A damaged record costs itself and what is in it; what lies behind it is still read.
TEST_P(DamagedBinary, KeepsTheRest)
{
	const std::vector<VTestRecord> records{
	    {"R", {std::int64_t(1)}, {{"C", {std::int64_t(2)}, {}}}}, {"S", {std::int64_t(3)}, {}}};
	std::string bytes = Write(c_Forms[1], records);
	ASSERT_EQ(Read(bytes), "R(1){C(2)} S(3)");
	bytes.replace(GetParam().m_Place, GetParam().m_Bytes.size(), GetParam().m_Bytes);
	std::string error;
	EXPECT_EQ(Read(bytes, &error), GetParam().m_pDump);
	EXPECT_EQ(error.substr(0, error.find(" (byte ")), GetParam().m_pError);
}

// R: header 27, name 40, value 41; C: header 50, name 63, value 64; the empty record 73; S: 86.
INSTANTIATE_TEST_SUITE_P(Rows, DamagedBinary,
    testing::Values(VBinaryRow{"UnknownType", 64, "?", "R(1){C()} S(3)", "the values of a record are damaged"},
        VBinaryRow{"CountTooHigh", 54, Bytes(2u), "R(1){C()} S(3)", "the values of a record are damaged"},
        VBinaryRow{"CountTooLow", 54, Bytes(0u), "R(1){C()} S(3)", "the values of a record are damaged"},
        VBinaryRow{"ValuesTooLong", 58, Bytes(1000u), "R(1){C()} S(3)", "the values of a record reach beyond it"},
        VBinaryRow{"EndTooFar", 50, Bytes(1000u), "R(1){C(2)} S(3)", "a record reaches beyond what holds it"},
        VBinaryRow{"EndTooEarly", 50, Bytes(51u), "R(1) S(3)", "a record ends before its header"},
        VBinaryRow{"TextTooLong", 64, "S\xff\xff\xff\xff", "R(1){C()} S(3)", "the values of a record are damaged"},
        VBinaryRow{"OuterEndTooFar", 27, Bytes(0xFFFFFFF0u), "R(1){C(2)}", "a record reaches beyond what holds it"}),
    [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

} // namespace
