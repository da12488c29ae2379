#pragma once

#include <algorithm>
#include <cstdint>

/// What a file may ask of this machine beyond what its reader allows: arrays are read once, but any number of nodes may
/// share a mesh, and each gets its own vertices.
namespace FBXIO::Limits
{

/// All meshes of one read. A character has some ten MB.
inline constexpr std::uint64_t c_MeshBytes = 256'000'000;

/// Of a small file less: this much for each of its bytes, and some for meshes that stand in many places.
inline constexpr std::uint64_t c_MeshPerByte = 32;
inline constexpr std::uint64_t c_MeshOfAny = 48'000'000;

constexpr std::uint64_t MeshBytes(std::uint64_t i_FileBytes)
{
	return std::min(c_MeshBytes, c_MeshOfAny + c_MeshPerByte * std::min(i_FileBytes, c_MeshBytes));
}

/// What a control point counts as beyond its vertex: its normal, which is kept with the mesh of the file.
inline constexpr std::uint64_t c_PointBytes = 24;

/// What a polygon vertex counts as: its own index, those of a triangle, and two while its vertex is looked for.
inline constexpr std::uint64_t c_CornerBytes = 24;

/// What a material of a mesh counts as: its values, and the path of its texture.
inline constexpr std::uint64_t c_PartBytes = 4096;

/// What binding a mesh to a cluster counts as, for the time that it takes.
inline constexpr std::uint64_t c_ClusterBytes = 512;

/// A picture, and the file that an FBX file holds of one: 8,192 by 8,192 points.
inline constexpr std::uint64_t c_ImageBytes = std::uint64_t(256) << 20;

/// Of a JPEG. Those that become clear step by step have about ten.
inline constexpr int c_ImageScans = 100;

/// All pictures of one FBX file as they are in memory. Of those that it holds itself less: two plain ones of 4,096 by
/// 4,096 points in a file of any size, and 64 bytes for each of its own, which no picture with anything to see needs.
inline constexpr std::uint64_t c_ImagesOfAny = std::uint64_t(128) << 20;
inline constexpr std::uint64_t c_ImagesPerByte = 64;
inline constexpr std::uint64_t c_ImagesBytes = std::uint64_t(2) << 30;

constexpr std::uint64_t ImagesBytes(std::uint64_t i_FileBytes)
{
	return std::min(c_ImagesBytes, c_ImagesOfAny + c_ImagesPerByte * std::min(i_FileBytes, c_ImagesBytes));
}

} // namespace FBXIO::Limits
