#include "UtilsRapidXml/Characters.h"

#include <cstdint>
#include <cstring>

namespace
{

constexpr std::uint64_t c_Ones = 0x0101010101010101u;

/// Words of eight bytes of which none is a control character or part of a longer sequence: nearly all of any file.
bool AllPlain(const char* i_pBytes, std::size_t i_Words)
{
	std::uint64_t found = 0;
	for (std::size_t i = 0; i < i_Words; ++i)
	{
		std::uint64_t word;
		std::memcpy(&word, i_pBytes + sizeof(word) * i, sizeof(word));
		found |= (word - c_Ones * 0x20) | word;
	}
	return (found & (c_Ones * 0x80)) == 0;
}

/// The length of the sequence that begins here, 0 if it is broken or no character of XML.
std::size_t SequenceLength(std::string_view i_Text)
{
	const unsigned char first = i_Text[0];
	const std::size_t length = first < 0x80 ? 1 : first >> 5 == 6 ? 2 : first >> 4 == 14 ? 3 : first >> 3 == 30 ? 4 : 0;
	if (length == 0 || length > i_Text.size())
		return 0;
	char32_t code = length == 1 ? first : first & (0x7F >> length);
	for (std::size_t i = 1; i < length; ++i)
	{
		const unsigned char byte = i_Text[i];
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
	std::size_t position = 0;
	while (position < i_Text.size())
	{
		// Four words at once are few instructions.
		if (i_Text.size() - position >= 32 && AllPlain(i_Text.data() + position, 4))
		{
			position += 32;
			continue;
		}
		if (i_Text.size() - position >= 8 && AllPlain(i_Text.data() + position, 1))
		{
			position += 8;
			continue;
		}
		const std::size_t length = SequenceLength(i_Text.substr(position));
		if (length == 0)
			return position;
		position += length;
	}
	return std::string_view::npos;
}
