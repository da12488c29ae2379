#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <string_view>

/// Numbers as text and back, always in the C form: no locale of the process is ever asked.
namespace NumberText
{

/// Reads one real number from the start of a text with the rules of the scan format "%lf%n": leading white space
/// is skipped, a sign, decimal and hexadecimal digits, "inf", "infinity" and "nan" are taken in any case; an exponent
/// letter without digits fails the number; an overflow gives an infinity and an underflow the nearest value or zero.
/// @return the number of bytes that were read, 0 if the text does not begin with a number; then o_rValue is untouched.
std::size_t ScanReal(std::string_view i_Text, double& o_rValue);

/// Reads finite numbers as ScanReal does, with white space around each, until one does not follow or there is no more
/// room: lists of numbers are most of many files.
/// @return how many there were; they are taken off the text's front, with the white space behind them.
std::size_t ScanReals(std::string_view& io_rText, std::span<double> o_Values);

/// True if ScanReal reads the whole text.
bool ScanWholeReal(std::string_view i_Text, double& o_rValue);

/// Equals printf's "%.17g" byte for byte, so that reading it back gives the same double. Values that are not finite
/// give the spelling that expressions can read: "1.#INF", "-1.#INF", "1.#IND" and "-1.#IND" for not a number.
void AppendG17(std::string& io_rText, double i_Value);
std::string PrintG17(double i_Value);

/// As AppendG17 with another number of significant digits.
void AppendG(std::string& io_rText, double i_Value, int i_Digits);

/// The fewest digits that read back as the same double.
std::string PrintShortest(double i_Value);

/// Equals printf's "%f" byte for byte for finite values; the others as PrintG17.
std::string PrintF(double i_Value);

} // namespace NumberText
