#pragma once

#include <QVector3D>

#include <cstdint>

namespace RetargetSetup
{

/// Which side of a body a fixed view shows: "front", "back", "left side" or "right side"; empty for the other views,
/// and for a body whose left is above or below it.
/// @param i_rLeft from the body's right to its left, of any length
/// @param i_CameraType CoreGraphics::ECameraType
const char* SideSeen(const QVector3D& i_rLeft, bool i_bYUp, std::uint32_t i_CameraType);

} // namespace RetargetSetup
