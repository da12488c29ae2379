#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

#include <vector>

/// The form in which people edit a joint's mean and covariance: a rest pose, and for each degree of freedom a stiffness
/// in percent of which 100 is stiff. It runs with the logarithm of the standard deviation, from 0.001 (stiff) to 50 for
/// rotations in radians and from 0.01 to 1e6 for translations in mm; what lies beyond counts as the end.
///
/// Of ball and free joints the rest pose is Euler angles of order XYZ, then the translation; the covariance of their
/// rotation is about the axes of the joint at rest. There and back gives the same angles and stiffness, but for a
/// gimbal lock, where the outer angles turn about one axis: there the first angle comes back as 0, the third as the
/// sum, and the two share what is known of their stiffness.
namespace CoreOrlexTypesUtils::TemplateSubjectUtils
{

/// False for a joint type without statistics (told), for lists of other than the joint's sizes (asserted), and for
/// values that are not finite (told). A negative variance counts as 0.
/// @param i_rCovariance row by row.
bool MeanCovarianceToRestPoseStiffness(CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType i_JointType,
    const std::vector<double>& i_rMeanPose, const std::vector<double>& i_rCovariance, std::vector<double>& o_rRestPose,
    std::vector<double>& o_rStiffness);

/// The inverse, with the same refusals. A stiffness outside 0 to 100 counts as the nearer of them.
bool RestPoseStiffnessToMeanCovariance(CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType i_JointType,
    const std::vector<double>& i_rRestPose, const std::vector<double>& i_rStiffness, std::vector<double>& o_rMean,
    std::vector<double>& o_rCovariance);

} // namespace CoreOrlexTypesUtils::TemplateSubjectUtils
