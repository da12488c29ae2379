#pragma once

#include <cstddef>

namespace Math
{

/// Parentheses and function calls inside each other in one expression. The parser descends by recursion, so this bounds
/// its stack; no expression that a person writes comes near it.
inline constexpr std::size_t c_MaxExpressionDepth = 200;

} // namespace Math
