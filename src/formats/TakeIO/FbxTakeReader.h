#pragma once

#include "TakeIO/ReadTake.h"

namespace TakeIO
{

bool IsFbx(std::string_view i_Bytes);

/// Reads one animation stack of an FBX file of version 7, or one take of version 6. Joints are the bones with all above
/// them, or all models where there are none; the file's own place of each is its rest pose. Scaling, pivots and the
/// rest of the chain are worked into the places, so that a take has rotations and places only. Its first layer is read;
/// told in the log category "TakeIO": other layers, and which of several stacks is read.
/// @param i_rSettings the rate is that of the samples
/// @return false if it cannot be read, o_rError tells why; o_rTake is undefined then.
bool ReadFbxTake(std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError);

} // namespace TakeIO
