#include "UtilsRapidXml/Parser.h"

#include "UtilsRapidXml/Characters.h"
#include "UtilsRapidXml/Limits.h"

#include <rapidxml/rapidxml.hpp>

#include <algorithm>
#include <array>
#include <charconv>
#include <cstring>
#include <string_view>
#include <vector>

namespace
{

using namespace UtilsRapidXml;

bool IsSpace(char i_Byte)
{
	return i_Byte == ' ' || i_Byte == '\t' || i_Byte == '\n' || i_Byte == '\r';
}

constexpr unsigned char c_StartsName = 1;
constexpr unsigned char c_ContinuesName = 2;

/// What a byte may do in a name.
constexpr auto c_NameBytes = []
{
	std::array<unsigned char, 256> bytes{};
	for (int byte = 0; byte < 256; ++byte)
	{
		const int lower = byte | 0x20;
		if ((lower >= 'a' && lower <= 'z') || byte == '_' || byte == ':' || byte >= 0x80)
			bytes[byte] = c_StartsName | c_ContinuesName;
		else if ((byte >= '0' && byte <= '9') || byte == '-' || byte == '.')
			bytes[byte] = c_ContinuesName;
	}
	return bytes;
}();

bool IsInName(char i_Byte, unsigned char i_Place)
{
	return (c_NameBytes[static_cast<unsigned char>(i_Byte)] & i_Place) != 0;
}

/// True if a quoted value has no reference and nothing that becomes a blank: nearly all of any file.
bool IsPlainValue(std::string_view i_Value)
{
	const auto isOther = [](const auto& i_rBytes) { return ((i_rBytes >= 0) & (i_rBytes < ' ')) | (i_rBytes == '&'); };
	if (i_Value.size() < sizeof(VBlock))
		return std::none_of(
		    i_Value.begin(), i_Value.end(), [&](char i_Byte) { return isOther(static_cast<signed char>(i_Byte)); });
	// The last block may overlap the one before.
	const char* const pLast = i_Value.data() + i_Value.size() - sizeof(VBlock);
	for (const char* p = i_Value.data(); p < pLast; p += sizeof(VBlock))
		if (BlockHas(p, isOther))
			return false;
	return !BlockHas(pLast, isOther);
}

constexpr std::pair<std::string_view, char> c_Entities[] = {
    {"&amp;", '&'}, {"&lt;", '<'}, {"&gt;", '>'}, {"&quot;", '"'}, {"&apos;", '\''}};

char* AppendUtf8(std::uint32_t i_Code, char* o_p)
{
	if (i_Code < 0x80)
	{
		*o_p++ = static_cast<char>(i_Code);
		return o_p;
	}
	const int more = i_Code < 0x800 ? 1 : i_Code < 0x10000 ? 2 : 3;
	constexpr unsigned char c_Marks[] = {0, 0xC0, 0xE0, 0xF0};
	*o_p++ = static_cast<char>(c_Marks[more] | i_Code >> 6 * more);
	for (int i = more; i-- > 0;)
		*o_p++ = static_cast<char>(0x80 | (i_Code >> 6 * i & 0x3F));
	return o_p;
}

/// Attributes that are looked through for each further one of an element; of more all are sorted.
constexpr std::size_t c_Few = 24;

/// What an "&" stands for.
struct VReference
{
	/// @param i_pEnd of the text, where a zero byte stands.
	VReference(const char* i_pAt, const char* i_pEnd) : m_pEnd(i_pAt + 1)
	{
		if (*m_pEnd == '#')
		{
			const bool bHexadecimal = i_pAt[2] == 'x';
			const auto result = std::from_chars(i_pAt + 2 + bHexadecimal, i_pEnd, m_Code, bHexadecimal ? 16 : 10);
			m_bFine = result.ec == std::errc() && *result.ptr == ';' && IsXmlCharacter(m_Code);
			m_pEnd = result.ptr + 1;
			return;
		}
		for (const auto& [text, character] : c_Entities)
			if (std::string_view(i_pAt, i_pEnd - i_pAt).starts_with(text))
			{
				m_Code = static_cast<unsigned char>(character);
				m_pEnd = i_pAt + text.size();
				return;
			}
	}

