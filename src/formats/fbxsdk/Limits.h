#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>

/// What a file may ask of this machine. Files come from anywhere, so every size that a file claims is held against
/// one of these, or against the bytes that back it, before memory is taken.
namespace FbxFormat::Limits
{

/// Records inside records. Exporters use about ten; the limit keeps hostile nesting from costing anything.
inline constexpr std::size_t c_RecordDepth = 64;

/// Positions in a file are kept in 32 bits, and the whole file stands in memory. Characters are below 0.5 GiB.
inline constexpr std::uint64_t c_FileBytes = std::uint64_t(2) << 30;

/// The lists that are made of a file, whatever is in it, stay below 150 MB together: 28 bytes for a record, 24 for a
/// connection, 150 for an object, 1 KiB for a node, 0.2 KiB for a cluster, 0.8 KiB at most for another part of nodes.
/// Large scenes with animation have some hundred thousand records; a character has some hundred nodes, and some
/// thousand objects when it moves.
inline constexpr std::size_t c_Records = 1'000'000;
inline constexpr std::size_t c_Objects = 250'000;
inline constexpr std::size_t c_Nodes = 60'000;

/// Materials, textures, pictures, meshes and skins; a character has some hundred, a crowd some thousand.
inline constexpr std::size_t c_Parts = 10'000;

/// One for each mesh and bone that moves it; a set of a thousand modular meshes has some ten thousand.
inline constexpr std::size_t c_Clusters = 100'000;

/// All arrays that are decoded from one file, as bytes of their final storage.
inline constexpr std::uint64_t c_DecodedBytes = 256'000'000;

/// Of a small file less: this much for each of its bytes, and some for what is all alike. The arrays of exporters are
/// two to ten times as large as what they are deflated to; those of bombs a thousand times.
inline constexpr std::uint64_t c_DecodedPerByte = 32;
inline constexpr std::uint64_t c_DecodedOfAny = 16'000'000;

constexpr std::uint64_t DecodedBytes(std::uint64_t i_FileBytes)
{
	return std::min(c_DecodedBytes, c_DecodedOfAny + c_DecodedPerByte * i_FileBytes);
}

/// Names and paths, which messages, bones and parts of meshes repeat, are cut to this. It is the longest path of Linux.
inline constexpr std::size_t c_TextBytes = 4096;

/// The best ratio that the deflate format can reach: 258 bytes from two bits. An array that claims more than this
/// cannot be in the bytes that it has.
inline constexpr std::uint64_t c_DeflateRatio = 1032;

/// How far the text form is searched for its version before the file counts as something else.
inline constexpr std::size_t c_TextHeaderBytes = 65536;

} // namespace FbxFormat::Limits
