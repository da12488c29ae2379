#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/FilePose.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/RootHeight.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "SetupReview/rebind/Rebind.h"
#include "SetupReview/rebind/Renaming.h"
#include "SetupReview/rebind/SegmentMatch.h"
#include "math/NumberText.h"
#include "numerics/Rotation.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace SetupReview
{
namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VMatrix3;
using Rotation::VPose;
using Rotation::VVector3;
using VJoint = VSubjectParametrised::VJoint;
using VTarget = VSubjectParametrised::VTarget;

/// Below these what the new file has is what the old one had: what six printed digits leave open.
constexpr double c_SameRotation = 1e-5;
constexpr double c_SameLengthShare = 0.001;
/// A bone whose child lies in another direction by more, in radians, has other axes; by less it was moved.
constexpr double c_OtherAxes = 0.5;
/// Poses that differ by less, in mm and radians, are the same but for rounding.
constexpr double c_SamePlace = 1e-6;
constexpr double c_SameTurn = 1e-7;

double Length(const VVector3& i_rVector)
{
	return std::hypot(i_rVector[0], i_rVector[1], i_rVector[2]);
}

VVector3 Minus(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]};
}

VVector3 AngleAxis(const VMatrix3& i_rRotation)
{
	return Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(i_rRotation));
}

/// A subject with its numbers and where its segments stand.
struct VStanding
{
	explicit VStanding(const VSubjectParametrised& i_rSubject)
	{
		CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, m_Subject);
		if (const auto pFK = RetargetSetup::KinematicsInBindPose(i_rSubject, m_Subject, "target"))
			m_Poses = RetargetSetup::SegmentPoses(*pFK);
	}

	VVector3 Offset(std::size_t i_Segment) const { return m_Subject.m_Segments[i_Segment].m_PreTranslation; }

	VSubject m_Subject;
	/// Empty if the segments make no tree.
	std::vector<VPose<double>> m_Poses;
};

VSubjectParametrised AtScaleOne(VSubjectParametrised i_Subject)
{
	RetargetSetup::SetGlobalScale(i_Subject, 1.0);
	return i_Subject;
}

VMatchSide Side(const VSubjectParametrised& i_rSubject)
{
	const VStanding atScaleOne(AtScaleOne(i_rSubject));
	VMatchSide side{i_rSubject, RetargetSetup::RestOf(i_rSubject, atScaleOne.m_Subject), {}};
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
		side.m_Offsets.push_back(atScaleOne.Offset(i));
	return side;
}

std::size_t FindRoot(const VSubjectParametrised& i_rOld, const VNewCharacter& i_rCharacter, double i_LeastScore)
{
	const FBXIO::VSkinSkeleton& rBones = i_rCharacter.m_rBones;
	if (i_rCharacter.m_Root)
		return *i_rCharacter.m_Root;
	for (std::size_t i = 0; i < rBones.size(); ++i)
		if (RetargetSetup::StripNamespace(rBones[i].m_Name) == i_rOld.m_Segments.front().m_Name)
			return i;
	SetupProposal::VRestSkeleton old = Side(i_rOld).m_Rest;
	for (SetupProposal::VRestJoint& rJoint : old)
		rJoint.m_bMoves = true;
	const SetupProposal::VRestSkeleton rest = RetargetSetup::RestOf(rBones, i_rCharacter.m_Axis);
	const SetupProposal::VProposal proposal = SetupProposal::Propose(old, rest, i_LeastScore);
	for (const SetupProposal::VProposedPair& rPair : proposal.m_Pairs)
		if (rPair.m_Source == 0)
			return rPair.m_Target;
	return std::size_t(std::max<std::int64_t>(0, SetupProposal::BodyRoot(proposal, rest)));
}

/// As it is made of the file, in the pose of the file, at scale 1.
VSubjectParametrised SubjectOfFile(
    const VNewCharacter& i_rCharacter, std::size_t i_Root, VSubjectApplicationData& o_rData)
{
	VSubjectParametrised subject;
	RetargetSetup::BuildTargetSubject(i_rCharacter.m_rBones, subject, o_rData, i_Root);
	RetargetSetup::SetGlobalScale(subject, 1.0);
	RetargetSetup::MatchFilePose(
	    subject, RetargetSetup::ExtractSubtree(i_rCharacter.m_rBones, i_Root), i_rCharacter.m_Axis);
	return subject;
}

