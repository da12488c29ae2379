#pragma once

#include <string>
#include <string_view>

namespace CommandLine
{

// Names come from files of other people: what a terminal obeys, what nobody sees and what turns the direction of its
// neighbours must not reach whoever reads.

/// Bytes that are no UTF-8, control characters, and characters that are not seen or turn the direction of what is
/// beside them, stand as their numbers: "[0x9B]", "[U+202E]".
std::string VisibleText(std::string_view i_Text);

/// The same on one line: line ends and the other control characters of ASCII become blanks.
std::string VisibleLine(std::string_view i_Text);

/// JSON text that says the same with such characters as "\u202E".
std::string VisibleJson(std::string_view i_Json);

} // namespace CommandLine
