#pragma once

#include <string>
#include <vector>

namespace CommandLine
{

/// A table for people: columns as wide as their widest text, two blanks between them, numbers to the right. Where the
/// terminal is narrower, the last column is wrapped at blanks, and columns that do not fit go on in lines below.
class VTable
{
public:
	enum EAlign
	{
		ELeft,
		ERight
	};

	void AddColumn(const std::string& i_rTitle, EAlign i_Align);
	/// One text for each column; bytes that would drive a terminal become blanks.
	void AddRow(const std::vector<std::string>& i_rTexts);
	/// The titles, bold if wanted, then each row, without blanks at the ends of lines.
	/// @param i_Width columns of the terminal; 0 for no limit, where each row is one line
	std::string Text(bool i_bBold, std::size_t i_Width = 0) const;
	/// Columns of the terminal that its longest line takes.
	std::size_t LineWidth() const;

private:
	/// How wide a column is, and whether it begins a line.
	struct VColumn
	{
		std::size_t m_Width = 0;
		bool m_bBreak = false;
	};

	std::vector<std::size_t> Widths() const;
	std::vector<VColumn> Layout(std::size_t i_Width) const;
	std::string RowText(const std::vector<std::string>& i_rRow, const std::vector<VColumn>& i_rColumns) const;

	std::vector<EAlign> m_Aligns;
	std::vector<std::vector<std::string>> m_Rows{1};
};

/// Numbers for people, whatever the language of the process.
std::string Fixed(double i_Value, int i_Decimals);
std::string Shortest(double i_Value);

} // namespace CommandLine
