#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

namespace CoreOrlexTypesUtils
{

/// The joint states of a whole subject in segment order, as forward kinematics takes them: of each joint as many
/// values as its type has degrees of freedom. A statistic that is shorter counts as zeros for what is missing, a longer
/// one is cut.
/// @param i_pStatistic for instance &VJoint::m_BindPose, &VJoint::m_Mean or &VJoint::m_TPoseMean.
std::vector<double> PoseVector(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    std::vector<double> CoreOrlexTypes::VSubjectParametrised::VJoint::*i_pStatistic);

/// Which of a joint's statistics make up a pose.
enum class ESubjectParametrisedPoseType
{
	EMean,
	ETPose,
	ETemplate
};

std::vector<double> CoreOrlexTypes::VSubjectParametrised::VJoint::*PoseMean(ESubjectParametrisedPoseType i_PoseType);
std::vector<double> CoreOrlexTypes::VSubjectParametrised::VJoint::*PoseCovariance(
    ESubjectParametrisedPoseType i_PoseType);

} // namespace CoreOrlexTypesUtils
