#include "SetupProposal/Alignment.h"

#include "SetupProposal/BodyParts.h"
#include "SetupProposal/PoseCheck.h"
#include "SetupProposal/Sole.h"
#include "math/NumberText.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <set>

namespace SetupProposal
{
namespace
{

using Rotation::VMatrix3;
using Rotation::VVector3;

/// Shorter directions than this part of the body's height tell nothing.
constexpr double c_TellsNothing = 0.004;
/// A foot that slopes by more degrees otherwise than the source's is posed so, and is not built so.
constexpr double c_BuiltSlope = 30.0;
/// No joint of a pose at rest is so many degrees off: the mapping is wrong.
constexpr double c_FarthestTurn = 120.0;
/// Means of angles that differ by less are as good.
constexpr double c_AsGoodDegrees = 0.1;
/// The cosine of a slope from which on a direction seen from above tells nothing.
constexpr double c_Steep = 0.2;

enum EChain : std::size_t
{
	ESpineChain,
	ELeftArm,
	ERightArm,
	ELeftLeg,
	ERightLeg,
	EOtherChain,
	EChains
};

constexpr const char* c_ChainNames[EChains] = {
    "spine", "left arm", "right arm", "left leg", "right leg", "chain without a part of a body"};

using VChains = std::set<EChain>;

VVector3 FromTo(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rB[0] - i_rA[0], i_rB[1] - i_rA[1], i_rB[2] - i_rA[2]};
}

double LengthOf(const VVector3& i_rVector)
{
	return std::hypot(i_rVector[0], i_rVector[1], i_rVector[2]);
}

VVector3 Horizontal(const VVector3& i_rVector)
{
	return {i_rVector[0], i_rVector[1], 0.0};
}

/// In degrees, from 0 to 180; 0 where one of them has no length.
double AngleFromTo(const VVector3& i_rA, const VVector3& i_rB)
{
	const VVector3 cross{i_rA[1] * i_rB[2] - i_rA[2] * i_rB[1], i_rA[2] * i_rB[0] - i_rA[0] * i_rB[2],
	    i_rA[0] * i_rB[1] - i_rA[1] * i_rB[0]};
	return Rotation::c_Degrees * std::atan2(LengthOf(cross), i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2]);
}

/// The smallest rotation from one direction to the other; none for opposite ones.
VMatrix3 Swing(const VVector3& i_rFrom, const VVector3& i_rTo)
{
	VVector3 axis{i_rFrom[1] * i_rTo[2] - i_rFrom[2] * i_rTo[1], i_rFrom[2] * i_rTo[0] - i_rFrom[0] * i_rTo[2],
	    i_rFrom[0] * i_rTo[1] - i_rFrom[1] * i_rTo[0]};
	const double length = LengthOf(axis);
	if (!(length > 0.0))
		return Rotation::c_Identity3;
	const double angle = AngleFromTo(i_rFrom, i_rTo) / Rotation::c_Degrees;
	for (double& rValue : axis)
		rValue *= angle / length;
	return Rotation::RotationMatrixFromAngleAxis(axis);
}

VMatrix3 AboutVertical(double i_Radians)
{
	return Rotation::RotationMatrixFromAngleAxis({0.0, 0.0, i_Radians});
}

/// To the left as seen from above, in radians.
double HeadingFromTo(const VVector3& i_rA, const VVector3& i_rB)
{
	return std::atan2(i_rA[0] * i_rB[1] - i_rA[1] * i_rB[0], i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1]);
}

double SlopeOf(const VVector3& i_rVector)
{
	return Rotation::c_Degrees * std::atan2(i_rVector[2], std::hypot(i_rVector[0], i_rVector[1]));
}

bool IsFlat(const VVector3& i_rVector)
{
	return LengthOf(Horizontal(i_rVector)) > c_Steep * LengthOf(i_rVector);
}

