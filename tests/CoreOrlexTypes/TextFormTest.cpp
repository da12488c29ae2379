#include "RandomValue.h"

#include <gtest/gtest.h>

#include <limits>

namespace
{

using namespace CoreOrlexTypes;

struct VRow
{
	const char* pName;
	const char* pText;
	/// Null if the text is refused.
	const char* pSchema;
	std::array<std::uint32_t, 3> Version{};
};

const VRow c_Header[] = {
    {"positional", "[[1,0,1],\"s\"]", "s", {1, 0, 1}},
    {"keyed", R"({"Version":[1,0,1],"Schema":"s"})", "s", {1, 0, 1}},
    {"keyed in another order", R"({"Schema":"s","Version":[1,0,1]})", "s", {1, 0, 1}},
    {"blanks before every token", " \t\r\n{ \"Version\" : [ 1 , 0\n, 1 ] , \"Schema\" : \"s\" }", "s", {1, 0, 1}},
    {"empty keyed record", "{ }", ""},
    {"missing key", R"({"Schema":"s"})", "s"},
    {"unknown keys of any shape", R"({"A":{"x":[1,"]"]},"Schema":"s","B":nonsense 1 2,"C":})", "s"},
    {"first of equal keys", R"({"Schema":"a","Schema":"b","Schema":7})", "a"},
    {"escaped key", R"({"Sch\ema":"s"})", "s"},
    {"tab escape gives two bytes", R"({"Schema":"a\tb"})", "a\ttb"},
    {"escapes", R"({"Schema":"\n\r\"\\\q"})", "\n\r\"\\q"},
    {"raw control bytes", "{\"Schema\":\"a\n\tb\"}", "a\n\tb"},
    {"brackets inside a text", R"({"Schema":"a],}\"b"})", "a],}\"b"},
    {"signs of unsigned numbers", R"({"Version":[+1,-1,007]})", "", {1, 0xFFFFFFFFu, 7}},
    {"saturated unsigned numbers", R"({"Version":[4294967295,4294967296,-99999999999999999999]})", "",
        {0xFFFFFFFFu, 0xFFFFFFFFu, 0xFFFFFFFFu}},
    {"what follows is ignored", "[[1,2,3],\"s\"] garbage", "s", {1, 2, 3}},

    {"empty text", "", nullptr},
    {"blanks only", " \n", nullptr},
    {"neither spelling", "7", nullptr},
    {"positional, a field missing", "[[1,0,1]]", nullptr},
    {"positional, a field too many", "[[1,0,1],\"s\",1]", nullptr},
    {"positional, empty", "[ ]", nullptr},
    {"array too short", R"({"Version":[1,0]})", nullptr},
    {"array too long", R"({"Version":[1,0,1,0]})", nullptr},
    {"trailing comma in a list", R"({"Version":[1,0,1,]})", nullptr},
    {"trailing comma in a record", R"({"Schema":"s",})", nullptr},
    {"value followed by another token", R"({"Schema":"s" x})", nullptr},
    {"value missing", R"({"Schema":})", nullptr},
    {"colon missing", R"({"Schema" "s"})", nullptr},
    {"key not quoted", R"({Schema:"s"})", nullptr},
    {"wrong closing bracket", R"({"Schema":"s"])", nullptr},
    {"not a number", R"({"Version":[1,x,1]})", nullptr},
    {"real number for an unsigned one", R"({"Version":[1,0.5,1]})", nullptr},
    {"unended text", R"({"Schema":"s)", nullptr},
    {"backslash at the end", R"({"Schema":"s\)", nullptr},
    {"unended record", R"({"Schema":"s")", nullptr},
    {"first of equal keys is bad", R"({"Schema":7,"Schema":"b"})", nullptr},
};

TEST(TextForm, ReadsRecords)
{
	for (const VRow& rRow : c_Header)
	{
		SCOPED_TRACE(rRow.pName);
		VTextHeader header;
		ASSERT_EQ(ReadText(rRow.pText, header), rRow.pSchema != nullptr);
		if (!rRow.pSchema)
			continue;
		EXPECT_EQ(header.m_Schema, rRow.pSchema);
		EXPECT_EQ(header.m_Version, rRow.Version);
	}
}

TEST(TextForm, AFailedFieldStopsTheLaterOnes)
{
	VTextHeader header{{7, 7, 7}, "kept"};
	EXPECT_FALSE(ReadText(R"({"Schema":"new","Version":[1,x,1]})", header));
	EXPECT_EQ(header.m_Schema, "kept");
}

TEST(TextForm, AZeroByteEndsTheText)
{
	VTextHeader header;
	EXPECT_TRUE(ReadText(std::string_view("{}\0{", 4), header));
	EXPECT_FALSE(ReadText(std::string_view("{\"Schema\":\"a\0b\"}", 16), header));
}

TEST(TextForm, TellsWhereTheRecordBehindTheHeaderBegins)
{
	const std::string_view text = R"( {"Version":[1,0,0],"Schema":"x"}
{"SubjectParametrised":{"Name":"Template"},"SubjectApplicationData":{"Skin":"s"}})";
	VTextHeader header;
	std::size_t read = 0;
	ASSERT_TRUE(ReadText(text, header, &read));
	EXPECT_EQ(text[read], '\n');
	VSubjectRecord record;
	ASSERT_TRUE(ReadText(text.substr(read), record));
	EXPECT_EQ(record.m_SubjectParametrised.m_Name, "Template");
	EXPECT_EQ(record.m_SubjectApplicationData.m_Skin, "s");
}

