#include "CoreOrlexTypesUtils/rigidbody/RigidBodyAttachment.h"

#include "CoreOrlexTypesUtils/rigidbody/RigidBodyRefusal.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypesUtils/Expectation.h"
#include "CoreOrlexTypesUtils/SubjectKind.h"
#include "CoreOrlexTypesUtils/observations/Renumbering.h"
#include "CoreOrlexTypesUtils/observations/TargetFrames.h"
#include "CoreOrlexTypesUtils/observations/UnusedParameters.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBody.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyFrames.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyLayout.h"

#include <algorithm>
#include <set>
#include <span>

namespace CoreOrlexTypesUtils::RigidBodyUtils
{

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VMatrix3;
using Rotation::VVector3;
using VPose = Rotation::VPose<double>;

template <typename TSubject>
bool GoTogether(const TSubject& i_rSubject, const VSubjectApplicationData& i_rAppData)
{
	return i_rAppData.m_Markers.size() == i_rSubject.m_Markers.size()
	    && i_rAppData.m_Segments.size() == i_rSubject.m_Segments.size()
	    && i_rAppData.m_Targets.size() == i_rSubject.m_Targets.size();
}

/// Brings a rigid body into the layout of one target and evaluates it. False, with the assertions that do not hold and
/// a message, if it is none.
template <typename TSubject>
bool PrepareBody(TSubject& io_rRigidBody, VSubjectApplicationData& io_rAppData, VSubject& o_rEvaluated)
{
	const std::string name = io_rRigidBody.m_Name;
	VPose pose;
	std::vector<VVector3> positions;
	VPoseCovariance poseCovariance;
	std::vector<VMatrix3> covariance;
	// An index beyond the list could come to mean a marker of the other subject.
	const auto inRange = [&](const auto& i_rTarget)
	{
		return std::all_of(i_rTarget.m_MarkerIndices.begin(), i_rTarget.m_MarkerIndices.end(),
		    [&](std::uint32_t i_Index) { return i_Index < io_rRigidBody.m_Markers.size(); });
	};
	bool bGood = ValidateRigidBody(io_rRigidBody)
	    && std::all_of(io_rRigidBody.m_Targets.begin(), io_rRigidBody.m_Targets.end(), inRange)
	    && (io_rRigidBody.m_Targets.size() == 1 || ToRigidBodyTarget(io_rRigidBody, io_rAppData))
	    && EvaluateSubject(io_rRigidBody, o_rEvaluated)
	    && ReadRigidBody(o_rEvaluated.m_Targets.front(), pose, positions, poseCovariance, covariance);
	bGood &= Expect(!io_rRigidBody.m_Segments.empty()
	        && io_rRigidBody.m_Segments.front().m_Joint.m_JointType == VSubjectParametrised::VJoint::EFree,
	    "rRigidBodySegment.m_Joint.m_JointType == TSubjectType::VJoint::EFree");
	bGood &= Expect(io_rRigidBody.m_Targets.size() == 1, "RigidBody.m_Targets.size() == 1");
	bGood &= Expect(
	    !io_rRigidBody.m_Targets.empty() && io_rRigidBody.m_Targets.front().m_Type == TSubject::VTarget::ERigidBody,
	    "rRigidBodyTgt.m_Type == TSubjectType::VTarget::ERigidBody");
	return bGood || Refuse("Invalid inptut, subject %1% is not a rigid body!", name);
}

bool CanMergeParameters(const VSubject&, const VSubject&)
{
	return true;
}

bool CanMergeParameters(const VSubjectParametrised& i_rSubject, const VSubjectParametrised& i_rRigidBody)
{
	// Expressions tell static and dynamic parameters by their names alone.
	std::set<std::string> names;
	for (const auto& rParameter : i_rSubject.m_StaticParameters)
		names.insert(rParameter.m_Name);
	for (const auto& rParameter : i_rSubject.m_DynamicParameters)
		names.insert(rParameter.m_Name);
	for (const auto& rParameter : i_rRigidBody.m_StaticParameters)
		if (names.contains(rParameter.m_Name))
			return Refuse("Rigid body static parameter name clash: %1%", rParameter.m_Name);
	for (const auto& rParameter : i_rRigidBody.m_DynamicParameters)
		if (names.contains(rParameter.m_Name))
			return Refuse("Rigid body dynamic parameter name clash: %1%", rParameter.m_Name);
	return true;
}

void MergeParameters(VSubject&, const VSubject&) {}

void MergeParameters(VSubjectParametrised& io_rSubject, const VSubjectParametrised& i_rRigidBody)
{
	io_rSubject.m_StaticParameters.insert(io_rSubject.m_StaticParameters.end(), i_rRigidBody.m_StaticParameters.begin(),
	    i_rRigidBody.m_StaticParameters.end());
	io_rSubject.m_DynamicParameters.insert(io_rSubject.m_DynamicParameters.end(),
	    i_rRigidBody.m_DynamicParameters.begin(), i_rRigidBody.m_DynamicParameters.end());
}

template <typename TSubject>
bool CanMergeMarkers(const TSubject& i_rSubject, const TSubject& i_rRigidBody)
{
	std::set<std::string> names;
	std::set<std::uint32_t> ids;
	for (const auto& rMarker : i_rSubject.m_Markers)
	{
		names.insert(rMarker.m_Name);
		ids.insert(rMarker.m_MarkerId);
	}
	for (const auto& rMarker : i_rRigidBody.m_Markers)
	{
		if (!names.insert(rMarker.m_Name).second)
			return Refuse("Cannot add this marker, duplicate name: %1%", rMarker.m_Name);
		if (!ids.insert(CoreOrlexTypes::HashName(rMarker.m_Name)).second)
			return Refuse("Cannot add this marker, hash collision for name: %1%", rMarker.m_Name);
	}
	return true;
}

/// The position's part of a pose's covariance turns with the frame; that of the orientation is about the body's own
/// axes.
void TurnPoseCovariance(const VMatrix3& i_rR, std::vector<double>& io_rCovariance)
{
	if (io_rCovariance.size() < 36 || i_rR == Rotation::c_Identity3)
		return;
	VMatrix3 position;
	VMatrix3 mixed;
	for (std::size_t i = 0; i < 9; ++i)
	{
		position[i] = io_rCovariance[i / 3 * 6 + i % 3];
		mixed[i] = io_rCovariance[i / 3 * 6 + 3 + i % 3];
	}
	position = TurnedCovariance(i_rR, position);
	mixed = Rotation::Product(i_rR, mixed);
	for (std::size_t i = 0; i < 9; ++i)
	{
		io_rCovariance[i / 3 * 6 + i % 3] = position[i];
		io_rCovariance[i / 3 * 6 + 3 + i % 3] = mixed[i];
		io_rCovariance[(3 + i % 3) * 6 + i / 3] = mixed[i];
	}
	MatrixValidity::TakeOffRounding<6>(std::span(io_rCovariance).first<36>());
}

void TurnTemplates(const VMatrix3&, VSubject::VTarget&) {}

void TurnTemplates(const VMatrix3& i_rR, VSubjectParametrised::VTarget& io_rTarget)
{
	TurnPoseCovariance(i_rR, io_rTarget.m_TemplateCovariance);
}

/// Gives a target in another frame.
/// @param i_rState the numbers of its state.
template <typename TSubject>
void MoveTarget(const VPose& i_rFrame, const std::vector<double>& i_rState, typename TSubject::VTarget& io_rTarget)
{
	using VKind = VSubjectKind<TSubject>;
	const VPose pose = Rotation::Compose(i_rFrame,
	    Rotation::PoseFromAngleAxis({i_rState[3], i_rState[4], i_rState[5]}, {i_rState[0], i_rState[1], i_rState[2]}));
	const VVector3 angleAxis = Rotation::AngleAxisFromRotationMatrix(pose.R);
	for (std::size_t i = 0; i < 3; ++i)
	{
		VKind::State(io_rTarget)[i] = VKind::ToState(pose.t[i]);
		VKind::State(io_rTarget)[3 + i] = VKind::ToState(angleAxis[i]);
	}
	TurnPoseCovariance(i_rFrame.R, io_rTarget.m_Covariance);
	TurnTemplates(i_rFrame.R, io_rTarget);
	TurnNormals(i_rFrame.R, io_rTarget.m_ViewNormals);
}

template <typename TSubject>
bool OwnsSegment(const TSubject& i_rSubject, std::size_t i_TargetIndex)
{
	const auto& rParents = i_rSubject.m_Targets[i_TargetIndex].m_SegmentIndices;
	if (rParents.size() != 1 || rParents.front() >= i_rSubject.m_Segments.size())
		return false;
	const auto& rSegment = i_rSubject.m_Segments[rParents.front()];
	if (rSegment.m_Name != "Root" || rSegment.m_Joint.m_Name != "RootJoint"
	    || rSegment.m_Joint.m_JointType != VSubjectParametrised::VJoint::EFree)
		return false;
	for (std::size_t i = 0; i < i_rSubject.m_Targets.size(); ++i)
	{
		const auto& rOthers = i_rSubject.m_Targets[i].m_SegmentIndices;
		if (i != i_TargetIndex && std::find(rOthers.begin(), rOthers.end(), rParents.front()) != rOthers.end())
			return false;
	}
	return true;
}

/// The share of one joint in a list of values for each degree of freedom, where it is such a list.
void CutShare(const VSubject&, std::size_t) {}

void CutShare(VSubjectParametrised& io_rSubject, std::size_t i_Segment)
{
	std::size_t size = 0;
	std::size_t begin = 0;
	std::size_t end = 0;
	for (std::size_t i = 0; i < io_rSubject.m_Segments.size(); ++i)
	{
		begin = i == i_Segment ? size : begin;
		size += CoreOrlexTypes::StateSize(io_rSubject.m_Segments[i].m_Joint.m_JointType);
		end = i == i_Segment ? size : end;
	}
	std::vector<double>& rValues = io_rSubject.m_TPoseConstraints;
	if (rValues.size() == size)
		rValues.erase(rValues.begin() + std::ptrdiff_t(begin), rValues.begin() + std::ptrdiff_t(end));
}

template <typename TSubject>
void RemoveSegment(TSubject& io_rSubject, VSubjectApplicationData& io_rAppData, std::size_t i_Segment)
{
	CutShare(io_rSubject, i_Segment);
	std::vector<bool> keep(io_rSubject.m_Segments.size(), true);
	keep[i_Segment] = false;
	const VRenumbering segments(keep);
	segments.Close(io_rSubject.m_Segments);
	segments.Close(io_rAppData.m_Segments);
	for (auto& rSegment : io_rSubject.m_Segments)
	{
		segments.Renumber(rSegment.m_SegmentIndex);
		segments.Renumber(rSegment.m_ParentSegmentIndex);
	}
	for (auto& rTarget : io_rSubject.m_Targets)
		segments.Renumber(rTarget.m_SegmentIndices);
}

} // namespace