	/// The character; the "&" itself if it is no entity of XML's own.
	std::uint32_t m_Code = '&';
	/// Behind the reference.
	const char* m_pEnd;
	bool m_bFine = true;
};

class VParser
{
public:
	VParser(std::string& io_rText, VXmlDocument& io_rDocument)
	    : m_rText(io_rText), m_rDocument(io_rDocument), m_p(io_rText.data()), m_pEnd(m_p + io_rText.size()),
	      m_pOpen(&io_rDocument)
	{
	}

	bool Run();
	std::string Error() const;

private:
	bool Fail(const char* i_pAt, std::string i_Text)
	{
		m_pAt = i_pAt;
		m_Error = std::move(i_Text);
		return false;
	}

	void SkipSpace()
	{
		// The text ends with a zero byte.
		while (IsSpace(*m_p))
			++m_p;
	}

	bool Take(std::string_view i_Text)
	{
		if (!std::string_view(m_p, m_pEnd - m_p).starts_with(i_Text))
			return false;
		m_p += i_Text.size();
		return true;
	}

	bool Take(char i_Byte)
	{
		if (*m_p != i_Byte)
			return false;
		++m_p;
		return true;
	}

	std::string_view TakeName()
	{
		char* const pBegin = m_p;
		char* p = pBegin;
		if (IsInName(*p, c_StartsName))
			while (IsInName(*p, c_ContinuesName))
				++p;
		m_p = p;
		return {pBegin, p};
	}

	bool SkipPast(std::string_view i_End, const char* i_pWhat)
	{
		const std::size_t found = std::string_view(m_p, m_pEnd - m_p).find(i_End);
		if (found == std::string_view::npos)
			return Fail(m_p, std::string(i_pWhat) + " does not end");
		m_p += found + i_End.size();
		return true;
	}

	/// Before each node: whether there may be one more.
	bool Count(std::size_t i_Bytes)
	{
		m_Bytes += i_Bytes;
		return m_Bytes <= c_MaximumDocumentBytes || Fail(m_p, "too many elements and attributes");
	}

	bool Markup();
	bool DocumentType();
	bool Opening();
	bool Closing();
	bool Attribute(VXmlNode& io_rElement);
	static std::string_view TwiceAmongMany(const VXmlNode& i_rElement);
	bool Text();
	bool References(const char* i_pBegin, const char* i_pEnd);
	char* Decode(char* i_pBegin, const char* i_pEnd);

