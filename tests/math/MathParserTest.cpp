#include "math/MathParser.h"
#include "OneNumber.h"
#include "math/Limits.h"
#include "math/MathFactorySimple.h"

#include <gtest/gtest.h>

#include <cmath>

namespace
{

using namespace Math;
using MathTest::VOneNumber;

class VCopy final : public IMathResult
{
public:
	void Receive(const VMathNodePointer& i_rpNode) override { ASSERT_TRUE(m_Node.Assign(*i_rpNode)); }
	VMathNodeSimple m_Node;
};

/// With the constants Arm = 2, "Arm Length" = 6 and "it's" = 3, and the variable GlobalScale = 4.
template <typename TFactory>
class VWorkplace
{
public:
	VWorkplace()
	{
		m_Factory.SetConstant("Arm", VOneNumber(2));
		m_Factory.SetConstant("Arm Length", VOneNumber(6));
		m_Factory.SetConstant("it's", VOneNumber(3));
		m_Factory.SetVariable("GlobalScale", VOneNumber(4));
	}

	bool Parse(std::string_view i_Text, char i_Delimiter = ',')
	{
		return VMathParser(m_Factory).Parse(i_Text, m_Result, m_Diagnostic, i_Delimiter);
	}

	double Value() const { return m_Result.m_Node.Value(); }

