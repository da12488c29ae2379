#include "math/VisibleText.h"

#include <algorithm>
#include <array>
#include <cstdint>

namespace VisibleText
{
namespace
{

/// Characters that nobody sees, or that change how their neighbours are shown.
bool IsUnseen(std::uint32_t i_Character)
{
	struct VSpan
	{
		std::uint32_t m_First;
		std::uint32_t m_Last;
	};
	constexpr std::array c_Spans{VSpan{0x00, 0x1F}, VSpan{0x7F, 0x9F}, VSpan{0xAD, 0xAD}, VSpan{0x61C, 0x61C},
	    VSpan{0x115F, 0x1160}, VSpan{0x180E, 0x180E}, VSpan{0x200B, 0x200F}, VSpan{0x2028, 0x202E},
	    VSpan{0x2060, 0x206F}, VSpan{0x3164, 0x3164}, VSpan{0xFE00, 0xFE0F}, VSpan{0xFEFF, 0xFEFF},
	    VSpan{0xFFF0, 0xFFFB}, VSpan{0xFFFE, 0xFFFF}, VSpan{0xE0000, 0xE0FFF}};
	return std::ranges::any_of(
	    c_Spans, [&](const VSpan& i_rSpan) { return i_Character >= i_rSpan.m_First && i_Character <= i_rSpan.m_Last; });
}

/// The character at the start of a text, and how many bytes it takes; 0 bytes for what is no UTF-8.
std::size_t Decode(std::string_view i_Text, std::uint32_t& o_rCharacter)
{
	const auto byte = [&](std::size_t i_Index) { return std::uint32_t(std::uint8_t(i_Text[i_Index])); };
	const std::uint32_t first = byte(0);
	const std::size_t size = first < 0x80 ? 1
	    : first < 0xC2                    ? 0
	    : first < 0xE0                    ? 2
	    : first < 0xF0                    ? 3
	    : first < 0xF5                    ? 4
	                                      : 0;
	if (size == 0 || size > i_Text.size())
		return 0;
	o_rCharacter = size == 1 ? first : first & (0x7Fu >> size);
	for (std::size_t i = 1; i < size; ++i)
	{
		if ((byte(i) & 0xC0u) != 0x80u)
			return 0;
		o_rCharacter = o_rCharacter << 6 | (byte(i) & 0x3Fu);
	}
	constexpr std::array<std::uint32_t, 5> c_Least{0, 0, 0x80, 0x800, 0x10000};
	const bool bSurrogate = o_rCharacter >= 0xD800 && o_rCharacter <= 0xDFFF;
	return o_rCharacter < c_Least[size] || o_rCharacter > 0x10FFFF || bSurrogate ? 0 : size;
}

std::string Hexadecimal(std::uint32_t i_Value, std::size_t i_Digits)
{
	std::string digits;
	for (int shift = 20; shift >= 0; shift -= 4)
		if (const std::uint32_t digit = i_Value >> shift & 15u;
		    digit > 0 || !digits.empty() || shift < 4 * int(i_Digits))
			digits += "0123456789ABCDEF"[digit];
	return digits;
}

/// @param i_Replace makes the text that stands for a character, or for a byte that is none.
template <typename TReplace>
std::string Replaced(std::string_view i_Text, const TReplace& i_Replace)
{
	std::string text;
	text.reserve(i_Text.size());
	while (!i_Text.empty())
	{
		// Nearly all of it.
		const auto plain = std::ranges::find_if(i_Text, [](char i_Byte) { return i_Byte < 0x20 || i_Byte > 0x7E; });
		text.append(i_Text.begin(), plain);
		i_Text.remove_prefix(std::size_t(plain - i_Text.begin()));
		if (i_Text.empty())
			break;
		std::uint32_t character = 0;
		const std::size_t size = Decode(i_Text, character);
		if (size == 0)
			text += i_Replace(std::uint8_t(i_Text.front()), false);
		else if (IsUnseen(character))
			text += i_Replace(character, true);
		else
			text += i_Text.substr(0, size);
		i_Text.remove_prefix(std::max<std::size_t>(size, 1));
	}
	return text;
}

std::string InBrackets(std::uint32_t i_Value, bool i_bCharacter)
{
	return (i_bCharacter ? "[U+" : "[0x") + Hexadecimal(i_Value, 2) + "]";
}

} // namespace

std::string Of(std::string_view i_Text)
{
	return Replaced(i_Text, InBrackets);
}

std::string OnOneLine(std::string_view i_Text)
{
	return Replaced(i_Text,
	    [](std::uint32_t i_Value, bool i_bCharacter)
	    { return i_bCharacter && i_Value < 0x80 ? " " : InBrackets(i_Value, i_bCharacter); });
}

std::string InJson(std::string_view i_Json)
{
	return Replaced(i_Json,
	    [](std::uint32_t i_Value, bool i_bCharacter)
	    {
		    // Line ends between the values, which a text in JSON cannot hold.
		    if (!i_bCharacter || i_Value < 0x20)
			    return std::string(1, char(i_Value));
		    if (i_Value < 0x10000)
			    return "\\u" + Hexadecimal(i_Value, 4);
		    const std::uint32_t pair = i_Value - 0x10000;
		    return "\\u" + Hexadecimal(0xD800 + (pair >> 10), 4) + "\\u" + Hexadecimal(0xDC00 + (pair & 0x3FF), 4);
	    });
}

} // namespace VisibleText
