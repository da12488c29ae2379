#include "SetupProposal/BodyCheck.h"

#include "SetupProposal/LimbVote.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace SetupProposal
{
namespace
{

/// Of a limb so many parts must have been recognised on each side, or of the whole so many by names.
constexpr std::size_t c_LimbParts = 2;
constexpr std::size_t c_NamedParts = 3;
constexpr double c_TellsPart = 0.5;
/// Legs that stand so far in front of others, as a part of the height, carry a back that lies.
constexpr double c_BackLies = 0.25;

bool HasBoth(const VBodyReading& i_rBody, EBodyPart i_First, EBodyPart i_Last)
{
	std::set<EBodyPart> left;
	std::set<EBodyPart> right;
	for (const VJointReading& rJoint : i_rBody.m_Joints)
		if (rJoint.m_Part >= i_First && rJoint.m_Part <= i_Last && rJoint.m_Side != ESide::None)
			(rJoint.m_Side == ESide::Left ? left : right).insert(rJoint.m_Part);
	return left.size() >= c_LimbParts && right.size() >= c_LimbParts;
}

std::size_t CountNamedParts(const VBodyReading& i_rBody)
{
	std::set<std::size_t> parts;
	for (const VJointReading& rJoint : i_rBody.m_Joints)
		for (std::size_t part = EPelvis; part < EOther && rJoint.m_ByName; ++part)
			if ((*rJoint.m_ByName)[part] >= c_TellsPart)
				parts.insert(part);
	return parts.size();
}

bool IsNamedArm(const VJointReading& i_rJoint)
{
	if (!i_rJoint.m_ByName)
		return false;
	double arm = 0.0;
	for (std::size_t part = EClavicle; part <= EHand; ++part)
		arm += (*i_rJoint.m_ByName)[part];
	return arm >= c_TellsPart;
}

/// Whether two pairs of legs carry it, and no names tell that one of them is arms.
bool StandsOnFour(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody)
{
	const std::vector<VLegs> legs = LegsByShape(i_rSkeleton, i_rBody.m_Frame);
	const auto forward = [&](const VLegs& i_rLegs) {
		return 0.5
		    * (i_rBody.m_Joints[i_rLegs.m_A].m_Place.m_Forward + i_rBody.m_Joints[i_rLegs.m_B].m_Place.m_Forward);
	};
	return std::ranges::any_of(legs,
	    [&](const VLegs& i_rFront)
	    {
		    return !IsNamedArm(i_rBody.m_Joints[i_rFront.m_A])
		        && std::ranges::any_of(legs,
		            [&](const VLegs& i_rOther) {
			            return !IsNamedArm(i_rBody.m_Joints[i_rOther.m_A])
			                && forward(i_rFront) - forward(i_rOther) > c_BackLies;
		            });
	    });
}

} // namespace

std::string WhyNoBody(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody)
{
	if (!HasBoth(i_rBody, EUpperArm, EHand) && !HasBoth(i_rBody, EThigh, EFoot)
	    && CountNamedParts(i_rBody) < c_NamedParts)
		return "it has neither arms nor legs on both sides, nor names of parts of a body";
	if (StandsOnFour(i_rSkeleton, i_rBody))
		return "it stands on four legs, and the performer on two";
	return "";
}

} // namespace SetupProposal
