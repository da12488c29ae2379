#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace CoreOrlexQRTIO
{

/// Takes blanks and tabs off both ends.
std::string_view Trimmed(std::string_view i_Text);

/// Takes the first expression off a list without blanks and tabs at its front; empty at the end.
std::string_view TakeExpression(std::string_view& io_rText);

/// Cuts a list of expressions that stand between blanks. An expression that begins with a single quote, or with a minus
/// and one, holds blanks up to the closing quote.
std::vector<std::string_view> CutExpressions(std::string_view i_Text);

/// True for digits with a point or a minus sign, which are an expression that needs no parser.
bool IsPlainNumber(std::string_view i_Text);

/// The expressions with one blank between them, an empty one as "0".
/// @return false if cutting the text would not give the same expressions back.
bool JoinExpressions(std::span<const std::string> i_Expressions, std::string& o_rText);

} // namespace CoreOrlexQRTIO
