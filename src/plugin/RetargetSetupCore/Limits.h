#pragma once

#include <cstddef>

namespace RetargetSetup
{

/// Largest legacy text file that is read: the text form refuses what would make more than some 20,000 segments, and no
/// such subject needs more text than this. Keeps a wrongly named file of many gigabytes out of memory.
inline constexpr std::size_t c_MaxLegacyFileBytes = std::size_t(64) << 20;

} // namespace RetargetSetup
