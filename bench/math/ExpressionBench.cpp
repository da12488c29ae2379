// Expressions of the kinds that subjects hold, parsed and evaluated from their text each time: through the factory that
// segments and targets use, and by muParser. The last rows show that a sum costs the same per term however long it is.
#include "../../tests/math/OneNumber.h"
#include "../Ratios.h"

#include "math/MathFactorySimple.h"
#include "math/MathParser.h"

#include <muParser.h>

namespace
{

using namespace Math;
using MathTest::VOneNumber;

class VValue final : public IMathResult
{
public:
	void Receive(const VMathNodePointer& i_rpNode) override { m_Value = AsSimple(i_rpNode.get())->Value(); }
	double m_Value = 0.0;
};

const char* const c_Expressions[] = {
    "0", "-12.345678", "12.345678*GlobalScale", "2*(Arm+10)-Leg/3", "0.5*Arm+0.25*(Leg-Arm)*GlobalScale/(1+Leg)"};

void Declare(IMathFactory& io_rFactory)
{
	io_rFactory.SetVariable("GlobalScale", VOneNumber(1.1));
	io_rFactory.SetConstant("Arm", VOneNumber(300));
	io_rFactory.SetConstant("Leg", VOneNumber(450));
}

void Factory(benchmark::State& io_rState)
{
	const char* const pExpression = c_Expressions[io_rState.range(0)];
	VMathFactorySimpleLinear factory;
	Declare(factory);
	const VMathParser parser(factory);
	VValue value;
	std::string diagnostic;
	for (auto unused : io_rState)
	{
		if (!parser.Parse(pExpression, value, diagnostic))
			io_rState.SkipWithError(diagnostic.c_str());
		benchmark::DoNotOptimize(value.m_Value);
	}
	io_rState.SetLabel(pExpression);
}

void MuParser(benchmark::State& io_rState)
{
	const char* const pExpression = c_Expressions[io_rState.range(0)];
	double globalScale = 1.1;
	mu::Parser parser;
	parser.DefineVar("GlobalScale", &globalScale);
	parser.DefineConst("Arm", 300);
	parser.DefineConst("Leg", 450);
	VMathFactorySimpleLinear factory;
	Declare(factory);
	VValue ours;
	std::string diagnostic;
	VMathParser(factory).Parse(pExpression, ours, diagnostic);
	double value = 0.0;
	for (auto unused : io_rState)
	{
		parser.SetExpr(pExpression);
		value = parser.Eval();
		benchmark::DoNotOptimize(value);
	}
	if (std::abs(value - ours.m_Value) > 1e-9)
		io_rState.SkipWithError("The two disagree about the value.");
	io_rState.SetLabel(pExpression);
}

void SumPerTerm(benchmark::State& io_rState)
{
	VMathFactorySimpleLinear factory;
	Declare(factory);
	const VMathParser parser(factory);
	std::string text = "Arm";
	for (std::int64_t i = 1; i < io_rState.range(0); ++i)
		text += "+Leg";
	VValue value;
	std::string diagnostic;
	for (auto unused : io_rState)
		if (!parser.Parse(text, value, diagnostic))
			io_rState.SkipWithError(diagnostic.c_str());
	io_rState.counters["s/term"] = benchmark::Counter(
	    double(io_rState.range(0)), benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

BENCHMARK(Factory)->DenseRange(0, std::size(c_Expressions) - 1);
BENCHMARK(MuParser)->DenseRange(0, std::size(c_Expressions) - 1);
BENCHMARK(SumPerTerm)->RangeMultiplier(10)->Range(100, 100000);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments, {{"Factory", "MuParser", 0.25}});
}
