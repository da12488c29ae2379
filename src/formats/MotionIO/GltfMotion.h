#pragma once

#include "MotionIO/Bones.h"

namespace MotionIO
{

/// A glTF 2.0 binary file: a node for each bone and all above it, the meshes that bones move with up to four bones for
/// each vertex, materials, pictures of PNG and JPEG, and one animation. Bones have no scale: what the file scales is
/// worked into places and bind matrices.
EPrinted PrintGltfMotion(const VBones& i_rBones, const VCharacterFile& i_rCharacter, const TakeIO::VTake& i_rMotion,
    const VMotionSettings& i_rSettings, std::string& o_rBytes, std::string& o_rError);

} // namespace MotionIO
