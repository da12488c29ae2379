#include "retarget/text/Table.h"

#include "CommandLineText/HelpFormatter.h"
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

std::size_t LongestWord(const std::string& i_rText)
{
	std::size_t longest = 0;
	for (std::size_t begin = 0; begin < i_rText.size();)
	{
		const std::size_t end = std::min(i_rText.find(' ', begin), i_rText.size());
		longest = std::max(longest, Width(i_rText.substr(begin, end - begin)));
		begin = end + 1;
	}
	return longest;
}

/// Where lines of a row begin that go on with it: under its second column, behind an index.
constexpr std::size_t c_Continued = 7;

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

std::vector<VTable::VColumn> VTable::Layout(std::size_t i_Width) const
{
	const std::vector<std::size_t> widths = Widths();
	std::vector<VColumn> columns;
	std::size_t used = 0;
	for (std::size_t i = 0; i < widths.size(); ++i)
	{
		VColumn& rColumn = columns.emplace_back(VColumn{widths[i]});
		std::size_t least = widths[i];
		if (i + 1 == widths.size())
		{
			least = 0;
			for (const auto& rRow : m_Rows)
				least = std::max(least, LongestWord(rRow[i]));
		}
		rColumn.m_bBreak = i_Width > 0 && i > 0 && used + 2 + least > i_Width;
		used = i == 0 ? 0 : rColumn.m_bBreak ? c_Continued : used + 2;
		if (i_Width > 0 && used + widths[i] > i_Width)
			rColumn.m_Width = std::max(least, i_Width - std::min(i_Width, used));
		used += rColumn.m_Width;
	}
	return columns;
}

std::string VTable::RowText(const std::vector<std::string>& i_rRow, const std::vector<VColumn>& i_rColumns) const
{
	std::string text;
	std::string line;
	const auto endLine = [&]
	{
		line.erase(line.find_last_not_of(' ') + 1);
		if (!line.empty())
			text += line + "\n";
	};
	for (std::size_t i = 0; i < i_rRow.size(); ++i)
	{
		const VColumn& rColumn = i_rColumns[i];
		if (rColumn.m_bBreak)
		{
			endLine();
			line = std::string(c_Continued, ' ');
		}
		else if (i > 0)
			line += "  ";
		const std::size_t width = Width(i_rRow[i]);
		if (width > rColumn.m_Width)
		{
			line += Wrap(i_rRow[i], rColumn.m_Width, Width(line));
			continue;
		}
		const std::string pad(rColumn.m_Width - width, ' ');
		line += m_Aligns[i] == ERight ? pad + i_rRow[i] : i_rRow[i] + pad;
	}
	endLine();
	return text;
}

std::string VTable::Text(bool i_bBold, std::size_t i_Width) const
{
	const std::vector<VColumn> columns = Layout(i_Width);
	const std::string titles = RowText(m_Rows.front(), columns);
	std::string text = i_bBold ? "\033[1m" + titles.substr(0, titles.size() - 1) + "\033[0m\n" : titles;
	for (std::size_t row = 1; row < m_Rows.size(); ++row)
		text += RowText(m_Rows[row], columns);
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
