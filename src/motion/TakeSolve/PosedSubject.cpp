#include "TakeSolve/PosedSubject.h"

#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"

namespace TakeSolve
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

VPosedSubject::VPosedSubject(const VSubjectParametrised& i_rSubject)
    : m_BindPose(CoreOrlexTypesUtils::PoseVector(i_rSubject, &VSubjectParametrised::VJoint::m_BindPose))
{
	for (const auto& rFailure :
	    CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertAllOfSubject(i_rSubject, m_Subject))
		m_Subject.m_Targets[rFailure.m_Index].m_Type = VSubject::VTarget::EBadTargetType;
}

} // namespace TakeSolve
