#pragma once

#include <string_view>

namespace RetargetSetup
{

/// Reads a text that is one real number, blanks and tabs around it aside, with the rules of the scan format "%lf".
/// The words that an old runtime printed for numbers that are not finite are understood too ("1.#INF", "-1.#IND",
/// "1.#QNAN", ..., with any zeros behind them).
/// @param io_rValue on false keeps what the scan made of it: the number at the start of the text, or its old value.
bool ParseNumber(std::string_view i_Text, double& io_rValue);

} // namespace RetargetSetup