/// Whether a joint of one part points to one of the other.
bool PointsTo(EBodyPart i_From, EBodyPart i_To)
{
	switch (i_From)
	{
	case ESpine: return i_To == ESpine || i_To == ENeck || i_To == EHead;
	case ENeck: return i_To == ENeck || i_To == EHead;
	case EUpperArm: return i_To == EForeArm || i_To == EHand;
	case EForeArm: return i_To == EHand;
	case EHand: return IsFinger(i_To) && i_To != EThumb;
	case EThigh: return i_To == EShin || i_To == EFoot;
	case EShin: return i_To == EFoot;
	case EFoot: return i_To == EToe;
	default: return (IsFinger(i_From) || i_From == EOther) && i_To == i_From;
	}
}

/// A pair, and what it is.
struct VMember
{
	std::size_t m_Source = 0;
	std::size_t m_Target = 0;
	EBodyPart m_Part = EOther;
	ESide m_Side = ESide::None;
	EChain m_Chain = EOtherChain;
};

EChain ChainOf(EBodyPart i_Part, ESide i_Side)
{
	if (i_Part >= EPelvis && i_Part <= EHead)
		return ESpineChain;
	if (!HasSides(i_Part) || i_Side == ESide::None)
		return EOtherChain;
	const bool bLeft = i_Side == ESide::Left;
	return i_Part >= EThigh ? (bLeft ? ELeftLeg : ERightLeg) : (bLeft ? ELeftArm : ERightArm);
}

/// Where a joint is to point: from one joint, itself but for a pelvis, to the middle of others.
struct VAim
{
	VMember m_Member;
	std::size_t m_From = 0;
	std::vector<std::size_t> m_Ends;
	/// Of the source, in the world.
	VVector3 m_Direction{};
};

struct VPosed
{
	std::vector<VMatrix3> m_Turns;
	std::vector<VVector3> m_Places;
	/// The largest turn of a joint against what it hangs on, for each chain, and whose.
	double m_Farthest[EChains] = {};
	std::size_t m_FarthestJoint[EChains] = {};
	/// For each joint, whether it is a foot that was held as when its skin was bound.
	std::vector<bool> m_bLevelled;
};

class VAligner
{
public:
	VAligner(const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget, const VAlignmentRequest& i_rRequest)
	    : m_Source(Sound(i_rSource)), m_Target(Sound(i_rTarget)), m_rRequest(i_rRequest),
	      m_SourceBody(ReadBody(m_Source)), m_TargetBody(ReadBody(m_Target)), m_MemberOf(m_Target.size(), -1),
	      m_AimOf(m_Target.size(), -1)
	{
		for (const VMappedJoints& rPair : i_rRequest.m_Pairs)
			if (rPair.m_Source < m_Source.size() && rPair.m_Target < m_Target.size())
				AddMember(rPair);
		for (const VMember& rMember : m_Members)
			AddAim(rMember);
		m_Turn = Facing();
		for (std::size_t i = 0; i < m_Target.size(); ++i)
			m_Levels.push_back(IsPart(i, EFoot) || IsPart(i, EToe) ? LevelAsBound(m_Target[i]) : std::nullopt);
	}

