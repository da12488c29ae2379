#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/text/Output.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "math/NumberText.h"
#include "math/VisibleText.h"

#include <cmath>
#include <cstdio>
#include <map>

namespace CommandLine
{
namespace
{

using VElement = CoreOrlexTypesUtils::VStaticExpressionParser::VSingleElementIVector;

struct VEvalSettings
{
	std::string m_Expression;
	std::string m_Context = "static";
	/// In the order of the line: each sees those before it.
	std::vector<std::pair<std::string, std::string>> m_Static;
	std::vector<std::pair<std::string, double>> m_Dynamic;
};

class VValue : public Math::IMathResult
{
public:
	void Receive(const Math::VMathNodePointer& i_rpNode) override
	{
		if (const auto* pNode = dynamic_cast<const Math::VMathNodeSimple*>(i_rpNode.get()))
			m_Value = pNode->Value();
	}
	double m_Value = 0.0;
};

/// Equals printf's "%.17g" for values that are not finite too.
std::string ValueText(double i_Value)
{
	if (std::isfinite(i_Value))
		return NumberText::PrintG17(i_Value);
	return std::string(std::signbit(i_Value) ? "-" : "") + (std::isnan(i_Value) ? "nan" : "inf");
}

bool Evaluate(const VEvalSettings& i_rSettings, double& o_rValue, std::string& o_rDiagnostic)
{
	CoreOrlexTypesUtils::VStaticExpressionParser parameters;
	for (const auto& [rName, rExpression] : i_rSettings.m_Static)
		if (!parameters.AddStaticParameter(rName, rExpression, o_rDiagnostic))
			return false;

	const bool bLinear = i_rSettings.m_Context == "linear";
	const bool bStatic = i_rSettings.m_Context == "static";
	// The geometry of a subject is zero where nothing is written; a parameter's own text must say something.
	if (i_rSettings.m_Expression.empty() && !bStatic)
	{
		o_rValue = 0.0;
		return true;
	}
	Math::VMathFactorySimple full;
	Math::VMathFactorySimpleLinear linear;
	Math::VMathFactorySimple& rFactory = bLinear ? linear : full;
	for (const auto& [rName, rExpression] : i_rSettings.m_Static)
	{
		double value = 0.0;
		parameters.GetStaticParameter(rName, value);
		rFactory.SetConstant(rName, VElement(value));
	}
	if (!bStatic)
		for (const auto& [rName, value] : i_rSettings.m_Dynamic)
			rFactory.SetVariable(rName, VElement(value));

	VValue result;
	const bool bParsed = Math::VMathParser(rFactory).Parse(i_rSettings.m_Expression, result, o_rDiagnostic);
	o_rValue = result.m_Value;
	return bParsed;
}

EExitStatus ShowValue(const VEvalSettings& i_rSettings)
{
	double value = 0.0;
	std::string diagnostic;
	if (!Evaluate(i_rSettings, value, diagnostic))
	{
		if (JsonAsked())
			throw VCommandError(EBadInput, diagnostic);
		std::fprintf(stderr, "%s\n", VisibleText::OnOneLine(diagnostic).c_str());
		return EBadInput;
	}
	PrintResult({{"value", value}}, ValueText(value) + "\n");
	return EFine;
}

std::pair<std::string, std::string> SplitName(const std::string& i_rOption, const std::string& i_rText)
{
	const std::size_t at = i_rText.find('=');
	if (at == std::string::npos || at == 0)
		throw CLI::ValidationError(i_rOption, "\"" + i_rText + "\" is not NAME=VALUE");
	return {i_rText.substr(0, at), i_rText.substr(at + 1)};
}

} // namespace

VCommand AddEvalCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "eval",
	    "Evaluate an expression as subjects hold them, and print its value. Put -- before one that begins with -",
	    {"eval '2*(Arm + 10)' --static Arm=250", "eval 'sin(a)^2' --static b=3 --static 'a=b/2'",
	        "eval --context linear '12.5*GlobalScale' --dynamic GlobalScale=1.1", "eval --static Arm=1 -- -Arm"});
	const auto pSettings = std::make_shared<VEvalSettings>();
	pApp->add_option("EXPR", pSettings->m_Expression, "The expression")->required();
	pApp->add_option("--context", pSettings->m_Context,
	        "What the expression may use: static parameters, powers and functions (static); static and dynamic "
	        "parameters, "
	        "but no powers and functions (linear), as the geometry of segments and targets; all of it (full)")
	    ->option_text("static|linear|full")
	    ->check(OneOf({"static", "linear", "full"}));
	pApp->add_option_function<std::string>(
	        "--static",
	        [pSettings](const std::string& i_rText) { pSettings->m_Static.push_back(SplitName("--static", i_rText)); },
	        "A static parameter: an expression over those before it; may be repeated")
	    ->option_text("NAME=EXPR")
	    ->trigger_on_parse();
	pApp->add_option_function<std::string>(
	        "--dynamic",
	        [pSettings](const std::string& i_rText)
	        {
		        const auto [name, text] = SplitName("--dynamic", i_rText);
		        double value = 0.0;
		        if (!NumberText::ScanWholeReal(text, value))
			        throw CLI::ValidationError("--dynamic", "\"" + text + "\" is not a number");
		        pSettings->m_Dynamic.emplace_back(name, value);
	        },
	        "A dynamic parameter, which the static context does not know; may be repeated")
	    ->option_text("NAME=NUMBER")
	    ->trigger_on_parse();
	return {pApp, [pSettings] { return ShowValue(*pSettings); }};
}

} // namespace CommandLine
