#include "math/VisibleText.h"

#include <gtest/gtest.h>

namespace
{

TEST(VisibleText, NamesReachNobodyRaw)
{
	struct VTextRow
	{
		const char* m_pText;
		const char* m_pLine;
		const char* m_pJson;
	};
	for (const VTextRow& rRow : {VTextRow{"\xC3\xA9t\xC3\xA9", "\xC3\xA9t\xC3\xA9", "\xC3\xA9t\xC3\xA9"},
	         {"a\x1B[31m\n\x7F", "a [31m  ", "a\x1B[31m\n\\u007F"}, {"\xC2\x9BK", "[U+9B]K", "\\u009BK"},
	         {"\x9B", "[0x9B]", "\x9B"}, {"\xE2\x80\xAEgpj", "[U+202E]gpj", "\\u202Egpj"},
	         // Letters that are written from the right are letters.
	         {"\xD7\x90\xD8\xA8", "\xD7\x90\xD8\xA8", "\xD7\x90\xD8\xA8"},
	         {"\xF3\xA0\x80\x81", "[U+E0001]", "\\uDB40\\uDC01"}})
	{
		EXPECT_EQ(VisibleText::OnOneLine(rRow.m_pText), rRow.m_pLine);
		EXPECT_EQ(VisibleText::InJson(rRow.m_pText), rRow.m_pJson);
	}
}

} // namespace