/// The work on one set-up.
class VRebinding
{
public:
	VRebinding(const VSetup& i_rOld, const VSubjectParametrised& i_rFile, const VSubjectApplicationData& i_rFileData,
	    double i_LeastScore)
	    : m_rOld(i_rOld.m_Record.m_SubjectParametrised), m_rFile(i_rFile), m_rFileData(i_rFileData),
	      m_OldStanding(m_rOld), m_FileStanding(m_rFile),
	      m_Matches(MatchSegments(Side(m_rOld), Side(m_rFile), i_LeastScore)), m_OldOf(m_rFile.m_Segments.size(), -1)
	{
		for (std::size_t i = 0; i < m_Matches.size(); ++i)
			if (m_Matches[i].m_New >= 0)
				m_OldOf[std::size_t(m_Matches[i].m_New)] = std::int64_t(i);
		m_Rebound.m_Setup = i_rOld;
	}

	VRebound Run()
	{
		if (m_OldStanding.m_Poses.empty() || m_FileStanding.m_Poses.empty())
		{
			m_Rebound.m_Refusal = "The segments make no tree";
			return m_Rebound;
		}
		const std::vector<std::string> names = StandardTargetNames(m_Rebound.m_Setup);
		TellMatches();
		MakeSegments();
		FindWorldPoses();
		Pose();
		KeepHeight();
		MoveTargets();
		KeepExtras();
		// Targets that went have taken their places along.
		std::vector<std::string> left;
		for (const std::size_t target : m_KeptTargets)
			left.push_back(names[target]);
		RenameTargets(m_Rebound.m_Setup, left);
		return m_Rebound;
	}

private:
	VSubjectParametrised& New() { return m_Rebound.m_Setup.m_Record.m_SubjectParametrised; }
	const std::string& OldName(std::size_t i_Index) const { return m_rOld.m_Segments[i_Index].m_Name; }

	void TellMatches()
	{
		for (std::size_t i = 0; i < m_Matches.size(); ++i)
		{
			const VSegmentMatch& rMatch = m_Matches[i];
			m_Rebound.m_Matches.push_back(
			    {OldName(i), rMatch.m_New < 0 ? "" : m_rFile.m_Segments[std::size_t(rMatch.m_New)].m_Name,
			        rMatch.m_Rule, rMatch.m_Score});
		}
		for (std::size_t i = 0; i < m_OldOf.size(); ++i)
			if (m_OldOf[i] < 0)
				m_Rebound.m_Added.push_back(m_rFile.m_Segments[i].m_Name);
	}

	/// All but poses.
	void MakeSegments()
	{
		const bool bAllJoints = std::ranges::none_of(m_rOld.m_Segments,
		    [](const VSubjectParametrised::VSegment& i_rSegment)
		    { return i_rSegment.m_Joint.m_JointType == VJoint::EDummy; });
		const VStanding oldAtScaleOne(AtScaleOne(m_rOld));
		auto& rData = m_Rebound.m_Setup.m_Record.m_SubjectApplicationData.m_Segments;
		std::vector<VSubjectParametrised::VSegment> segments = m_rFile.m_Segments;
		std::vector<VSubjectApplicationData::VSegment> data = m_rFileData.m_Segments;
		for (std::size_t i = 0; i < segments.size(); ++i)
		{
			VSubjectParametrised::VSegment& rSegment = segments[i];
			if (m_OldOf[i] < 0)
			{
				if (!bAllJoints && i > 0)
					rSegment.m_Joint = VJoint();
				continue;
			}
			const auto old = std::size_t(m_OldOf[i]);
			const VSubjectParametrised::VSegment file = rSegment;
			rSegment = m_rOld.m_Segments[old];
			rSegment.m_Name = file.m_Name;
			rSegment.m_SegmentIndex = file.m_SegmentIndex;
			rSegment.m_ParentSegmentIndex = file.m_ParentSegmentIndex;
			rSegment.m_TreeDepth = file.m_TreeDepth;
			const VVector3 offset = m_FileStanding.Offset(i);
			if (Length(Minus(offset, oldAtScaleOne.Offset(old))) > c_SameLengthShare * Length(offset))
				rSegment.m_PreTranslation = file.m_PreTranslation;
			const auto rotation = [](const VStanding& i_rStanding, std::size_t i_Index)
			{ return Rotation::RotationMatrixFromAngleAxis(i_rStanding.m_Subject.m_Segments[i_Index].m_PreRotation); };
			if (rSegment.m_Joint.m_JointType != VJoint::EDummy
			    && RetargetSetup::AngleBetween(rotation(m_FileStanding, i), rotation(m_OldStanding, old))
			        > c_SameRotation)
				rSegment.m_PreRotation = file.m_PreRotation;
			// A root is free, and nothing else is.
			if ((i == 0) != (old == 0))
				rSegment.m_Joint = file.m_Joint;
			if (old < rData.size())
				data[i] = rData[old];
		}
		New().m_Segments = std::move(segments);
		rData = std::move(data);
	}

