#include "UtilsRapidXml/Printer.h"

#include "UtilsRapidXml/Characters.h"

#include <rapidxml/rapidxml.hpp>

#include <algorithm>
#include <array>
#include <string_view>

namespace
{

using UtilsRapidXml::VXmlNode;

/// What a byte becomes; empty for itself.
using VEscapes = std::array<std::string_view, 256>;

constexpr VEscapes c_TextEscapes = []
{
	VEscapes escapes{};
	escapes['<'] = "&lt;";
	escapes['>'] = "&gt;";
	escapes['&'] = "&amp;";
	escapes['"'] = "&quot;";
	escapes['\''] = "&apos;";
	return escapes;
}();

/// Within quotes of one kind the other kind stands for itself.
constexpr VEscapes AttributeEscapes(unsigned char i_OtherQuote)
{
	VEscapes escapes = c_TextEscapes;
	escapes[i_OtherQuote] = {};
	escapes['\t'] = "&#9;";
	escapes['\n'] = "&#10;";
	escapes['\r'] = "&#13;";
	return escapes;
}

constexpr VEscapes c_DoubleQuotedEscapes = AttributeEscapes('\'');
constexpr VEscapes c_SingleQuotedEscapes = AttributeEscapes('"');

void AppendEscaped(std::string_view i_Text, const VEscapes& i_rEscapes, std::string& io_rText)
{
	std::size_t begin = 0;
	for (std::size_t i = 0; i < i_Text.size(); ++i)
	{
		const std::string_view escape = i_rEscapes[static_cast<unsigned char>(i_Text[i])];
		if (escape.empty())
			continue;
		(io_rText += i_Text.substr(begin, i - begin)) += escape;
		begin = i + 1;
	}
	io_rText += i_Text.substr(begin);
}

void AppendAttributes(const VXmlNode& i_rNode, std::string& io_rText)
{
	for (const auto* pAttribute = i_rNode.first_attribute(); pAttribute; pAttribute = pAttribute->next_attribute())
		UtilsRapidXml::PrintAttribute(
		    {pAttribute->name(), pAttribute->name_size()}, {pAttribute->value(), pAttribute->value_size()}, io_rText);
}

/// Writes a node without its children.
/// @return true if they follow, and then the closing tag.
bool Open(const VXmlNode& i_rNode, std::size_t i_Depth, std::string& io_rText)
{
	const std::string_view name(i_rNode.name(), i_rNode.name_size());
	const std::string_view value(i_rNode.value(), i_rNode.value_size());
	io_rText.append(i_Depth, '\t');
	if (i_rNode.type() == rapidxml::node_declaration)
	{
		io_rText += "<?xml";
		AppendAttributes(i_rNode, io_rText);
		io_rText += "?>\n";
		return false;
	}
	if (i_rNode.type() == rapidxml::node_pi)
	{
		(((io_rText += "<?") += name) += ' ') += value;
		io_rText += "?>\n";
		return false;
	}
	(io_rText += '<') += name;
	AppendAttributes(i_rNode, io_rText);
	if (i_rNode.first_node())
	{
		io_rText += ">\n";
		return true;
	}
	if (value.empty())
		io_rText += "/>\n";
	else
	{
		io_rText += '>';
		AppendEscaped(value, c_TextEscapes, io_rText);
		((io_rText += "</") += name) += ">\n";
	}
	return false;
}

} // namespace

bool UtilsRapidXml::StandsForItself(std::string_view i_Text)
{
	const auto isOther = [](const auto& i_rBytes)
	{
		return (i_rBytes < ' ') | (i_rBytes == '<') | (i_rBytes == '>') | (i_rBytes == '&') | (i_rBytes == '"')
		    | (i_rBytes == '\'');
	};
	for (; i_Text.size() >= sizeof(VBlock); i_Text.remove_prefix(sizeof(VBlock)))
		if (BlockHas(i_Text.data(), isOther))
			return false;
	return std::none_of(
	    i_Text.begin(), i_Text.end(), [&](char i_Byte) { return isOther(static_cast<signed char>(i_Byte)); });
}

void UtilsRapidXml::PrintAttribute(std::string_view i_Name, std::string_view i_Value, std::string& io_rText)
{
	(io_rText += ' ') += i_Name;
	if (StandsForItself(i_Value))
	{
		((io_rText += "=\"") += i_Value) += '"';
		return;
	}
	const char quote = i_Value.find('"') == std::string_view::npos ? '"' : '\'';
	(io_rText += '=') += quote;
	AppendEscaped(i_Value, quote == '"' ? c_DoubleQuotedEscapes : c_SingleQuotedEscapes, io_rText);
	io_rText += quote;
}

std::string UtilsRapidXml::Print(const VXmlNode& i_rDocument)
{
	std::string text;
	std::size_t depth = 0;
	const VXmlNode* pNode = i_rDocument.first_node();
	while (pNode)
	{
		if (Open(*pNode, depth, text))
		{
			pNode = pNode->first_node();
			++depth;
			continue;
		}
		while (!pNode->next_sibling() && depth > 0)
		{
			pNode = pNode->parent();
			text.append(--depth, '\t').append("</").append(pNode->name(), pNode->name_size()).append(">\n");
		}
		pNode = pNode->next_sibling();
	}
	return text += '\n';
}
