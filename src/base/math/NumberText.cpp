#include "math/NumberText.h"

#include <algorithm>
#include <array>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <limits>

namespace
{

bool IsSpace(char i_Byte)
{
	return i_Byte == ' ' || (i_Byte >= '\t' && i_Byte <= '\r');
}

bool IsDigit(char i_Byte)
{
	return i_Byte >= '0' && i_Byte <= '9';
}

bool IsHexDigit(char i_Byte)
{
	return IsDigit(i_Byte) || (i_Byte >= 'a' && i_Byte <= 'f') || (i_Byte >= 'A' && i_Byte <= 'F');
}

/// True if the text goes on with the lower-case word in any case.
bool GoesOnWith(const char* i_pFrom, const char* i_pEnd, std::string_view i_Word)
{
	if (std::size_t(i_pEnd - i_pFrom) < i_Word.size())
		return false;
	for (std::size_t i = 0; i < i_Word.size(); ++i)
		if ((i_pFrom[i] | 0x20) != i_Word[i])
			return false;
	return true;
}

template <typename TIsDigit>
const char* SkipDigits(const char* i_pFrom, const char* i_pEnd, TIsDigit i_IsDigit)
{
	while (i_pFrom != i_pEnd && i_IsDigit(*i_pFrom))
		++i_pFrom;
	return i_pFrom;
}

/// The end of digits [. digits] [exponent], or null if there is no digit or an exponent letter stands without digits.
template <typename TIsDigit>
const char* EndOfNumber(const char* i_pFrom, const char* i_pEnd, TIsDigit i_IsDigit, char i_ExponentLetter)
{
	const char* p = SkipDigits(i_pFrom, i_pEnd, i_IsDigit);
	std::size_t digits = p - i_pFrom;
	if (p != i_pEnd && *p == '.')
	{
		const char* const pFraction = ++p;
		p = SkipDigits(p, i_pEnd, i_IsDigit);
		digits += p - pFraction;
	}
	if (digits == 0)
		return nullptr;
	if (p != i_pEnd && (*p | 0x20) == i_ExponentLetter)
	{
		++p;
		if (p != i_pEnd && (*p == '+' || *p == '-'))
			++p;
		const char* const pExponent = p;
		p = SkipDigits(p, i_pEnd, IsDigit);
		if (p == pExponent)
			return nullptr;
	}
	return p;
}

/// What digits [. digits] [exponent] stand for where no double is near: an infinity or zero. C libraries differ there.
template <typename TIsDigit>
double OutOfRange(std::string_view i_Number, TIsDigit i_IsDigit, int i_BitsOfDigit)
{
	const char* const pEnd = i_Number.data() + i_Number.size();
	const char* const pPoint = SkipDigits(i_Number.data(), pEnd, i_IsDigit);
	const char* pExponent = pPoint != pEnd && *pPoint == '.' ? SkipDigits(pPoint + 1, pEnd, i_IsDigit) : pPoint;
	const char* const pLeading = i_Number.data() + std::min(i_Number.find_first_not_of("0."), i_Number.size());
	if (pExponent == pEnd)
		return pLeading < pPoint ? HUGE_VAL : 0.0;
	pExponent += pExponent[1] == '+' ? 2 : 1;
	long long exponent = 0;
	if (std::from_chars(pExponent, pEnd, exponent).ec == std::errc::result_out_of_range)
		return *pExponent == '-' ? 0.0 : HUGE_VAL;
	// More text than memory would be needed to come near the exponent's own end.
	exponent = std::clamp(exponent, -(1LL << 60), 1LL << 60);
	return exponent + (pPoint - pLeading) * i_BitsOfDigit > 0 ? HUGE_VAL : 0.0;
}

bool AppendNotFinite(std::string& io_rText, double i_Value)
{
	if (std::isfinite(i_Value))
		return false;
	if (std::signbit(i_Value))
		io_rText += '-';
	io_rText += std::isnan(i_Value) ? "1.#IND" : "1.#INF";
	return true;
}

constexpr std::uint64_t PowerOf(std::uint64_t i_Base, int i_Exponent)
{
	return i_Exponent == 0 ? 1 : i_Base * PowerOf(i_Base, i_Exponent - 1);
}

constexpr int c_RoundTripDigits = 17;
constexpr std::uint64_t c_TenToDigits = PowerOf(10, c_RoundTripDigits);

/// 17 significant digits of the magnitude, to the nearest, ties to even, and the power of ten of the first of them, for
/// magnitudes from 1e-4 to 1e16. There the product of the mantissa and the power of five that brings them in front of
/// the point has at most 102 bits: all of it is exact.
std::uint64_t RoundTripDigits(double i_Magnitude, int& o_rExponent)
{
	__extension__ using VWide = unsigned __int128;
	constexpr auto c_Fives = []
	{
		std::array<std::uint64_t, c_RoundTripDigits + 5> fives{};
		for (int i = 0; i < int(fives.size()); ++i)
			fives[std::size_t(i)] = PowerOf(5, i);
		return fives;
	}();
	const auto bits = std::bit_cast<std::uint64_t>(i_Magnitude);
	const int exponentOfTwo = int(bits >> 52) - 1075;
	const std::uint64_t mantissa = (bits & ((std::uint64_t(1) << 52) - 1)) | std::uint64_t(1) << 52;
	// At most one too low: log10(2) = 0.30103.
	o_rExponent = int(std::floor((exponentOfTwo + 52) * 0.30102999));
	for (;; ++o_rExponent)
	{
		const int power = c_RoundTripDigits - 1 - o_rExponent;
		const VWide product = VWide(mantissa) * c_Fives[std::size_t(power)];
		const int shift = -(exponentOfTwo + power);
		if (shift <= 0)
		{
			if ((product << -shift) < c_TenToDigits)
				return std::uint64_t(product << -shift);
			continue;
		}
		std::uint64_t digits = std::uint64_t(product >> shift);
		if (digits >= c_TenToDigits)
			continue;
		const VWide rest = product & ((VWide(1) << shift) - 1);
		const VWide half = VWide(1) << (shift - 1);
		digits += rest > half || (rest == half && digits % 2 == 1);
		if (digits < c_TenToDigits)
			return digits;
		++o_rExponent;
		return c_TenToDigits / 10;
	}
}

/// As "%.17g" has them, which is without an exponent where RoundTripDigits takes the magnitude.
void AppendRoundTripDigits(std::string& io_rText, double i_Value)
{
	int exponent = 0;
	const std::uint64_t number = RoundTripDigits(std::abs(i_Value), exponent);
	char digits[c_RoundTripDigits];
	std::to_chars(digits, digits + c_RoundTripDigits, number);
	std::size_t count = c_RoundTripDigits;
	while (digits[count - 1] == '0')
		--count;
	if (i_Value < 0)
		io_rText += '-';
	if (exponent < 0)
	{
		io_rText.append("0.000", std::size_t(1 - exponent)).append(digits, count);
		return;
	}
	const std::size_t whole = std::size_t(exponent) + 1;
	io_rText.append(digits, whole);
	if (count > whole)
		(io_rText += '.').append(digits + whole, count - whole);
}

/// Nearly every number is plain: digits that neither a mark of another base nor an exponent without digits follows.
/// @return where such a number ends, null if none begins here.
inline const char* ScanPlainReal(const char* i_pFrom, const char* i_pEnd, double& o_rValue)
{
	const char* const pDigits = i_pFrom != i_pEnd && *i_pFrom == '-' ? i_pFrom + 1 : i_pFrom;
	if (pDigits == i_pEnd || !(IsDigit(*pDigits) || *pDigits == '.'))
		return nullptr;
	double value = 0.0;
	const auto result = std::from_chars(i_pFrom, i_pEnd, value);
	const char next = result.ptr == i_pEnd ? ' ' : char(*result.ptr | 0x20);
	if (result.ec != std::errc() || next == 'x' || next == 'e')
		return nullptr;
	o_rValue = value;
	return result.ptr;
}

} // namespace

