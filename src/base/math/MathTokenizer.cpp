#include "math/MathTokenizer.h"

#include "math/NumberText.h"

#include <algorithm>
#include <limits>

namespace Math
{

namespace
{

// The classes of the C locale, whatever the process' locale is.
bool IsSpace(char i_Byte)
{
	return i_Byte == ' ' || (i_Byte >= '\t' && i_Byte <= '\r');
}

bool IsDigitOrPoint(char i_Byte)
{
	return (i_Byte >= '0' && i_Byte <= '9') || i_Byte == '.';
}

bool IsOfIdentifier(char i_Byte)
{
	return (i_Byte >= '0' && i_Byte <= '9') || (i_Byte >= 'a' && i_Byte <= 'z') || (i_Byte >= 'A' && i_Byte <= 'Z')
	    || i_Byte == '_';
}

EToken OperatorType(char i_Byte)
{
	switch (i_Byte)
	{
	case '(': return EToken::ELeftParenthesis;
	case ')': return EToken::ERightParenthesis;
	case '*': return EToken::EMultiply;
	case '+': return EToken::EPlus;
	case '-': return EToken::EMinus;
	case '/': return EToken::EDivide;
	case '^': return EToken::EPower;
	default: return EToken::EEnd;
	}
}

} // namespace

bool IsIdentifier(std::string_view i_Text)
{
	return !i_Text.empty() && !IsDigitOrPoint(i_Text.front())
	    && std::all_of(i_Text.begin(), i_Text.end(), IsOfIdentifier);
}

VMathCursor::VMathCursor(std::string_view i_Text, char i_Delimiter)
    : m_pBegin(i_Text.data()), m_pAt(m_pBegin), m_pEnd(m_pBegin + i_Text.size()), m_Delimiter(i_Delimiter)
{
	if (IsSpace(i_Delimiter))
		Fail(std::string("Invalid delimiting character '") + i_Delimiter + "'");
}

void VMathCursor::Fail(std::string i_Message) const
{
	throw VMathParseException(std::move(i_Message), m_pAt - m_pBegin + 1);
}

void VMathCursor::Next(VToken& o_rToken)
{
	while (m_pAt != m_pEnd && IsSpace(*m_pAt))
		++m_pAt;
	o_rToken.Text.clear();
	o_rToken.Type = EToken::EEnd;
	if (m_pAt == m_pEnd)
		return;

	const char byte = *m_pAt;
	o_rToken.Type = byte == m_Delimiter ? EToken::EDelimiter : OperatorType(byte);
	if (o_rToken.Type != EToken::EEnd)
	{
		o_rToken.Text = byte;
		++m_pAt;
	}
	else if (IsDigitOrPoint(byte))
		ReadNumber(o_rToken);
	else if (IsOfIdentifier(byte))
	{
		o_rToken.Type = EToken::EIdentifier;
		const char* const pFrom = m_pAt;
		while (m_pAt != m_pEnd && IsOfIdentifier(*m_pAt))
			++m_pAt;
		o_rToken.Text.assign(pFrom, m_pAt);
	}
	else if (byte == '\'')
		ReadQuotedIdentifier(o_rToken);
	else
	{
		++m_pAt;
		Fail(std::string("Unexpected token \"") + byte + "\"");
	}
}

void VMathCursor::ReadNumber(VToken& io_rToken)
{
	const auto appendDigits = [&]
	{
		const char* const pFrom = m_pAt;
		while (m_pAt != m_pEnd && IsDigitOrPoint(*m_pAt))
			++m_pAt;
		io_rToken.Text.append(pFrom, m_pAt);
	};
	io_rToken.Type = EToken::ENumber;
	appendDigits();
	if (At('e'))
	{
		io_rToken.Text += *m_pAt++;
		io_rToken.Text += At('-') || At('+') ? *m_pAt++ : '+';
		appendDigits();
	}
	else if (At('#') && io_rToken.Text == "1.")
	{
		ReadNotFinite(io_rToken);
		return;
	}
	io_rToken.Value = 0.0;
	NumberText::ScanReal(io_rToken.Text, io_rToken.Value);
}

void VMathCursor::ReadNotFinite(VToken& io_rToken)
{
	const std::string_view rest(m_pAt, m_pEnd);
	const bool bInfinity = rest.starts_with("#INF");
	if (!bInfinity && !rest.starts_with("#IND"))
		Fail("Unexpected token \"" + std::string(rest) + "\"");
	io_rToken.Text.append(rest.substr(0, 4));
	io_rToken.Value = bInfinity ? std::numeric_limits<double>::infinity() : std::numeric_limits<double>::quiet_NaN();
	m_pAt += 4;
	while (At('0'))
		++m_pAt;
	if (!AtEnd())
		Fail("Unexpected token \"" + std::string(m_pAt, m_pEnd) + "\"");
}

void VMathCursor::ReadQuotedIdentifier(VToken& io_rToken)
{
	io_rToken.Type = EToken::EQuotedIdentifier;
	for (++m_pAt; !AtEnd() && *m_pAt != '\''; ++m_pAt)
	{
		if (*m_pAt == '\\' && ++m_pAt == m_pEnd)
			break;
		io_rToken.Text += *m_pAt;
	}
	if (AtEnd())
		Fail("Missing variable name terminator before end of expression");
	++m_pAt;
}

} // namespace Math
