#pragma once

#include "TakeIO/Take.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace TakeIO
{

/// What a file does not tell. What is not given either is guessed from the skeleton's rest pose, and told.
struct VTakeSettings
{
	std::optional<EUp> m_Up;
	/// Millimetres of one unit of the file.
	std::optional<double> m_Unit;
	/// Frames a second: the take is resampled. Without it the file's own.
	std::optional<double> m_Rate;
	/// The name of an animation stack; without it the first.
	std::optional<std::string> m_Stack{};
	/// Called now and then with how much is read, from 0 to 1; false ends the reading, as an error. Empty for none.
	std::function<bool(double)> m_Progress{};
};

/// Reads a take from a file of any kind that is known; BVH, and FBX of versions 6 and 7. What is guessed, mended or
/// left out is told in the log category "TakeIO".
/// @return false if it cannot be read; then o_rTake is as it was, and o_rError tells why, with the line.
bool ReadTake(const std::string& i_rPath, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError);

/// The same from bytes in memory.
bool ReadTakeFrom(std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError);

} // namespace TakeIO