	TFactory m_Factory;
	VCopy m_Result;
	std::string m_Diagnostic;
};

struct VValueRow
{
	const char* pText;
	double Value;
};

class MathParserValue : public testing::TestWithParam<VValueRow>
{
};

TEST_P(MathParserValue, InEveryContextThatTakesIt)
{
	VWorkplace<VMathFactorySimple> workplace;
	ASSERT_TRUE(workplace.Parse(GetParam().pText)) << workplace.m_Diagnostic;
	EXPECT_EQ(workplace.m_Diagnostic, "Parse Succeeded");
	if (std::isnan(GetParam().Value))
		EXPECT_TRUE(std::isnan(workplace.Value()));
	else
		EXPECT_EQ(workplace.Value(), GetParam().Value);
}

const double c_Infinity = std::numeric_limits<double>::infinity();
INSTANTIATE_TEST_SUITE_P(Numbers, MathParserValue,
    testing::Values(VValueRow{"12.5", 12.5}, VValueRow{"1.e2", 100}, VValueRow{"2e3", 2000}, VValueRow{"2e+3", 2000},
        VValueRow{"2e-3", 0.002}, VValueRow{".5", 0.5}, VValueRow{"1.5.2", 1.5}, VValueRow{".", 0}, VValueRow{"2e", 0},
        VValueRow{"2e5.3", 2e5}, VValueRow{"1e400", c_Infinity}, VValueRow{"1e-400", 0}, VValueRow{"0x10", 0},
        VValueRow{"1.#INF", c_Infinity}, VValueRow{"-1.#INF0000", -c_Infinity}, VValueRow{"1.#IND", std::nan("")},
        VValueRow{"1/0", c_Infinity}));
INSTANTIATE_TEST_SUITE_P(Grammar, MathParserValue,
    testing::Values(VValueRow{" \t\n\v\f\r1 ", 1}, VValueRow{"1-2-3", -4}, VValueRow{"2+3*4", 14},
        VValueRow{"12/2/3", 2}, VValueRow{"2*( Arm + 10 )", 24}, VValueRow{"-2^2", 4}, VValueRow{"2^3^2", 64},
        VValueRow{"2^-1", 0.5}, VValueRow{"2^+1", 2}, VValueRow{"1--2", 3}, VValueRow{"1-+2", -1},
        VValueRow{"2*-3", -6}, VValueRow{"((((1))))", 1}, VValueRow{"12.345678*GlobalScale", 49.382712}));
INSTANTIATE_TEST_SUITE_P(Names, MathParserValue,
    testing::Values(VValueRow{"'Arm Length'/3", 2}, VValueRow{"'it\\'s'", 3}, VValueRow{"'Arm'", 2},
        VValueRow{"sin(0)+COS(0)", 1}, VValueRow{"tan(sin(0)) + TAN( 0 ) + SIN(0) + cos(0)", 1},
        VValueRow{"sin(1)^2+cos(1)*cos(1)", std::sin(1.0) * std::sin(1.0) + std::cos(1.0) * std::cos(1.0)}));
// Once the last token has been read, nobody looks at it.
INSTANTIATE_TEST_SUITE_P(LastToken, MathParserValue,
    testing::Values(VValueRow{"1+", 1}, VValueRow{"1)", 1}, VValueRow{"1 2", 1}, VValueRow{"1*", 1}, VValueRow{"2^", 2},
        VValueRow{"1 Unknown", 1}, VValueRow{"1+2(", 3}, VValueRow{"2E5", 2}, VValueRow{"1+2*3 ^", 7},
        VValueRow{"1,", 1}));

struct VErrorRow
{
	const char* pText;
	const char* pDiagnostic;
};

class MathParserError : public testing::TestWithParam<VErrorRow>
{
};

TEST_P(MathParserError, IsToldWithItsColumn)
{
	VWorkplace<VMathFactorySimple> workplace;
	ASSERT_TRUE(workplace.Parse("7"));
	EXPECT_FALSE(workplace.Parse(GetParam().pText));
	EXPECT_EQ(workplace.m_Diagnostic, GetParam().pDiagnostic);
	EXPECT_EQ(workplace.Value(), 7) << "a failed parse delivered something";
}

INSTANTIATE_TEST_SUITE_P(Tokens, MathParserError,
    testing::Values(VErrorRow{"", "Parse Error at column 1: Empty expression"},
        VErrorRow{"   ", "Parse Error at column 4: Empty expression"},
        VErrorRow{"1 2 3", "Parse Error at column 4: Unexpected token \"2\""},
        VErrorRow{"1 + $", "Parse Error at column 6: Unexpected token \"$\""},
        VErrorRow{"\xC3\xA4", "Parse Error at column 2: Unexpected token \"\xC3\""},
        VErrorRow{"1.#INF0001", "Parse Error at column 10: Unexpected token \"1\""},
        VErrorRow{"1.#INF*2", "Parse Error at column 7: Unexpected token \"*2\""},
        VErrorRow{"1.#INX", "Parse Error at column 3: Unexpected token \"#INX\""},
        VErrorRow{"2.#INF", "Parse Error at column 4: Unexpected token \"#\""},
        VErrorRow{"'Arm", "Parse Error at column 5: Missing variable name terminator before end of expression"},
        VErrorRow{"'Arm\\", "Parse Error at column 6: Missing variable name terminator before end of expression"}));
INSTANTIATE_TEST_SUITE_P(Grammar, MathParserError,
    testing::Values(VErrorRow{"1+ ", "Parse Error at column 4: Unexpected token \"\""},
        VErrorRow{"--2", "Parse Error at column 3: Unexpected token \"-\""},
        VErrorRow{"2^--1", "Parse Error at column 5: Unexpected token \"-\""},
        VErrorRow{"*2", "Parse Error at column 2: Unexpected token \"*\""},
        VErrorRow{"1)+2", "Parse Error at column 3: Unexpected token \")\""},
        VErrorRow{"()", "Parse Error at column 3: Missing argument"},
        VErrorRow{"(1", "Parse Error at column 3: Unbalanced parentheses"},
        VErrorRow{"(1 2) ", "Parse Error at column 5: Unbalanced parentheses"}));
INSTANTIATE_TEST_SUITE_P(NamesAndCalls, MathParserError,
    testing::Values(VErrorRow{"Leg", "Parse Error at column 4: ID \"Leg\" was referenced but never declared"},
        VErrorRow{"'a b'+1", "Parse Error at column 6: ID \"a b\" was referenced but never declared"},
        VErrorRow{"sin (0)", "Parse Error at column 4: ID \"sin\" was referenced but never declared"},
        VErrorRow{"'sin'(0)", "Parse Error at column 6: ID \"sin\" was referenced but never declared"},
        VErrorRow{"Sin(0)", "Parse Error at column 4: Unknown function \"Sin\""},
        VErrorRow{"Arm(0)", "Parse Error at column 4: Unknown function \"Arm\""},
        VErrorRow{"sin()", "Parse Error at column 6: Missing argument(s) in function \"sin\""},
        VErrorRow{"sin(1,)", "Parse Error at column 8: Missing argument(s) in function \"sin\""},
        VErrorRow{"sin(", "Parse Error at column 5: Unexpected token \"\""},
        VErrorRow{"sin(1", "Parse Error at column 6: Unbalanced parentheses"},
        VErrorRow{"sin(1,", "Parse Error at column 7: Unbalanced parentheses"},
        VErrorRow{"sin(1,2)",
            "Parse Error at column 9: Cannot evaluate \"sin\" for 2 input arguments (1 arguments required)"}));

TEST(MathParser, RefusesABlankAsTheDelimiter)
{
	VWorkplace<VMathFactorySimple> workplace;
	EXPECT_FALSE(workplace.Parse("1", ' '));
	EXPECT_EQ(workplace.m_Diagnostic, "Parse Error at column 1: Invalid delimiting character ' '");
	EXPECT_FALSE(workplace.Parse("sin(1;2)", ';'));
	EXPECT_EQ(workplace.m_Diagnostic,
	    "Parse Error at column 9: Cannot evaluate \"sin\" for 2 input arguments (1 arguments required)");
}

TEST(MathParser, LinearContextRefusesPowersAndFunctions)
{
	VWorkplace<VMathFactorySimpleLinear> workplace;
	EXPECT_FALSE(workplace.Parse("Arm^2"));
	EXPECT_EQ(workplace.m_Diagnostic, "Parse Error at column 6: Power operator invalid for arguments");
	EXPECT_FALSE(workplace.Parse("sin(Arm)"));
	EXPECT_EQ(workplace.m_Diagnostic, "Parse Error at column 4: Unknown function \"sin\"");
	ASSERT_TRUE(workplace.Parse("GlobalScale*GlobalScale/Arm - 'it\\'s'"));
	EXPECT_EQ(workplace.Value(), 5);
}

TEST(MathParser, NodesTellTextAndNames)
{
	VWorkplace<VMathFactorySimpleLinear> linear;
	ASSERT_TRUE(linear.Parse("-Arm*(GlobalScale+0.1)/2 - 'Arm Length'*Arm"));
	// 0.1 in 53 significant digits, from Python's decimal.
	EXPECT_EQ(linear.m_Result.m_Node.Text(),
	    "( ( ( -Arm * ( GlobalScale + 0.10000000000000000555111512312578270211815834045410156 ) ) * 1/2 ) + "
	    "-( Arm Length * Arm ) )");
	std::set<std::string> constants;
	std::set<std::string> variables;
	linear.m_Result.m_Node.GatherNames(constants, variables);
	EXPECT_EQ(constants, (std::set<std::string>{"Arm", "Arm Length"}));
	EXPECT_EQ(variables, std::set<std::string>{"GlobalScale"});

	VWorkplace<VMathFactorySimple> full;
	ASSERT_TRUE(full.Parse("sin(Arm)^cos(GlobalScale)*tan(1)"));
	EXPECT_EQ(full.m_Result.m_Node.Text(), "( ( sin( Arm ) ^ cos( GlobalScale ) ) * tan( 1 ) )");
	constants.clear();
	variables.clear();
	full.m_Result.m_Node.GatherNames(constants, variables);
	EXPECT_TRUE(constants.empty() && variables.empty());

	// A number keeps its spelling where it is given as one, and a kind of function beyond the three has no value.
	EXPECT_EQ(AsSimple(full.m_Factory.MakeNumberFromText("1.50").get())->Text(), "1.50");
	EXPECT_EQ(AsSimple(full.m_Factory.MakeNumberFromText("1.50").get())->Value(), 1.5);
	const VMathNodePointer arguments[] = {full.m_Factory.MakeNumber(2)};
	const VMathFunctionPointer pFunction(new VMathFunctionSimple(VMathFunctionSimple::EKind(3)));
	const VMathNodePointer pNode = pFunction->Evaluate(arguments);
	EXPECT_EQ(AsSimple(pNode.get())->Text(), "fn( 2 )");
	EXPECT_EQ(AsSimple(pNode.get())->Value(), 0);
}

TEST(MathParser, CanKeepValuesOnly)
{
	VWorkplace<VMathFactorySimple> workplace;
	workplace.m_Factory.SetKeepsExpressions(false);
	ASSERT_TRUE(workplace.Parse("-(2*Arm+10)^2/tan('it\\'s')-cos(GlobalScale)"));
	EXPECT_EQ(workplace.Value(), 196.0 * (1.0 / std::tan(3.0)) - std::cos(4.0));
	ASSERT_TRUE(workplace.Parse("-'Arm Length'+sin(0)"));
	EXPECT_EQ(workplace.m_Result.m_Node.Text(), "-6");
}

TEST(MathParser, VariablesComeBeforeConstantsAndCanBeCleared)
{
	VWorkplace<VMathFactorySimple> workplace;
	workplace.m_Factory.SetVariable("Arm", VOneNumber(100));
	ASSERT_TRUE(workplace.Parse("Arm"));
	EXPECT_EQ(workplace.Value(), 100);
	workplace.m_Factory.ClearVariables();
	ASSERT_TRUE(workplace.Parse("Arm"));
	EXPECT_EQ(workplace.Value(), 2);
	workplace.m_Factory.ClearConstants();
	EXPECT_FALSE(workplace.Parse("Arm"));
}

TEST(MathParser, BoundsNesting)
{
	VWorkplace<VMathFactorySimple> workplace;
	const auto nested = [](std::size_t i_Depth, const std::string& i_rOpen)
	{
		std::string text;
		for (std::size_t i = 0; i < i_Depth; ++i)
			text += i_rOpen;
		return text + "0" + std::string(i_Depth, ')');
	};
	for (const char* pOpen : {"(", "sin(", "-(1*("})
	{
		const std::size_t depth = std::string_view(pOpen) == "-(1*(" ? c_MaxExpressionDepth / 2 : c_MaxExpressionDepth;
		std::string good = nested(depth, pOpen);
		if (depth != c_MaxExpressionDepth)
			good += std::string(depth, ')');
		EXPECT_TRUE(workplace.Parse(good)) << workplace.m_Diagnostic;
	}
	EXPECT_FALSE(workplace.Parse(nested(c_MaxExpressionDepth + 1, "(")));
	EXPECT_EQ(workplace.m_Diagnostic, "Parse Error at column 202: Expression is nested too deeply");
	EXPECT_FALSE(workplace.Parse(std::string(1000000, '(')));
	// Side by side is not nested.
	std::string text = "sin(0)";
	for (std::size_t i = 0; i <= c_MaxExpressionDepth; ++i)
		text += "+(1)";
	EXPECT_TRUE(workplace.Parse(text)) << workplace.m_Diagnostic;
}

/// Neither quadratic nor deep: any of these would take minutes or the stack if it were.
TEST(MathParser, LongExpressions)
{
	constexpr std::size_t c_Terms = 100000;
	VWorkplace<VMathFactorySimpleLinear> workplace;
	std::string text = "Arm";
	for (std::size_t i = 1; i < c_Terms; ++i)
		text += i % 2 ? "-Arm" : "+Arm*1";
	ASSERT_TRUE(workplace.Parse(text));
	EXPECT_EQ(workplace.Value(), 0);
	// Brackets and operator of each sum, the first name, 50,000 times "-Arm" and 49,999 times "( Arm * 1 )".
	constexpr std::size_t c_TextSize = 7 * (c_Terms - 1) + 3 + 4 * 50000 + 11 * 49999;
	EXPECT_EQ(workplace.m_Result.m_Node.Text().size(), c_TextSize);
	std::set<std::string> names;
	workplace.m_Result.m_Node.GatherNames(names, names);
	EXPECT_EQ(names.size(), 1u);
	// Whoever holds the last reference takes the chain apart.
	const VMathNodeSimple kept = workplace.m_Result.m_Node;
	workplace.m_Result.m_Node.Reset();
	EXPECT_EQ(workplace.m_Result.m_Node.Text(), "0");
	EXPECT_EQ(kept.Text().size(), c_TextSize);
	EXPECT_FALSE(workplace.Parse(text + "+Leg"));
}

} // namespace
