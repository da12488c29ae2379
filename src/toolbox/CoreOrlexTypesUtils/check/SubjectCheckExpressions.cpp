#include "CoreOrlexTypesUtils/check/SubjectCheckRules.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"

namespace CoreOrlexTypesUtils::SubjectCheck
{
namespace
{

bool LoadStaticParameters(
    const VSubjectParametrised& i_rSubject, VDynamicExpressionParserSimple& o_rParser, IFindings& io_rFindings)
{
	std::vector<VStaticParameterFailure> failures;
	if (o_rParser.Initialise(i_rSubject, failures))
		return true;
	io_rFindings.Line("Error parsing Subject static parameter expressions");
	for (const VStaticParameterFailure& rFailure : failures)
	{
		const auto& rParameter = i_rSubject.m_StaticParameters[rFailure.m_Index];
		VReport(io_rFindings, VSubjectFinding::EStaticParameter, rFailure.m_Index, rParameter.m_Name)
		    .Fail(rFailure.m_Error,
		        rFailure.m_bNameTaken ? "Rename or remove it: one before it has this name."
		                              : "Correct its DefaultExpression, which may use the static parameters before it, "
		                                "or set its UserValue.");
	}
	return false;
}

/// The expression of one component; an empty one is good.
/// @param i_rWhere gives the text that the message begins with.
template <typename TWhere>
bool CheckExpression(const std::string& i_rExpression, const VDynamicExpressionParserSimple& i_rParser,
    const VReport& i_rReport, TWhere&& i_rWhere)
{
	double value = 0.0;
	std::string error;
	return i_rParser.Evaluate(i_rExpression, value, error)
	    || i_rReport.Fail(i_rWhere() + ", invalid expresssion: " + error,
	        "Correct \"" + i_rExpression
	            + "\": it may use numbers, the subject's parameters, + - * / and parentheses, but no powers and "
	              "functions.");
}

bool CheckSegmentExpressions(const VSubjectParametrised::VSegment& i_rSegment, std::size_t i_Index,
    const VDynamicExpressionParserSimple& i_rParser, IFindings& io_rFindings)
{
	const VReport report(io_rFindings, VSubjectFinding::ESegment, i_Index, i_rSegment.m_Name);
	bool bGood = true;
	const auto check = [&](const std::array<std::string, 3>& i_rExpressions, const char* i_pWhat)
	{
		for (std::size_t axis = 0; axis < 3; ++axis)
			bGood &= CheckExpression(i_rExpressions[axis], i_rParser, report,
			    [&] { return "Segment " + i_rSegment.m_Name + ", " + "XYZ"[axis] + i_pWhat; });
	};
	check(i_rSegment.m_PreRotation, " pre-rotation");
	check(i_rSegment.m_PreTranslation, " pre-translation");
	return bGood;
}

} // namespace

bool CheckExpressions(const VSubjectParametrised& i_rSubject, IFindings& io_rFindings)
{
	VDynamicExpressionParserSimple parser;
	bool bGood = LoadStaticParameters(i_rSubject, parser, io_rFindings);
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
		bGood &= CheckSegmentExpressions(i_rSubject.m_Segments[i], i, parser, io_rFindings);
	for (std::size_t i = 0; i < i_rSubject.m_Targets.size(); ++i)
	{
		const VReport report(io_rFindings, VSubjectFinding::ETarget, i);
		const std::vector<std::string>& rState = i_rSubject.m_Targets[i].m_StateExpressions;
		for (std::size_t component = 0; component < rState.size(); ++component)
			bGood &= CheckExpression(rState[component], parser, report,
			    [&] { return "Target " + std::to_string(i) + ", state component " + std::to_string(component); });
	}
	return bGood;
}

} // namespace CoreOrlexTypesUtils::SubjectCheck
