#include "TakeSolve/SourceMotion.h"

#include "TakeSolve/Vectors.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ConstructionException.h"
#include "CoreOrlexTypes/Subject.h"
#include "SetupProposal/BodyParts.h"
#include "math/NumberText.h"

namespace TakeSolve
{
namespace
{

using CoreOrlexTypes::VSubject;
using SetupProposal::VRestSkeleton;
using TakeIO::VTake;

/// Smaller differences at rest are not told.
constexpr double c_ToldArc = 5.0 / c_Degrees;
/// Where bones at rest point so far apart, the pair is most likely wrong: arms that hang are 90 degrees off a T-pose.
constexpr double c_Contradiction = 120.0 / c_Degrees;
/// Bones that point as much alike are those of one skeleton.
constexpr double c_SameDirection = 0.5 / c_Degrees;
/// Joints that are closer have no direction between them, in mm.
constexpr double c_SamePlace = 1.0;
/// Frames that the scale is the median of; of a longer take as many, evenly spread.
constexpr std::size_t c_ScaleFrames = 1000;

VRestSkeleton SkeletonOf(const VTake& i_rTake, const std::vector<VWorldPose>& i_rPoses)
{
	VRestSkeleton skeleton;
	for (std::size_t i = 0; i < i_rPoses.size(); ++i)
	{
		const TakeIO::VJoint& rJoint = i_rTake.m_Joints[i];
		skeleton.push_back({rJoint.m_Name.substr(rJoint.m_Name.rfind(':') + 1), rJoint.m_Parent, i_rPoses[i].t, true});
	}
	return skeleton;
}

/// About the vertical, from where the second body faces to where the first does; 0 where their shapes do not tell.
double Facing(const VRestSkeleton& i_rTo, const VRestSkeleton& i_rFrom)
{
	const SetupProposal::VBodyFrame to = SetupProposal::ReadBody(i_rTo).m_Frame;
	const SetupProposal::VBodyFrame from = SetupProposal::ReadBody(i_rFrom).m_Frame;
	for (const auto* pFrame : {&to, &from})
		if (!pFrame->m_bSidesByName && !pFrame->m_bFrontByFeet)
			return 0.0;
	const double angle = std::atan2(from.m_Left[0] * to.m_Left[1] - from.m_Left[1] * to.m_Left[0],
	    from.m_Left[0] * to.m_Left[0] + from.m_Left[1] * to.m_Left[1]);
	return std::abs(angle) > c_ToldArc ? angle : 0.0;
}

std::string DegreesText(double i_Radians)
{
	return std::to_string(std::lround(c_Degrees * i_Radians)) + " degrees";
}

void Append(std::string& io_rList, const std::string& i_rName, double i_Radians)
{
	io_rList += (io_rList.empty() ? "" : ", ") + i_rName + " by " + DegreesText(i_Radians);
}

} // namespace

std::shared_ptr<const VSourceMotion> VSourceMotion::Make(const VSubject& i_rSource, std::span<const double> i_BindPose,
    std::shared_ptr<const VTake> i_pTake, const VSourceSettings& i_rSettings, std::string& o_rError)
{
	const std::shared_ptr<VSourceMotion> pMotion(new VSourceMotion);
	ComputeSubject::VSegmentTree tree;
	try
	{
		tree = ComputeSubject::MakeSegmentTree(i_rSource);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
	}
	if (tree.empty() || i_pTake->m_Joints.empty() || i_pTake->m_Frames == 0)
	{
		o_rError = tree.empty() ? "The performer's segments make no tree, or have a joint without kinematics"
		                        : "The take holds no motion";
		return nullptr;
	}
	if (i_rSettings.m_RestFrame && *i_rSettings.m_RestFrame >= i_pTake->m_Frames)
	{
		o_rError = "The take has no frame " + std::to_string(*i_rSettings.m_RestFrame) + ": its last one is "
		    + std::to_string(i_pTake->m_Frames - 1);
		return nullptr;
	}
	VSourceMotion& rMotion = *pMotion;
	rMotion.m_pTake = std::move(i_pTake);

	std::size_t states = 0;
	for (const auto& rpSegment : tree)
		states += rpSegment->NumberOfStates();
	std::vector<double> bindPose(states, 0.0);
	std::copy_n(i_BindPose.begin(), std::min(i_BindPose.size(), states), bindPose.begin());
	const auto pose = [&tree](const std::vector<double>& i_rStates, std::vector<VWorldPose>& o_rPoses,
	                      std::vector<VVector3>& o_rCentres)
	{
		const double* pState = i_rStates.data();
		for (const auto& rpSegment : tree)
		{
			rpSegment->Update(pState);
			o_rPoses.push_back(rpSegment->SegmentPose());
			o_rCentres.push_back(rpSegment->WorldPose().t);
		}
	};
	pose(bindPose, rMotion.m_BindPoses, rMotion.m_Centres);
	std::ranges::fill(bindPose.begin() + std::ptrdiff_t(tree.front()->NumberOfStates()), bindPose.end(), 0.0);
	std::vector<VWorldPose> atZero;
	std::vector<VVector3> centresAtZero;
	pose(bindPose, atZero, centresAtZero);
	for (std::size_t i = 0; i < tree.size(); ++i)
	{
		const VSubject::VSegment& rSegment = i_rSource.m_Segments[i];
		rMotion.m_Names.push_back(rSegment.m_Name);
		VLink link;
		link.m_Parent = i == 0 ? -1 : std::int64_t(rSegment.m_ParentSegmentIndex);
		rMotion.m_Links.push_back(link);
		rMotion.m_Rest.push_back({rSegment.m_Name, link.m_Parent, rMotion.m_BindPoses[i].t,
		    rSegment.m_Joint.m_JointType != CoreOrlexTypes::VSubjectParametrised::VJoint::EDummy});
	}

	std::vector<VWorldPose> rest;
	if (i_rSettings.m_RestFrame)
		TakeIO::WorldPoses(*rMotion.m_pTake, *i_rSettings.m_RestFrame, rest);
	else
		TakeIO::WorldRestPoses(*rMotion.m_pTake, rest);
	const VRestSkeleton joints = SkeletonOf(*rMotion.m_pTake, rest);
	if (!PairJoints(joints, rMotion.m_Rest, i_rSettings.m_Joints, rMotion.m_Joints, rMotion.m_Findings, o_rError))
		return nullptr;
	const auto first = std::ranges::find_if(rMotion.m_Joints, [](std::int32_t i_Joint) { return i_Joint >= 0; });
	if (first == rMotion.m_Joints.end())
	{
		o_rError = "No joint of the take belongs to a segment of the performer";
		return nullptr;
	}
	rMotion.m_First = std::size_t(first - rMotion.m_Joints.begin());
	rMotion.m_Above.assign(tree.size(), false);
	for (std::int64_t i = rMotion.m_Links[rMotion.m_First].m_Parent; i >= 0;
	     i = rMotion.m_Links[std::size_t(i)].m_Parent)
		rMotion.m_Above[std::size_t(i)] = true;

	if (!i_rSettings.m_RestFrame && rMotion.StandsAs(rest, centresAtZero))
		rMotion.FindArcs(rest, atZero, centresAtZero, true);
	else
		rMotion.FindArcs(rest, rMotion.m_BindPoses, rMotion.m_Centres, !i_rSettings.m_RestFrame);
	rMotion.FindScale();
	return pMotion;
}

std::int64_t VSourceMotion::DrivenAbove(std::size_t i_Segment) const
{
	std::int64_t above = m_Links[i_Segment].m_Parent;
	while (above >= 0 && m_Joints[std::size_t(above)] < 0)
		above = m_Links[std::size_t(above)].m_Parent;
	return above;
}

bool VSourceMotion::StandsAs(const std::vector<VWorldPose>& i_rRest, const std::vector<VVector3>& i_rCentres) const
{
	for (std::size_t i = 0; i < m_Links.size(); ++i)
	{
		const std::int64_t above = m_Joints[i] >= 0 ? DrivenAbove(i) : -1;
		if (above >= 0
		    && AngleBetween(Difference(i_rCentres[i], i_rCentres[std::size_t(above)]),
		           Difference(
		               i_rRest[std::size_t(m_Joints[i])].t, i_rRest[std::size_t(m_Joints[std::size_t(above)])].t))
		        > c_SameDirection)
			return false;
	}
	return true;
}

void VSourceMotion::FindArcs(const std::vector<VWorldPose>& i_rRest, const std::vector<VWorldPose>& i_rReference,
    const std::vector<VVector3>& i_rCentres, bool i_bArcs)
{
	const double facing = Facing(SkeletonOf(*m_pTake, i_rRest), m_Rest);
	const VMatrix3 turned = Rotation::RotationMatrixFromAngleAxis({0.0, 0.0, facing});
	if (facing != 0.0)
		m_Findings.push_back({"facing",
		    "At rest the performer of the take faces another way than the performer's skeleton, which is turned by "
		        + DegreesText(facing) + " about the vertical."});

	const std::size_t count = m_Links.size();
	const auto bindDirection = [&](std::size_t i_From, std::size_t i_To)
	{ return Difference(i_rCentres[i_To], i_rCentres[i_From]); };
	const auto restDirection = [&](std::size_t i_From, std::size_t i_To)
	{ return Difference(i_rRest[std::size_t(m_Joints[i_To])].t, i_rRest[std::size_t(m_Joints[i_From])].t); };
	const auto bApart = [&](std::size_t i_From, std::size_t i_To)
	{ return std::min(Length(bindDirection(i_From, i_To)), Length(restDirection(i_From, i_To))) > c_SamePlace; };
	// Where the bones of a segment lead to: the next driven ones below, beyond those that stand where it does.
	std::vector<std::vector<std::size_t>> ends(count);
	for (std::size_t i = 0; i < count; ++i)
		if (m_Joints[i] >= 0)
			for (std::int64_t above = DrivenAbove(i), below = std::int64_t(i);
			     above >= 0 && (below == std::int64_t(i) || !bApart(std::size_t(above), std::size_t(below)))
			     && bApart(std::size_t(above), i);
			     below = above, above = DrivenAbove(std::size_t(above)))
				ends[std::size_t(above)].push_back(i);

	std::vector<VMatrix3> corrections(count, turned);
	m_Arcs.assign(count, 0.0);
	std::string arcs;
	std::string left;
	for (std::size_t i = 0; i < count; ++i)
	{
		const std::int64_t parent = m_Links[i].m_Parent;
		const VMatrix3& rAbove = parent >= 0 ? corrections[std::size_t(parent)] : turned;
		if (m_Joints[i] >= 0 && i_bArcs)
		{
			const auto worst = [&](const VMatrix3& i_rCorrection)
			{
				double angle = 0.0;
				for (const std::size_t end : ends[i])
					angle = std::max(angle,
					    AngleBetween(Rotation::Product(i_rCorrection, bindDirection(i, end)), restDirection(i, end)));
				return angle;
			};
			if (ends[i].size() == 1)
			{
				const VVector3 from = Rotation::Product(turned, bindDirection(i, ends[i].front()));
				const VVector3 to = restDirection(i, ends[i].front());
				m_Arcs[i] = AngleBetween(from, to);
				corrections[i] = Rotation::Product(ShortestArc(from, to), turned);
				if (m_Arcs[i] > c_Contradiction)
					m_Findings.push_back({"direction",
					    "At rest the joint " + m_pTake->m_Joints[std::size_t(m_Joints[i])].m_Name
					        + " points nearly against the segment " + m_Names[i] + " that it drives ("
					        + DegreesText(m_Arcs[i]) + "). See whether they are the right pair."});
				else if (m_Arcs[i] > c_ToldArc)
					Append(arcs, m_Names[i], m_Arcs[i]);
			}
			else
			{
				if (ends[i].empty() || worst(rAbove) < worst(turned))
					corrections[i] = rAbove;
				if (const double angle = worst(corrections[i]); angle > c_ToldArc)
					Append(left, m_Names[i], angle);
			}
		}
		else if (m_Joints[i] < 0)
			corrections[i] = rAbove;

		// R(frame) R(rest)' correction reference.
		const VMatrix3& rBind = m_BindPoses[i].R;
		m_Links[i].m_Offset =
		    Rotation::Product(Rotation::Transposed(rBind), Difference(m_BindPoses[i].t, m_Centres[i]));
		if (m_Joints[i] >= 0)
			m_Links[i].m_Turn = Rotation::Product(Rotation::Transposed(i_rRest[std::size_t(m_Joints[i])].R),
			    Rotation::Product(corrections[i], i_rReference[i].R));
		if (parent < 0)
			continue;
		const VWorldPose& rParent = m_BindPoses[std::size_t(parent)];
		m_Links[i].m_Centre = Rotation::Apply(Rotation::Inverse(rParent), m_Centres[i]);
		if (m_Joints[i] < 0)
			m_Links[i].m_Turn = Rotation::Product(Rotation::Transposed(rParent.R), rBind);
	}
	if (!arcs.empty())
		m_Findings.push_back({"rest-arc",
		    "The take's rest pose is another one than the performer's bind pose; these bones follow it by the "
		    "shortest way: "
		        + arcs + ". A frame that fits the bind pose would be the other way."});
	if (!left.empty())
		m_Findings.push_back({"rest-left",
		    "Segments that lead to several others keep what their bones differ by at rest: " + left + "."});
}

void VSourceMotion::FindScale()
{
	std::vector<VWorldPose> joints;
	std::vector<VWorldPose> segments;
	std::vector<double> ratios;
	const std::size_t step = std::max<std::size_t>(1, m_pTake->m_Frames / c_ScaleFrames);
	for (std::size_t frame = 0; frame < m_pTake->m_Frames; frame += step)
	{
		Poses(frame, joints, segments);
		double own = 0.0;
		double take = 0.0;
		const auto centre = [&](std::size_t i_Segment)
		{
			const VVector3 offset = Rotation::Product(segments[i_Segment].R, m_Links[i_Segment].m_Offset);
			return segments[i_Segment].t[2] - offset[2];
		};
		for (std::size_t i = 0; i < segments.size(); ++i)
			if (m_Joints[i] >= 0)
			{
				own = std::max(own, centre(m_First) - centre(i));
				take =
				    std::max(take, joints[std::size_t(m_Joints[m_First])].t[2] - joints[std::size_t(m_Joints[i])].t[2]);
			}
		if (own > c_SamePlace && take > c_SamePlace)
			ratios.push_back(own / take);
	}
	if (ratios.empty())
		return;
	const auto middle = ratios.begin() + std::ptrdiff_t(ratios.size() / 2);
	std::ranges::nth_element(ratios, middle);
	m_Scale = *middle;
}

void VSourceMotion::Poses(
    std::size_t i_Frame, std::vector<VWorldPose>& io_rJoints, std::vector<VWorldPose>& o_rSegments) const
{
	TakeIO::WorldPoses(*m_pTake, i_Frame, io_rJoints);
	o_rSegments.resize(m_Links.size());
	const auto place = [&](std::size_t i_Segment, const VMatrix3& i_rFrom, const VVector3& i_rCentre)
	{
		VWorldPose& rPose = o_rSegments[i_Segment];
		rPose.R = Rotation::Product(i_rFrom, m_Links[i_Segment].m_Turn);
		rPose.t = Sum(i_rCentre, Rotation::Product(rPose.R, m_Links[i_Segment].m_Offset));
	};
	const VWorldPose& rFirst = io_rJoints[std::size_t(m_Joints[m_First])];
	place(m_First, rFirst.R, {m_Scale * rFirst.t[0], m_Scale * rFirst.t[1], m_Scale * rFirst.t[2]});
	const VWorldPose fromBind = Rotation::Compose(o_rSegments[m_First], Rotation::Inverse(m_BindPoses[m_First]));
	for (std::size_t i = 0; i < m_Links.size(); ++i)
	{
		if (i == m_First)
			continue;
		if (m_Above[i])
		{
			o_rSegments[i] = Rotation::Compose(fromBind, m_BindPoses[i]);
			continue;
		}
		const VWorldPose& rParent = o_rSegments[std::size_t(m_Links[i].m_Parent)];
		place(i, m_Joints[i] >= 0 ? io_rJoints[std::size_t(m_Joints[i])].R : rParent.R,
		    Rotation::Apply(rParent, m_Links[i].m_Centre));
	}
}

} // namespace TakeSolve
