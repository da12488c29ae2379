#include "fbxsdk/container/TextScan.h"

#include <array>
#include <cstring>

namespace
{

enum EByteClass : unsigned char
{
	EBlank = 1,
	ELineEnd = 2,
	/// Ends a name.
	ENameEnd = 4,
	/// Ends a bare value.
	EValueEnd = 8,
	/// Braces, quotes and comments.
	EMark = 16
};

constexpr std::array<unsigned char, 256> c_ByteClasses = []
{
	std::array<unsigned char, 256> classes{};
	const auto mark = [&classes](std::string_view i_Bytes, unsigned char i_Class)
	{
		for (const char byte : i_Bytes)
			classes[static_cast<unsigned char>(byte)] |= i_Class;
	};
	mark(" \t", EBlank);
	mark("\r\n\f\v", ELineEnd);
	mark(" \t\r\n\f\v{},\";*:", ENameEnd);
	mark(" \t\r\n\f\v{},\";:", EValueEnd);
	mark("{}\";", EMark);
	return classes;
}();

bool Is(char i_Byte, unsigned char i_Classes)
{
	return c_ByteClasses[static_cast<unsigned char>(i_Byte)] & i_Classes;
}

const char* Find(const char* i_pFrom, const char* i_pEnd, char i_Byte)
{
	return static_cast<const char*>(std::memchr(i_pFrom, i_Byte, i_pEnd - i_pFrom));
}

} // namespace

const char* FbxFormat::Text::SkipByteOrderMark(const char* i_pFrom, const char* i_pEnd)
{
	return i_pEnd - i_pFrom >= 3 && std::memcmp(i_pFrom, "\xEF\xBB\xBF", 3) == 0 ? i_pFrom + 3 : i_pFrom;
}

const char* FbxFormat::Text::SkipBlanks(const char* i_pFrom, const char* i_pEnd)
{
	while (i_pFrom != i_pEnd && Is(*i_pFrom, EBlank))
		++i_pFrom;
	return i_pFrom;
}

const char* FbxFormat::Text::SkipSpace(const char* i_pFrom, const char* i_pEnd)
{
	while (i_pFrom != i_pEnd)
	{
		if (Is(*i_pFrom, EBlank | ELineEnd))
			++i_pFrom;
		else if (*i_pFrom == ';')
			i_pFrom = SkipLine(i_pFrom, i_pEnd);
		else
			break;
	}
	return i_pFrom;
}

const char* FbxFormat::Text::SkipLine(const char* i_pFrom, const char* i_pEnd)
{
	while (i_pFrom != i_pEnd && *i_pFrom != '\n' && *i_pFrom != '\r')
		++i_pFrom;
	return i_pFrom;
}

const char* FbxFormat::Text::FindMark(const char* i_pFrom, const char* i_pEnd)
{
	// The loop over a block has no way out, so that a compiler makes a few instructions of it.
	constexpr std::ptrdiff_t c_Block = 64;
	for (; i_pEnd - i_pFrom >= c_Block; i_pFrom += c_Block)
	{
		unsigned char marks = 0;
		for (std::ptrdiff_t i = 0; i < c_Block; ++i)
		{
			const char byte = i_pFrom[i];
			marks |= (byte == '{') | (byte == '}') | (byte == '"') | (byte == ';');
		}
		if (marks)
			break;
	}
	while (i_pFrom != i_pEnd && !Is(*i_pFrom, EMark))
		++i_pFrom;
	return i_pFrom;
}

const char* FbxFormat::Text::ScanName(const char* i_pFrom, const char* i_pEnd)
{
	while (i_pFrom != i_pEnd && !Is(*i_pFrom, ENameEnd))
		++i_pFrom;
	return i_pFrom;
}

const char* FbxFormat::Text::ScanValue(const char* i_pFrom, const char* i_pEnd)
{
	if (i_pFrom != i_pEnd && *i_pFrom == '"')
	{
		const char* const pQuote = Find(i_pFrom + 1, i_pEnd, '"');
		return pQuote ? pQuote + 1 : nullptr;
	}
	while (i_pFrom != i_pEnd && !Is(*i_pFrom, EValueEnd))
		++i_pFrom;
	return i_pFrom;
}

bool FbxFormat::Text::EndsValue(const char* i_pAt, const char* i_pEnd)
{
	return i_pAt == i_pEnd || Is(*i_pAt, EValueEnd);
}

const char* FbxFormat::Text::NextValue(const char* i_pFrom, const char* i_pEnd)
{
	i_pFrom = SkipSpace(i_pFrom, i_pEnd);
	if (i_pFrom == i_pEnd || *i_pFrom != ',')
		return nullptr;
	return SkipSpace(i_pFrom + 1, i_pEnd);
}