std::size_t NumberText::ScanReal(std::string_view i_Text, double& o_rValue)
{
	const char* const pBegin = i_Text.data();
	const char* const pEnd = pBegin + i_Text.size();
	const char* p = SkipDigits(pBegin, pEnd, IsSpace);
	if (const char* const pBehind = ScanPlainReal(p, pEnd, o_rValue))
		return pBehind - pBegin;
	bool bNegative = false;
	if (p != pEnd && (*p == '+' || *p == '-'))
		bNegative = *p++ == '-';

	if (GoesOnWith(p, pEnd, "nan"))
	{
		o_rValue = std::copysign(std::numeric_limits<double>::quiet_NaN(), bNegative ? -1.0 : 1.0);
		return p + 3 - pBegin;
	}
	if (GoesOnWith(p, pEnd, "inf"))
	{
		p += 3;
		if (p != pEnd && (*p | 0x20) == 'i')
		{
			if (!GoesOnWith(p, pEnd, "inity"))
				return 0;
			p += 5;
		}
		o_rValue = bNegative ? -HUGE_VAL : HUGE_VAL;
		return p - pBegin;
	}

	const bool bHexadecimal = GoesOnWith(p, pEnd, "0x");
	const char* const pNumber = bHexadecimal ? p + 2 : p;
	const char* const pNumberEnd =
	    bHexadecimal ? EndOfNumber(pNumber, pEnd, IsHexDigit, 'p') : EndOfNumber(pNumber, pEnd, IsDigit, 'e');
	if (!pNumberEnd)
		return 0;
	double value = 0.0;
	const auto result =
	    std::from_chars(pNumber, pNumberEnd, value, bHexadecimal ? std::chars_format::hex : std::chars_format::general);
	if (result.ec == std::errc::result_out_of_range)
	{
		const std::string_view number(pNumber, pNumberEnd);
		value = bHexadecimal ? OutOfRange(number, IsHexDigit, 4) : OutOfRange(number, IsDigit, 1);
	}
	o_rValue = bNegative ? -value : value;
	return pNumberEnd - pBegin;
}

