#pragma once

#include "UtilsRapidXml/Limits.h"

#include <cstddef>

namespace CoreOrlexQRTIO
{

/// The longest chain of segments in a file. A segment at depth d stands under KinematicModel and Skeleton, and its
/// joint and the joint's template stand below it, so that the chain is what the depth of XML elements leaves to it. The
/// writer refuses what the reader would not take back.
inline constexpr std::size_t c_MaximumSegmentDepth = UtilsRapidXml::c_MaximumDepth - 4;

/// The largest file that is read. A subject of 1,000 segments with all its statistics takes 2 MiB, and a parsed
/// document takes several times its text.
inline constexpr std::size_t c_MaximumFileSize = std::size_t(32) << 20;

} // namespace CoreOrlexQRTIO
