#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"

/// Turns the editable subject into numbers and numbers back into a subject. The directions are not inverses: one
/// evaluates expressions, the other prints numbers as text and knows no parameters, T-pose, bind pose, mass or
/// placement. Stateless; failures are logged as errors of category "SubjectUtils" and never thrown.
namespace CoreOrlexTypesUtils::SubjectParametrisedConverter
{

/// What the output held before is cleared. Its lists always have the lengths of those converted; after the first
/// failure what remains of segments, markers and targets stays default. An expression of a segment that fails leaves 0
/// and is only logged; a static parameter, a joint statistic of wrong size or the state of a target that fails make the
/// result false.
bool ConvertSubject(const CoreOrlexTypes::VSubjectParametrised& i_rParametrised, CoreOrlexTypes::VSubject& o_rSubject);

/// The same for a subject that was edited: expressions of segments that stand as they did, while all parameters do, are
/// not evaluated again.
/// @param i_rConvertedBefore what ConvertSubject made of i_rBefore.
bool ConvertEditedSubject(const CoreOrlexTypes::VSubjectParametrised& i_rParametrised,
    const CoreOrlexTypes::VSubjectParametrised& i_rBefore, const CoreOrlexTypes::VSubject& i_rConvertedBefore,
    CoreOrlexTypes::VSubject& o_rSubject);

/// A target whose state does not evaluate, and why.
struct VTargetFailure
{
	std::size_t m_Index = 0;
	std::string m_Reason;
};

/// The same without the stop at a failure, which costs only the element that has it. What fails of targets is not
/// logged but returned.
std::vector<VTargetFailure> ConvertAllOfSubject(
    const CoreOrlexTypes::VSubjectParametrised& i_rParametrised, CoreOrlexTypes::VSubject& o_rSubject);

/// Cannot fail. Joint statistics become both the calibrated and the template ones.
void ConvertSubject(const CoreOrlexTypes::VSubject& i_rSubject, CoreOrlexTypes::VSubjectParametrised& o_rParametrised);

/// @param i_bUseTemplate takes the template statistics in place of the calibrated ones.
bool ConvertSegment(const VDynamicExpressionParserSimple& i_rParser,
    const CoreOrlexTypes::VSubjectParametrised::VSegment& i_rParametrised,
    CoreOrlexTypes::VSubject::VSegment& o_rSegment, bool i_bUseTemplate);
bool ConvertTarget(const VDynamicExpressionParserSimple& i_rParser,
    const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rParametrised, CoreOrlexTypes::VSubject::VTarget& o_rTarget,
    bool i_bUseTemplate);
/// The same without a log: what it would tell is appended.
bool ConvertSegment(const VDynamicExpressionParserSimple& i_rParser,
    const CoreOrlexTypes::VSubjectParametrised::VSegment& i_rParametrised,
    CoreOrlexTypes::VSubject::VSegment& o_rSegment, bool i_bUseTemplate, std::vector<std::string>& io_rErrors);
bool ConvertTarget(const VDynamicExpressionParserSimple& i_rParser,
    const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rParametrised, CoreOrlexTypes::VSubject::VTarget& o_rTarget,
    bool i_bUseTemplate, std::vector<std::string>& io_rErrors);
/// False if a statistic is neither empty nor of the size that the joint type prescribes; it is copied all the same.
bool ConvertJoint(const CoreOrlexTypes::VSubjectParametrised::VJoint& i_rParametrised,
    CoreOrlexTypes::VSubject::VJoint& o_rJoint, bool i_bUseTemplate);

/// Always true. The status is dropped, and is EMarkerStatus::ERequired on the way back.
bool ConvertMarker(
    const CoreOrlexTypes::VSubjectParametrised::VMarker& i_rParametrised, CoreOrlexTypes::VSubject::VMarker& o_rMarker);
bool ConvertMarker(
    const CoreOrlexTypes::VSubject::VMarker& i_rMarker, CoreOrlexTypes::VSubjectParametrised::VMarker& o_rParametrised);

} // namespace CoreOrlexTypesUtils::SubjectParametrisedConverter
