#include "SetupProposal/LimbVote.h"

#include "SetupProposal/Twins.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>

namespace SetupProposal
{
namespace
{

/// Where a joint hangs.
enum class ERegion
{
	Nowhere,
	AboveLegs,
	AtLegs,
	LegsToArms,
	AtArms,
	BeyondArms,
	Trunk,
	Leg,
	Arm,
	Twig
};

/// A limb reaches this near to the lowest joint to be a leg, and is this long; parts of the height.
constexpr double c_ReachesFloor = 0.15;
constexpr double c_LegLength = 0.18;
constexpr double c_ArmLength = 0.12;
constexpr std::size_t c_ArmJoints = 3;
constexpr double c_OtherRegion = -2.5;
/// How much nearer to the legs, as a part of the height, another joint must stand.
constexpr double c_Nearer = 0.01;
/// The joint that arms hang on stands no lower beneath them than this part of the height.
constexpr double c_HangsTooLow = 0.2;
/// A joint of a limb or of the trunk is rather some part, however odd the pose.
constexpr double c_HelperOnTheWay = -1.5;
/// What stands beside the way from the legs to the head, and twins that are no limbs.
constexpr double c_BesideTheWay = -1.5;

constexpr VPartLogs Only(double i_Cost, std::initializer_list<EBodyPart> i_Parts)
{
	VPartLogs logs{};
	logs[EOther] = i_Parts.size() > 0 ? c_HelperOnTheWay : 0.0;
	for (std::size_t part = 0; part < EOther; ++part)
		logs[part] = i_Cost;
	for (const EBodyPart part : i_Parts)
		logs[part] = 0.0;
	return logs;
}

VPartLogs VoteOf(ERegion i_Region)
{
	switch (i_Region)
	{
	case ERegion::Nowhere: return {};
	case ERegion::AboveLegs: return Only(c_OtherRegion, {ERoot, EPelvis});
	case ERegion::AtLegs: return Only(c_OtherRegion, {EPelvis, ESpine});
	case ERegion::LegsToArms: return Only(c_OtherRegion, {ESpine});
	case ERegion::AtArms: return Only(c_OtherRegion, {ESpine, ENeck});
	case ERegion::BeyondArms: return Only(c_OtherRegion, {ENeck, EHead});
	case ERegion::Trunk: return Only(c_OtherRegion, {ERoot, EPelvis, ESpine, ENeck, EHead});
	case ERegion::Leg: return Only(c_OtherRegion, {EThigh, EShin, EFoot, EToe});
	case ERegion::Arm:
		return Only(c_OtherRegion,
		    {EClavicle, EUpperArm, EForeArm, EHand, EThumb, EIndexFinger, EMiddleFinger, ERingFinger, ELittleFinger});
	case ERegion::Twig: break;
	}
	return Only(c_BesideTheWay, {});
}

struct VLimb
{
	ERegion m_Region = ERegion::Twig;
	double m_Length = 0.0;
};

/// What a twin that hangs on the trunk is.
VLimb LimbFrom(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame,
    const std::vector<std::int64_t>& i_rMainChildren, std::size_t i_Joint)
{
	VLimb limb;
	std::size_t joints = 1;
	double lowest = i_rSkeleton[i_Joint].m_Place[2];
	for (std::size_t joint = i_Joint; i_rMainChildren[joint] >= 0; ++joints)
	{
		const auto child = std::size_t(i_rMainChildren[joint]);
		const auto& rFrom = i_rSkeleton[joint].m_Place;
		const auto& rTo = i_rSkeleton[child].m_Place;
		limb.m_Length += std::hypot(rTo[0] - rFrom[0], rTo[1] - rFrom[1], rTo[2] - rFrom[2]);
		lowest = std::min(lowest, rTo[2]);
		joint = child;
	}
	if (lowest - i_rFrame.m_Floor < c_ReachesFloor * i_rFrame.m_Height
	    && limb.m_Length > c_LegLength * i_rFrame.m_Height)
		limb.m_Region = ERegion::Leg;
	else if (limb.m_Length > c_ArmLength * i_rFrame.m_Height && joints >= c_ArmJoints)
		limb.m_Region = ERegion::Arm;
	return limb;
}

bool IsAbove(const VRestSkeleton& i_rSkeleton, std::int64_t i_Above, std::int64_t i_Joint)
{
	while (i_Joint > i_Above)
		i_Joint = i_rSkeleton[std::size_t(i_Joint)].m_Parent;
	return i_Joint == i_Above;
}

/// Where the longest limbs of a kind hang, -1 for none.
struct VAttached
{
	std::int64_t m_Joint = -1;
	double m_Length = 0.0;
	/// Between the two.
	Rotation::VVector3 m_Middle{};

