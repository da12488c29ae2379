#include "CoreOrlexTypesUtils/rigidbody/RigidBodyLayout.h"

#include "CoreOrlexTypesUtils/Expectation.h"
#include "CoreOrlexTypesUtils/SubjectKind.h"
#include "CoreOrlexTypesUtils/observations/TargetFrames.h"
#include "CoreOrlexTypesUtils/observations/UnusedParameters.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBody.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyFrames.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyRefusal.h"

#include "DebugServices/GlobalLog.h"

#include <algorithm>

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
bool HasBodyTarget(const TSubject& i_rSubject)
{
	return i_rSubject.m_Targets.size() == 1 && i_rSubject.m_Targets.front().m_Type == TSubject::VTarget::ERigidBody;
}

template <typename TTarget>
bool IsOnRoot(const TTarget& i_rTarget)
{
	return i_rTarget.m_Type != TTarget::ERigidBody && i_rTarget.m_SegmentIndices == std::vector<std::uint32_t>{0};
}

template <typename TSubject>
bool IsRigidBody(const TSubject& i_rSubject)
{
	if (ValidateRigidBody(i_rSubject))
		return true;
	NVX_LOG("RigidBodyUtils", NVX::ELogError, "Invalid input, subject %1% is not a rigid body!", i_rSubject.m_Name);
	return false;
}

template <typename TSubject>
bool TellNothingToDo(const TSubject& i_rSubject)
{
	NVX_LOG("RigidBodyUtils", NVX::ELogInformation, "No conversion needed for subject %1%!", i_rSubject.m_Name);
	return true;
}

/// What the markers of a body are, in the frame of the root's targets and in the order of its targets.
struct VGeometry
{
	std::vector<VVector3> m_Positions;
	std::vector<VMatrix3> m_Covariance;
	/// From the frame in which the target holds its markers, and from that of its segment.
	VPose m_FromBody;
	VPose m_FromSegment;
};

bool ReadPoints(const VSubject& i_rSubject, VGeometry& o_rGeometry)
{
	for (const VSubject::VTarget& rTarget : i_rSubject.m_Targets)
	{
		if (rTarget.m_Type != VSubject::VTarget::ELocalPointToWorldPoint
		    && rTarget.m_Type != VSubject::VTarget::ELocalPointToWorldPointGaussian)
			return Refuse("Unsupported target type in geometry calculation");
		if (rTarget.m_State.size() != 3 || rTarget.m_MarkerIndices.size() != 1)
			return Refuse("A point target of a rigid body must have one marker and a state of 3 values!");
		std::copy(rTarget.m_State.begin(), rTarget.m_State.end(), o_rGeometry.m_Positions.emplace_back().begin());
		o_rGeometry.m_Covariance.push_back({});
		if (rTarget.m_Covariance.size() == 9)
			std::copy(
			    rTarget.m_Covariance.begin(), rTarget.m_Covariance.end(), o_rGeometry.m_Covariance.back().begin());
	}
	return true;
}

bool ReadBody(const VSubject& i_rSubject, VGeometry& o_rGeometry)
{
	const VSubject::VTarget& rTarget = i_rSubject.m_Targets.front();
	VPose pose;
	VPoseCovariance poseCovariance;
	if (!ReadRigidBody(rTarget, pose, o_rGeometry.m_Positions, poseCovariance, o_rGeometry.m_Covariance))
		return false;
	if (const std::uint32_t segment = rTarget.m_SegmentIndices.front(); segment != 0)
	{
		std::vector<VPose> frames;
		if (!ComputeTargetFrames(i_rSubject, frames))
			return false;
		o_rGeometry.m_FromSegment = Rotation::Relative(frames[0], frames[segment]);
	}
	o_rGeometry.m_FromBody = Rotation::Compose(o_rGeometry.m_FromSegment, pose);
	for (VVector3& rPosition : o_rGeometry.m_Positions)
		rPosition = Rotation::Apply(o_rGeometry.m_FromBody, rPosition);
	for (VMatrix3& rCovariance : o_rGeometry.m_Covariance)
		rCovariance = TurnedCovariance(o_rGeometry.m_FromBody.R, rCovariance);
	return true;
}

/// Only the parametrised subject has template covariances: a body's is that of its pose, which nobody knows, and those
/// of its markers if all have one.
void MergeTemplates(const std::vector<VSubject::VTarget>&, VSubject::VTarget&) {}

void MergeTemplates(const std::vector<VSubjectParametrised::VTarget>& i_rPoints, VSubjectParametrised::VTarget& o_rBody)
{
	o_rBody.m_PlacementCovariance.clear();
	o_rBody.m_TemplateCovariance.assign(36, 0.0);
	for (const auto& rPoint : i_rPoints)
		o_rBody.m_TemplateCovariance.insert(
		    o_rBody.m_TemplateCovariance.end(), rPoint.m_TemplateCovariance.begin(), rPoint.m_TemplateCovariance.end());
	if (std::any_of(i_rPoints.begin(), i_rPoints.end(),
	        [](const auto& i_rPoint) { return i_rPoint.m_TemplateCovariance.size() != 9; }))
		o_rBody.m_TemplateCovariance.clear();
}

