#pragma once

#include "fbxsdk/container/ElementTree.h"

namespace FbxFormat
{

/// From this version on a file lists its objects and their connections.
inline constexpr std::uint32_t c_FirstVersionWithObjects = 6000;
/// In whose form WithObjects writes.
inline constexpr std::uint32_t c_WrittenVersion = 6100;

/// The records of a file of version 5, which has its models at the top and in them their materials, textures, mesh and
/// the bones that move it, written as the records of a file of version 6.1 with objects and connections; in the form of
/// the tree, text or binary. Names lead from models to their children and bones; of several with one name the first
/// counts. A model stands where the defaults of its own channels place it; without such, where those of the take do
/// that the file calls the current one, or else the first.
std::string WithObjects(const VElementTree& i_rTree);

} // namespace FbxFormat
