#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace CommandLine
{

/// Text as it may stand in HTML, in elements and in quoted attributes: markup escaped; bytes that are no UTF-8,
/// control characters, and characters that are not seen or turn the direction of what is beside them, as their numbers.
std::string EscapedForHtml(std::string_view i_Text);

/// A page in one file, with nothing from elsewhere and no script, for a screen and for paper. Everything that is given
/// is escaped here.
class VPage
{
public:
	explicit VPage(const std::string& i_rTitle);

	void Heading(const std::string& i_rText);
	void Paragraph(const std::string& i_rText);
	void List(const std::vector<std::string>& i_rItems);
	/// @param i_rColumns their titles; those that begin with "#" hold numbers and are written without it.
	void Table(const std::vector<std::string>& i_rColumns, const std::vector<std::vector<std::string>>& i_rRows);
	/// Pictures beside each other.
	/// @param i_rPngs the bytes of each
	void Pictures(const std::vector<std::string>& i_rCaptions, const std::vector<std::string>& i_rPngs);

	/// A drawing as wide as the page, and what it shows.
	/// @param i_rSvg an element "svg" of ours, which escapes what it is given itself
	void Drawing(const std::string& i_rCaption, const std::string& i_rSvg);

	/// The whole page.
	std::string Text() const;

private:
	std::string m_Text;
};

} // namespace CommandLine