	void Offer(const VRestSkeleton& i_rSkeleton, std::size_t i_A, std::size_t i_B, double i_Length)
	{
		if (i_Length <= m_Length * 1.01)
			return;
		m_Joint = i_rSkeleton[i_A].m_Parent;
		m_Length = i_Length;
		for (std::size_t axis = 0; axis < 3; ++axis)
			m_Middle[axis] = 0.5 * (i_rSkeleton[i_A].m_Place[axis] + i_rSkeleton[i_B].m_Place[axis]);
	}
};

/// Where the legs belong: where they hang or, if the joint that they hang on stands higher than one above it in the
/// tree, on that; some rigs hang them on the first joint of the back.
std::int64_t BelongTo(const VRestSkeleton& i_rSkeleton, const VAttached& i_rLegs, double i_Height)
{
	const auto away = [&](std::int64_t i_Joint)
	{ return std::abs(i_rSkeleton[std::size_t(i_Joint)].m_Place[2] - i_rLegs.m_Middle[2]); };
	std::int64_t best = i_rLegs.m_Joint;
	for (std::int64_t joint = best; joint >= 0; joint = i_rSkeleton[std::size_t(joint)].m_Parent)
		if (away(joint) < away(best) - c_Nearer * i_Height)
			best = joint;
	return best;
}

ERegion RegionOfTrunk(const VRestSkeleton& i_rSkeleton, std::int64_t i_Joint, std::int64_t i_Legs, std::int64_t i_Arms)
{
	if (i_Legs < 0 || i_Arms < 0 || i_Legs == i_Arms)
		return ERegion::Trunk;
	if (i_Joint == i_Arms)
		return ERegion::AtArms;
	if (i_Joint == i_Legs)
		return ERegion::AtLegs;
	const bool bAboveLegs = IsAbove(i_rSkeleton, i_Joint, i_Legs);
	if (bAboveLegs && IsAbove(i_rSkeleton, i_Joint, i_Arms))
		return ERegion::AboveLegs;
	if (IsAbove(i_rSkeleton, i_Joint, i_Arms))
		return ERegion::LegsToArms;
	return IsAbove(i_rSkeleton, i_Arms, i_Joint) ? ERegion::BeyondArms : bAboveLegs ? ERegion::Trunk : ERegion::Twig;
}

} // namespace

VLimbVotes VoteByLimbs(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame)
{
	const std::vector<std::int64_t> twins = FindTwins(i_rSkeleton);
	const std::vector<std::int64_t> mainChildren = MainChildren(i_rSkeleton);
	std::vector<ERegion> regions(i_rSkeleton.size(), ERegion::Nowhere);
	VAttached legs;
	VAttached arms;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		const std::int64_t parent = i_rSkeleton[i].m_Parent;
		if (parent >= 0 && regions[std::size_t(parent)] != ERegion::Nowhere)
			regions[i] = regions[std::size_t(parent)];
		else if (twins[i] >= 0)
		{
			// In a walk one of the legs may be off the floor.
			const VLimb own = LimbFrom(i_rSkeleton, i_rFrame, mainChildren, i);
			const VLimb other = LimbFrom(i_rSkeleton, i_rFrame, mainChildren, std::size_t(twins[i]));
			regions[i] = other.m_Region == ERegion::Leg ? ERegion::Leg : own.m_Region;
			if (regions[i] == ERegion::Leg)
				legs.Offer(i_rSkeleton, i, std::size_t(twins[i]), own.m_Length);
			if (regions[i] == ERegion::Arm)
				arms.Offer(i_rSkeleton, i, std::size_t(twins[i]), own.m_Length);
		}
	}
	VLimbVotes limbs;
	std::vector<VPartLogs>& rVotes = limbs.m_Logs;
	rVotes.resize(i_rSkeleton.size());
	if (legs.m_Joint >= 0)
		limbs.m_LegsUp = PlaceIn(i_rFrame, legs.m_Middle).m_Up;
	if (arms.m_Joint >= 0)
		limbs.m_ArmsUp = PlaceIn(i_rFrame, arms.m_Middle).m_Up;
	legs.m_Joint = BelongTo(i_rSkeleton, legs, i_rFrame.m_Height);
	// Arms that hang far below where they begin tell nothing of the trunk.
	if (arms.m_Joint >= 0
	    && arms.m_Middle[2] - i_rSkeleton[std::size_t(arms.m_Joint)].m_Place[2] > c_HangsTooLow * i_rFrame.m_Height)
		arms.m_Joint = -1;
	const bool bAny = legs.m_Joint >= 0 || arms.m_Joint >= 0;
	for (std::size_t i = 0; i < i_rSkeleton.size() && bAny; ++i)
	{
		rVotes[i] = VoteOf(regions[i] != ERegion::Nowhere
		        ? regions[i]
		        : RegionOfTrunk(i_rSkeleton, std::int64_t(i), legs.m_Joint, arms.m_Joint));
		// The end of a chain may well be no joint but where the last bone ends.
		if (mainChildren[i] < 0)
			rVotes[i][EOther] = 0.0;
	}
	return limbs;
}

std::vector<VLegs> LegsByShape(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame)
{
	const std::vector<std::int64_t> twins = FindTwins(i_rSkeleton);
	const std::vector<std::int64_t> mainChildren = MainChildren(i_rSkeleton);
	// What hangs on a twin is of its limb.
	std::vector<bool> bLimb(i_rSkeleton.size());
	std::vector<VLegs> legs;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		const std::int64_t parent = i_rSkeleton[i].m_Parent;
		bLimb[i] = twins[i] >= 0 || (parent >= 0 && bLimb[std::size_t(parent)]);
		if (twins[i] <= std::int64_t(i) || (parent >= 0 && bLimb[std::size_t(parent)]))
			continue;
		const auto twin = std::size_t(twins[i]);
		if (LimbFrom(i_rSkeleton, i_rFrame, mainChildren, i).m_Region == ERegion::Leg
		    && LimbFrom(i_rSkeleton, i_rFrame, mainChildren, twin).m_Region == ERegion::Leg)
			legs.push_back({i, twin});
	}
	return legs;
}

} // namespace SetupProposal
