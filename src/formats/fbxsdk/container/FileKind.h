#pragma once

#include <cstddef>
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

/// From this version on the three counts of a binary record have 64 bits.
inline constexpr std::uint32_t c_FirstWideVersion = 7500;

/// End, count of values, size of values, and a byte for the length of the name; all zero at the end of a list.
constexpr std::size_t RecordHeaderSize(bool i_bWide)
{
	return i_bWide ? 25 : 13;
}

} // namespace FbxFormat
