#pragma once

#include <string>
#include <string_view>

/// Names come from files of other people: what a terminal obeys, what nobody sees and what turns the direction of its
/// neighbours must not reach whoever reads. What comes from here is for eyes only: a name that is looked up, edited or
/// written stays as it is. All letters stay, those that are written from the right, too.
namespace VisibleText
{

/// Bytes that are no UTF-8, control characters, and characters that are not seen or turn the direction of what is
/// beside them, stand as their numbers: "[0x9B]", "[U+202E]".
std::string Of(std::string_view i_Text);

/// The same of a sentence: line ends and the other control characters of ASCII become blanks.
std::string OnOneLine(std::string_view i_Text);

/// JSON text that says the same with such characters as "\u202E".
std::string InJson(std::string_view i_Json);

} // namespace VisibleText
