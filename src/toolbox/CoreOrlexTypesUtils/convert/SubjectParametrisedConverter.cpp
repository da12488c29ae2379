#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

#include "CoreOrlexTypes/JointType.h"

#include "DebugServices/GlobalLog.h"
#include "math/NumberText.h"

#include <algorithm>
#include <optional>
#include <utility>

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::CovarianceSize;
using CoreOrlexTypes::StateSize;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

/// A segment as it was, and what was made of it under the same parameters.
struct VSegmentBefore
{
	const VSubjectParametrised::VSegment& m_rParametrised;
	const VSubject::VSegment& m_rConverted;
};

bool HaveSameParameters(const VSubjectParametrised& i_rLeft, const VSubjectParametrised& i_rRight)
{
	const auto isSameStatic = [](const auto& i_rOne, const auto& i_rOther)
	{
		return i_rOne.m_Name == i_rOther.m_Name && i_rOne.m_DefaultExpression == i_rOther.m_DefaultExpression
		    && i_rOne.m_UserValue == i_rOther.m_UserValue && i_rOne.m_Prior == i_rOther.m_Prior;
	};
	const auto isSameDynamic = [](const auto& i_rOne, const auto& i_rOther)
	{
		return i_rOne.m_Name == i_rOther.m_Name && i_rOne.m_Value == i_rOther.m_Value
		    && i_rOne.m_Prior == i_rOther.m_Prior;
	};
	return std::ranges::equal(i_rLeft.m_StaticParameters, i_rRight.m_StaticParameters, isSameStatic)
	    && std::ranges::equal(i_rLeft.m_DynamicParameters, i_rRight.m_DynamicParameters, isSameDynamic);
}

/// Continues after a component that fails and leaves 0 there.
/// @param i_pBefore null, or where expressions that stand as they did have their values from. One that failed left 0
/// and fails again.
template <std::size_t c_Count>
bool EvaluateAll(const VDynamicExpressionParserSimple& i_rParser, const VSubjectParametrised::VSegment& i_rParametrised,
    std::array<std::string, c_Count> VSubjectParametrised::VSegment::*i_pExpressions, const VSegmentBefore* i_pBefore,
    std::array<double, c_Count> VSubject::VSegment::*i_pValues, VSubject::VSegment& o_rSegment)
{
	bool bGood = true;
	std::string error;
	for (std::size_t i = 0; i < c_Count; ++i)
	{
		const std::string& rExpression = (i_rParametrised.*i_pExpressions)[i];
		double& rValue = (o_rSegment.*i_pValues)[i];
		const double before = i_pBefore ? (i_pBefore->m_rConverted.*i_pValues)[i] : 0.0;
		if (before != 0.0 && (i_pBefore->m_rParametrised.*i_pExpressions)[i] == rExpression)
			rValue = before;
		else
			bGood &= i_rParser.Evaluate(rExpression, rValue, error);
	}
	return bGood;
}

template <std::size_t c_Count>
void PrintAll(const std::array<double, c_Count>& i_rValues, std::array<std::string, c_Count>& o_rExpressions)
{
	for (std::size_t i = 0; i < c_Count; ++i)
		o_rExpressions[i] = NumberText::PrintG17(i_rValues[i]);
}

/// The same enumeration of the other subject type; a value outside it becomes the bad one.
template <typename TTo, typename TFrom>
TTo ConvertBehaviour(TFrom i_Behaviour)
{
	return i_Behaviour >= 0 && i_Behaviour <= 3 ? TTo(i_Behaviour) : TTo(0);
}

void LogErrors(const std::vector<std::string>& i_rErrors)
{
	for (const std::string& rError : i_rErrors)
		NVX_LOG("SubjectUtils", NVX::ELogError, "%1%", rError);
}

