#include "CoreOrlexTypesUtils/joints/JointParameters.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/Expectation.h"

namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
{

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VNumbers = std::vector<double>;

/// @return whether the joint can have a pose at all.
bool HasPose(const VSubjectParametrised::VJoint& i_rJoint)
{
	if (CoreOrlexTypes::StateSize(i_rJoint.m_JointType) > 0)
		return true;
	Expect(i_rJoint.m_TPoseCovariance.empty() && i_rJoint.m_TPoseMean.empty(),
	    "i_rJoint.m_TPoseCovariance.empty() && i_rJoint.m_TPoseMean.empty()");
	return false;
}

bool Fits(const VNumbers& i_rValues, std::size_t i_Size)
{
	return i_rValues.empty() || i_rValues.size() == i_Size;
}

} // namespace

VJointParameters GatherJointParameters(const VSubjectParametrised& i_rSubject, ESubjectParametrisedPoseType i_PoseType)
{
	VJointParameters JointParams;
	for (const auto& rSegment : i_rSubject.m_Segments)
	{
		const VSubjectParametrised::VJoint& rJoint = rSegment.m_Joint;
		if (!HasPose(rJoint))
			continue;
		const auto JointIt = JointParams.m_SubjectDynamicParameters.find(rJoint.m_Name);
		if (Expect(JointIt == JointParams.m_SubjectDynamicParameters.end(),
		        "JointIt == JointParams.m_SubjectDynamicParameters.end()"))
			JointParams.m_SubjectDynamicParameters[rJoint.m_Name] = {
			    rJoint.*PoseMean(i_PoseType), rJoint.*PoseCovariance(i_PoseType)};
	}
	return JointParams;
}

void ApplyJointParameters(
    const VJointParameters& i_rParameters, ESubjectParametrisedPoseType i_PoseType, VSubjectParametrised& io_rSubject)
{
	for (auto& rSegment : io_rSubject.m_Segments)
	{
		VSubjectParametrised::VJoint& rJoint = rSegment.m_Joint;
		const auto found = i_rParameters.m_SubjectDynamicParameters.find(rJoint.m_Name);
		if (!HasPose(rJoint) || found == i_rParameters.m_SubjectDynamicParameters.end()
		    || !Fits(found->second.m_Mean, CoreOrlexTypes::StateSize(rJoint.m_JointType))
		    || !Fits(found->second.m_Covariance, CoreOrlexTypes::CovarianceSize(rJoint.m_JointType)))
			continue;
		rJoint.*PoseMean(i_PoseType) = found->second.m_Mean;
		rJoint.*PoseCovariance(i_PoseType) = found->second.m_Covariance;
	}
}

} // namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
