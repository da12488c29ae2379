#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

namespace CoreOrlexTypes
{

/// False for EBadJointType and any value outside the enumeration.
constexpr bool IsJointType(VSubjectParametrised::VJoint::EJointType i_Type)
{
	return i_Type >= VSubjectParametrised::VJoint::EFree && i_Type <= VSubjectParametrised::VJoint::EDummy;
}

/// Degrees of freedom of a joint type, the size of its state vectors; 0 for any value outside the enumeration.
constexpr std::size_t StateSize(VSubjectParametrised::VJoint::EJointType i_Type)
{
	switch (i_Type)
	{
	case VSubjectParametrised::VJoint::EFree: return 6;
	case VSubjectParametrised::VJoint::EBall: return 3;
	case VSubjectParametrised::VJoint::EHardySpicer: return 2;
	case VSubjectParametrised::VJoint::EHinge: return 1;
	case VSubjectParametrised::VJoint::ESlider: return 1;
	default: return 0;
	}
}

/// Number of values of a DoF times DoF matrix, row by row.
constexpr std::size_t CovarianceSize(VSubjectParametrised::VJoint::EJointType i_Type)
{
	return StateSize(i_Type) * StateSize(i_Type);
}

/// The covariance of a joint that nothing is known about: a diagonal matrix, row by row, of 10 (rotations)
/// and 1e8 (translations, mm squared).
std::vector<double> DefaultCovariance(VSubjectParametrised::VJoint::EJointType i_Type);

} // namespace CoreOrlexTypes