	/// Whether the bone's axes point elsewhere in the body than the old one's: then no pose of it can be taken over.
	std::vector<bool> SegmentsOfOtherAxes() const
	{
		std::vector<bool> bOther(m_OldOf.size());
		std::vector<double> longest(m_OldOf.size());
		std::vector<bool> bMeasured(m_OldOf.size());
		for (std::size_t i = 1; i < m_OldOf.size(); ++i)
		{
			const std::size_t parent = m_rFile.m_Segments[i].m_ParentSegmentIndex;
			if (m_OldOf[i] < 0 || m_OldOf[parent] < 0
			    || m_rOld.m_Segments[std::size_t(m_OldOf[i])].m_ParentSegmentIndex != std::size_t(m_OldOf[parent]))
				continue;
			const VVector3 before = m_OldStanding.Offset(std::size_t(m_OldOf[i]));
			const VVector3 now = m_FileStanding.Offset(i);
			const double lengths = Length(before) * Length(now);
			if (!(lengths > longest[parent]))
				continue;
			longest[parent] = lengths;
			bMeasured[parent] = true;
			bOther[parent] = std::acos(std::clamp(
			                     (before[0] * now[0] + before[1] * now[1] + before[2] * now[2]) / lengths, -1.0, 1.0))
			    > c_OtherAxes;
		}
		// The end of a limb has no child that would tell.
		for (std::size_t i = 1; i < m_OldOf.size(); ++i)
			if (!bMeasured[i])
				bOther[i] = bOther[m_rFile.m_Segments[i].m_ParentSegmentIndex];
		return bOther;
	}

	void FindWorldPoses()
	{
		const std::vector<bool> bOther = SegmentsOfOtherAxes();
		for (std::size_t i = 0; i < m_OldOf.size(); ++i)
		{
			const VPose<double>& rFile = m_FileStanding.m_Poses[i];
			const bool bKept = m_OldOf[i] >= 0 && !bOther[i];
			if (bKept)
				m_World.push_back(m_OldStanding.m_Poses[std::size_t(m_OldOf[i])].R);
			else if (i == 0)
				m_World.push_back(rFile.R);
			else
			{
				const std::size_t parent = m_rFile.m_Segments[i].m_ParentSegmentIndex;
				m_World.push_back(
				    Rotation::Product(m_World[parent], Rotation::Relative(m_FileStanding.m_Poses[parent], rFile).R));
			}
			if (m_OldOf[i] >= 0 && !bKept)
				m_Rebound.m_Lost.push_back("The pose of \"" + m_rFile.m_Segments[i].m_Name
				    + "\": its axes are others in the new file, so it stands as it does there");
		}
	}

	void Pose()
	{
		VSubject numbers;
		CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(New(), numbers);
		const VVector3 root = m_OldOf[0] == 0 ? m_OldStanding.m_Poses[0].t : m_FileStanding.m_Poses[0].t;
		for (std::size_t i = 0; i < m_World.size(); ++i)
		{
			VSubjectParametrised::VSegment& rSegment = New().m_Segments[i];
			const VMatrix3 inParent = i == 0
			    ? m_World[0]
			    : Rotation::Product(Rotation::Transposed(m_World[rSegment.m_ParentSegmentIndex]), m_World[i]);
			const VPose<double> pre = Rotation::PoseFromAngleAxis(
			    numbers.m_Segments[i].m_PreRotation, numbers.m_Segments[i].m_PreTranslation);
			const VPose<double> motion = Rotation::Relative(pre, {inParent, i == 0 ? root : pre.t});
			const VVector3 rotation = AngleAxis(motion.R);
			const std::size_t size = CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
			if (size < 3)
			{
				if (Length(rotation) > c_SameRotation)
					for (std::size_t axis = 0; axis < 3; ++axis)
						rSegment.m_PreRotation[axis] = NumberText::PrintG17(AngleAxis(inParent)[axis]);
				continue;
			}
			std::vector<double>& rBindPose = rSegment.m_Joint.m_BindPose;
			const std::vector<double> before = rBindPose;
			if (rBindPose.size() != size)
				rBindPose.assign(size, 0.0);
			const VMatrix3 kept = Rotation::RotationMatrixFromAngleAxis({rBindPose[0], rBindPose[1], rBindPose[2]});
			if (RetargetSetup::AngleBetween(kept, motion.R) > c_SameTurn)
				std::ranges::copy(rotation, rBindPose.begin());
			if (size == 6 && Length(Minus(motion.t, {rBindPose[3], rBindPose[4], rBindPose[5]})) > c_SamePlace)
				std::ranges::copy(motion.t, rBindPose.begin() + 3);
			if (rSegment.m_Joint.m_Mean == before)
				rSegment.m_Joint.m_Mean = rBindPose;
		}
	}

