#pragma once

#include <cstddef>

namespace CoreOrlexTypes
{

/// Sum of the sizes in memory of all list elements that one text may make. A text such as "[{},{},{}" makes a segment
/// of more than a kilobyte from three bytes; with this bound, and the growth of a vector to at most three times its
/// content, a text costs less than 128 MB before it is refused. It leaves room for some 20,000 segments.
inline constexpr std::size_t c_MaxTextElementBytes = std::size_t(32) << 20;

} // namespace CoreOrlexTypes
