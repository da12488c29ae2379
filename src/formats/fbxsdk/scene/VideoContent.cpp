#include "fbxsdk/scene/VideoContent.h"

#include "fbxsdk/container/Values.h"

#include <string_view>

namespace
{

/// The six bits of a base64 character; -1 if it is none.
int SixBits(char i_Character)
{
	if (i_Character >= 'A' && i_Character <= 'Z')
		return i_Character - 'A';
	if (i_Character >= 'a' && i_Character <= 'z')
		return i_Character - 'a' + 26;
	if (i_Character >= '0' && i_Character <= '9')
		return i_Character - '0' + 52;
	return i_Character == '+' ? 62 : i_Character == '/' ? 63 : -1;
}

/// One piece; what comes after its padding begins anew.
/// @return false if a character is none of base64, nor white space.
bool AppendBase64(std::string_view i_Text, std::string& io_rBytes)
{
	std::uint32_t bits = 0;
	int count = 0;
	for (const char character : i_Text)
	{
		if (character == '=' || character == '\n' || character == '\r' || character == ' ' || character == '\t')
		{
			count = character == '=' ? 0 : count;
			continue;
		}
		const int six = SixBits(character);
		if (six < 0)
			return false;
		bits = bits << 6 | std::uint32_t(six);
		count += 6;
		if (count >= 8)
			io_rBytes += char(bits >> (count -= 8));
	}
	return true;
}

} // namespace

std::string FbxFormat::ReadContent(const VArraySource& i_rContent)
{
	if (i_rContent.m_Element == c_NoElement)
		return {};
	const VElementTree& rTree = *i_rContent.m_pTree;
	if (!i_rContent.m_pBudget->Take(rTree.Values(i_rContent.m_Element).size()))
		return {};
	std::string bytes;
	VValueCursor cursor(rTree, i_rContent.m_Element);
	for (VValue value = cursor.Next(); value.m_Kind == EValueKind::Text; value = cursor.Next())
	{
		if (rTree[i_rContent.m_Element].m_Form == EValueForm::Binary)
			bytes += value.m_Text;
		else if (!AppendBase64(value.m_Text, bytes))
			return {};
	}
	return bytes;
}

bool FbxFormat::HasContent(const VArraySource& i_rContent)
{
	if (i_rContent.m_Element == c_NoElement)
		return false;
	VValueCursor cursor(*i_rContent.m_pTree, i_rContent.m_Element);
	for (VValue value = cursor.Next(); value.m_Kind == EValueKind::Text; value = cursor.Next())
		if (!value.m_Text.empty())
			return true;
	return false;
}