void ConvertSegmentBack(const VSubject::VSegment& i_rSegment, VSubjectParametrised::VSegment& o_rParametrised)
{
	o_rParametrised.m_Name = i_rSegment.m_Name;
	o_rParametrised.m_SegmentIndex = i_rSegment.m_SegmentIndex;
	o_rParametrised.m_ParentSegmentIndex = i_rSegment.m_ParentSegmentIndex;
	o_rParametrised.m_TreeDepth = i_rSegment.m_TreeDepth;
	o_rParametrised.m_InversePostRotation = i_rSegment.m_InversePostRotation;
	o_rParametrised.m_InversePostTranslation = i_rSegment.m_InversePostTranslation;
	PrintAll(i_rSegment.m_PreTranslation, o_rParametrised.m_PreTranslation);
	PrintAll(i_rSegment.m_PreRotation, o_rParametrised.m_PreRotation);
	PrintAll(i_rSegment.m_Bounds, o_rParametrised.m_Bounds);

	const VSubject::VJoint& rJoint = i_rSegment.m_Joint;
	VSubjectParametrised::VJoint& rBack = o_rParametrised.m_Joint;
	rBack.m_Name = rJoint.m_Name;
	rBack.m_JointType = rJoint.m_JointType;
	rBack.m_JointOrientation = rJoint.m_JointOrientation;
	rBack.m_Covariance = rBack.m_TemplateCovariance = rJoint.m_Covariance;
	rBack.m_Mean = rBack.m_TemplateMean = rJoint.m_Mean;
	rBack.m_RangeCentringState = rBack.m_TemplateRangeCentringState = rJoint.m_RangeCentringState;
	rBack.m_RangeMatrix = rBack.m_TemplateRangeMatrix = rJoint.m_RangeMatrix;
}

void ConvertTargetBack(const VSubject::VTarget& i_rTarget, VSubjectParametrised::VTarget& o_rParametrised)
{
	using VTarget = VSubjectParametrised::VTarget;
	o_rParametrised.m_Type = VTarget::ETargetType(i_rTarget.m_Type);
	o_rParametrised.m_Weight = i_rTarget.m_Weight;
	o_rParametrised.m_MarkerIndices = i_rTarget.m_MarkerIndices;
	o_rParametrised.m_RotationObservationIndices = i_rTarget.m_RotationObservationIndices;
	o_rParametrised.m_SegmentIndices = i_rTarget.m_SegmentIndices;
	o_rParametrised.m_ViewNormals = i_rTarget.m_ViewNormals;
	o_rParametrised.m_NumberOfDegreesOfFreedom = i_rTarget.m_NumberOfDegreesOfFreedom;
	o_rParametrised.m_RotationTargetOrientation = i_rTarget.m_RotationTargetOrientation;
	o_rParametrised.m_Covariance = o_rParametrised.m_TemplateCovariance = i_rTarget.m_Covariance;
	o_rParametrised.m_RotationCalibrationBehaviour =
	    ConvertBehaviour<VTarget::ERotationCalibrationBehaviourType>(i_rTarget.m_RotationCalibrationBehaviour);
	for (const double state : i_rTarget.m_State)
		o_rParametrised.m_StateExpressions.push_back(NumberText::PrintG17(state));
}

/// @param i_pBefore null if nothing is known.
bool ConvertSegmentAfter(const VSegmentBefore* i_pBefore, const VDynamicExpressionParserSimple& i_rParser,
    const VSubjectParametrised::VSegment& i_rParametrised, VSubject::VSegment& o_rSegment, bool i_bUseTemplate,
    std::vector<std::string>& io_rErrors)
{
	o_rSegment.m_Name = i_rParametrised.m_Name;
	o_rSegment.m_SegmentIndex = i_rParametrised.m_SegmentIndex;
	o_rSegment.m_ParentSegmentIndex = i_rParametrised.m_ParentSegmentIndex;
	o_rSegment.m_TreeDepth = i_rParametrised.m_TreeDepth;
	o_rSegment.m_InversePostRotation = i_rParametrised.m_InversePostRotation;
	o_rSegment.m_InversePostTranslation = i_rParametrised.m_InversePostTranslation;

	const bool bJoint =
	    SubjectParametrisedConverter::ConvertJoint(i_rParametrised.m_Joint, o_rSegment.m_Joint, i_bUseTemplate);
	const auto fail = [&](const char* i_pWhat)
	{ io_rErrors.push_back(std::string(i_pWhat) + " segment '" + i_rParametrised.m_Name + "'"); };
	if (!bJoint)
		fail("Could not generate joint for");
	const auto evaluate = [&](auto i_pExpressions, auto i_pValues)
	{ return EvaluateAll(i_rParser, i_rParametrised, i_pExpressions, i_pBefore, i_pValues, o_rSegment); };
	using VParametrised = VSubjectParametrised::VSegment;
	using VConverted = VSubject::VSegment;
	if (!evaluate(&VParametrised::m_PreTranslation, &VConverted::m_PreTranslation))
		fail("Could not evaluate m_PreTranslation expressions in");
	if (!evaluate(&VParametrised::m_PreRotation, &VConverted::m_PreRotation))
		fail("Could not evaluate m_PreRotation expressions in");
	if (!evaluate(&VParametrised::m_Bounds, &VConverted::m_Bounds))
		fail("Could not evaluate m_Bounds expressions in");
	return bJoint;
}

