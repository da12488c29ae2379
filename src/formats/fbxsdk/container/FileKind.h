#pragma once

#include <cstdint>
#include <string_view>

namespace FbxFormat
{

enum class EFileKind
{
	None,
	Binary,
	BinaryBigEndian,
	/// Its first bytes are those of the binary form, but not all of them.
	DamagedBinary,
	Text
};

struct VFileKind
{
	EFileKind m_Kind = EFileKind::None;
	/// Major times 1000, minor times 100, revision times 10: 7400 is 7.4.0. 0 if the file does not tell. Old binary
	/// files have another number for their records than for themselves: this is the file's.
	std::uint32_t m_Version = 0;
};

/// What the first bytes of a file say about it; c_TextHeaderBytes of them are enough.
VFileKind DetectFileKind(std::string_view i_Head);

/// The oldest and the first too new version that are read.
inline constexpr std::uint32_t c_OldestVersion = 5000;
inline constexpr std::uint32_t c_TooNewVersion = 8000;

/// The length of the magic, the byte order and the version of a binary file: its records follow.
inline constexpr std::size_t c_BinaryHeaderSize = 27;

} // namespace FbxFormat