std::size_t NumberText::ScanReals(std::string_view& io_rText, std::span<double> o_Values)
{
	const char* const pEnd = io_rText.data() + io_rText.size();
	const char* p = SkipDigits(io_rText.data(), pEnd, IsSpace);
	std::size_t count = 0;
	for (; p != pEnd && count < o_Values.size(); ++count)
	{
		double value = 0.0;
		const char* pBehind = ScanPlainReal(p, pEnd, value);
		if (!pBehind)
			pBehind = p + ScanReal({p, pEnd}, value);
		if (pBehind == p || (pBehind != pEnd && !IsSpace(*pBehind)) || !std::isfinite(value))
			break;
		o_Values[count] = value;
		p = SkipDigits(pBehind, pEnd, IsSpace);
	}
	io_rText = {p, pEnd};
	return count;
}

bool NumberText::ScanWholeReal(std::string_view i_Text, double& o_rValue)
{
	double value = 0.0;
	const std::size_t read = ScanReal(i_Text, value);
	if (read == 0 || read != i_Text.size())
		return false;
	o_rValue = value;
	return true;
}

void NumberText::AppendG(std::string& io_rText, double i_Value, int i_Digits)
{
	if (AppendNotFinite(io_rText, i_Value))
		return;
	// The digits, up to four zeros before them, sign, point and exponent; a double has at most 767 digits.
	char buffer[800];
	const auto result =
	    std::to_chars(buffer, buffer + sizeof(buffer), i_Value, std::chars_format::general, std::min(i_Digits, 770));
	io_rText.append(buffer, result.ptr);
}

void NumberText::AppendG17(std::string& io_rText, double i_Value)
{
	const double magnitude = std::abs(i_Value);
	if (magnitude >= 1e-4 && magnitude < 1e16)
		AppendRoundTripDigits(io_rText, i_Value);
	else if (magnitude == 0.0)
		io_rText += std::signbit(i_Value) ? "-0" : "0";
	else
		AppendG(io_rText, i_Value, c_RoundTripDigits);
}

std::string NumberText::PrintG17(double i_Value)
{
	std::string text;
	AppendG17(text, i_Value);
	return text;
}

std::string NumberText::PrintF(double i_Value)
{
	std::string text;
	if (AppendNotFinite(text, i_Value))
		return text;
	char buffer[512];
	const auto result = std::to_chars(buffer, buffer + sizeof(buffer), i_Value, std::chars_format::fixed, 6);
	text.assign(buffer, result.ptr);
	return text;
}

std::string NumberText::PrintShortest(double i_Value)
{
	std::string text;
	if (AppendNotFinite(text, i_Value))
		return text;
	char buffer[32];
	text.assign(buffer, std::to_chars(buffer, buffer + sizeof(buffer), i_Value).ptr);
	return text;
}
