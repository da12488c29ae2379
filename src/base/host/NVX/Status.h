#pragma once

#include <cstdint>

/// 32-bit results: 0 is success, the top bit marks failure.
namespace NVX::Status
{

inline constexpr std::uint32_t c_Success = 0;
inline constexpr std::uint32_t c_Failure = 0x80000000u;
inline constexpr std::uint32_t c_SharingViolation = 0x80000006u;
inline constexpr std::uint32_t c_NothingToActOn = 0x8000000Au;
inline constexpr std::uint32_t c_UnknownName = 0x80000011u;
inline constexpr std::uint32_t c_ParseFailure = 0x80000016u;
inline constexpr std::uint32_t c_NewerFileVersion = 0x80000018u;
inline constexpr std::uint32_t c_WriteFailure = 0x80000020u;
inline constexpr std::uint32_t c_FileNotOpened = 0x8000002Au;

} // namespace NVX::Status