	VAlignment Run()
	{
		VAlignment alignment;
		VChains chains = Wanted();
		VPosed posed = Pose(chains);
		while (const auto refused = Refused(chains, posed))
		{
			alignment.m_Refused.push_back({c_ChainNames[refused->first], refused->second});
			chains.erase(refused->first);
			posed = Pose(chains);
		}
		for (const VAim& rAim : m_Aims)
			if (Wanted().contains(rAim.m_Member.m_Chain))
				alignment.m_Joints.push_back(Row(rAim, chains, posed));
		alignment.m_TurnDegrees = Turns(chains) ? Rotation::c_Degrees * m_Turn : 0.0;
		alignment.m_MoveMm = Move(chains, posed);
		for (VVector3& rPlace : posed.m_Places)
			for (std::size_t axis = 0; axis < 3; ++axis)
				rPlace[axis] += alignment.m_MoveMm[axis];
		alignment.m_Turns = std::move(posed.m_Turns);
		alignment.m_Places = std::move(posed.m_Places);
		return alignment;
	}

private:
	void AddMember(const VMappedJoints& i_rPair)
	{
		const VJointReading& rSource = m_SourceBody.m_Joints[i_rPair.m_Source];
		const VJointReading& rTarget = m_TargetBody.m_Joints[i_rPair.m_Target];
		// The performer is a person, whatever the character is.
		const auto isPart = [](EBodyPart i_Part) { return i_Part != EOther && i_Part != ERoot; };
		const EBodyPart part = isPart(rSource.m_Part) ? rSource.m_Part
		    : isPart(rTarget.m_Part)                  ? rTarget.m_Part
		                                              : EOther;
		const ESide side = rSource.m_Side != ESide::None ? rSource.m_Side : rTarget.m_Side;
		m_MemberOf[i_rPair.m_Target] = std::int64_t(m_Members.size());
		m_Members.push_back({i_rPair.m_Source, i_rPair.m_Target, part, side, ChainOf(part, side)});
	}

	bool IsPart(std::size_t i_Joint, EBodyPart i_Part) const
	{
		return m_MemberOf[i_Joint] < 0 ? m_TargetBody.m_Joints[i_Joint].m_Part == i_Part
		                               : m_Members[std::size_t(m_MemberOf[i_Joint])].m_Part == i_Part;
	}

	/// What holds a foot against the vertical as its skin was bound, from where it stands.
	VMatrix3 Level(std::size_t i_Joint) const { return m_Levels[i_Joint].value_or(Rotation::c_Identity3); }

	bool IsLevelled(std::size_t i_Joint) const { return Level(i_Joint) != Rotation::c_Identity3; }

	bool IsBelow(std::size_t i_Joint, std::size_t i_Above) const
	{
		std::int64_t joint = m_Target[i_Joint].m_Parent;
		while (joint > std::int64_t(i_Above))
			joint = m_Target[std::size_t(joint)].m_Parent;
		return joint == std::int64_t(i_Above);
	}

	/// Whether nothing between the two turns by itself.
	bool IsCarriedBy(std::size_t i_Joint, std::size_t i_Above) const
	{
		std::int64_t joint = m_Target[i_Joint].m_Parent;
		while (joint > std::int64_t(i_Above) && m_MemberOf[std::size_t(joint)] < 0)
			joint = m_Target[std::size_t(joint)].m_Parent;
		return joint == std::int64_t(i_Above);
	}

	bool Tells(const VMember& i_rFrom, const VMember& i_rTo) const
	{
		return LengthOf(FromTo(m_Target[i_rFrom.m_Target].m_Place, m_Target[i_rTo.m_Target].m_Place))
		    > c_TellsNothing * m_TargetBody.m_Frame.m_Height
		    && LengthOf(FromTo(m_Source[i_rFrom.m_Source].m_Place, m_Source[i_rTo.m_Source].m_Place))
		    > c_TellsNothing * m_SourceBody.m_Frame.m_Height;
	}

