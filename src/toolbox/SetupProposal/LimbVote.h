#pragma once

#include "SetupProposal/BodyParts.h"

#include <optional>
#include <vector>

namespace SetupProposal
{

/// What the limbs of the tree tell.
struct VLimbVotes
{
	/// What speaks against each part.
	std::vector<VPartLogs> m_Logs;
	/// How high legs and arms begin, as parts of the height; nothing if none were found.
	std::optional<double> m_LegsUp;
	std::optional<double> m_ArmsUp;
};

/// A pair of twins that hangs on the trunk is a pair of legs if
/// it reaches the floor, one of arms if it is long, else neither; the trunk goes from the root to the legs, from there
/// to the arms and on to the head. Nothing without twins.
VLimbVotes VoteByLimbs(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame);

/// A joint and its twin, from which chains of bones reach the floor.
struct VLegs
{
	std::size_t m_A = 0;
	std::size_t m_B = 0;
};

/// All pairs of limbs that are legs by their shape, whatever their names: two in front of two others are a beast's.
std::vector<VLegs> LegsByShape(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame);

} // namespace SetupProposal
