#include "../Require.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"

#include "math/MathFactorySymbolicLinear.h"

#include <cmath>
#include <cstdlib>

using namespace CoreOrlexTypesUtils;

namespace
{

class VIgnore final : public Math::IMathResult
{
public:
	void Receive(const Math::VMathNodePointer& i_rpNode) override { Require(i_rpNode != nullptr); }
};

} // namespace

/// The contexts agree about an expression, and what they say about a bad one has the form that it must have.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	const std::string text(reinterpret_cast<const char*>(i_pData), i_Size);
	VDynamicExpressionParserSimple parser;
	std::string error;
	parser.AddStaticParameter("Arm", 2.5, error);
	parser.AddStaticParameter("Arm Length", "Arm*3", error);
	parser.SetVariable("GlobalScale", 1.25);

	double value = 0.0;
	const bool bLinear = parser.Evaluate(text, value, error);
	Require(bLinear == error.empty());
	Require(bLinear || (value == 0.0 && error.starts_with("Parse Error at column ")));
	Require(bLinear || std::strtoull(error.c_str() + 22, nullptr, 10) <= i_Size + 1);

	std::set<std::string> names;
	Require(parser.EvaluateChecked(text, names, error) == bLinear);
	for (const std::string& rName : names)
		Require(rName == "Arm" || rName == "Arm Length" || rName == "GlobalScale");
	std::set<std::string> fullNames;
	const bool bFull = parser.EvaluateFull(text, fullNames);
	Require(bFull || !bLinear);

	// The static context lacks the dynamic parameters only.
	const bool bStatic = parser.AddStaticParameter("New", text, error);
	Require(!bStatic || bFull);
	if (bStatic && bLinear)
	{
		double same = 0.0;
		Require(parser.Evaluate("New", same, error));
		Require(same == value || (std::isnan(same) && std::isnan(value)));
	}

	Math::VMathFactorySymbolicLinear<1> symbolic;
	for (const char* pName : {"Arm", "Arm Length", "GlobalScale"})
		symbolic.SetVariable(pName, VStaticExpressionParser::VSingleElementIVector(1.0));
	VIgnore ignore;
	Math::VMathParser(symbolic).Parse(text, ignore, error);
	return 0;
}
