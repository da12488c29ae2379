#include "retarget/report/Page.h"

#include <boost/archive/iterators/base64_from_binary.hpp>
#include <boost/archive/iterators/transform_width.hpp>

#include <algorithm>
#include <array>
#include <cstdint>

namespace CommandLine
{
namespace
{

constexpr const char* c_pStyle = R"(
body { font: 10pt/1.4 sans-serif; color: #000; background: #fff; max-width: 60em; margin: 2em auto; padding: 0 1em; }
h1 { font-size: 1.6em; overflow-wrap: anywhere; }
h2 { font-size: 1.2em; margin: 1.6em 0 0.4em; border-bottom: 1px solid #888; break-after: avoid; }
table { border-collapse: collapse; width: 100%; }
th, td { border-bottom: 1px solid #ccc; padding: 0.15em 0.8em 0.15em 0; text-align: left; vertical-align: top;
	overflow-wrap: anywhere; }
th { border-bottom: 1px solid #000; }
td.n, th.n { text-align: right; white-space: nowrap; font-variant-numeric: tabular-nums; }
tr { break-inside: avoid; }
thead { display: table-header-group; }
.pictures { display: flex; flex-wrap: wrap; gap: 1em; }
figure { margin: 0; width: calc(50% - 0.5em); break-inside: avoid; }
img { width: 100%; border: 1px solid #ccc; }
@media print { body { margin: 0; max-width: none; font-size: 9pt; } }
)";

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

std::string Number(std::uint32_t i_Value, const char* i_pBegin)
{
	std::string digits;
	for (int shift = 20; shift >= 0; shift -= 4)
		if (const std::uint32_t digit = i_Value >> shift & 15u; digit > 0 || !digits.empty() || shift < 8)
			digits += "0123456789ABCDEF"[digit];
	return "[" + std::string(i_pBegin) + digits + "]";
}

std::string Base64(std::string_view i_Bytes)
{
	using namespace boost::archive::iterators;
	using VBase64 = base64_from_binary<transform_width<const char*, 6, 8>>;
	// The last group is filled with zeros, which "=" then stands for.
	std::string padded(i_Bytes);
	padded.append((3 - padded.size() % 3) % 3, '\0');
	std::string text(VBase64(padded.data()), VBase64(padded.data() + padded.size()));
	std::fill_n(text.rbegin(), padded.size() - i_Bytes.size(), '=');
	return text;
}

/// With a direction of its own, so that a name that is written from right to left leaves what follows in its place.
std::string Cell(const std::string& i_rText)
{
	return "<bdi>" + EscapedForHtml(i_rText) + "</bdi>";
}

} // namespace

std::string EscapedForHtml(std::string_view i_Text)
{
	std::string text;
	while (!i_Text.empty())
	{
		std::uint32_t character = 0;
		const std::size_t size = Decode(i_Text, character);
		if (size == 0)
			text += Number(std::uint8_t(i_Text.front()), "0x");
		else if (IsUnseen(character))
			text += Number(character, "U+");
		else if (character == '&')
			text += "&amp;";
		else if (character == '<')
			text += "&lt;";
		else if (character == '>')
			text += "&gt;";
		else if (character == '"')
			text += "&quot;";
		else if (character == '\'')
			text += "&#39;";
		else
			text += i_Text.substr(0, size);
		i_Text.remove_prefix(std::max<std::size_t>(size, 1));
	}
	return text;
}

VPage::VPage(const std::string& i_rTitle)
{
	m_Text = "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n"
	         "<meta http-equiv=\"Content-Security-Policy\" content=\"default-src 'none'; img-src data:; style-src "
	         "'unsafe-inline'\">\n<meta name=\"viewport\" content=\"width=device-width\">\n<title>"
	    + EscapedForHtml(i_rTitle) + "</title>\n<style>" + c_pStyle + "</style>\n</head>\n<body>\n<h1>" + Cell(i_rTitle)
	    + "</h1>\n";
}

void VPage::Heading(const std::string& i_rText)
{
	m_Text += "<h2>" + EscapedForHtml(i_rText) + "</h2>\n";
}

void VPage::Paragraph(const std::string& i_rText)
{
	m_Text += "<p>" + Cell(i_rText) + "</p>\n";
}

void VPage::List(const std::vector<std::string>& i_rItems)
{
	m_Text += "<ul>\n";
	for (const std::string& rItem : i_rItems)
		m_Text += "<li>" + Cell(rItem) + "</li>\n";
	m_Text += "</ul>\n";
}

void VPage::Table(const std::vector<std::string>& i_rColumns, const std::vector<std::vector<std::string>>& i_rRows)
{
	const auto begin = [&](const char* i_pElement, std::size_t i_Column)
	{
		const bool bNumber = i_Column < i_rColumns.size() && i_rColumns[i_Column].starts_with('#');
		return "<" + std::string(i_pElement) + (bNumber ? " class=\"n\">" : ">");
	};
	m_Text += "<table>\n<thead><tr>";
	for (std::size_t i = 0; i < i_rColumns.size(); ++i)
		m_Text += begin("th", i) + EscapedForHtml(i_rColumns[i].substr(i_rColumns[i].starts_with('#'))) + "</th>";
	m_Text += "</tr></thead>\n<tbody>\n";
	for (const std::vector<std::string>& rRow : i_rRows)
	{
		m_Text += "<tr>";
		for (std::size_t i = 0; i < rRow.size(); ++i)
			m_Text += begin("td", i) + Cell(rRow[i]) + "</td>";
		m_Text += "</tr>\n";
	}
	m_Text += "</tbody>\n</table>\n";
}

void VPage::Pictures(const std::vector<std::string>& i_rCaptions, const std::vector<std::string>& i_rPngs)
{
	m_Text += "<div class=\"pictures\">\n";
	for (std::size_t i = 0; i < std::min(i_rCaptions.size(), i_rPngs.size()); ++i)
	{
		const std::string caption = EscapedForHtml(i_rCaptions[i]);
		m_Text += "<figure><img alt=\"" + caption + "\" src=\"data:image/png;base64," + Base64(i_rPngs[i])
		    + "\"><figcaption>" + caption + "</figcaption></figure>\n";
	}
	m_Text += "</div>\n";
}

std::string VPage::Text() const
{
	return m_Text + "</body>\n</html>\n";
}

} // namespace CommandLine
