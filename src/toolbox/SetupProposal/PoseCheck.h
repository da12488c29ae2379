#pragma once

#include "SetupProposal/Proposal.h"

#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace SetupProposal
{

/// One thing in which a character at rest may differ from the performer.
struct VPoseFinding
{
	/// "facing", "sides", "arms", "legs", "scale", "floor", "soles": as scripts know it.
	const char* m_pId = "";
	bool m_bFine = true;
	/// A sentence for the operator.
	std::string m_Message;
	/// By name, with the unit at its end: "sourceDegrees".
	std::vector<std::pair<const char*, double>> m_Numbers;
	/// Options of "retarget edit" and "create" that mend it; empty if it is fine, or no option does.
	std::string m_Options;
};

/// All of them that the two skeletons have the joints for, whether fine or not.
std::vector<VPoseFinding> CheckPose(
    const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget, const VProposal& i_rProposal);

/// What the character's scale is to be multiplied by, as the options of a finding "scale" have it; 1 for others.
double SuggestedScale(const VPoseFinding& i_rFinding);

/// What a body stands on.
struct VStand
{
	std::size_t m_Joint = 0;
	/// Of the joint or, if it stands on its skin, of the lowest point that the joint carries, in mm.
	double m_Height = 0.0;
	bool m_bSkin = false;
};

/// The lowest point of the skin of the feet, if one is known of every foot, or else the lowest joint of them; nothing
/// without feet.
std::optional<VStand> StandOf(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody);

/// What brings the feet to the floor, in mm; 0 if they stand on it.
double LiftToFloor(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody);

} // namespace SetupProposal
