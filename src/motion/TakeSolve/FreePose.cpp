#include "TakeSolve/FreePose.h"

#include <utility>

namespace TakeSolve
{

CoreOrlexTypes::VSubject WithFreeJoints(CoreOrlexTypes::VSubject i_Subject)
{
	for (auto& rSegment : i_Subject.m_Segments)
	{
		CoreOrlexTypes::VSubject::VJoint joint;
		joint.m_Name = std::move(rSegment.m_Joint.m_Name);
		joint.m_JointType = CoreOrlexTypes::VSubjectParametrised::VJoint::EFree;
		rSegment.m_Joint = std::move(joint);
		rSegment.m_InversePostRotation = {};
		rSegment.m_InversePostTranslation = {};
	}
	return i_Subject;
}

void FreeStates(const CoreOrlexTypes::VSubject& i_rFree, std::span<const Rotation::VPose<double>> i_World,
    std::vector<double>& o_rStates)
{
	o_rStates.clear();
	for (std::size_t i = 0; i < i_rFree.m_Segments.size(); ++i)
	{
		const auto& rSegment = i_rFree.m_Segments[i];
		Rotation::VPose<double> base = Rotation::PoseFromAngleAxis(rSegment.m_PreRotation, rSegment.m_PreTranslation);
		if (rSegment.m_ParentSegmentIndex < i_World.size())
			base = Rotation::Compose(i_World[rSegment.m_ParentSegmentIndex], base);
		const Rotation::VPose<double> pose = Rotation::Relative(base, i_World[i]);
		const Rotation::VVector3 turn = Rotation::AngleAxisFromRotationMatrix(pose.R);
		o_rStates.insert(o_rStates.end(), turn.begin(), turn.end());
		o_rStates.insert(o_rStates.end(), pose.t.begin(), pose.t.end());
	}
}

} // namespace TakeSolve
