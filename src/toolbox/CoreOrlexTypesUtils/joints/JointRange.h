#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

#include <vector>

/// The range of a joint is an ellipsoid about its centring state, {x : x' M^-1 x <= 1} with the range matrix M, row by
/// row; people edit it as the least and the greatest value of each degree of freedom.
namespace CoreOrlexTypesUtils::TemplateSubjectUtils
{

/// Of ball and free joints the values are Euler angles of order XYZ, then the translation: the extremes over 64 points
/// on each ellipse that two axes of the ellipsoid span. The rotation is measured from the centring state, about its
/// axes. The angles are those next to the centre's, so that they run on beyond half a turn.
/// False for an unknown joint type (told), for lists of other than the joint's sizes (asserted), and for values that
/// are not finite (told). A negative extent counts as 0.
bool RangeToMinMax(CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType i_JointType,
    const std::vector<double>& i_rRangeCenteringState, const std::vector<double>& i_rRangeMatrix,
    std::vector<double>& o_rMin, std::vector<double>& o_rMax);

/// The inverse for all joints but ball and free ones, for which it is refused (asserted and told).
bool MinMaxToRange(CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType i_JointType,
    const std::vector<double>& i_rMin, const std::vector<double>& i_rMax, std::vector<double>& o_rRangeCenteringState,
    std::vector<double>& o_rRangeMatrix);

} // namespace CoreOrlexTypesUtils::TemplateSubjectUtils
