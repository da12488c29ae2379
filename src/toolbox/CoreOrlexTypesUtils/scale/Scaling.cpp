#include "CoreOrlexTypesUtils/scale/Scaling.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/scale/ScaledExpression.h"
#include "CoreOrlexTypesUtils/scale/ScalingRules.h"

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using VNumbers = std::vector<double>;
using VJointType = VSubjectParametrised::VJoint::EJointType;

/// The lengths in a state: the translation of a free joint, behind its rotation, and that of a slider.
void ScaleState(VJointType i_Type, VNumbers& io_rState, double i_Factor)
{
	const std::size_t size = CoreOrlexTypes::StateSize(i_Type);
	for (std::size_t i = i_Type == VSubjectParametrised::VJoint::EFree ? 3 : 0; i < io_rState.size() && i < size; ++i)
		if (io_rState[i] != CoreOrlexTypes::c_NotSet)
			io_rState[i] *= i_Factor;
}

void ScaleMatrix(VJointType i_Type, VNumbers& io_rMatrix, double i_Factor)
{
	if (io_rMatrix.size() != CoreOrlexTypes::CovarianceSize(i_Type))
		return;
	const std::size_t size = CoreOrlexTypes::StateSize(i_Type);
	const std::size_t angles = i_Type == VSubjectParametrised::VJoint::EFree ? 3 : 0;
	for (std::size_t row = 0; row < size; ++row)
		for (std::size_t column = 0; column < size; ++column)
			io_rMatrix[row * size + column] *= (row < angles ? 1.0 : i_Factor) * (column < angles ? 1.0 : i_Factor);
}

template <typename TSubject>
void ScaleJointOf(typename TSubject::VJoint& io_rJoint, double i_Factor, const char* i_pUnknownType,
    std::initializer_list<VNumbers*> i_States, std::initializer_list<VNumbers*> i_Matrices)
{
	using VJoint = VSubjectParametrised::VJoint;
	using VKind = VSubjectKind<TSubject>;
	switch (io_rJoint.m_JointType)
	{
	case VJoint::EFree:
	case VJoint::ESlider:
		for (VNumbers* pState : i_States)
			ScaleState(io_rJoint.m_JointType, *pState, i_Factor);
		for (VNumbers* pMatrix : i_Matrices)
			ScaleMatrix(io_rJoint.m_JointType, *pMatrix, i_Factor);
		break;
	case VJoint::EBall:
	case VJoint::EHardySpicer:
	case VJoint::EHinge:
	case VJoint::EDummy: break;
	case VJoint::EBadJointType: NVX_LOG(VKind::c_LogCategory, NVX::ELogError, "Cannot scale bad joint"); break;
	default: NVX_LOG(VKind::c_LogCategory, NVX::ELogError, i_pUnknownType); break;
	}
}

} // namespace

void TemplateSubjectUtils::ScaleJoint(VSubject::VJoint& io_rJoint, double i_Factor)
{
	ScaleJointOf<VSubject>(io_rJoint, i_Factor, "Cannot scale unknown joint",
	    {&io_rJoint.m_Mean, &io_rJoint.m_RangeCentringState}, {&io_rJoint.m_Covariance, &io_rJoint.m_RangeMatrix});
}

void SubjectParametrisedUtils::ScaleJoint(VSubjectParametrised::VJoint& io_rJoint, double i_Factor)
{
	ScaleJointOf<VSubjectParametrised>(io_rJoint, i_Factor, "Unknown joint type",
	    {&io_rJoint.m_Mean, &io_rJoint.m_TPoseMean, &io_rJoint.m_RangeCentringState, &io_rJoint.m_TemplateMean,
	        &io_rJoint.m_TemplateRangeCentringState, &io_rJoint.m_BindPose},
	    {&io_rJoint.m_Covariance, &io_rJoint.m_TPoseCovariance, &io_rJoint.m_RangeMatrix,
	        &io_rJoint.m_TemplateCovariance, &io_rJoint.m_TemplateRangeMatrix});
}

void TemplateSubjectUtils::ScaleTarget(VSubject::VTarget& io_rTarget, double i_Factor)
{
	TellUnscalableState<VSubject>(io_rTarget);
	for (std::size_t i = 0; i < io_rTarget.m_State.size(); ++i)
		if (IsLength(io_rTarget.m_Type, i))
			io_rTarget.m_State[i] *= i_Factor;
	ScaleTargetStatistics<VSubject>(io_rTarget, i_Factor, io_rTarget.m_Covariance);
}

void SubjectParametrisedUtils::ScaleTarget(VSubjectParametrised::VTarget& io_rTarget, double i_Factor)
{
	TellUnscalableState<VSubjectParametrised>(io_rTarget);
	std::vector<std::string> scaled = io_rTarget.m_StateExpressions;
	for (std::size_t i = 0; i < scaled.size(); ++i)
	{
		if (!IsLength(io_rTarget.m_Type, i))
			continue;
		const std::optional<std::string> text = ScaledExpression(scaled[i], i_Factor);
		if (!text)
		{
			NVX_LOG(VSubjectKind<VSubjectParametrised>::c_LogCategory, NVX::ELogError,
			    "Cannot scale the length '%1%': the target stays as it is", scaled[i]);
			return;
		}
		scaled[i] = *text;
	}
	io_rTarget.m_StateExpressions = std::move(scaled);
	ScaleTargetStatistics<VSubjectParametrised>(io_rTarget, i_Factor, io_rTarget.m_Covariance,
	    io_rTarget.m_TemplateCovariance, io_rTarget.m_PlacementCovariance);
}

bool TemplateSubjectUtils::ScaleSubject(VSubject& io_rSubject, double i_Factor)
{
	if (!IsUsableFactor(io_rSubject, i_Factor))
		return false;
	for (VSubject::VSegment& rSegment : io_rSubject.m_Segments)
	{
		for (double& rValue : rSegment.m_PreTranslation)
			rValue *= i_Factor;
		for (double& rValue : rSegment.m_InversePostTranslation)
			rValue *= i_Factor;
		for (double& rValue : rSegment.m_Bounds)
			rValue *= i_Factor;
		ScaleJoint(rSegment.m_Joint, i_Factor);
	}
	for (VSubject::VTarget& rTarget : io_rSubject.m_Targets)
		ScaleTarget(rTarget, i_Factor);
	return true;
}

} // namespace CoreOrlexTypesUtils
