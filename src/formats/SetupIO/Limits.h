#pragma once

#include <cstddef>

/// What a text of a set-up may ask of this machine.
namespace SetupIO::Limits
{

/// Thousands of edits for each segment that a subject may have; by mistake it is no text.
inline constexpr std::size_t c_FileBytes = 16u << 20;

/// Values in all: a pair takes five, and 16 MiB of the shortest ones would take a gigabyte of memory.
inline constexpr std::size_t c_Values = 500'000;

/// Of one object: the form has fewer. Each is held against those before it.
inline constexpr std::size_t c_Members = 64;

/// The form has four levels.
inline constexpr std::size_t c_Depth = 16;

} // namespace SetupIO::Limits
