#include "fbxsdk/document/Text.h"

#include <gtest/gtest.h>

using namespace FbxFormat;
using namespace std::string_literals;

namespace
{

TEST(Text, FullNamesComeApart)
{
	struct VRow
	{
		std::string m_FullName, m_Name, m_Class;
	};
	for (const VRow& rRow : {VRow{"Model::Hips", "Hips", "Model"}, VRow{"Hips\0\1Model"s, "Hips", "Model"},
	         VRow{"Model::ns:Hips", "ns:Hips", "Model"}, VRow{"a::b\0\1Model"s, "a::b", "Model"},
	         VRow{"Hips", "Hips", ""}, VRow{"Model::", "", "Model"}, VRow{"", "", ""}})
	{
		EXPECT_EQ(SplitFullName(rRow.m_FullName).m_Name, rRow.m_Name) << rRow.m_FullName;
		EXPECT_EQ(SplitFullName(rRow.m_FullName).m_Class, rRow.m_Class) << rRow.m_FullName;
	}
}

TEST(Text, IsDeliveredAsUtf8)
{
	const std::pair<std::string, std::string> rows[]{{"plain", "plain"},
	    {"H\xC3\xBC"
	     "fte",
	        "H\xC3\xBC"
	        "fte"},
	    {"H\xFC"
	     "fte",
	        "H\xC3\xBC"
	        "fte"},
	    {"\xE8\x85\xB0", "\xE8\x85\xB0"}, {"\xF0\x9F\xA6\xB4", "\xF0\x9F\xA6\xB4"},
	    // Cut short, overlong, a surrogate, beyond the last code point: none is UTF-8.
	    {"\xE8\x85", "\xC3\xA8\xC2\x85"}, {"\xC3-", "\xC3\x83-"}, {"\xE8-\x80", "\xC3\xA8-\xC2\x80"},
	    {"\xC0\x80", "\xC3\x80\xC2\x80"}, {"\xE0\x80\x80", "\xC3\xA0\xC2\x80\xC2\x80"},
	    {"\xED\xA0\x80", "\xC3\xAD\xC2\xA0\xC2\x80"}, {"\xF5\x80\x80\x80", "\xC3\xB5\xC2\x80\xC2\x80\xC2\x80"},
	    {"\xF4\x90\x80\x80", "\xC3\xB4\xC2\x90\xC2\x80\xC2\x80"},
	    {"\xF0\x80\x80\x80", "\xC3\xB0\xC2\x80\xC2\x80\xC2\x80"}};
	for (const auto& [bytes, text] : rows)
		EXPECT_EQ(DecodeText(bytes, false), text);
}

TEST(Text, EscapesOfTheTextFormAreResolved)
{
	EXPECT_EQ(DecodeText("a&quot;b&lf;&cr;c&amp;&", true), "a\"b\n\rc&amp;&");
	EXPECT_EQ(DecodeText("a&quot;b", false), "a&quot;b");
}

} // namespace
