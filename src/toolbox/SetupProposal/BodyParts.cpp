#include "SetupProposal/BodyParts.h"

#include "SetupProposal/FingerOrder.h"
#include "SetupProposal/LimbVote.h"
#include "SetupProposal/PartWords.h"
#include "SetupProposal/RestPoseVote.h"
#include "SetupProposal/SkinVote.h"
#include "SetupProposal/TreeVote.h"
#include "SetupProposal/Twins.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>

namespace SetupProposal
{
namespace
{

/// What a name costs the parts that it does not tell.
constexpr double c_NotTheName = -4.0;
/// Nearer than this part of the height to the mirror plane a place tells no side, and to another joint it is the same
/// place.
constexpr double c_Central = 0.012;
constexpr double c_SamePart = 0.004;
/// How much each tells of a side.
constexpr double c_SideByName = 0.6;
/// Where the feet tell that all names are of the other side.
constexpr double c_SideByContradictedName = 0.3;
constexpr double c_SideByPlace = 0.9;
constexpr double c_SideByParent = 0.8;
constexpr double c_LeastSide = 0.2;

double Signed(ESide i_Side, double i_Weight)
{
	return i_Side == ESide::None ? 0.0 : i_Side == ESide::Left ? i_Weight : -i_Weight;
}

/// How far to the left each joint stands, and those in the middle with what hangs on them.
std::vector<double> LeftOfPlane(const VRestSkeleton& i_rSkeleton, const std::vector<VJointReading>& i_rJoints)
{
	std::vector<double> sum(i_rSkeleton.size());
	std::vector<double> left(i_rSkeleton.size());
	for (std::size_t i = i_rSkeleton.size(); i-- > 0;)
	{
		const double own = i_rJoints[i].m_Place.m_Left;
		sum[i] += own;
		left[i] = std::abs(own) > c_Central || !HasSides(i_rJoints[i].m_Part) ? own : sum[i];
		if (i_rSkeleton[i].m_Parent >= 0)
			sum[std::size_t(i_rSkeleton[i].m_Parent)] += sum[i];
	}
	return left;
}

void ReadSides(const VRestSkeleton& i_rSkeleton, VBodyReading& io_rBody)
{
	const std::vector<double> left = LeftOfPlane(i_rSkeleton, io_rBody.m_Joints);
	const double byName = io_rBody.m_Frame.m_bContradiction ? c_SideByContradictedName : c_SideByName;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		VJointReading& rJoint = io_rBody.m_Joints[i];
		double side = Signed(io_rBody.m_Names[i].m_Side, byName);
		if (std::abs(left[i]) > c_Central)
			side += left[i] > 0.0 ? c_SideByPlace : -c_SideByPlace;
		if (const std::int64_t parent = i_rSkeleton[i].m_Parent;
		    parent >= 0 && HasSides(io_rBody.m_Joints[std::size_t(parent)].m_Part))
			side += Signed(io_rBody.m_Joints[std::size_t(parent)].m_Side, c_SideByParent);
		if (std::abs(side) > c_LeastSide)
			rJoint.m_Side = side > 0.0 ? ESide::Left : ESide::Right;
	}
}

/// The part above, past helpers, -1 without one.
std::int64_t PartAbove(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody, std::size_t i_Joint)
{
	std::int64_t parent = i_rSkeleton[i_Joint].m_Parent;
	while (parent >= 0 && i_rBody.m_Joints[std::size_t(parent)].m_Part == EOther)
		parent = i_rSkeleton[std::size_t(parent)].m_Parent;
	return parent;
}

bool StandsAt(const VJointReading& i_rA, const VJointReading& i_rB)
{
	return std::hypot(i_rA.m_Place.m_Left - i_rB.m_Place.m_Left, i_rA.m_Place.m_Forward - i_rB.m_Place.m_Forward,
	           i_rA.m_Place.m_Up - i_rB.m_Place.m_Up)
	    < c_SamePart;
}

void ReadChains(const VRestSkeleton& i_rSkeleton, VBodyReading& io_rBody)
{
	std::vector<VJointReading>& rJoints = io_rBody.m_Joints;
	for (std::size_t i = 0; i < rJoints.size(); ++i)
	{
		VJointReading& rJoint = rJoints[i];
		const std::int64_t above = PartAbove(i_rSkeleton, io_rBody, i);
		rJoint.m_ParentPart = above < 0 ? EOther : rJoints[std::size_t(above)].m_Part;
		rJoint.m_bUsualParent = UsualBeneath(rJoint.m_ParentPart, rJoint.m_Part) > -1.6;
		if (above < 0)
			continue;
		VJointReading& rAbove = rJoints[std::size_t(above)];
		if (rAbove.m_Part == rJoint.m_Part)
		{
			// The base of a finger that stands in the hand is no joint of the finger.
			const std::int64_t hand = PartAbove(i_rSkeleton, io_rBody, std::size_t(above));
			if (IsFinger(rJoint.m_Part) && rAbove.m_Ordinal == 0 && hand >= 0
			    && StandsAt(rAbove, rJoints[std::size_t(hand)]))
				rAbove.m_Ordinal = -1;
			rJoint.m_Ordinal = rAbove.m_Ordinal + (i_rSkeleton[std::size_t(above)].m_bMoves ? 1 : 0);
		}
		if (rJoint.m_Part == EClavicle || rJoint.m_Part == EUpperArm)
			for (std::int64_t k = above; k >= 0; k = i_rSkeleton[std::size_t(k)].m_Parent)
				if (rJoints[std::size_t(k)].m_Part == ESpine && i_rSkeleton[std::size_t(k)].m_bMoves)
				{
					rJoints[std::size_t(k)].m_bCarriesArms = true;
					io_rBody.m_bBackCarriesArms = true;
					break;
				}
	}
}

/// The likeliest joint of a part that moves, of several alike the first or the last; -1 without one.
std::int64_t Likeliest(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody, EBodyPart i_Part, bool i_bFirst)
{
	std::int64_t best = -1;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
		if (i_rBody.m_Joints[i].m_Part == i_Part && i_rSkeleton[i].m_bMoves)
		{
			const double gain = best < 0
			    ? 1.0
			    : i_rBody.m_Joints[i].m_Likely[i_Part] - i_rBody.m_Joints[std::size_t(best)].m_Likely[i_Part];
			if (gain > (i_bFirst ? 0.3 : -0.3))
				best = std::int64_t(i);
		}
	return best;
}

/// Where the joints of a part stand on the line from one joint to another.
void ReadAlong(
    const VRestSkeleton& i_rSkeleton, VBodyReading& io_rBody, EBodyPart i_Part, std::int64_t i_From, std::int64_t i_To)
{
	if (i_From < 0 || i_To < 0)
		return;
	const auto& rFrom = i_rSkeleton[std::size_t(i_From)].m_Place;
	const auto& rTo = i_rSkeleton[std::size_t(i_To)].m_Place;
	double squared = 0.0;
	for (std::size_t axis = 0; axis < 3; ++axis)
		squared += (rTo[axis] - rFrom[axis]) * (rTo[axis] - rFrom[axis]);
	for (std::size_t i = 0; i < i_rSkeleton.size() && squared > 0.0; ++i)
	{
		if (io_rBody.m_Joints[i].m_Part != i_Part)
			continue;
		double along = 0.0;
		for (std::size_t axis = 0; axis < 3; ++axis)
			along += (i_rSkeleton[i].m_Place[axis] - rFrom[axis]) * (rTo[axis] - rFrom[axis]) / squared;
		io_rBody.m_Joints[i].m_Along = std::clamp(along, 0.0, 1.0);
	}
}

/// How high the joints stand that are one of these parts by their names, as a part of the height.
std::optional<double> UpByNames(
    const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody, std::initializer_list<EBodyPart> i_Parts)
{
	double sum = 0.0;
	double weights = 0.0;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
		if (const auto scores = PartsByName(i_rBody.m_Names[i]))
			for (const EBodyPart part : i_Parts)
			{
				sum += (*scores)[part] * PlaceIn(i_rBody.m_Frame, i_rSkeleton[i].m_Place).m_Up;
				weights += (*scores)[part];
			}
	return weights > 0.0 ? std::optional(sum / weights) : std::nullopt;
}

} // namespace

