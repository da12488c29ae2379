#pragma once

#include <optional>
#include <string>

namespace CoreOrlexTypesUtils
{

/// The text of an expression times a factor: a number is multiplied, an empty text stays, any other becomes
/// (expression)*factor, without blanks of its own. A factor that stands there already is multiplied, so that scaling
/// again and again does not nest. A last token that the parser passes over, and that parentheses would give a meaning,
/// as in "Arm+", goes. Nothing for a text that no names would make an expression.
std::optional<std::string> ScaledExpression(const std::string& i_rExpression, double i_Factor);

} // namespace CoreOrlexTypesUtils