void SplitTemplates(const VMatrix3&, std::size_t, const VSubject::VTarget&, VSubject::VTarget&) {}

void SplitTemplates(const VMatrix3& i_rR, std::size_t i_Marker, const VSubjectParametrised::VTarget& i_rBody,
    VSubjectParametrised::VTarget& o_rPoint)
{
	o_rPoint.m_PlacementCovariance.clear();
	o_rPoint.m_TemplateCovariance.clear();
	if (i_rBody.m_TemplateCovariance.size() != 36 + 9 * i_rBody.m_MarkerIndices.size())
		return;
	VMatrix3 block;
	std::copy_n(i_rBody.m_TemplateCovariance.begin() + std::ptrdiff_t(36 + 9 * i_Marker), 9, block.begin());
	block = TurnedCovariance(i_rR, block);
	o_rPoint.m_TemplateCovariance.assign(block.begin(), block.end());
}

template <typename TTarget>
bool StoreGeometry(TTarget& io_rTarget, const std::vector<VVector3>& i_rLocalPositions,
    const std::vector<VMatrix3>& i_rMarkerCovariance)
{
	Expect(i_rLocalPositions.size() == i_rMarkerCovariance.size(),
	    "i_rLocalPositions.size() == i_rMarkerCovariance.size()");
	return WriteRigidBody(io_rTarget, VPose(), i_rLocalPositions, VPoseCovariance{}, i_rMarkerCovariance)
	    || Refuse("Cannot write marker position and covariances to the rigid body target!");
}

template <typename TSubject>
bool MakeBodyTarget(const TSubject& i_rSubject, const VGeometry& i_rGeometry, typename TSubject::VTarget& o_rBody)
{
	using VKind = VSubjectKind<TSubject>;
	const auto& rPoints = i_rSubject.m_Targets;
	o_rBody = rPoints.front();
	o_rBody.m_Type = TSubject::VTarget::ERigidBody;
	o_rBody.m_MarkerIndices.clear();
	o_rBody.m_RotationObservationIndices.clear();
	o_rBody.m_ViewNormals.clear();
	o_rBody.m_Weight = 0.0;
	for (const auto& rPoint : rPoints)
	{
		o_rBody.m_MarkerIndices.push_back(rPoint.m_MarkerIndices.front());
		o_rBody.m_ViewNormals.push_back(rPoint.m_ViewNormals.size() == 1 ? rPoint.m_ViewNormals.front() : VVector3{});
		o_rBody.m_Weight += rPoint.m_Weight;
	}
	o_rBody.m_Weight /= double(rPoints.size());
	if (!StoreGeometry(o_rBody, i_rGeometry.m_Positions, i_rGeometry.m_Covariance))
		return false;
	MergeTemplates(rPoints, o_rBody);
	for (std::size_t i = 0; i < rPoints.size(); ++i)
		std::copy_n(VKind::State(rPoints[i]).begin(), 3, VKind::State(o_rBody).begin() + std::ptrdiff_t(6 + 3 * i));
	return true;
}

template <typename TSubject>
typename TSubject::VTarget MakePointTarget(
    const typename TSubject::VTarget& i_rBody, const VGeometry& i_rGeometry, std::size_t i_Marker)
{
	using VKind = VSubjectKind<TSubject>;
	typename TSubject::VTarget rTgt = i_rBody;
	rTgt.m_Type = TSubject::VTarget::ELocalPointToWorldPointGaussian;
	rTgt.m_MarkerIndices = {i_rBody.m_MarkerIndices[i_Marker]};
	rTgt.m_SegmentIndices = {0};
	rTgt.m_RotationObservationIndices.clear();
	rTgt.m_ViewNormals.clear();
	if (i_Marker < i_rBody.m_ViewNormals.size())
		rTgt.m_ViewNormals.push_back(i_rBody.m_ViewNormals[i_Marker]);
	if (!Expect(rTgt.m_ViewNormals.size() == 1, "rTgt.m_ViewNormals.size()==1"))
		rTgt.m_ViewNormals.emplace_back();
	TurnNormals(i_rGeometry.m_FromSegment.R, rTgt.m_ViewNormals);
	rTgt.m_Covariance.assign(i_rGeometry.m_Covariance[i_Marker].begin(), i_rGeometry.m_Covariance[i_Marker].end());
	SplitTemplates(i_rGeometry.m_FromBody.R, i_Marker, i_rBody, rTgt);

	const bool bAsWritten = i_rGeometry.m_FromBody.R == Rotation::c_Identity3 && i_rGeometry.m_FromBody.t == VVector3{};
	auto& rState = VKind::State(rTgt);
	rState.resize(3);
	for (std::size_t i = 0; i < 3; ++i)
		rState[i] = bAsWritten ? VKind::State(i_rBody)[6 + 3 * i_Marker + i]
		                       : VKind::ToState(i_rGeometry.m_Positions[i_Marker][i]);
	return rTgt;
}

} // namespace