TEST(TextForm, ReadsColoursInTheirSpellings)
{
	const struct
	{
		const char* pText;
		bool bGood;
	} rows[] = {{R"({"Markers":[[1,2,3,255]]})", true}, {R"({"Markers":[[ [1,2,3,255] ]]})", true},
	    {R"({"Markers":[{"Colour":[1,2,3,255]}]})", true}, {R"({"Markers":[[1,2,3,256]]})", false},
	    {R"({"Markers":[[1,2,3]]})", false}, {R"({"Markers":[[[1,2,3,255],1]]})", false},
	    {R"({"Markers":[{"Colour":{"Red":1}}]})", false}, {R"({"Markers":[)", false}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.pText);
		VSubjectApplicationData data;
		ASSERT_EQ(ReadText(rRow.pText, data), rRow.bGood);
		if (!rRow.bGood)
			continue;
		EXPECT_EQ(data.m_Markers.at(0).m_Colour, (VColour{1, 2, 3, 255}));
	}
}

TEST(TextForm, ReadsBooleansEnumerationsNumbersAndLists)
{
	const struct
	{
		const char* pText;
		bool bGood;
	} rows[] = {{R"({"DynamicParameters":[{"Visible":true},{"Visible":0}]})", true},
	    {R"({"DynamicParameters":[{"Visible":True}]})", false}, {R"({"DynamicParameters":[{"Visible":10}]})", false},
	    {R"({"DynamicParameters":[{"Visible":"true"}]})", false}, {R"({"Markers":[{"Status":"Optional"}]})", true},
	    {R"({"Markers":[{"Status":"EOptional"}]})", false}, {R"({"Markers":[{"Status":"optional"}]})", false},
	    {R"({"Markers":[{"Status":1}]})", false}, {R"({"TPoseConstraints":[ +1 , 0x10,inf, -nan,1e400,.5]})", true},
	    {R"({"TPoseConstraints":[1,5 6]})", false}, {R"({"TPoseConstraints":[1.#INF]})", false},
	    {R"({"TPoseConstraints":[]})", true}, {R"({"TPoseConstraints":[,]})", false},
	    {R"({"Targets":[{"ViewNormals":[[1,0,0],[0,1,0]]}]})", true},
	    {R"({"Targets":[{"ViewNormals":[[1,0]]}]})", false}};
	for (const auto& rRow : rows)
	{
		VSubjectParametrised subject;
		EXPECT_EQ(ReadText(rRow.pText, subject), rRow.bGood) << rRow.pText;
	}
}

TEST(TextForm, EmptiesAListBeforeItIsRead)
{
	VSubjectParametrised subject;
	subject.m_TPoseConstraints = {1, 2, 3};
	ASSERT_TRUE(ReadText(R"({"TPoseConstraints":[4]})", subject));
	EXPECT_EQ(subject.m_TPoseConstraints, std::vector<double>{4});
}

TEST(TextForm, RefusesATextThatWouldGrowBeyondItsBytes)
{
	std::string text = R"({"Segments":[{})";
	for (int i = 0; i < 300000; ++i)
		text += ",{}";
	text += "]}";
	VSubjectParametrised subject;
	EXPECT_FALSE(ReadText(text, subject));
	EXPECT_LT(subject.m_Segments.capacity() * sizeof(subject.m_Segments[0]), std::size_t(100) << 20);
	// Nesting costs no stack.
	EXPECT_FALSE(ReadText("{\"x\":" + std::string(2000000, '['), subject));
}

template <typename T>
class TextFormOf : public testing::Test
{
};
using VTopLevelTypes = testing::Types<VSubjectParametrised, VSubject, VSubjectApplicationData, VSubjectRecord>;
TYPED_TEST_SUITE(TextFormOf, VTopLevelTypes);

TYPED_TEST(TextFormOf, ReadsBackWhatItWrote)
{
	VRandomValue random(11);
	for (int round = 0; round < 50; ++round)
	{
		TypeParam value;
		random.Fill(value);
		for (const ETextSpelling spelling : {ETextSpelling::EKeyed, ETextSpelling::EPositional})
		{
			std::string text;
			ASSERT_TRUE(WriteText(value, text, spelling));
			TypeParam back;
			std::size_t read = 0;
			ASSERT_TRUE(ReadText(text, back, &read)) << text;
			EXPECT_EQ(read, text.size());
			ASSERT_TRUE(back == value) << text;
			ASSERT_FALSE(ReadText(std::string_view(text).substr(0, text.size() / 2), back));
		}
	}
}

TEST(TextForm, WritesKeyedAndPositional)
{
	VSubjectApplicationData data;
	data.m_Sticks.resize(1);
	std::string text;
	ASSERT_TRUE(WriteText(data, text, ETextSpelling::EPositional));
	EXPECT_EQ(text,
	    "[0, [93, 93, 93, 255], [], [], [\n\t\t[0, [0, 0, 0, 0], 0, [0, 0, 0, 0]]\n\t], [], \"\", "
	    "[0, 0, 0, 0], [0, 0, 0, 0], \"\", \"\"]");
	text.clear();
	ASSERT_TRUE(WriteText(VTextHeader{{1, 0, 1}, "a\tb"}, text));
	EXPECT_EQ(text, "{\n\t\"Version\": [1, 0, 1],\n\t\"Schema\": \"a\tb\"\n}");
}

TEST(TextForm, DoesNotWriteWhatItCannotHold)
{
	std::string text;
	VSubjectParametrised subject;
	subject.m_Name = std::string("a\0b", 3);
	EXPECT_FALSE(WriteText(subject, text));
	subject.m_Name.clear();
	subject.m_Segments.resize(1);
	subject.m_Segments[0].m_Joint.m_JointType = VSubjectParametrised::VJoint::EJointType(7);
	EXPECT_FALSE(WriteText(subject, text));
}

} // namespace