	void AddAim(const VMember& i_rMember)
	{
		VAim aim{i_rMember, i_rMember.m_Target, {}, {}};
		if (i_rMember.m_Part == EPelvis)
		{
			const VMember* const pLeft = Find(EThigh, ESide::Left);
			const VMember* const pRight = Find(EThigh, ESide::Right);
			if (!pLeft || !pRight || !IsCarriedBy(pLeft->m_Target, i_rMember.m_Target)
			    || !IsCarriedBy(pRight->m_Target, i_rMember.m_Target) || !Tells(*pRight, *pLeft))
				return;
			aim.m_From = pRight->m_Target;
			aim.m_Ends = {pLeft->m_Target};
			aim.m_Direction = FromTo(m_Source[pRight->m_Source].m_Place, m_Source[pLeft->m_Source].m_Place);
		}
		else
		{
			std::vector<const VMember*> ends;
			for (const VMember& rEnd : m_Members)
				if (PointsTo(i_rMember.m_Part, rEnd.m_Part) && rEnd.m_Side == i_rMember.m_Side
				    && IsBelow(rEnd.m_Target, i_rMember.m_Target) && Tells(i_rMember, rEnd))
					ends.push_back(&rEnd);
			for (const VMember* const pEnd : ends)
				if (std::ranges::none_of(
				        ends, [&](const VMember* i_pOther) { return IsBelow(pEnd->m_Target, i_pOther->m_Target); }))
				{
					aim.m_Ends.push_back(pEnd->m_Target);
					const VVector3 direction =
					    FromTo(m_Source[i_rMember.m_Source].m_Place, m_Source[pEnd->m_Source].m_Place);
					for (std::size_t axis = 0; axis < 3; ++axis)
						aim.m_Direction[axis] += direction[axis];
				}
			if (aim.m_Ends.empty())
				return;
		}
		m_AimOf[i_rMember.m_Target] = std::int64_t(m_Aims.size());
		m_Aims.push_back(std::move(aim));
	}

	const VMember* Find(EBodyPart i_Part, ESide i_Side) const
	{
		const auto found = std::ranges::find_if(m_Members,
		    [&](const VMember& i_rMember) { return i_rMember.m_Part == i_Part && i_rMember.m_Side == i_Side; });
		return found == m_Members.end() ? nullptr : &*found;
	}

	/// What turns the target to where the source faces, in radians: by the hips, which no pose of a limb reaches, or
	/// the shoulders, or by the whole body.
	double Facing() const
	{
		for (const EBodyPart part : {EThigh, EUpperArm})
		{
			const VMember* const pLeft = Find(part, ESide::Left);
			const VMember* const pRight = Find(part, ESide::Right);
			if (!pLeft || !pRight)
				continue;
			const VVector3 source = FromTo(m_Source[pRight->m_Source].m_Place, m_Source[pLeft->m_Source].m_Place);
			const VVector3 target = FromTo(m_Target[pRight->m_Target].m_Place, m_Target[pLeft->m_Target].m_Place);
			if (Tells(*pRight, *pLeft) && IsFlat(source) && IsFlat(target))
				return HeadingFromTo(target, source);
		}
		return HeadingFromTo(m_TargetBody.m_Frame.m_Left, m_SourceBody.m_Frame.m_Left);
	}

	VChains Wanted() const
	{
		VChains chains;
		if (m_rRequest.m_bSpine)
			chains.insert(ESpineChain);
		if (m_rRequest.m_bArms)
			chains.insert({ELeftArm, ERightArm});
		if (m_rRequest.m_bLegs)
			chains.insert({ELeftLeg, ERightLeg});
		if (m_rRequest.m_bOthers)
			chains.insert(EOtherChain);
		return chains;
	}

	/// Whether the whole turns to where the source faces.
	bool Turns(const VChains& i_rChains) const
	{
		return i_rChains.contains(ESpineChain) && !m_Members.empty() && !m_rRequest.m_Held.contains(0);
	}

	VMatrix3 TurnOfBody(const VChains& i_rChains) const
	{
		return Turns(i_rChains) ? AboutVertical(m_Turn) : Rotation::c_Identity3;
	}

	/// Where an aim is to point. A target that keeps its facing takes the source's pose as if that faced so.
	VVector3 Wished(const VAim& i_rAim, const VChains& i_rChains) const
	{
		return Turns(i_rChains) ? i_rAim.m_Direction : Rotation::Product(AboutVertical(-m_Turn), i_rAim.m_Direction);
	}

	VVector3 Pointing(const VAim& i_rAim, const std::vector<VVector3>& i_rPlaces) const
	{
		VVector3 direction{};
		for (const std::size_t end : i_rAim.m_Ends)
			for (std::size_t axis = 0; axis < 3; ++axis)
				direction[axis] += i_rPlaces[end][axis] - i_rPlaces[i_rAim.m_From][axis];
		return direction;
	}

