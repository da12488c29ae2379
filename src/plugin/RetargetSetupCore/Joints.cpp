#include "RetargetSetupCore/Joints.h"

#include "CoreOrlexTypes/JointType.h"
#include "RetargetSetupCore/ParseNumber.h"
#include "RetargetSetupCore/TPoseConstraints.h"
#include "math/NumberText.h"

#include <algorithm>

using CoreOrlexTypes::VSubjectParametrised;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

namespace RetargetSetup
{

namespace
{

/// Turns the segment's pre-rotation by its joint's bind pose.
void BakeBindPose(VSubjectParametrised::VSegment& io_rSegment)
{
	Rotation::VVector3 preRotation{};
	for (std::size_t i = 0; i < 3; ++i)
	{
		double value = 0.0;
		if (ParseNumber(io_rSegment.m_PreRotation[i], value))
			preRotation[i] = value;
	}
	Rotation::VVector3 bindPose{};
	std::copy_n(io_rSegment.m_Joint.m_BindPose.begin(), std::min<std::size_t>(3, io_rSegment.m_Joint.m_BindPose.size()),
	    bindPose.begin());
	const Rotation::VVector3 baked = Rotation::AngleAxisFromRotationMatrix(Rotation::Product(
	    Rotation::RotationMatrixFromAngleAxis(bindPose), Rotation::RotationMatrixFromAngleAxis(preRotation)));
	for (std::size_t i = 0; i < 3; ++i)
		io_rSegment.m_PreRotation[i] = NumberText::PrintF(baked[i]);
}

} // namespace

std::vector<bool> SegmentsWithTargets(const VSubjectParametrised& i_rSubject)
{
	std::vector<bool> used(i_rSubject.m_Segments.size());
	for (const VSubjectParametrised::VTarget& rTarget : i_rSubject.m_Targets)
		if (rTarget.m_SegmentIndices.size() == 1 && rTarget.m_SegmentIndices.front() < used.size())
			used[rTarget.m_SegmentIndices.front()] = true;
	return used;
}

void RemoveJoint(VSubjectParametrised::VSegment& io_rSegment)
{
	if (io_rSegment.m_Joint.m_JointType == VJoint::EBall)
		BakeBindPose(io_rSegment);
	io_rSegment.m_Joint = VJoint();
}

void DefaultCovariance(VJoint& io_rJoint)
{
	io_rJoint.m_Covariance = CoreOrlexTypes::DefaultCovariance(io_rJoint.m_JointType);
}

void EnableJoint(VSubjectParametrised& io_rSubject, std::size_t i_SegmentIndex, const Rotation::VVector3& i_rRotation)
{
	VJoint& rJoint = io_rSubject.m_Segments[i_SegmentIndex].m_Joint;
	if (rJoint.m_JointType != VJoint::EDummy)
		return;
	const VJoint::EJointType type = i_SegmentIndex == 0 ? VJoint::EFree : VJoint::EBall;
	rJoint.m_JointType = type;
	rJoint.m_Mean.assign(CoreOrlexTypes::StateSize(type), 0.0);
	std::copy(i_rRotation.begin(), i_rRotation.end(), rJoint.m_Mean.begin());
	rJoint.m_BindPose = rJoint.m_Mean;
	DefaultCovariance(rJoint);
}

void EnableAllJoints(VSubjectParametrised& io_rSubject, CoreOrlexQRTIO::VSubjectQRTExtras& io_rExtras)
{
	const VTPoseShares shares(io_rSubject, io_rExtras);
	for (std::size_t i = 1; i < io_rSubject.m_Segments.size(); ++i)
		EnableJoint(io_rSubject, i, {});
	shares.Restore(io_rSubject, io_rExtras);
}

std::vector<std::size_t> JointsWithoutTargets(const VSubjectParametrised& i_rSubject)
{
	std::vector<std::size_t> joints;
	const std::vector<bool> used = SegmentsWithTargets(i_rSubject);
	for (std::size_t i = 1; i < i_rSubject.m_Segments.size(); ++i)
		if (!used[i] && i_rSubject.m_Segments[i].m_Joint.m_JointType != VJoint::EDummy)
			joints.push_back(i);
	return joints;
}

void RemoveJoints(VSubjectParametrised& io_rSubject, CoreOrlexQRTIO::VSubjectQRTExtras& io_rExtras,
    const std::vector<std::size_t>& i_rSegments)
{
	const VTPoseShares shares(io_rSubject, io_rExtras);
	for (const std::size_t segment : i_rSegments)
		RemoveJoint(io_rSubject.m_Segments[segment]);
	shares.Restore(io_rSubject, io_rExtras);
}

} // namespace RetargetSetup
