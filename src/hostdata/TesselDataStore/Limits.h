#pragma once

#include <cstddef>
#include <cstdint>

namespace TesselDataStore
{

/// Sum of the sizes in memory of all list elements that reading one value may make. A subject of 20,000 segments has
/// some 40 MB of them; a damaged count must not take the machine's memory.
inline constexpr std::uint64_t c_MaxElementBytes = std::uint64_t(128) << 20;

/// Bytes of the text that shows a value. It is for a person who looks for a fault, and a list of elements without
/// bytes could make it endless.
inline constexpr std::size_t c_MaxTextBytes = std::size_t(1) << 20;

} // namespace TesselDataStore
