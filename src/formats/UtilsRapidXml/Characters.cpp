#include "UtilsRapidXml/Characters.h"

#include <algorithm>
#include <cstddef>

namespace
{

/// Neither a control character nor part of a longer sequence.
bool IsPlain(char i_Byte)
{
	return static_cast<signed char>(i_Byte) >= 0x20;
}

/// The length of the sequence that begins here, 0 if it is broken or no character of XML.
std::size_t SequenceLength(std::string_view i_Text)
{
	const auto first = static_cast<unsigned char>(i_Text[0]);
	const std::size_t length = first < 0x80 ? 1 : first >> 5 == 6 ? 2 : first >> 4 == 14 ? 3 : first >> 3 == 30 ? 4 : 0;
	if (length == 0 || length > i_Text.size())
		return 0;
	char32_t code = length == 1 ? first : first & (0x7F >> length);
	for (std::size_t i = 1; i < length; ++i)
	{
		const auto byte = static_cast<unsigned char>(i_Text[i]);
		if (byte >> 6 != 2)
			return 0;
		code = code << 6 | (byte & 0x3F);
	}
	constexpr char32_t c_First[] = {0, 0, 0x80, 0x800, 0x10000};
	return code >= c_First[length] && UtilsRapidXml::IsXmlCharacter(code) ? length : 0;
}

} // namespace

std::size_t UtilsRapidXml::FindBrokenCharacter(std::string_view i_Text)
{
	// Indented text is plain, too.
	const auto isNotPlain = [](VBlock i_Bytes)
	{ return (i_Bytes < 0x20) & (i_Bytes != '\t') & (i_Bytes != '\n') & (i_Bytes != '\r'); };
	constexpr std::size_t c_Blocks = 4;
	constexpr std::size_t c_Step = c_Blocks * sizeof(VBlock);
	std::size_t position = 0;
	while (position < i_Text.size())
	{
		const std::size_t end = std::min(position + c_Step, i_Text.size());
		if (end - position == c_Step && !BlockHas<c_Blocks>(i_Text.data() + position, isNotPlain))
			position = end;
		while (position < end)
		{
			const std::size_t length = IsPlain(i_Text[position]) ? 1 : SequenceLength(i_Text.substr(position));
			if (length == 0)
				return position;
			position += length;
		}
	}
	return std::string_view::npos;
}