	std::string& m_rText;
	VXmlDocument& m_rDocument;
	char* m_p;
	char* const m_pEnd;
	/// The element in hand; the document where there is none.
	VXmlNode* m_pOpen;
	std::size_t m_Depth = 0;
	/// The attributes of the tag in hand, their names, and that of one which stands twice.
	std::size_t m_AttributeCount = 0;
	std::uint64_t m_NameBits = 0;
	std::string_view m_Twice;
	/// Of text and nodes.
	std::size_t m_Bytes = m_rText.size();
	/// Line ends of the values behind us that are no longer in the text.
	std::ptrdiff_t m_LineEndsGone = 0;
	const char* m_pAt = nullptr;
	std::string m_Error;
};

bool VParser::Run()
{
	const std::size_t broken = FindBrokenCharacter(m_rText);
	if (broken != std::string::npos)
		return Fail(
		    m_p + broken, m_rText[broken] == 0 ? "zero byte" : "byte that is no valid UTF-8 or no character of XML");
	Take("\xEF\xBB\xBF");
	while (Text())
	{
		if (m_p == m_pEnd)
			return m_Depth == 0
			    || Fail(m_p, "element " + std::string(m_pOpen->name(), m_pOpen->name_size()) + " is not closed");
		if (!Markup())
			return false;
	}
	return false;
}

/// What stands before the next "<" or the end. Its references are checked, and it is forgotten.
bool VParser::Text()
{
	SkipSpace();
	if (*m_p == '<')
		return true;
	char* const pText = m_p;
	char* const pMarkup = static_cast<char*>(std::memchr(m_p, '<', m_pEnd - m_p));
	m_p = pMarkup ? pMarkup : m_pEnd;
	if (m_Depth == 0 && m_p != pText)
		return Fail(pText, "text outside of any element");
	return References(pText, m_p);
}

bool VParser::Markup()
{
	const char next = m_p[1];
	if (next != '/' && next != '?' && next != '!')
	{
		++m_p;
		return Opening();
	}
	if (Take("</"))
		return Closing();
	if (Take("<?"))
		return SkipPast("?>", "processing instruction");
	if (Take("<!--"))
		return SkipPast("-->", "comment");
	if (Take("<![CDATA["))
		return SkipPast("]]>", "character data");
	if (Take("<!DOCTYPE"))
		return DocumentType();
	return Fail(m_p + 1, "element without a name");
}

/// Nothing asks for its identifiers, which may hold what would end it.
bool VParser::DocumentType()
{
	const char* const pAt = m_p;
	const auto fail = [&] { return Fail(pAt, "document type that is broken or has an internal subset"); };
	if (!IsSpace(*m_p))
		return fail();
	while (m_p != m_pEnd && *m_p != '>' && *m_p != '[')
	{
		const char quote = *m_p++;
		if (quote != '"' && quote != '\'')
			continue;
		m_p = std::find(m_p, m_pEnd, quote);
		if (m_p == m_pEnd)
			return fail();
		++m_p;
	}
	return Take('>') || fail();
}

bool VParser::Opening()
{
	const std::string_view name = TakeName();
	if (name.empty())
		return Fail(m_p, "element without a name");
	if (!Count(sizeof(VXmlNode)))
		return false;
	VXmlNode* const pElement = m_rDocument.allocate_node(rapidxml::node_element);
	pElement->name(name.data(), name.size());
	m_pOpen->append_node(pElement);
	m_AttributeCount = 0;
	m_NameBits = 0;
	m_Twice = {};
	SkipSpace();
	while (m_p != m_pEnd && *m_p != '>' && *m_p != '/')
		if (!Attribute(*pElement))
			return false;
	if (m_AttributeCount > c_Few)
		m_Twice = TwiceAmongMany(*pElement);
	if (!m_Twice.empty())
		return Fail(m_Twice.data(), "attribute " + std::string(m_Twice) + " stands twice");
	const bool bEmpty = *m_p == '/' && m_p[1] == '>';
	m_p += bEmpty;
	if (!Take('>'))
		return Fail(m_p, "tag of element " + std::string(name) + " does not end");
	if (bEmpty)
		return true;
	m_pOpen = pElement;
	return ++m_Depth <= c_MaximumDepth
	    || Fail(m_p, "elements are nested deeper than " + std::to_string(c_MaximumDepth));
}

bool VParser::Closing()
{
	const char* const pAt = m_p;
	const std::string_view name = TakeName();
	SkipSpace();
	if (m_Depth == 0 || name != std::string_view(m_pOpen->name(), m_pOpen->name_size()))
		return Fail(pAt, "closing tag " + std::string(name) + " does not match");
	if (!Take('>'))
		return Fail(m_p, "closing tag " + std::string(name) + " does not end");
	m_pOpen = m_pOpen->parent();
	--m_Depth;
	return true;
}

bool VParser::Attribute(VXmlNode& io_rElement)
{
	const std::string_view name = TakeName();
	if (name.empty())
		return Fail(m_p, "attribute without a name");
	SkipSpace();
	if (!Take('='))
		return Fail(m_p, "attribute " + std::string(name) + " has no value");
	SkipSpace();
	const char quote = *m_p;
	if (quote != '"' && quote != '\'')
		return Fail(m_p, "value of attribute " + std::string(name) + " is not quoted");
	char* const pBegin = ++m_p;
	char* const pQuote = static_cast<char*>(std::memchr(pBegin, quote, m_pEnd - pBegin));
	char* pEnd = pQuote ? pQuote : m_pEnd;
	const bool bPlain = IsPlainValue({pBegin, pEnd});
	if (!bPlain && !References(pBegin, pEnd))
		return false;
	if (!pQuote)
		return Fail(pBegin, "value of attribute " + std::string(name) + " does not end");
	if (!bPlain)
		pEnd = Decode(pBegin, pQuote);
	m_p = pQuote + 1;
	if (!Count(sizeof(VXmlAttribute)))
		return false;
	const std::uint64_t bit = NameBit(name);
	if (++m_AttributeCount <= c_Few && (m_NameBits & bit) != 0 && m_Twice.empty()
	    && io_rElement.first_attribute(name.data(), name.size()))
		m_Twice = name;
	m_NameBits |= bit;
	VXmlAttribute* const pAttribute = m_rDocument.allocate_attribute();
	pAttribute->name(name.data(), name.size());
	pAttribute->value(pBegin, pEnd - pBegin);
	io_rElement.append_attribute(pAttribute);
	SkipSpace();
	return true;
}

/// Checks the references to characters.
bool VParser::References(const char* i_pBegin, const char* i_pEnd)
{
	for (const char* p = i_pBegin; (p = static_cast<const char*>(std::memchr(p, '&', i_pEnd - p))); ++p)
	{
		const VReference reference(p, m_pEnd);
		if (!reference.m_bFine)
			return Fail(p, "broken character reference");
	}
	return true;
}

/// Puts what references mean in their place, and blanks in that of white space, one for a line end of two bytes.
/// @return where the value ends then.
char* VParser::Decode(char* i_pBegin, const char* i_pEnd)
{
	const auto lineEnds = [&] { return std::count(static_cast<const char*>(i_pBegin), i_pEnd, '\n'); };
	m_LineEndsGone += lineEnds();
	char* pOut = i_pBegin;
	for (const char* p = i_pBegin; p != i_pEnd;)
		if (*p == '&')
		{
			const VReference reference(p, m_pEnd);
			pOut = AppendUtf8(reference.m_Code, pOut);
			p = reference.m_pEnd;
		}
		else
		{
			p += *p == '\r' && p + 1 != i_pEnd && p[1] == '\n';
			*pOut++ = IsSpace(*p) ? ' ' : *p;
			++p;
		}
	m_LineEndsGone -= lineEnds();
	return pOut;
}

/// A name that two attributes of the element have, empty if there is none.
std::string_view VParser::TwiceAmongMany(const VXmlNode& i_rElement)
{
	std::vector<std::string_view> names;
	for (const auto* pAttribute = i_rElement.first_attribute(); pAttribute; pAttribute = pAttribute->next_attribute())
		names.emplace_back(pAttribute->name(), pAttribute->name_size());
	std::sort(names.begin(), names.end());
	const auto twice = std::adjacent_find(names.begin(), names.end());
	return twice == names.end() ? std::string_view() : *twice;
}

std::string VParser::Error() const
{
	const auto line = 1 + m_LineEndsGone + std::count(static_cast<const char*>(m_rText.data()), m_pAt, '\n');
	return "line " + std::to_string(line) + ": " + m_Error;
}

} // namespace

bool UtilsRapidXml::ParseText(std::string& io_rText, VXmlDocument& io_rDocument, std::string& o_rError)
{
	if (io_rText.size() > c_MaximumDocumentBytes)
	{
		o_rError = "text of " + std::to_string(io_rText.size()) + " bytes is larger than "
		    + std::to_string(c_MaximumDocumentBytes);
		return false;
	}
	VParser parser(io_rText, io_rDocument);
	if (parser.Run())
		return true;
	o_rError = parser.Error();
	return false;
}
