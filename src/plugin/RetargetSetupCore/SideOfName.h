#pragma once

#include <string_view>

namespace RetargetSetup
{

enum class ESide
{
	None,
	Left,
	Right
};

/// The side that a segment's name tells: by a word of its own, as in "LeftArm", "arm_l", "Bip01 L Arm" and "lArm", or
/// one that begins with it, as in "lefthand". None for a name that tells both or neither. What stands before the last
/// ":" is a namespace and does not count.
ESide SideOfName(std::string_view i_Name);

} // namespace RetargetSetup
