#pragma once

#include <cstddef>
#include <cstdint>

namespace TesselDataStore
{

/// Sum of the sizes in memory of all list elements that reading one value may make. A subject of 20,000 segments has
/// some 40 MB of them; a damaged count must not take the machine's memory.
inline constexpr std::uint64_t c_MaxElementBytes = std::uint64_t(128) << 20;

/// Elements of one list that take no bytes in the file, as those do of which no member is stored: nothing but the count
/// stands for them, and each would take time and memory.
inline constexpr std::uint32_t c_MaxEmptyElements = 1 << 12;

/// Bytes of the text that shows a value. It is for a person who looks for a fault, and a list of elements without
/// bytes could make it endless.
inline constexpr std::size_t c_MaxTextBytes = std::size_t(1) << 20;

} // namespace TesselDataStore