template <typename TSubject>
bool AttachRigidBody(TSubject& io_rSubject, VSubjectApplicationData& io_rSubjectAppData, const TSubject& i_rRigidBody,
    const VSubjectApplicationData& i_rRigidBodyAppData, const std::string& i_rSegmentName)
{
	TSubject RigidBody = i_rRigidBody;
	VSubjectApplicationData bodyAppData = i_rRigidBodyAppData;
	VSubject evaluated;
	if (!PrepareBody(RigidBody, bodyAppData, evaluated))
		return false;
	if (!GoTogether(i_rRigidBody, i_rRigidBodyAppData))
		return Refuse("RigidBodyAppData does not match RigidBody for cluster %1%", i_rRigidBody.m_Name);
	if (!GoTogether(io_rSubject, io_rSubjectAppData))
		return Refuse("SubjectAppData does not match Subject for %1%", io_rSubject.m_Name);
	const auto segment = std::find_if(io_rSubject.m_Segments.begin(), io_rSubject.m_Segments.end(),
	    [&](const auto& i_rSegment) { return i_rSegment.m_Name == i_rSegmentName; });
	if (segment == io_rSubject.m_Segments.end())
		return Refuse("Cannot attach rigid body to segment %1% the segment does not exist!", i_rSegmentName);
	if (!CanMergeParameters(io_rSubject, RigidBody) || !CanMergeMarkers(io_rSubject, RigidBody))
		return false;
	std::vector<VPose> subjectFrames;
	std::vector<VPose> bodyFrames;
	if (!ComputeTargetFrames(io_rSubject, subjectFrames) || !ComputeTargetFrames(RigidBody, bodyFrames))
		return false;

	const std::size_t segmentIndex = std::size_t(segment - io_rSubject.m_Segments.begin());
	const std::uint32_t firstMarker = std::uint32_t(io_rSubject.m_Markers.size());
	auto& rRigidBodyTgt = RigidBody.m_Targets.front();
	const typename TSubject::VTarget asWritten = rRigidBodyTgt;
	const VPose& rBodyFrame = bodyFrames[rRigidBodyTgt.m_SegmentIndices.front()];
	MoveTarget<TSubject>(Rotation::Relative(subjectFrames[segmentIndex], rBodyFrame),
	    evaluated.m_Targets.front().m_State, rRigidBodyTgt);
	DropParametersOf(asWritten, RigidBody);
	rRigidBodyTgt.m_SegmentIndices = {std::uint32_t(segmentIndex)};
	for (std::uint32_t& rIndex : rRigidBodyTgt.m_MarkerIndices)
		rIndex += firstMarker;
	MergeParameters(io_rSubject, RigidBody);
	for (auto& rMarker : RigidBody.m_Markers)
	{
		rMarker.m_MarkerId = CoreOrlexTypes::HashName(rMarker.m_Name);
		io_rSubject.m_Markers.push_back(std::move(rMarker));
	}
	io_rSubject.m_Targets.push_back(std::move(rRigidBodyTgt));

	io_rSubjectAppData.m_Markers.insert(
	    io_rSubjectAppData.m_Markers.end(), bodyAppData.m_Markers.begin(), bodyAppData.m_Markers.end());
	io_rSubjectAppData.m_Targets.push_back(bodyAppData.m_Targets.front());
	for (VSubjectApplicationData::VStick& rStick : bodyAppData.m_Sticks)
	{
		if (std::max(rStick.m_MarkerIndexA, rStick.m_MarkerIndexB) >= RigidBody.m_Markers.size())
			continue;
		rStick.m_MarkerIndexA += firstMarker;
		rStick.m_MarkerIndexB += firstMarker;
		io_rSubjectAppData.m_Sticks.push_back(rStick);
	}
	return true;
}

