#pragma once

#include <cstdint>

/// What a file may ask of this machine beyond what its reader allows: arrays are read once, but any number of nodes may
/// share a mesh, and each gets its own vertices.
namespace FBXIO::Limits
{

/// All meshes of one read. A character has some ten MB.
inline constexpr std::uint64_t c_MeshBytes = 256'000'000;

/// What binding a mesh to a cluster counts as, for the time that it takes.
inline constexpr std::uint64_t c_ClusterBytes = 512;

/// A picture, and the file that an FBX file holds of one: 8,192 by 8,192 points.
inline constexpr std::uint64_t c_ImageBytes = std::uint64_t(256) << 20;

} // namespace FBXIO::Limits
