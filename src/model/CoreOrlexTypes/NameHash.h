#pragma once

#include <cstdint>
#include <string_view>

namespace CoreOrlexTypes
{

/// The id that a name stands for: 32-bit MurmurHash3 (x86 variant, seed 0) of its bytes.
/// A hash of 0xFFFFFFFF becomes 0xFFFFFFFE; the empty name has 0xFFFFFFFF.
std::uint32_t HashName(std::string_view i_Name);

} // namespace CoreOrlexTypes
