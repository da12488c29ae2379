#include "retarget/text/Table.h"

#include "retarget/text/Output.h"

#include <algorithm>
#include <charconv>

namespace CommandLine
{
namespace
{

/// Number of UTF-8 characters: all bytes but those that continue one.
std::size_t Width(const std::string& i_rText)
{
	return std::size_t(std::count_if(i_rText.begin(), i_rText.end(),
	    [](char i_Byte) { return (static_cast<unsigned char>(i_Byte) & 0xC0) != 0x80; }));
}

} // namespace

void VTable::AddColumn(const std::string& i_rTitle, EAlign i_Align)
{
	m_Aligns.push_back(i_Align);
	m_Rows.front().push_back(i_rTitle);
}

void VTable::AddRow(const std::vector<std::string>& i_rTexts)
{
	m_Rows.emplace_back();
	for (const std::string& rText : i_rTexts)
		m_Rows.back().push_back(Printable(rText));
}

std::vector<std::size_t> VTable::Widths() const
{
	std::vector<std::size_t> widths(m_Aligns.size());
	for (const auto& rRow : m_Rows)
		for (std::size_t i = 0; i < rRow.size(); ++i)
			widths[i] = std::max(widths[i], Width(rRow[i]));
	return widths;
}

std::size_t VTable::LineWidth() const
{
	std::size_t width = 0;
	for (const std::size_t column : Widths())
		width += column + (width == 0 ? 0 : 2);
	return width;
}

std::string VTable::Text(bool i_bBold) const
{
	const std::vector<std::size_t> widths = Widths();
	std::string text;
	for (std::size_t row = 0; row < m_Rows.size(); ++row)
	{
		std::string line;
		for (std::size_t i = 0; i < m_Rows[row].size(); ++i)
		{
			const std::string& rText = m_Rows[row][i];
			const std::string pad(widths[i] - Width(rText), ' ');
			line += (i == 0 ? "" : "  ") + (m_Aligns[i] == ERight ? pad + rText : rText + pad);
		}
		line.erase(line.find_last_not_of(' ') + 1);
		text += row == 0 && i_bBold ? "\033[1m" + line + "\033[0m\n" : line + "\n";
	}
	return text;
}

std::string Fixed(double i_Value, int i_Decimals)
{
	// The largest double has 309 digits before the point.
	char text[400];
	return {text, std::to_chars(text, text + sizeof(text), i_Value, std::chars_format::fixed, i_Decimals).ptr};
}

std::string Shortest(double i_Value)
{
	char text[32];
	return {text, std::to_chars(text, text + sizeof(text), i_Value).ptr};
}

} // namespace CommandLine
