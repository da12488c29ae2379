#include "RetargetSetupCore/BindPose.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/Identity.h"

#include <algorithm>
#include <cmath>
#include <numbers>

using ComputeSubject::VComputeSubjectFK;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

/// What the kinematics of segments is made of: no statistics and names, whose copies would cost more than the rest, and
/// no targets, of which one that fits no class would keep the segments from being measured.
VSubject BareSegments(const VSubject& i_rSubject)
{
	VSubject subject;
	subject.m_Segments.resize(i_rSubject.m_Segments.size());
	for (std::size_t i = 0; i < subject.m_Segments.size(); ++i)
	{
		const VSubject::VSegment& rFrom = i_rSubject.m_Segments[i];
		VSubject::VSegment& rTo = subject.m_Segments[i];
		rTo.m_ParentSegmentIndex = rFrom.m_ParentSegmentIndex;
		rTo.m_PreRotation = rFrom.m_PreRotation;
		rTo.m_PreTranslation = rFrom.m_PreTranslation;
		rTo.m_InversePostRotation = rFrom.m_InversePostRotation;
		rTo.m_InversePostTranslation = rFrom.m_InversePostTranslation;
		rTo.m_Joint.m_JointType = rFrom.m_Joint.m_JointType;
		rTo.m_Joint.m_JointOrientation = rFrom.m_Joint.m_JointOrientation;
	}
	return subject;
}

} // namespace

double AngleBetween(const Rotation::VMatrix3& i_rA, const Rotation::VMatrix3& i_rB)
{
	const Rotation::VVector3 turn =
	    Rotation::AngleAxisFromRotationMatrix(Rotation::Product(Rotation::Transposed(i_rA), i_rB));
	const double angle = std::hypot(turn[0], turn[1], turn[2]);
	return std::min(angle, 2.0 * std::numbers::pi - angle);
}

std::unique_ptr<VComputeSubjectFK> KinematicsInBindPose(
    const VSubjectParametrised& i_rParametrised, const VSubject& i_rSubject, std::string_view i_Which)
{
	try
	{
		auto pFK = std::make_unique<VComputeSubjectFK>(BareSegments(i_rSubject));
		const std::vector<double> state =
		    CoreOrlexTypesUtils::PoseVector(i_rParametrised, &VSubjectParametrised::VJoint::m_BindPose);
		if (pFK->NumberOfSegments() > 0 && pFK->NumberOfSegments() == i_rParametrised.m_Segments.size()
		    && pFK->NumberOfStates() == state.size())
		{
			pFK->Update(state.data());
			return pFK;
		}
	}
	catch (const ComputeSubject::VConstructionException&)
	{
	}
	NVX_LOG(c_LogCategory, NVX::ELogWarning,
	    "The segments of the %1% subject make no tree with joints, so their poses are not known", i_Which);
	return nullptr;
}

std::vector<Rotation::VPose<double>> SegmentPoses(const VComputeSubjectFK& i_rFK)
{
	std::vector<Rotation::VPose<double>> poses(i_rFK.NumberOfSegments());
	for (std::size_t i = 0; i < poses.size(); ++i)
		i_rFK.Segment(i).SegmentPose(poses[i]);
	return poses;
}

std::optional<VPoseDifference> WorstPoseDifference(
    const std::vector<Rotation::VPose<double>>& i_rBefore, const std::vector<Rotation::VPose<double>>& i_rAfter)
{
	VPoseDifference farthest;
	VPoseDifference mostTurned;
	for (std::size_t i = 0; i < std::min(i_rBefore.size(), i_rAfter.size()); ++i)
	{
		const Rotation::VVector3& rA = i_rBefore[i].t;
		const Rotation::VVector3& rB = i_rAfter[i].t;
		const VPoseDifference difference{
		    i, std::hypot(rA[0] - rB[0], rA[1] - rB[1], rA[2] - rB[2]), AngleBetween(i_rBefore[i].R, i_rAfter[i].R)};
		if (difference.m_Distance > farthest.m_Distance)
			farthest = difference;
		if (difference.m_Angle > mostTurned.m_Angle)
			mostTurned = difference;
	}
	if (farthest.m_Distance >= c_SamePoseDistance)
		return farthest;
	if (mostTurned.m_Angle >= c_SamePoseAngle)
		return mostTurned;
	return std::nullopt;
}

} // namespace RetargetSetup