	std::vector<VVector3> PlacesAtRest() const
	{
		std::vector<VVector3> places;
		for (const VRestJoint& rJoint : m_Target)
			places.push_back(rJoint.m_Place);
		return places;
	}

	/// Whether a foot keeps its tilt, or gets the one of its skin, and turns about the vertical alone.
	/// @param i_rNow with the tilt that it keeps or gets.
	bool KeepsTilt(const VAim& i_rAim, const VVector3& i_rNow, const VVector3& i_rWished) const
	{
		return i_rAim.m_Member.m_Part == EFoot && IsFlat(i_rNow) && IsFlat(i_rWished)
		    && (IsLevelled(i_rAim.m_Member.m_Target) || std::abs(SlopeOf(i_rNow) - SlopeOf(i_rWished)) <= c_BuiltSlope);
	}

	VPosed Pose(const VChains& i_rChains) const
	{
		VPosed posed;
		posed.m_Places = PlacesAtRest();
		const VMatrix3 body = TurnOfBody(i_rChains);
		for (std::size_t i = 0; i < m_Target.size(); ++i)
		{
			VMatrix3 turn = body;
			if (const std::int64_t parent = m_Target[i].m_Parent; parent >= 0)
			{
				turn = posed.m_Turns[std::size_t(parent)];
				const VVector3 offset =
				    Rotation::Product(turn, FromTo(m_Target[std::size_t(parent)].m_Place, m_Target[i].m_Place));
				for (std::size_t axis = 0; axis < 3; ++axis)
					posed.m_Places[i][axis] = posed.m_Places[std::size_t(parent)][axis] + offset[axis];
			}
			const VMember* const pMember = m_MemberOf[i] < 0 ? nullptr : &m_Members[std::size_t(m_MemberOf[i])];
			if (pMember && i_rChains.contains(pMember->m_Chain) && !m_rRequest.m_Held.contains(i))
				turn = TurnOf(i, *pMember, i_rChains, body, turn, posed);
			if (const std::int64_t parent = m_Target[i].m_Parent; parent >= 0 && posed.m_bLevelled[std::size_t(parent)]
			    && IsPart(i, EToe) && m_Levels[i] && !m_rRequest.m_Held.contains(i))
				turn = Rotation::Product(posed.m_Turns[std::size_t(parent)],
				    Rotation::Product(Rotation::Transposed(Level(std::size_t(parent))), *m_Levels[i]));
			posed.m_bLevelled.push_back(pMember && pMember->m_Part == EFoot && i_rChains.contains(pMember->m_Chain)
			    && !m_rRequest.m_Held.contains(i) && IsLevelled(i));
			posed.m_Turns.push_back(turn);
		}
		return posed;
	}

	VMatrix3 TurnOf(std::size_t i_Joint, const VMember& i_rMember, const VChains& i_rChains, const VMatrix3& i_rBody,
	    const VMatrix3& i_rCarried, VPosed& io_rPosed) const
	{
		if (m_AimOf[i_Joint] < 0)
			return i_rMember.m_Part == EFoot ? Rotation::Product(i_rBody, Level(i_Joint))
			    : i_rMember.m_Part == EHead  ? i_rBody
			                                 : i_rCarried;
		const VAim& rAim = m_Aims[std::size_t(m_AimOf[i_Joint])];
		const VVector3 wished = Wished(rAim, i_rChains);
		const VVector3 atRest = Pointing(rAim, PlacesAtRest());
		const VMatrix3 level = Rotation::Product(i_rBody, Level(i_Joint));
		if (const VVector3 now = Rotation::Product(level, atRest); KeepsTilt(rAim, now, wished))
			return WithShin(
			    i_Joint, wished, Rotation::Product(AboutVertical(HeadingFromTo(now, wished)), level), io_rPosed);
		const VVector3 carried = Rotation::Product(i_rCarried, atRest);
		if (const double angle = AngleFromTo(carried, wished); angle > io_rPosed.m_Farthest[i_rMember.m_Chain])
		{
			io_rPosed.m_Farthest[i_rMember.m_Chain] = angle;
			io_rPosed.m_FarthestJoint[i_rMember.m_Chain] = i_Joint;
		}
		return Rotation::Product(Swing(carried, wished), i_rCarried);
	}