/// All but segments, markers and targets, whose lists get their lengths.
bool Begin(const VSubjectParametrised& i_rParametrised, VDynamicExpressionParserSimple& o_rParser, VSubject& o_rSubject)
{
	o_rSubject = {};
	std::vector<std::string> errors;
	const bool bGood = o_rParser.Initialise(i_rParametrised, errors);
	if (!bGood)
		NVX_LOG("SubjectUtils", NVX::ELogError, "Error parsing subject static parameter expressions");
	LogErrors(errors);
	o_rSubject.m_SubjectId = i_rParametrised.m_SubjectId;
	o_rSubject.m_Name = i_rParametrised.m_Name;
	o_rSubject.m_Segments.resize(i_rParametrised.m_Segments.size());
	o_rSubject.m_Markers.resize(i_rParametrised.m_Markers.size());
	for (const VSubjectParametrised::VRotation& rRotation : i_rParametrised.m_Rotations)
		o_rSubject.m_Rotations.push_back({rRotation.m_Name, rRotation.m_RotationId});
	o_rSubject.m_Targets.resize(i_rParametrised.m_Targets.size());
	return bGood;
}

} // namespace

bool SubjectParametrisedConverter::ConvertJoint(
    const VSubjectParametrised::VJoint& i_rParametrised, VSubject::VJoint& o_rJoint, bool i_bUseTemplate)
{
	o_rJoint.m_Name = i_rParametrised.m_Name;
	o_rJoint.m_JointType = i_rParametrised.m_JointType;
	o_rJoint.m_JointOrientation = i_rParametrised.m_JointOrientation;
	o_rJoint.m_Covariance = i_bUseTemplate ? i_rParametrised.m_TemplateCovariance : i_rParametrised.m_Covariance;
	o_rJoint.m_Mean = i_bUseTemplate ? i_rParametrised.m_TemplateMean : i_rParametrised.m_Mean;
	o_rJoint.m_RangeCentringState =
	    i_bUseTemplate ? i_rParametrised.m_TemplateRangeCentringState : i_rParametrised.m_RangeCentringState;
	o_rJoint.m_RangeMatrix = i_bUseTemplate ? i_rParametrised.m_TemplateRangeMatrix : i_rParametrised.m_RangeMatrix;

	const auto fits = [](const std::vector<double>& i_rStatistic, std::size_t i_Size)
	{ return i_rStatistic.empty() || i_rStatistic.size() == i_Size; };
	const std::size_t stateSize = StateSize(o_rJoint.m_JointType);
	const std::size_t covarianceSize = CovarianceSize(o_rJoint.m_JointType);
	return fits(o_rJoint.m_Covariance, covarianceSize) && fits(o_rJoint.m_Mean, stateSize)
	    && fits(o_rJoint.m_RangeCentringState, stateSize) && fits(o_rJoint.m_RangeMatrix, covarianceSize);
}

bool SubjectParametrisedConverter::ConvertSegment(const VDynamicExpressionParserSimple& i_rParser,
    const VSubjectParametrised::VSegment& i_rParametrised, VSubject::VSegment& o_rSegment, bool i_bUseTemplate,
    std::vector<std::string>& io_rErrors)
{
	return ConvertSegmentAfter(nullptr, i_rParser, i_rParametrised, o_rSegment, i_bUseTemplate, io_rErrors);
}