VBodyReading ReadBody(const VRestSkeleton& i_rSkeleton)
{
	VBodyReading body;
	std::vector<std::string_view> names;
	for (const VRestJoint& rJoint : i_rSkeleton)
		names.push_back(rJoint.m_Name);
	body.m_Names = WordsOf(names);
	const std::vector<std::int64_t> twins = FindTwins(i_rSkeleton);
	body.m_Frame = BodyFrameOf(i_rSkeleton, body.m_Names, twins);
	body.m_Joints.resize(i_rSkeleton.size());

	const VLimbVotes limbs = VoteByLimbs(i_rSkeleton, body.m_Frame);
	const auto legsUp = limbs.m_LegsUp ? limbs.m_LegsUp : UpByNames(i_rSkeleton, body, {EThigh});
	const auto armsUp = limbs.m_ArmsUp ? limbs.m_ArmsUp : UpByNames(i_rSkeleton, body, {EClavicle, EUpperArm});
	if (legsUp && armsUp)
	{
		body.m_Frame.m_LegsUp = *legsUp;
		body.m_Frame.m_ArmsUp = *armsUp;
	}
	const std::vector<VPartLogs>& rByLimbs = limbs.m_Logs;
	const std::vector<VPartLogs> byRestPose = VoteByRestPose(i_rSkeleton, body.m_Frame);
	const std::vector<VPartLogs> bySkin = VoteBySkin(i_rSkeleton, body.m_Frame);
	std::vector<VPartLogs> votes = byRestPose;
	for (std::size_t i = 0; i < votes.size(); ++i)
	{
		VJointReading& rJoint = body.m_Joints[i];
		rJoint.m_Place = PlaceIn(body.m_Frame, i_rSkeleton[i].m_Place);
		rJoint.m_Twin = twins[i];
		rJoint.m_ByRestPose = byRestPose[i];
		if (i_rSkeleton[i].m_Skin)
			rJoint.m_BySkin = bySkin[i];
		for (std::size_t part = 0; part < c_BodyParts; ++part)
			votes[i][part] += rByLimbs[i][part] + bySkin[i][part];
		rJoint.m_ByName = PartsByName(body.m_Names[i]);
		for (std::size_t part = 0; rJoint.m_ByName && part < c_BodyParts; ++part)
			votes[i][part] += std::max(c_NotTheName, std::log(std::max((*rJoint.m_ByName)[part], 1e-9)));
	}
	const std::vector<VPartScores> likely = LikelyParts(i_rSkeleton, votes);
	for (std::size_t i = 0; i < votes.size(); ++i)
	{
		body.m_Joints[i].m_Likely = likely[i];
		body.m_Joints[i].m_Part = EBodyPart(std::ranges::max_element(likely[i]) - likely[i].begin());
	}
	TellFingersApart(i_rSkeleton, body);
	ReadSides(i_rSkeleton, body);
	ReadChains(i_rSkeleton, body);
	const std::int64_t neck = Likeliest(i_rSkeleton, body, ENeck, true);
	const std::int64_t head = Likeliest(i_rSkeleton, body, EHead, true);
	ReadAlong(i_rSkeleton, body, ESpine, Likeliest(i_rSkeleton, body, EPelvis, false), neck >= 0 ? neck : head);
	ReadAlong(i_rSkeleton, body, ENeck, neck, head);
	return body;
}

} // namespace SetupProposal