	/// A foot that leans as its shin does, about the way that it points, if that is asked for. One that is held as when
	/// its skin was bound is level under an upright shin.
	VMatrix3 WithShin(std::size_t i_Foot, const VVector3& i_rWay, const VMatrix3& i_rTurn, const VPosed& i_rPosed) const
	{
		std::int64_t shin = m_Target[i_Foot].m_Parent;
		while (shin >= 0 && m_MemberOf[std::size_t(shin)] < 0)
			shin = m_Target[std::size_t(shin)].m_Parent;
		if (!m_rRequest.m_bFeetWithShins || shin < 0)
			return i_rTurn;
		VVector3 ahead = Horizontal(i_rWay);
		const double length = LengthOf(ahead);
		const auto lean = [&](const VVector3& i_rShin)
		{ return std::atan2((i_rShin[1] * ahead[0] - i_rShin[0] * ahead[1]) / length, -i_rShin[2]); };
		const VVector3 atRest = FromTo(m_Target[std::size_t(shin)].m_Place, m_Target[i_Foot].m_Place);
		const double angle = lean(FromTo(i_rPosed.m_Places[std::size_t(shin)], i_rPosed.m_Places[i_Foot]))
		    - (IsLevelled(i_Foot) ? 0.0 : lean(Rotation::Product(i_rTurn, atRest)));
		for (double& rValue : ahead)
			rValue *= angle / length;
		return Rotation::Product(Rotation::RotationMatrixFromAngleAxis(ahead), i_rTurn);
	}

	VAlignedJoint Row(const VAim& i_rAim, const VChains& i_rChains, const VPosed& i_rPosed) const
	{
		const VVector3 wished = Wished(i_rAim, i_rChains);
		const VVector3 before = Pointing(i_rAim, PlacesAtRest());
		const VVector3 after = Pointing(i_rAim, i_rPosed.m_Places);
		VAlignedJoint row{i_rAim.m_Member.m_Source, i_rAim.m_Member.m_Target, 0.0, 0.0, ""};
		const bool bFoot = KeepsTilt(
		    i_rAim, Rotation::Product(TurnOfBody(i_rChains), Rotation::Product(Level(row.m_Target), before)), wished);
		row.m_Before = bFoot ? AngleFromTo(Horizontal(before), Horizontal(wished)) : AngleFromTo(before, wished);
		row.m_After = bFoot ? AngleFromTo(Horizontal(after), Horizontal(wished)) : AngleFromTo(after, wished);
		const auto held = m_rRequest.m_Held.find(row.m_Target);
		if (!i_rChains.contains(i_rAim.m_Member.m_Chain))
			row.m_Note = std::string("stays: the ") + c_ChainNames[i_rAim.m_Member.m_Chain] + " was refused";
		else if (held != m_rRequest.m_Held.end())
			row.m_Note = "stays: it " + held->second;
		else if (bFoot)
			row.m_Note = m_rRequest.m_bFeetWithShins ? "seen from above: the foot leans as the shin does"
			    : IsLevelled(row.m_Target)           ? "seen from above: the sole is level, as its skin was bound"
			                                         : "seen from above: the foot keeps its tilt";
		else if (i_rAim.m_Member.m_Part == EPelvis)
			row.m_Note = "by the line through the hips";
		return row;
	}