template <typename TSubject>
bool RemoveRigidBody(TSubject& io_rSubject, VSubjectApplicationData& io_rSubjectAppData, std::size_t i_TargetIndex)
{
	if (i_TargetIndex >= io_rSubject.m_Targets.size())
		return Refuse("Cannot remove ERigidBody target, out of range target index!");
	const typename TSubject::VTarget target = io_rSubject.m_Targets[i_TargetIndex];
	if (target.m_Type != TSubject::VTarget::ERigidBody)
		return Refuse("Cannot remove a non RigidBody target!");

	std::vector<bool> keep(io_rSubject.m_Markers.size(), true);
	for (const std::uint32_t index : target.m_MarkerIndices)
		if (index < keep.size())
			keep[index] = false;
	for (std::size_t i = 0; i < io_rSubject.m_Targets.size(); ++i)
	{
		if (i == i_TargetIndex)
			continue;
		for (const std::uint32_t index : io_rSubject.m_Targets[i].m_MarkerIndices)
			if (Expect(index < keep.size(),
			        "MarkerIndicesMap.find(rOtherTgt.m_MarkerIndices[j]) != MarkerIndicesMap.end()")
			    && !keep[index])
				return Refuse("No other target should be associated with a target that is part of a RigidBody!");
	}
	const bool bOwnSegment = OwnsSegment(io_rSubject, i_TargetIndex);
	if (bOwnSegment
	    && std::any_of(io_rSubject.m_Segments.begin(), io_rSubject.m_Segments.end(),
	        [&](const auto& i_rSegment) { return i_rSegment.m_ParentSegmentIndex == target.m_SegmentIndices.front(); }))
		return Refuse("No other segment should be parented to a RigidBody segment!");

	io_rSubject.m_Targets.erase(io_rSubject.m_Targets.begin() + std::ptrdiff_t(i_TargetIndex));
	if (i_TargetIndex < io_rSubjectAppData.m_Targets.size())
		io_rSubjectAppData.m_Targets.erase(io_rSubjectAppData.m_Targets.begin() + std::ptrdiff_t(i_TargetIndex));
	DropMarkers(io_rSubject, io_rSubjectAppData, VRenumbering(keep));
	DropParametersOf(target, io_rSubject);
	if (bOwnSegment)
		RemoveSegment(io_rSubject, io_rSubjectAppData, target.m_SegmentIndices.front());
	return true;
}

template bool AttachRigidBody(
    VSubject&, VSubjectApplicationData&, const VSubject&, const VSubjectApplicationData&, const std::string&);
template bool AttachRigidBody(VSubjectParametrised&, VSubjectApplicationData&, const VSubjectParametrised&,
    const VSubjectApplicationData&, const std::string&);
template bool RemoveRigidBody(VSubject&, VSubjectApplicationData&, std::size_t);
template bool RemoveRigidBody(VSubjectParametrised&, VSubjectApplicationData&, std::size_t);

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
