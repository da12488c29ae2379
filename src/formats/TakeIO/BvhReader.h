#pragma once

#include "TakeIO/ReadTake.h"

namespace TakeIO
{

/// Whether that is the beginning of a BVH file, whatever follows.
bool IsBvh(std::string_view i_Bytes);

/// Reads a BVH file. Coordinates of a joint's place stand for those of its OFFSET, they are not added to it. Lines may
/// end in any way, names have blanks. Told in the log category "TakeIO": a count of frames that is not true, a last
/// line that was cut off, a time between frames that is none.
/// @param i_rSettings the rate only where the file tells none
/// @return false if it cannot be read; o_rError tells why, with the line. o_rTake is undefined then.
bool ReadBvh(std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError);

} // namespace TakeIO
