#include "fbxsdk/document/Text.h"

#include <utility>

namespace
{

using namespace std::string_view_literals;

/// The length of the UTF-8 sequence that begins a text, 0 if it begins with none. Overlong forms, surrogates and
/// what lies beyond the last code point are none.
std::size_t SequenceLength(std::string_view i_Text)
{
	const auto byte = [i_Text](std::size_t i_Place)
	{ return i_Place < i_Text.size() ? static_cast<unsigned char>(i_Text[i_Place]) : 0u; };
	const unsigned lead = byte(0);
	if (lead < 0x80)
		return 1;
	const std::size_t length = lead >= 0xC2 && lead < 0xE0 ? 2
	    : lead >= 0xE0 && lead < 0xF0                      ? 3
	    : lead >= 0xF0 && lead < 0xF5                      ? 4
	                                                       : 0;
	for (std::size_t i = 1; i < length; ++i)
		if ((byte(i) & 0xC0) != 0x80)
			return 0;
	const unsigned second = byte(1);
	const bool bBad = (lead == 0xE0 && second < 0xA0) || (lead == 0xED && second >= 0xA0)
	    || (lead == 0xF0 && second < 0x90) || (lead == 0xF4 && second >= 0x90);
	return bBad ? 0 : length;
}

bool IsUtf8(std::string_view i_Text)
{
	while (!i_Text.empty())
	{
		const std::size_t length = SequenceLength(i_Text);
		if (length == 0)
			return false;
		i_Text.remove_prefix(length);
	}
	return true;
}

std::string Unescape(std::string_view i_Text)
{
	static constexpr std::pair<std::string_view, char> c_Escapes[]{{"&quot;", '"'}, {"&lf;", '\n'}, {"&cr;", '\r'}};
	std::string text;
	text.reserve(i_Text.size());
	while (!i_Text.empty())
	{
		std::size_t taken = 1;
		char byte = i_Text.front();
		if (byte == '&')
			for (const auto& [escape, character] : c_Escapes)
				if (i_Text.starts_with(escape))
				{
					taken = escape.size();
					byte = character;
				}
		text += byte;
		i_Text.remove_prefix(taken);
	}
	return text;
}

} // namespace

FbxFormat::VFullName FbxFormat::SplitFullName(std::string_view i_FullName)
{
	if (const std::size_t at = i_FullName.find("\0\1"sv); at != std::string_view::npos)
		return {i_FullName.substr(0, at), i_FullName.substr(at + 2)};
	if (const std::size_t at = i_FullName.find("::"sv); at != std::string_view::npos)
		return {i_FullName.substr(at + 2), i_FullName.substr(0, at)};
	return {i_FullName, {}};
}

std::string FbxFormat::DecodeText(std::string_view i_Text, bool i_bEscaped)
{
	std::string text = i_bEscaped ? Unescape(i_Text) : std::string(i_Text);
	if (IsUtf8(text))
		return text;
	std::string utf8;
	utf8.reserve(2 * text.size());
	for (const char character : text)
	{
		const auto byte = static_cast<unsigned char>(character);
		if (byte >= 0x80)
			utf8 += char(0xC0 | byte >> 6);
		utf8 += byte < 0x80 ? character : char(0x80 | (byte & 0x3F));
	}
	return utf8;
}