bool SubjectParametrisedConverter::ConvertTarget(const VDynamicExpressionParserSimple& i_rParser,
    const VSubjectParametrised::VTarget& i_rParametrised, VSubject::VTarget& o_rTarget, bool i_bUseTemplate,
    std::vector<std::string>& io_rErrors)
{
	using VTarget = VSubject::VTarget;
	o_rTarget.m_Type = VTarget::ETargetType(i_rParametrised.m_Type);
	o_rTarget.m_Weight = i_rParametrised.m_Weight;
	o_rTarget.m_MarkerIndices = i_rParametrised.m_MarkerIndices;
	o_rTarget.m_RotationObservationIndices = i_rParametrised.m_RotationObservationIndices;
	o_rTarget.m_SegmentIndices = i_rParametrised.m_SegmentIndices;
	o_rTarget.m_ViewNormals = i_rParametrised.m_ViewNormals;
	o_rTarget.m_NumberOfDegreesOfFreedom = i_rParametrised.m_NumberOfDegreesOfFreedom;
	o_rTarget.m_RotationTargetOrientation = i_rParametrised.m_RotationTargetOrientation;
	o_rTarget.m_Covariance = i_bUseTemplate ? i_rParametrised.m_TemplateCovariance : i_rParametrised.m_Covariance;
	o_rTarget.m_RotationCalibrationBehaviour =
	    ConvertBehaviour<VTarget::ERotationCalibrationBehaviourType>(i_rParametrised.m_RotationCalibrationBehaviour);

	o_rTarget.m_State.assign(i_rParametrised.m_StateExpressions.size(), 0.0);
	bool bGood = true;
	for (std::size_t i = 0; i < o_rTarget.m_State.size(); ++i)
	{
		std::string error;
		if (i_rParser.Evaluate(i_rParametrised.m_StateExpressions[i], o_rTarget.m_State[i], error))
			continue;
		io_rErrors.push_back(std::move(error));
		bGood = false;
	}
	return bGood;
}

bool SubjectParametrisedConverter::ConvertSegment(const VDynamicExpressionParserSimple& i_rParser,
    const VSubjectParametrised::VSegment& i_rParametrised, VSubject::VSegment& o_rSegment, bool i_bUseTemplate)
{
	std::vector<std::string> errors;
	const bool bGood = ConvertSegment(i_rParser, i_rParametrised, o_rSegment, i_bUseTemplate, errors);
	LogErrors(errors);
	return bGood;
}

bool SubjectParametrisedConverter::ConvertTarget(const VDynamicExpressionParserSimple& i_rParser,
    const VSubjectParametrised::VTarget& i_rParametrised, VSubject::VTarget& o_rTarget, bool i_bUseTemplate)
{
	std::vector<std::string> errors;
	const bool bGood = ConvertTarget(i_rParser, i_rParametrised, o_rTarget, i_bUseTemplate, errors);
	LogErrors(errors);
	return bGood;
}

bool SubjectParametrisedConverter::ConvertMarker(
    const VSubjectParametrised::VMarker& i_rParametrised, VSubject::VMarker& o_rMarker)
{
	o_rMarker.m_Name = i_rParametrised.m_Name;
	o_rMarker.m_MarkerId = i_rParametrised.m_MarkerId;
	o_rMarker.m_Radius = i_rParametrised.m_Radius;
	o_rMarker.m_ViewAngle = i_rParametrised.m_ViewAngle;
	o_rMarker.m_Missing = i_rParametrised.m_Missing;
	return true;
}

bool SubjectParametrisedConverter::ConvertMarker(
    const VSubject::VMarker& i_rMarker, VSubjectParametrised::VMarker& o_rParametrised)
{
	o_rParametrised.m_Name = i_rMarker.m_Name;
	o_rParametrised.m_MarkerId = i_rMarker.m_MarkerId;
	o_rParametrised.m_Radius = i_rMarker.m_Radius;
	o_rParametrised.m_ViewAngle = i_rMarker.m_ViewAngle;
	o_rParametrised.m_Missing = i_rMarker.m_Missing;
	o_rParametrised.m_Status = VSubjectParametrised::VMarker::ERequired;
	return true;
}

bool SubjectParametrisedConverter::ConvertSubject(const VSubjectParametrised& i_rParametrised, VSubject& o_rSubject)
{
	return ConvertEditedSubject(i_rParametrised, {}, {}, o_rSubject);
}

