#pragma once

#include <string_view>

namespace SetupProposal
{

enum class ESide
{
	None,
	Left,
	Right
};

constexpr ESide Opposite(ESide i_Side)
{
	return i_Side == ESide::None ? ESide::None : i_Side == ESide::Left ? ESide::Right : ESide::Left;
}

/// The side that a word in lower case tells: "left", "l", "gauche", "links". One of its own in a name is meant, not a
/// part of another word.
/// @param o_pbWeak whether it may well mean something else: then it counts where the name of the other side exists.
ESide SideOfWord(std::string_view i_Word, bool* o_pbWeak = nullptr);

/// The side that a segment's name tells by a word of its own, as in "LeftArm", "arm_l", "Bip01 L Arm", "lArm" and
/// "bras gauche", or one that begins or ends with it, as in "lefthand". None for a name that tells both or neither.
/// What stands before the last ":" is a namespace and does not count.
ESide SideOfName(std::string_view i_Name);

} // namespace SetupProposal
