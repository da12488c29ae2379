#pragma once

#include <cstddef>
#include <cstdint>
#include <exception>
#include <string>
#include <string_view>

namespace Math
{

/// Raised inside the parser and reported as text.
class VMathParseException : public std::exception
{
public:
	VMathParseException(std::string i_Message, std::size_t i_Column)
	    : m_Message(std::move(i_Message)), m_Column(i_Column)
	{
	}

	const char* what() const noexcept override { return m_Message.c_str(); }
	const std::string& Message() const { return m_Message; }
	/// One-based, behind the token that was read last.
	std::size_t Column() const { return m_Column; }

private:
	std::string m_Message;
	std::size_t m_Column;
};

enum class EToken : std::uint8_t
{
	EEnd = 0,
	ENumber = 1,
	EIdentifier = 2,
	EDelimiter = 3,
	EPlus = 5,
	EMinus = 6,
	EMultiply = 7,
	EDivide = 8,
	EPower = 9,
	ELeftParenthesis = 10,
	ERightParenthesis = 11,
	EQuotedIdentifier = 12
};

struct VToken
{
	EToken Type = EToken::EEnd;
	std::string Text;
	/// Of a number; 0 for a text such as "." that does not convert.
	double Value = 0.0;
};

/// True for a name that needs no quotes in an expression: letters, digits and "_", the first no digit.
bool IsIdentifier(std::string_view i_Text);

/// A view on the text of an expression; the text must outlive it.
class VMathCursor
{
public:
	/// @param i_Delimiter separates the arguments of a function; a blank is refused with a VMathParseException.
	VMathCursor(std::string_view i_Text, char i_Delimiter);

	bool AtEnd() const { return m_pAt == m_pEnd; }
	/// Behind the last token that was read.
	std::size_t Position() const { return std::size_t(m_pAt - m_pBegin); }
	/// True if the byte directly at the cursor is this one.
	bool At(char i_Byte) const { return m_pAt != m_pEnd && *m_pAt == i_Byte; }

	/// Reads the next token over the given one.
	void Next(VToken& o_rToken);

	[[noreturn]] void Fail(std::string i_Message) const;

private:
	void ReadNumber(VToken& io_rToken);
	void ReadNotFinite(VToken& io_rToken);
	void ReadQuotedIdentifier(VToken& io_rToken);

	const char* m_pBegin;
	const char* m_pAt;
	const char* m_pEnd;
	char m_Delimiter;
};

} // namespace Math