bool SubjectParametrisedConverter::ConvertEditedSubject(const VSubjectParametrised& i_rParametrised,
    const VSubjectParametrised& i_rBefore, const VSubject& i_rConvertedBefore, VSubject& o_rSubject)
{
	VDynamicExpressionParserSimple parser;
	bool bGood = Begin(i_rParametrised, parser, o_rSubject);
	const std::size_t known = HaveSameParameters(i_rParametrised, i_rBefore)
	    ? std::min(i_rBefore.m_Segments.size(), i_rConvertedBefore.m_Segments.size())
	    : 0;
	std::vector<std::string> errors;
	for (std::size_t i = 0; bGood && i < o_rSubject.m_Segments.size(); ++i)
	{
		std::optional<VSegmentBefore> before;
		if (i < known)
			before.emplace(VSegmentBefore{i_rBefore.m_Segments[i], i_rConvertedBefore.m_Segments[i]});
		bGood = ConvertSegmentAfter(before ? &*before : nullptr, parser, i_rParametrised.m_Segments[i],
		    o_rSubject.m_Segments[i], false, errors);
		LogErrors(std::exchange(errors, {}));
	}
	for (std::size_t i = 0; bGood && i < o_rSubject.m_Markers.size(); ++i)
		bGood = ConvertMarker(i_rParametrised.m_Markers[i], o_rSubject.m_Markers[i]);
	for (std::size_t i = 0; bGood && i < o_rSubject.m_Targets.size(); ++i)
		bGood = ConvertTarget(parser, i_rParametrised.m_Targets[i], o_rSubject.m_Targets[i], false);
	return bGood;
}

std::vector<SubjectParametrisedConverter::VTargetFailure> SubjectParametrisedConverter::ConvertAllOfSubject(
    const VSubjectParametrised& i_rParametrised, VSubject& o_rSubject)
{
	VDynamicExpressionParserSimple parser;
	Begin(i_rParametrised, parser, o_rSubject);
	for (std::size_t i = 0; i < o_rSubject.m_Segments.size(); ++i)
		ConvertSegment(parser, i_rParametrised.m_Segments[i], o_rSubject.m_Segments[i], false);
	for (std::size_t i = 0; i < o_rSubject.m_Markers.size(); ++i)
		ConvertMarker(i_rParametrised.m_Markers[i], o_rSubject.m_Markers[i]);
	std::vector<VTargetFailure> failures;
	for (std::size_t i = 0; i < o_rSubject.m_Targets.size(); ++i)
	{
		std::vector<std::string> errors;
		if (!ConvertTarget(parser, i_rParametrised.m_Targets[i], o_rSubject.m_Targets[i], false, errors))
			failures.push_back({i, errors.front()});
	}
	return failures;
}

void SubjectParametrisedConverter::ConvertSubject(const VSubject& i_rSubject, VSubjectParametrised& o_rParametrised)
{
	o_rParametrised = {};
	o_rParametrised.m_SubjectId = i_rSubject.m_SubjectId;
	o_rParametrised.m_Name = i_rSubject.m_Name;
	o_rParametrised.m_Segments.resize(i_rSubject.m_Segments.size());
	for (std::size_t i = 0; i < o_rParametrised.m_Segments.size(); ++i)
		ConvertSegmentBack(i_rSubject.m_Segments[i], o_rParametrised.m_Segments[i]);
	o_rParametrised.m_Markers.resize(i_rSubject.m_Markers.size());
	for (std::size_t i = 0; i < o_rParametrised.m_Markers.size(); ++i)
		ConvertMarker(i_rSubject.m_Markers[i], o_rParametrised.m_Markers[i]);
	for (const VSubject::VRotation& rRotation : i_rSubject.m_Rotations)
		o_rParametrised.m_Rotations.push_back({rRotation.m_Name, rRotation.m_RotationId});
	o_rParametrised.m_Targets.resize(i_rSubject.m_Targets.size());
	for (std::size_t i = 0; i < o_rParametrised.m_Targets.size(); ++i)
		ConvertTargetBack(i_rSubject.m_Targets[i], o_rParametrised.m_Targets[i]);
}

} // namespace CoreOrlexTypesUtils
