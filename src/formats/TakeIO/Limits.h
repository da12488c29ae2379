#pragma once

#include <cstddef>

/// What a take may ask of this machine. Files come from anywhere: what they claim is held against the bytes that back
/// it, or against one of these, before memory is taken.
namespace TakeIO::Limits
{

/// An hour of a whole body at 120 Hz, as text, is half of that; all of it stands in memory while it is read.
inline constexpr std::size_t c_FileBytes = std::size_t(1) << 30;

/// A body with fingers and face has some 200. World poses are computed for all of them in each frame.
inline constexpr std::size_t c_Joints = 10'000;

/// Values of all frames, 8 bytes each: 300 channels for 45 minutes at 120 Hz.
inline constexpr std::size_t c_Values = 100'000'000;

/// Names are repeated by messages, tables and files; exporters cut them at 255.
inline constexpr std::size_t c_NameBytes = 1024;

/// Of a joint. The format has six; some exporters repeat one.
inline constexpr std::size_t c_Channels = 12;

/// Beyond any stage, in the file's units and in degrees: products of some such numbers are still finite.
inline constexpr double c_Largest = 1e9;

/// Frames a second.
inline constexpr double c_LeastRate = 1e-3;
inline constexpr double c_GreatestRate = 1e5;

/// Millimetres of one unit.
inline constexpr double c_LeastUnit = 1e-6;
inline constexpr double c_GreatestUnit = 1e9;

} // namespace TakeIO::Limits
