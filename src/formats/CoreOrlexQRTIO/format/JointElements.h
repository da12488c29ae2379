#pragma once

#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexTypes/JointType.h"

#include <algorithm>

namespace CoreOrlexQRTIO
{

struct VJointElement
{
	const Format::VElement& m_rElement;
	CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType m_Type;
};

/// In the order of declaration.
inline constexpr VJointElement c_JointElements[] = {
    {Format::Joint::c_Ball, CoreOrlexTypes::VSubjectParametrised::VJoint::EBall},
    {Format::Joint::c_Dummy, CoreOrlexTypes::VSubjectParametrised::VJoint::EDummy},
    {Format::Joint::c_Free, CoreOrlexTypes::VSubjectParametrised::VJoint::EFree},
    {Format::Joint::c_HardySpicer, CoreOrlexTypes::VSubjectParametrised::VJoint::EHardySpicer},
    {Format::Joint::c_Hinge, CoreOrlexTypes::VSubjectParametrised::VJoint::EHinge},
    {Format::Joint::c_Slider, CoreOrlexTypes::VSubjectParametrised::VJoint::ESlider},
};

/// Null if there is none.
template <typename TPredicate>
const VJointElement* FindJointElement(const TPredicate& i_rPredicate)
{
	const auto* const pFound = std::ranges::find_if(c_JointElements, i_rPredicate);
	return pFound == std::ranges::end(c_JointElements) ? nullptr : pFound;
}

} // namespace CoreOrlexQRTIO