template <typename TSubject>
bool ValidateRigidBody(const TSubject& i_rSubject)
{
	using VJoint = VSubjectParametrised::VJoint;
	const auto& rSegments = i_rSubject.m_Segments;
	const auto& rTargets = i_rSubject.m_Targets;
	if (i_rSubject.m_Markers.size() < c_MarkersOfBody)
		return Refuse("A rigid body must have at least 3 markers!");
	if (rSegments.empty())
		return Refuse("A rigid body must have at least 1 segment!");
	if (std::any_of(rSegments.begin() + 1, rSegments.end(),
	        [](const auto& i_rSegment) { return i_rSegment.m_Joint.m_JointType != VJoint::EDummy; }))
		return Refuse("All but the root segment must be of dummy type!");
	if (rSegments.front().m_Joint.m_JointType != VJoint::EFree)
		return Refuse("A rigid body must have a free joint as root!");
	if (!HasBodyTarget(i_rSubject)
	    && (rTargets.size() < 2
	        || !std::all_of(
	            rTargets.begin(), rTargets.end(), [](const auto& i_rTarget) { return IsOnRoot(i_rTarget); })))
		return Refuse(
		    "In a rigid body there must be either one target of RigidBody type or several targets parented to "
		    "the root segment");
	const auto& rParents = rTargets.front().m_SegmentIndices;
	if (rParents.size() != 1 || rParents.front() >= rSegments.size())
		return Refuse("A rigid body target must have a single parent segment!");
	return true;
}

template <typename TSubject>
bool ToRigidBodyTarget(TSubject& io_rSubject, VSubjectApplicationData& io_rAppData)
{
	if (!IsRigidBody(io_rSubject))
		return false;
	if (HasBodyTarget(io_rSubject))
		return TellNothingToDo(io_rSubject);
	VSubject evaluated;
	VGeometry geometry;
	typename TSubject::VTarget body;
	if (!EvaluateSubject(io_rSubject, evaluated) || !ReadPoints(evaluated, geometry)
	    || !MakeBodyTarget(io_rSubject, geometry, body))
		return false;
	io_rSubject.m_Targets.assign(1, std::move(body));
	Expect(io_rSubject.m_Targets.size() == 1, "io_rSubject.m_Targets.size()==1");
	io_rAppData.m_Targets.resize(1);
	io_rAppData.m_Targets.front().m_Name = io_rSubject.m_Name;
	return true;
}

template <typename TSubject>
bool ToPointTargets(TSubject& io_rSubject, VSubjectApplicationData& io_rAppData)
{
	if (!IsRigidBody(io_rSubject))
		return false;
	if (!HasBodyTarget(io_rSubject))
		return TellNothingToDo(io_rSubject);
	VSubject evaluated;
	VGeometry geometry;
	if (!EvaluateSubject(io_rSubject, evaluated) || !ReadBody(evaluated, geometry))
		return false;
	const typename TSubject::VTarget body = std::move(io_rSubject.m_Targets.front());
	io_rSubject.m_Targets.clear();
	io_rAppData.m_Targets.resize(1);
	io_rAppData.m_Targets.resize(body.m_MarkerIndices.size(), io_rAppData.m_Targets.front());
	for (std::size_t i = 0; i < body.m_MarkerIndices.size(); ++i)
	{
		io_rSubject.m_Targets.push_back(MakePointTarget<TSubject>(body, geometry, i));
		if (body.m_MarkerIndices[i] < io_rSubject.m_Markers.size())
			io_rAppData.m_Targets[i].m_Name = io_rSubject.m_Markers[body.m_MarkerIndices[i]].m_Name;
	}
	DropParametersOf(body, io_rSubject);
	return true;
}

template <typename TSubject>
bool ToRigidBodyTarget(TSubject& io_rSubject)
{
	VSubjectApplicationData none;
	return ToRigidBodyTarget(io_rSubject, none);
}

template <typename TSubject>
bool ToPointTargets(TSubject& io_rSubject)
{
	VSubjectApplicationData none;
	return ToPointTargets(io_rSubject, none);
}

template bool ValidateRigidBody(const VSubject&);
template bool ValidateRigidBody(const VSubjectParametrised&);
template bool ToRigidBodyTarget(VSubject&, VSubjectApplicationData&);
template bool ToRigidBodyTarget(VSubjectParametrised&, VSubjectApplicationData&);
template bool ToRigidBodyTarget(VSubject&);
template bool ToRigidBodyTarget(VSubjectParametrised&);
template bool ToPointTargets(VSubject&, VSubjectApplicationData&);
template bool ToPointTargets(VSubjectParametrised&, VSubjectApplicationData&);
template bool ToPointTargets(VSubject&);
template bool ToPointTargets(VSubjectParametrised&);

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
