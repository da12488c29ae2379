#include "UtilsRapidXml/TextCheck.h"

#include "UtilsRapidXml/Characters.h"
#include "UtilsRapidXml/Limits.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstring>
#include <string_view>
#include <vector>

namespace
{

using namespace UtilsRapidXml;

/// What the nodes of a document take in memory.
constexpr std::size_t c_ElementBytes = 96;
constexpr std::size_t c_AttributeBytes = 56;

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

/// True if a quoted value has no reference and nothing that becomes a blank: nearly all of any file. All bytes are
/// looked at, whatever is found: compilers make few instructions of it.
bool IsPlainValue(std::string_view i_Value)
{
	unsigned char found = 0;
	for (const unsigned char byte : i_Value)
		found |= static_cast<unsigned char>(byte < 0x20) | static_cast<unsigned char>(byte == '&');
	return found == 0;
}

class VTextCheck
{
public:
	explicit VTextCheck(std::string& io_rText) : m_rText(io_rText), m_p(io_rText.data()), m_pEnd(m_p + io_rText.size())
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
		while (m_p != m_pEnd && IsSpace(*m_p))
			++m_p;
	}

	bool Take(std::string_view i_Text)
	{
		if (!std::string_view(m_p, m_pEnd - m_p).starts_with(i_Text))
			return false;
		m_p += i_Text.size();
		return true;
	}

