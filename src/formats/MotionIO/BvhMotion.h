#pragma once

#include "MotionIO/Bones.h"

namespace MotionIO
{

/// The joints of the motion, each unturned in the world at rest: where angles are zero, BVH knows no turns, and what
/// reads it draws that pose. Only the directions of joints' own axes change by that. Blanks in names become
/// underscores.
/// @param i_pBones null, or those whose axes and unit it is to be in
EPrinted PrintBvhMotion(
    const VBones* i_pBones, const TakeIO::VTake& i_rMotion, const VMotionSettings& i_rSettings, std::string& o_rBytes);

} // namespace MotionIO
