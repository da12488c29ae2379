#include "CoreOrlexTypesUtils/observations/UnusedParameters.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"

namespace CoreOrlexTypesUtils
{

using CoreOrlexTypes::VSubjectParametrised;

std::set<std::string> ParametersInUse(const VSubjectParametrised& i_rSubject)
{
	VDynamicExpressionParserSimple parser;
	std::vector<std::string> errors;
	parser.Initialise(i_rSubject, errors);
	std::set<std::string> names;
	parser.GetUsedParameters(i_rSubject, names);
	for (const auto& rSegment : i_rSubject.m_Segments)
	{
		parser.EvaluateFull(rSegment.m_MassExpression, names);
		for (const auto* pTexts : {&rSegment.m_MassCentreExpressions, &rSegment.m_RadiusOfGyrationExpressions})
			for (const std::string& rText : *pTexts)
				parser.EvaluateFull(rText, names);
		for (const std::string& rText : rSegment.m_Bounds)
			parser.EvaluateFull(rText, names);
	}
	for (const auto& rParameter : i_rSubject.m_StaticParameters)
		parser.EvaluateFull(rParameter.m_DefaultExpression, names);
	return names;
}

void DropParametersOf(const VSubjectParametrised::VTarget& i_rTarget, VSubjectParametrised& io_rSubject)
{
	VDynamicExpressionParserSimple parser;
	std::vector<std::string> errors;
	parser.Initialise(io_rSubject, errors);
	std::string error;
	std::set<std::string> own;
	for (const std::string& rText : i_rTarget.m_StateExpressions)
		parser.EvaluateChecked(rText, own, error);
	const std::set<std::string> others = ParametersInUse(io_rSubject);
	std::erase_if(io_rSubject.m_StaticParameters,
	    [&](const auto& i_rParameter) { return own.count(i_rParameter.m_Name) && !others.count(i_rParameter.m_Name); });
}

} // namespace CoreOrlexTypesUtils