	/// Of the segments that have gone on the lowest stands as high as the lowest did.
	void KeepHeight()
	{
		const VStanding standing(New());
		double before = std::numeric_limits<double>::max();
		double now = before;
		for (std::size_t i = 0; i < m_OldOf.size(); ++i)
			if (m_OldOf[i] >= 0)
			{
				before = std::min(before, m_OldStanding.m_Poses[std::size_t(m_OldOf[i])].t[2]);
				now = std::min(now, standing.m_Poses[i].t[2]);
			}
		if (m_OldOf[0] == 0 && std::abs(now - before) > RetargetSetup::c_SamePoseDistance)
			RetargetSetup::MoveRoot(New(), [&](VPose<double>& io_rWorld) { io_rWorld.t[2] += before - now; });
	}

	void MoveTargets()
	{
		auto& rData = m_Rebound.m_Setup.m_Record.m_SubjectApplicationData.m_Targets;
		const VStanding standing(New());
		for (std::size_t i = New().m_Targets.size(); i-- > 0;)
		{
			const auto gone = std::ranges::find_if(New().m_Targets[i].m_SegmentIndices,
			    [&](std::uint32_t i_Segment)
			    { return i_Segment < m_Matches.size() && m_Matches[i_Segment].m_New < 0; });
			if (gone == New().m_Targets[i].m_SegmentIndices.end())
			{
				m_KeptTargets.insert(m_KeptTargets.begin(), i);
				continue;
			}
			m_Rebound.m_Lost.push_back("Target " + std::to_string(i) + " \""
			    + (i < rData.size() ? rData[i].m_Name : TargetName(m_rOld, i)) + "\" of weight "
			    + NumberText::PrintShortest(New().m_Targets[i].m_Weight) + ": the new character has no \""
			    + OldName(*gone) + "\"");
			RetargetSetup::RemoveTarget(New(), m_Rebound.m_Setup.m_Record.m_SubjectApplicationData, i);
		}
		for (std::size_t i = 0; i < m_KeptTargets.size(); ++i)
		{
			const VTarget& rOld = m_rOld.m_Targets[m_KeptTargets[i]];
			for (std::uint32_t& rSegment : New().m_Targets[i].m_SegmentIndices)
				if (rSegment < m_Matches.size())
					rSegment = std::uint32_t(m_Matches[rSegment].m_New);
			if (!rOld.m_SegmentIndices.empty() && rOld.m_SegmentIndices.front() < m_Matches.size())
				MoveOffset(i, m_KeptTargets[i], standing);
		}
	}

	/// So that what the target follows stands where it stood.
	void MoveOffset(std::size_t i_New, std::size_t i_Old, const VStanding& i_rStanding)
	{
		const VTarget& rTarget = New().m_Targets[i_New];
		const VPose<double>& rBefore = m_OldStanding.m_Poses[m_rOld.m_Targets[i_Old].m_SegmentIndices.front()];
		const VPose<double>& rNow = i_rStanding.m_Poses[rTarget.m_SegmentIndices.front()];
		if (Length(Minus(rBefore.t, rNow.t)) <= c_SamePlace
		    && RetargetSetup::AngleBetween(rBefore.R, rNow.R) <= c_SameTurn)
			return;
		const std::vector<double>& rState = m_OldStanding.m_Subject.m_Targets[i_Old].m_State;
		const bool bRotation = rTarget.m_Type == VTarget::ELocalRotationToWorldRotation;
		const bool bPoint = rTarget.m_Type == VTarget::ELocalPointToWorldPoint
		    || rTarget.m_Type == VTarget::ELocalPointToWorldPointGaussian;
		if ((!bRotation && !bPoint) || rState.size() != 3)
		{
			m_Rebound.m_Lost.push_back("Target " + std::to_string(i_New)
			    + " keeps its state as it is, though its segment stands elsewhere: it is no position or rotation "
			      "target");
			return;
		}
		const VVector3 state{rState[0], rState[1], rState[2]};
		const VPose<double> offset{bRotation ? Rotation::RotationMatrixFromAngleAxis(state) : Rotation::c_Identity3,
		    bPoint ? state : VVector3{}};
		const VPose<double> now = Rotation::Relative(rNow, Rotation::Compose(rBefore, offset));
		// A segment that moved and did not turn leaves a rotation as it is written.
		if (bRotation && RetargetSetup::AngleBetween(now.R, offset.R) <= c_SameTurn)
			return;
		RetargetSetup::UpdateTargetState(New(), now, i_New);
	}

