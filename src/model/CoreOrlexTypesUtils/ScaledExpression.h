#pragma once

#include <string>

namespace CoreOrlexTypesUtils
{

/// The text of an expression times a factor: a number is multiplied, an empty text stays, any other becomes
/// (expression)*factor, without blanks of its own. A factor that stands there already is multiplied, so that scaling
/// again and again does not nest.
std::string ScaledExpression(const std::string& i_rExpression, double i_Factor);

} // namespace CoreOrlexTypesUtils
