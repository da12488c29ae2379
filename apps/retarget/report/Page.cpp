#include "retarget/report/Page.h"

#include "math/VisibleText.h"

#include <boost/archive/iterators/base64_from_binary.hpp>
#include <boost/archive/iterators/transform_width.hpp>

#include <algorithm>

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
td { min-width: 8.5em; }
th { border-bottom: 1px solid #000; overflow-wrap: normal; }
td.n, th.n { min-width: 0; text-align: right; white-space: nowrap; font-variant-numeric: tabular-nums; }
tr { break-inside: avoid; }
thead { display: table-header-group; }
.pictures { display: flex; flex-wrap: wrap; gap: 1em; }
figure { margin: 0; width: calc(50% - 0.5em); break-inside: avoid; }
figure.wide { width: 100%; }
svg { width: 100%; height: auto; display: block; }
img { width: 100%; border: 1px solid #ccc; }
@media print { body { margin: 0; max-width: none; font-size: 9pt; } }
)";

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
	for (const char byte : VisibleText::Of(i_Text))
		text += byte == '&' ? "&amp;"
		    : byte == '<'   ? "&lt;"
		    : byte == '>'   ? "&gt;"
		    : byte == '"'   ? "&quot;"
		    : byte == '\''  ? "&#39;"
		                    : std::string(1, byte);
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
		m_Text.append("<figure><img alt=\"").append(caption).append("\" src=\"data:image/png;base64,");
		m_Text.append(Base64(i_rPngs[i])).append("\"><figcaption>").append(caption).append("</figcaption></figure>\n");
	}
	m_Text += "</div>\n";
}

void VPage::Drawing(const std::string& i_rCaption, const std::string& i_rSvg)
{
	m_Text +=
	    "<figure class=\"wide\">" + i_rSvg + "<figcaption>" + EscapedForHtml(i_rCaption) + "</figcaption></figure>\n";
}

std::string VPage::Text() const
{
	return m_Text + "</body>\n</html>\n";
}

} // namespace CommandLine