	void KeepExtras()
	{
		auto& rExtras = m_Rebound.m_Setup.m_Extras;
		VRenames renames;
		bool bSameJoints = m_OldOf.size() == m_Matches.size();
		for (std::size_t i = 0; i < m_Matches.size(); ++i)
		{
			bSameJoints = bSameJoints && m_Matches[i].m_New == std::int64_t(i);
			if (m_Matches[i].m_New >= 0)
				renames.emplace(OldName(i), m_rFile.m_Segments[std::size_t(m_Matches[i].m_New)].m_Name);
		}
		std::erase_if(rExtras.m_Segments, [&](const auto& i_rSegment) { return !renames.contains(i_rSegment.m_Name); });
		for (auto& rSegment : rExtras.m_Segments)
			rSegment.m_Name = renames[rSegment.m_Name];
		for (auto& rSubspace : rExtras.m_DynamicSubspaces)
			for (std::string& rJoint : rSubspace.m_JointNames)
				if (const auto found = renames.find(rJoint); found != renames.end())
					rJoint = found->second;
				else
					m_Rebound.m_Lost.push_back(
					    "Dynamic subspace \"" + rSubspace.m_Name + "\" names \"" + rJoint + "\", which is gone");
		if (bSameJoints || New().m_TPoseConstraints.empty())
			return;
		New().m_TPoseConstraints.clear();
		for (auto& rSegment : rExtras.m_Segments)
			rSegment.m_Joint.m_bHasT = false;
		m_Rebound.m_Lost.push_back("The constraints of the T-pose: they are of the old segments' order");
	}

	const VSubjectParametrised& m_rOld;
	const VSubjectParametrised& m_rFile;
	const VSubjectApplicationData& m_rFileData;
	const VStanding m_OldStanding;
	const VStanding m_FileStanding;
	const std::vector<VSegmentMatch> m_Matches;
	/// For each new segment the old one, or -1.
	std::vector<std::int64_t> m_OldOf;
	/// The orientations that the new segments are to have.
	std::vector<VMatrix3> m_World;
	/// The old targets that are left, in order.
	std::vector<std::size_t> m_KeptTargets;
	VRebound m_Rebound;
};

/// The old set-up with the names of the new one, so that only what else differs counts.
VSetup Renamed(VSetup i_Setup, const VRebound& i_rRebound)
{
	const std::vector<std::string> names = StandardTargetNames(i_Setup);
	auto& rSegments = i_Setup.m_Record.m_SubjectParametrised.m_Segments;
	VRenames renames;
	for (std::size_t i = 0; i < rSegments.size(); ++i)
		if (!i_rRebound.m_Matches[i].m_New.empty())
		{
			renames.emplace(rSegments[i].m_Name, i_rRebound.m_Matches[i].m_New);
			rSegments[i].m_Name = i_rRebound.m_Matches[i].m_New;
		}
	for (auto& rSegment : i_Setup.m_Extras.m_Segments)
		if (const auto found = renames.find(rSegment.m_Name); found != renames.end())
			rSegment.m_Name = found->second;
	RenameTargets(i_Setup, names);
	return i_Setup;
}

} // namespace

VRebound RebindCharacter(const VSetup& i_rSetup, const VNewCharacter& i_rCharacter, double i_LeastScore)
{
	VRebound refused;
	const VSubjectParametrised& rOld = i_rSetup.m_Record.m_SubjectParametrised;
	if (rOld.m_Segments.empty() || i_rCharacter.m_rBones.empty())
		refused.m_Refusal = "There is no segment to match";
	else if (!RetargetSetup::HoldsFilePose(rOld))
		refused.m_Refusal = "The subject has joints, post poses or parameters that no FBX file gives: make it anew";
	if (!refused.m_Refusal.empty())
		return refused;
	VSubjectApplicationData data;
	const VSubjectParametrised file = SubjectOfFile(i_rCharacter, FindRoot(rOld, i_rCharacter, i_LeastScore), data);
	VRebound rebound = VRebinding(i_rSetup, file, data, i_LeastScore).Run();
	if (!rebound.m_Refusal.empty())
		return rebound;
	rebound.m_Setup.m_Record.m_SubjectApplicationData.m_Skin = i_rCharacter.m_Name;
	rebound.m_Changes = CompareSetups(Renamed(i_rSetup, rebound), rebound.m_Setup);
	return rebound;
}

} // namespace SetupReview