	std::string_view TakeName()
	{
		char* const pBegin = m_p;
		char* p = pBegin;
		// The text ends with a zero byte.
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

	bool Markup();
	bool DocumentType();
	bool Opening();
	bool Closing();
	bool Attribute();
	bool Value(char* i_pBegin, char*& io_rpEnd);
	bool DuplicateAttribute();
	bool Text(const char* i_pBegin, const char* i_pEnd);
	bool Reference(const char* i_pAt);

	std::string& m_rText;
	char* m_p;
	char* const m_pEnd;
	std::vector<std::string_view> m_Open;
	std::vector<std::string_view> m_Attributes;
	std::size_t m_NodeBytes = 0;
	/// Line ends that were turned into blanks before the place of the error.
	std::size_t m_LineEndsReplaced = 0;
	const char* m_pAt = nullptr;
	std::string m_Error;
};

bool VTextCheck::Run()
{
	const std::size_t broken = FindBrokenCharacter(m_rText);
	if (broken != std::string::npos)
		return Fail(
		    m_p + broken, m_rText[broken] == 0 ? "zero byte" : "byte that is no valid UTF-8 or no character of XML");
	Take("\xEF\xBB\xBF");
	while (m_p != m_pEnd)
	{
		char* const pText = m_p;
		char* const pMarkup = static_cast<char*>(std::memchr(m_p, '<', m_pEnd - m_p));
		m_p = pMarkup ? pMarkup : m_pEnd;
		if (m_Open.empty())
		{
			const char* const pStray = std::find_if_not(pText, m_p, IsSpace);
			if (pStray != m_p)
				return Fail(pStray, "text outside of any element");
		}
		else if (!Text(pText, m_p))
			return false;
		if (m_p != m_pEnd && !Markup())
			return false;
		if (m_NodeBytes + m_rText.size() > c_MaximumDocumentBytes)
			return Fail(m_p, "too many elements and attributes");
	}
	return m_Open.empty() || Fail(m_p, "element " + std::string(m_Open.back()) + " is not closed");
}

bool VTextCheck::Markup()
{
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
	++m_p;
	return Opening();
}

/// Blanks its identifiers out, which may hold what would end it, and which nothing asks for.
bool VTextCheck::DocumentType()
{
	const char* const pAt = m_p;
	const auto fail = [&] { return Fail(pAt, "document type that is broken or has an internal subset"); };
	if (m_p == m_pEnd || !IsSpace(*m_p))
		return fail();
	while (m_p != m_pEnd && *m_p != '>' && *m_p != '[')
	{
		const char quote = *m_p++;
		if (quote != '"' && quote != '\'')
			continue;
		char* const pQuote = std::find(m_p, m_pEnd, quote);
		if (pQuote == m_pEnd)
			return fail();
		std::replace_if(
		    m_p, pQuote, [](char i_Byte) { return i_Byte != '\n'; }, ' ');
		m_p = pQuote + 1;
	}
	return Take(">") || fail();
}

bool VTextCheck::Opening()
{
	const std::string_view name = TakeName();
	if (name.empty())
		return Fail(m_p, "element without a name");
	m_NodeBytes += c_ElementBytes;
	m_Attributes.clear();
	SkipSpace();
	while (m_p != m_pEnd && *m_p != '>' && *m_p != '/')
		if (!Attribute())
			return false;
	if (DuplicateAttribute())
		return false;
	if (Take("/>"))
		return true;
	if (!Take(">"))
		return Fail(m_p, "tag of element " + std::string(name) + " does not end");
	m_Open.push_back(name);
	return m_Open.size() <= c_MaximumDepth
	    || Fail(m_p, "elements are nested deeper than " + std::to_string(c_MaximumDepth));
}

bool VTextCheck::Closing()
{
	const char* const pAt = m_p;
	const std::string_view name = TakeName();
	SkipSpace();
	if (m_Open.empty() || name != m_Open.back())
		return Fail(pAt, "closing tag " + std::string(name) + " does not match");
	if (!Take(">"))
		return Fail(m_p, "closing tag " + std::string(name) + " does not end");
	m_Open.pop_back();
	return true;
}

bool VTextCheck::Attribute()
{
	const std::string_view name = TakeName();
	if (name.empty())
		return Fail(m_p, "attribute without a name");
	m_Attributes.push_back(name);
	m_NodeBytes += c_AttributeBytes;
	SkipSpace();
	if (!Take("="))
		return Fail(m_p, "attribute " + std::string(name) + " has no value");
	SkipSpace();
	if (m_p == m_pEnd || (*m_p != '"' && *m_p != '\''))
		return Fail(m_p, "value of attribute " + std::string(name) + " is not quoted");
	const char quote = *m_p++;
	char* const pBegin = m_p;
	char* const pQuote = static_cast<char*>(std::memchr(pBegin, quote, m_pEnd - pBegin));
	m_p = pQuote ? pQuote : m_pEnd;
	char* pEnd = m_p;
	if (!IsPlainValue({pBegin, pEnd}) && !Value(pBegin, pEnd))
		return false;
	if (!pQuote)
		return Fail(pBegin, "value of attribute " + std::string(name) + " does not end");
	++m_p;
	if (pEnd != pQuote)
	{
		*pEnd = quote;
		std::fill(pEnd + 1, m_p, ' ');
	}
	SkipSpace();
	return true;
}

/// Checks references, and turns white space into blanks, a line end of two bytes into one.
/// @param io_rpEnd moves to where the value ends then.
bool VTextCheck::Value(char* i_pBegin, char*& io_rpEnd)
{
	char* pOut = i_pBegin;
	for (char* p = i_pBegin; p != io_rpEnd; ++p)
	{
		if (*p == '&' && !Reference(p))
			return false;
		if (*p == '\r' && p + 1 != io_rpEnd && p[1] == '\n')
			continue;
		m_LineEndsReplaced += *p == '\n';
		*pOut++ = IsSpace(*p) ? ' ' : *p;
	}
	io_rpEnd = pOut;
	return true;
}

/// True, with the error set, if two attributes of the element in hand have one name.
bool VTextCheck::DuplicateAttribute()
{
	// Names that differ in length or end nearly always have bits of their own here.
	std::uint64_t bits = 0;
	bool bMaybe = false;
	for (const std::string_view name : m_Attributes)
	{
		const std::uint64_t bit = std::uint64_t(1) << ((name.size() * 7 + name.back() * 3 + name.front()) % 64);
		bMaybe = bMaybe || (bits & bit) != 0;
		bits |= bit;
	}
	if (!bMaybe)
		return false;
	std::vector<std::string_view>& rNames = m_Attributes;
	constexpr std::size_t c_Few = 24;
	const char* pTwice = nullptr;
	std::size_t length = 0;
	const auto note = [&](std::string_view i_Name)
	{
		pTwice = i_Name.data();
		length = i_Name.size();
	};
	if (rNames.size() <= c_Few)
	{
		for (std::size_t i = 1; i < rNames.size() && !pTwice; ++i)
			if (std::find(rNames.begin(), rNames.begin() + i, rNames[i]) != rNames.begin() + i)
				note(rNames[i]);
	}
	else
	{
		std::sort(rNames.begin(), rNames.end());
		const auto twice = std::adjacent_find(rNames.begin(), rNames.end());
		if (twice != rNames.end())
			note(*twice);
	}
	return pTwice && !Fail(pTwice, "attribute " + std::string(pTwice, length) + " stands twice");
}

bool VTextCheck::Text(const char* i_pBegin, const char* i_pEnd)
{
	for (const char* p = i_pBegin; (p = static_cast<const char*>(std::memchr(p, '&', i_pEnd - p))); ++p)
		if (!Reference(p))
			return false;
	return true;
}

/// @param i_pAt the "&" of what may be a reference.
bool VTextCheck::Reference(const char* i_pAt)
{
	// The text ends with a zero byte.
	if (i_pAt[1] != '#')
		return true;
	const bool bHexadecimal = i_pAt[2] == 'x';
	std::uint32_t code = 0;
	const auto result = std::from_chars(i_pAt + 2 + bHexadecimal, m_pEnd, code, bHexadecimal ? 16 : 10);
	return (result.ec == std::errc() && *result.ptr == ';' && IsXmlCharacter(code))
	    || Fail(i_pAt, "broken character reference");
}

std::string VTextCheck::Error() const
{
	const auto line = 1 + m_LineEndsReplaced + std::count(static_cast<const char*>(m_rText.data()), m_pAt, '\n');
	return "line " + std::to_string(line) + ": " + m_Error;
}

} // namespace

bool UtilsRapidXml::CheckText(std::string& io_rText, std::string& o_rError)
{
	if (io_rText.size() > c_MaximumDocumentBytes)
	{
		o_rError = "text of " + std::to_string(io_rText.size()) + " bytes is larger than "
		    + std::to_string(c_MaximumDocumentBytes);
		return false;
	}
	VTextCheck check(io_rText);
	if (check.Run())
		return true;
	o_rError = check.Error();
	return false;
}
