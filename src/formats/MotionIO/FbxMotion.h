#pragma once

#include "MotionIO/Bones.h"

namespace MotionIO
{

/// The file of the bones with one more animation stack: a layer, a curve node for each place or rotation that is not
/// the file's own throughout, and a key for each frame where something moves. All other records stay as they are.
EPrinted PrintFbxMotion(const VBones& i_rBones, std::string_view i_File, const TakeIO::VTake& i_rMotion,
    const VMotionSettings& i_rSettings, std::string& o_rBytes, std::string& o_rError);

} // namespace MotionIO
