#pragma once

#include <string>
#include <vector>

namespace CommandLine
{

/// A table for people: columns as wide as their widest text, two blanks between them, numbers to the right.
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
	/// One line for the titles, bold if wanted, then one for each row, without blanks at its end.
	std::string Text(bool i_bBold) const;
	/// Columns of the terminal that its longest line takes.
	std::size_t LineWidth() const;

private:
	std::vector<std::size_t> Widths() const;

	std::vector<EAlign> m_Aligns;
	std::vector<std::vector<std::string>> m_Rows{1};
};

/// Numbers for people, whatever the language of the process.
std::string Fixed(double i_Value, int i_Decimals);
std::string Shortest(double i_Value);

} // namespace CommandLine
