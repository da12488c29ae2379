#include "RetargetSetupCore/SourceAlignment.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/RootHeight.h"

#include <algorithm>
#include <cmath>
#include <map>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VMatrix3;

namespace RetargetSetup
{
namespace
{

using VJoint = VSubjectParametrised::VJoint;

/// Less than this, in mm, is no lift, and less than this, in radians, no turn.
constexpr double c_NoMove = 1e-6;
constexpr double c_NoTurn = 1e-9;

/// What the targets tie: of several source segments the first that a rotation target names, or else the first.
std::vector<SetupProposal::VMappedJoints> MappedSegments(
    const VSubjectParametrised& i_rSource, const VSubjectParametrised& i_rTarget)
{
	std::map<std::string, std::size_t> sources;
	for (std::size_t i = 0; i < i_rSource.m_Segments.size(); ++i)
		sources.emplace(i_rSource.m_Segments[i].m_Name, i);
	std::map<std::size_t, std::size_t> mapped;
	for (const bool bRotation : {true, false})
		for (const VSubjectParametrised::VTarget& rTarget : i_rTarget.m_Targets)
		{
			if (rTarget.m_SegmentIndices.empty() || rTarget.m_SegmentIndices[0] >= i_rTarget.m_Segments.size()
			    || (rTarget.m_Type == VSubjectParametrised::VTarget::ELocalRotationToWorldRotation) != bRotation)
				continue;
			const std::string* const pName = SourceName(i_rTarget, rTarget);
			if (!pName)
				continue;
			if (const auto source = sources.find(*pName); source != sources.end())
				mapped.emplace(rTarget.m_SegmentIndices[0], source->second);
		}
	std::vector<SetupProposal::VMappedJoints> pairs;
	pairs.reserve(mapped.size());
	for (const auto& [target, source] : mapped)
		pairs.push_back({source, target});
	return pairs;
}

std::map<std::size_t, std::string> HeldSegments(
    const VSubjectParametrised& i_rTarget, const std::set<std::size_t>& i_rLocked)
{
	std::map<std::size_t, std::string> held;
	for (std::size_t i = 0; i < i_rTarget.m_Segments.size(); ++i)
	{
		const VJoint::EJointType type = i_rTarget.m_Segments[i].m_Joint.m_JointType;
		if (i_rLocked.contains(i))
			held.emplace(i, "is locked");
		else if (type == VJoint::EDummy)
			held.emplace(i, "has no joint");
		else if (type != VJoint::EBall && type != VJoint::EFree)
			held.emplace(i, "has no joint that turns every way");
	}
	return held;
}

/// Turns a joint in the world, after what it hangs on has turned.
/// @param i_rBase where the joint moves in, as it stood before.
void TurnJoint(VJoint& io_rJoint, const VMatrix3& i_rBase, const VMatrix3& i_rCarried, const VMatrix3& i_rTurn)
{
	const VMatrix3 own = Rotation::Product(i_rTurn, Rotation::Transposed(i_rCarried));
	if (AngleBetween(own, Rotation::c_Identity3) < c_NoTurn)
		return;
	const VMatrix3 base = Rotation::Product(i_rCarried, i_rBase);
	std::vector<double>& rBindPose = io_rJoint.m_BindPose;
	rBindPose.resize(CoreOrlexTypes::StateSize(io_rJoint.m_JointType));
	const VMatrix3 motion = Rotation::RotationMatrixFromAngleAxis({rBindPose[0], rBindPose[1], rBindPose[2]});
	const VMatrix3 turned =
	    Rotation::Product(Rotation::Transposed(base), Rotation::Product(own, Rotation::Product(base, motion)));
	std::ranges::copy(Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(turned)), rBindPose.begin());
	io_rJoint.m_Mean = rBindPose;
}

} // namespace

std::optional<SetupProposal::VPoseFinding> ScaleFinding(const VSubjectParametrised& i_rSourceParametrised,
    const VSubject& i_rSource, const VSubjectParametrised& i_rTargetParametrised, const VSubject& i_rTarget)
{
	const auto source = RestOf(i_rSourceParametrised, i_rSource);
	const auto target = RestOf(i_rTargetParametrised, i_rTarget);
	std::vector<SetupProposal::VPoseFinding> findings =
	    SetupProposal::CheckPose(source, target, SetupProposal::Propose(source, target));
	const auto found =
	    std::ranges::find(findings, std::string_view("scale"), [](const auto& i_rFinding) { return i_rFinding.m_pId; });
	return found == findings.end() ? std::nullopt : std::optional(std::move(*found));
}

std::optional<VAligned> AlignToSource(const VSubjectParametrised& i_rSourceParametrised, const VSubject& i_rSource,
    const VSubjectParametrised& i_rTargetParametrised, const VSubject& i_rTarget, const FBXIO::VSkinSkeleton& i_rBones,
    const VAlignmentChoice& i_rChoice, std::string& o_rReason)
{
	const auto pSourceFK = KinematicsInBindPose(i_rSourceParametrised, i_rSource, "source");
	const auto pTargetFK = KinematicsInBindPose(i_rTargetParametrised, i_rTarget, "target");
	if (!pSourceFK || !pTargetFK)
	{
		o_rReason = pSourceFK ? Ignored::c_TargetNoTree : Ignored::c_SourceNoTree;
		return std::nullopt;
	}
	SetupProposal::VAlignmentRequest request{MappedSegments(i_rSourceParametrised, i_rTargetParametrised),
	    i_rChoice.m_bSpine, i_rChoice.m_bArms, i_rChoice.m_bLegs, i_rChoice.m_bOthers, i_rChoice.m_bFeetWithShins,
	    HeldSegments(i_rTargetParametrised, i_rChoice.m_Locked)};
	if (request.m_Pairs.empty())
	{
		o_rReason = "No target ties a segment of the target subject to one of the source. Add targets first.";
		return std::nullopt;
	}
	VAligned aligned{i_rTargetParametrised,
	    SetupProposal::Align(
	        RestOf(i_rSourceParametrised, i_rSource), RestOf(i_rTargetParametrised, i_rTarget, i_rBones), request)};
	const SetupProposal::VAlignment& rAlignment = aligned.m_Alignment;
	for (std::size_t i = 0; i < aligned.m_Subject.m_Segments.size(); ++i)
	{
		const std::uint32_t parent = i_rTarget.m_Segments[i].m_ParentSegmentIndex;
		if (!request.m_Held.contains(i))
			TurnJoint(aligned.m_Subject.m_Segments[i].m_Joint, pTargetFK->Segment(i).JointBasePose().R,
			    parent == CoreOrlexTypes::c_NoParent ? Rotation::c_Identity3 : rAlignment.m_Turns[parent],
			    rAlignment.m_Turns[i]);
	}
	const Rotation::VVector3& rMove = rAlignment.m_MoveMm;
	if (std::hypot(rMove[0], rMove[1], rMove[2]) > c_NoMove
	    && !MoveRoot(aligned.m_Subject,
	        [&](Rotation::VPose<double>& io_rWorld)
	        {
		        for (std::size_t axis = 0; axis < 3; ++axis)
			        io_rWorld.t[axis] += rMove[axis];
	        }))
		aligned.m_Alignment.m_MoveMm = {};
	VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(aligned.m_Subject, subject);
	if (const auto pAlignedFK = KinematicsInBindPose(aligned.m_Subject, subject, "target"))
		UpdateTargetStates(*pSourceFK, *pAlignedFK, i_rSourceParametrised, aligned.m_Subject);
	return aligned;
}

} // namespace RetargetSetup