	/// The first chain that would stand worse than it does, and why.
	std::optional<std::pair<EChain, std::string>> Refused(const VChains& i_rChains, const VPosed& i_rPosed) const
	{
		for (const EChain chain : i_rChains)
		{
			if (i_rPosed.m_Farthest[chain] > c_FarthestTurn)
				return std::pair(chain,
				    "\"" + m_Target[i_rPosed.m_FarthestJoint[chain]].m_Name + "\" would have to turn by "
				        + Rounded(i_rPosed.m_Farthest[chain])
				        + " degrees: look whether its pair is the right one, and left is left");
			double before = 0.0;
			double after = 0.0;
			bool bTurned = false;
			VAlignedJoint worst;
			for (const VAim& rAim : m_Aims)
				if (rAim.m_Member.m_Chain == chain)
				{
					const VAlignedJoint row = Row(rAim, i_rChains, i_rPosed);
					before += row.m_Before;
					after += row.m_After;
					bTurned = bTurned || !m_rRequest.m_Held.contains(row.m_Target);
					if (row.m_After > worst.m_After)
						worst = row;
				}
			const auto count =
			    double(std::ranges::count(m_Aims, chain, [](const VAim& i_rAim) { return i_rAim.m_Member.m_Chain; }));
			if (bTurned && after > before + c_AsGoodDegrees * count)
			{
				const auto held = m_rRequest.m_Held.find(worst.m_Target);
				return std::pair(chain,
				    "its segments would point " + Rounded(after / count)
				        + " degrees away from the performer's on average, and do by " + Rounded(before / count)
				        + " now; most \"" + m_Target[worst.m_Target].m_Name + "\""
				        + (held == m_rRequest.m_Held.end() ? std::string() : ", which " + held->second));
			}
		}
		return std::nullopt;
	}

	static std::string Rounded(double i_Degrees)
	{
		const std::string text = NumberText::PrintF(std::round(10.0 * i_Degrees) / 10.0);
		return text.substr(0, text.find('.') + 2);
	}

	VVector3 Move(const VChains& i_rChains, const VPosed& i_rPosed) const
	{
		VVector3 move{0.0, 0.0, Lift(i_rPosed)};
		const VMember* const pLeft = Find(EFoot, ESide::Left);
		const VMember* const pRight = Find(EFoot, ESide::Right);
		if (!pLeft || !pRight || !i_rChains.contains(ELeftLeg) || !i_rChains.contains(ERightLeg) || !Turns(i_rChains))
			return move;
		for (const VMember* const pFoot : {pLeft, pRight})
		{
			const VVector3 way = FromTo(i_rPosed.m_Places[pFoot->m_Target], m_Source[pFoot->m_Source].m_Place);
			for (std::size_t axis = 0; axis < 2; ++axis)
				move[axis] += 0.5 * way[axis];
		}
		return move;
	}

	double Lift(const VPosed& i_rPosed) const
	{
		if (!m_rRequest.m_bLegs || m_rRequest.m_Held.contains(0))
			return 0.0;
		const auto before = StandOf(m_Target, m_TargetBody);
		const auto after = StandOf(Posed(m_Target, i_rPosed.m_Turns, i_rPosed.m_Places), m_TargetBody);
		if (!before || !after)
			return 0.0;
		return (after->m_bSkin ? 0.0 : before->m_Height + LiftToFloor(m_Target, m_TargetBody)) - after->m_Height;
	}

	const VRestSkeleton m_Source;
	const VRestSkeleton m_Target;
	const VAlignmentRequest& m_rRequest;
	const VBodyReading m_SourceBody;
	const VBodyReading m_TargetBody;
	std::vector<VMember> m_Members;
	std::vector<VAim> m_Aims;
	/// For each joint of the target, -1 for none.
	std::vector<std::int64_t> m_MemberOf;
	std::vector<std::int64_t> m_AimOf;
	/// For each joint of the target, as LevelAsBound gives it, nothing for all but feet and toes.
	std::vector<std::optional<VMatrix3>> m_Levels;
	double m_Turn = 0.0;
};

} // namespace

VAlignment Align(const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget, const VAlignmentRequest& i_rRequest)
{
	return VAligner(i_rSource, i_rTarget, i_rRequest).Run();
}

} // namespace SetupProposal
