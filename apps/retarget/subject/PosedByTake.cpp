#include "retarget/subject/PosedByTake.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"

#include <algorithm>

namespace CommandLine
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = VSubjectParametrised::VJoint;

VPosed::VPosed(const VSubjectParametrised& i_rSubject)
    : m_BindPose(CoreOrlexTypesUtils::PoseVector(i_rSubject, &VJoint::m_BindPose))
{
	for (const auto& rFailure :
	    CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertAllOfSubject(i_rSubject, m_Subject))
		m_Subject.m_Targets[rFailure.m_Index].m_Type = VSubject::VTarget::EBadTargetType;
}

VSubjectParametrised WithBindPose(VSubjectParametrised i_Subject, std::span<const double> i_States)
{
	for (auto& rSegment : i_Subject.m_Segments)
	{
		const std::size_t size = CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
		rSegment.m_Joint.m_BindPose.assign(i_States.begin(), i_States.begin() + std::ptrdiff_t(size));
		i_States = i_States.subspan(size);
	}
	return i_Subject;
}

VSubjectParametrised WithWorldPoses(
    VSubjectParametrised i_Subject, const std::vector<Rotation::VPose<double>>& i_rPoses)
{
	for (std::size_t i = 0; i < i_rPoses.size(); ++i)
	{
		VSubjectParametrised::VSegment& rSegment = i_Subject.m_Segments[i];
		const Rotation::VPose<double> pose =
		    i == 0 ? i_rPoses[i] : Rotation::Relative(i_rPoses[rSegment.m_ParentSegmentIndex], i_rPoses[i]);
		const Rotation::VVector3 turn = Rotation::AngleAxisFromRotationMatrix(pose.R);
		rSegment.m_PreRotation.fill("0");
		rSegment.m_PreTranslation.fill("0");
		rSegment.m_InversePostRotation = {};
		rSegment.m_InversePostTranslation = {};
		VJoint joint;
		joint.m_Name = rSegment.m_Joint.m_Name;
		joint.m_JointType = VJoint::EFree;
		joint.m_BindPose.assign(turn.begin(), turn.end());
		joint.m_BindPose.insert(joint.m_BindPose.end(), pose.t.begin(), pose.t.end());
		joint.m_Mean = joint.m_BindPose;
		joint.m_Covariance = CoreOrlexTypes::DefaultCovariance(VJoint::EFree);
		rSegment.m_Joint = std::move(joint);
	}
	return i_Subject;
}

} // namespace CommandLine
