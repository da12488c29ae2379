#include "../Assertions.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"

#include <gtest/gtest.h>

#include <bit>
#include <random>

namespace
{

using namespace CoreOrlexTypesUtils;
using CoreOrlexTypes::VSubjectParametrised;
using VNames = std::set<std::string>;

class StaticExpressionParser : public testing::Test
{
protected:
	double Value(const std::string& i_rExpression)
	{
		double value = 7.0;
		EXPECT_TRUE(m_Parser.Evaluate(i_rExpression, value, m_Error)) << m_Error;
		EXPECT_EQ(m_Error, "");
		return value;
	}

	static VSubjectParametrised::VStaticParameter Parameter(const char* i_pName, const char* i_pExpression = "")
	{
		VSubjectParametrised::VStaticParameter parameter;
		parameter.m_Name = i_pName;
		parameter.m_DefaultExpression = i_pExpression;
		return parameter;
	}

	VDynamicExpressionParserSimple m_Parser;
	std::string m_Error;
};

/// Products are evaluated without the parser, which the full context asks always.
TEST_F(StaticExpressionParser, EvaluatesProductsAsTheParserDoes)
{
	ASSERT_TRUE(m_Parser.AddStaticParameter("Arm", -3.7, m_Error));
	ASSERT_TRUE(m_Parser.AddStaticParameter("1", 5.0, m_Error));
	m_Parser.SetVariable("Arm", 0.1);
	m_Parser.SetVariable("e", 3.0);
	std::mt19937 random(3);
	const std::string huge(400, '9');
	const char* const pParts[] = {"-", "+", "*", "0", "12.5", "3", ".", "e", "1e3", "Arm", "'Arm'", "1", " ", "1.#INF",
	    "inf", "0x1", "99999999999999999999999999", huge.c_str(), "B"};
	std::size_t fine = 0;
	for (int round = 0; round < 50000; ++round)
	{
		std::string text;
		for (std::size_t parts = 1 + random() % 4; parts > 0; --parts)
			text += pParts[random() % std::size(pParts)];
		double value = 7.0;
		double parsed = 7.0;
		std::string error;
		const bool bGood = m_Parser.Evaluate(text, value, error);
		ASSERT_EQ(m_Parser.Evaluate(text, parsed, m_Error, EExpressionContext::EFull), bGood) << text;
		ASSERT_EQ(std::bit_cast<std::uint64_t>(value), std::bit_cast<std::uint64_t>(parsed)) << text;
		ASSERT_EQ(error, m_Error) << text;
		fine += bGood;
	}
	EXPECT_GT(fine, 5000u);
}

TEST_F(StaticExpressionParser, AddsInOrder)
{
	ASSERT_TRUE(m_Parser.AddStaticParameter("Arm", 3.0, m_Error));
	ASSERT_TRUE(m_Parser.AddStaticParameter("Area", "Arm^2*cos(0)", m_Error)) << m_Error;
	ASSERT_TRUE(m_Parser.AddStaticParameter("Empty", "", m_Error));
	EXPECT_EQ(Value("Area+1"), 10.0);
	EXPECT_EQ(Value("Empty"), 0.0);
	EXPECT_EQ(Value(""), 0.0);
}

TEST_F(StaticExpressionParser, TellsWhatItCannotAddOrSetAndChangesNothing)
{
	ASSERT_TRUE(m_Parser.AddStaticParameter("Arm", 3.0, m_Error));
	ASSERT_TRUE(m_Parser.AddStaticParameter("Twice", "Arm*2", m_Error));
	const char* const pKnown = "Cannot add StaticParameter 'Arm', a StaticParameter with that name already exists.";
	EXPECT_FALSE(m_Parser.AddStaticParameter("Arm", 4.0, m_Error));
	EXPECT_EQ(m_Error, pKnown);
	EXPECT_FALSE(m_Parser.AddStaticParameter("Arm", "1+$", m_Error));
	EXPECT_EQ(m_Error, pKnown);
	EXPECT_FALSE(m_Parser.AddStaticParameter("a", "x*2", m_Error));
	EXPECT_EQ(m_Error,
	    "Validation of StaticParameter 'a' expression 'x*2' failed, Parse Error at column 2: ID \"x\" was referenced "
	    "but "
	    "never declared.");
	EXPECT_FALSE(
	    m_Parser.SetStaticParameter("Arm", "2*", m_Error) && m_Parser.SetStaticParameter("Arm", "2* ", m_Error));
	EXPECT_EQ(m_Error,
	    "Validation of StaticParameter 'Arm' expression '2* ' failed, Parse Error at column 4: Unexpected token \"\".");
	EXPECT_EQ(Value("Twice"), 4.0) << "2* is 2, and the failed change after it is none";
	EXPECT_FALSE(m_Parser.SetStaticParameter("Leg", 1.0, m_Error));
	EXPECT_EQ(m_Error, "SetStaticParameter call failed, 'Leg' could not be found.");
	EXPECT_FALSE(m_Parser.SetStaticParameter("Leg", "1+", m_Error));
	EXPECT_EQ(m_Error, "SetStaticParameter call failed, 'Leg' could not be found.");
	double value = 7.0;
	EXPECT_FALSE(m_Parser.Evaluate("a", value, m_Error));
	EXPECT_EQ(m_Error, "Parse Error at column 2: ID \"a\" was referenced but never declared");
	EXPECT_EQ(value, 0.0);
}

TEST_F(StaticExpressionParser, ChangesReachLaterParameters)
{
	ASSERT_TRUE(m_Parser.AddStaticParameter("a", 1.0, m_Error));
	ASSERT_TRUE(m_Parser.AddStaticParameter("b", "a*2", m_Error));
	ASSERT_TRUE(m_Parser.AddStaticParameter("c", "b^2", m_Error));
	ASSERT_TRUE(m_Parser.SetStaticParameter("a", 5.0, m_Error));
	EXPECT_EQ(Value("b"), 10.0);
	EXPECT_EQ(Value("c"), 100.0);
	ASSERT_TRUE(m_Parser.SetStaticParameter("b", 3.0, m_Error));
	ASSERT_TRUE(m_Parser.SetStaticParameter("a", "4+4", m_Error));
	EXPECT_EQ(Value("100*a+10*b+c"), 839.0) << "b is a plain number now";
	VNames names;
	EXPECT_TRUE(m_Parser.EvaluateFull("sin(c)", names)) << "the full context follows too";
	double value = 0.0;
	EXPECT_TRUE(m_Parser.GetStaticParameter("c", value));
	EXPECT_EQ(value, 9.0);
	m_Parser.Reset();
	EXPECT_FALSE(m_Parser.GetStaticParameter("c", value));
	EXPECT_FALSE(m_Parser.Evaluate("a", value, m_Error));
	EXPECT_FALSE(m_Parser.EvaluateFull("a", names));
}

TEST_F(StaticExpressionParser, ChoosesTheSourceOfEachParameterOfASubject)
{
	VSubjectParametrised subject;
	VSubjectParametrised::VStaticParameter user = Parameter("User", "not valid at all");
	user.m_UserValue = 11.0;
	user.m_Prior = 12.0;
	VSubjectParametrised::VStaticParameter prior = Parameter("Prior");
	prior.m_Prior = 13.0;
	VSubjectParametrised::VStaticParameter expression = Parameter("Expression", "Prior+1");
	expression.m_Prior = 1.0;
	subject.m_StaticParameters = {user, prior, expression, Parameter("Unset")};
	subject.m_DynamicParameters = {{"GlobalScale", 9.0, 0.0, 2.5, false}};
	std::vector<std::string> errors;
	EXPECT_TRUE(m_Parser.Initialise(subject, errors));
	EXPECT_TRUE(errors.empty());
	EXPECT_EQ(Value("User"), 11.0);
	EXPECT_EQ(Value("Prior"), 13.0);
	EXPECT_EQ(Value("Expression"), 14.0);
	EXPECT_EQ(Value("Unset"), 0.0);
	EXPECT_EQ(Value("2*GlobalScale"), 5.0);

	// What was held before is gone; a failing parameter does not stop the later ones.
	subject.m_StaticParameters = {Parameter("Forward", "Later"), Parameter("Later", "1"), Parameter("Later", "2"),
	    Parameter("Dynamic", "GlobalScale"), Parameter("Last", "Later*3")};
	EXPECT_FALSE(m_Parser.Initialise(subject, errors));
	EXPECT_EQ(errors,
	    (std::vector<std::string>{"Validation of StaticParameter 'Forward' expression 'Later' failed, Parse Error at "
	                              "column 6: ID \"Later\" was "
	                              "referenced but never declared.",
	        "Cannot add StaticParameter 'Later', a StaticParameter with that name already exists.",
	        "Validation of StaticParameter 'Dynamic' expression 'GlobalScale' failed, Parse Error at column 12: ID "
	        "\"GlobalScale\" was referenced but never declared."}));
	EXPECT_EQ(Value("Last"), 3.0);
	EXPECT_FALSE(m_Parser.AddStaticParameter("Last", 0.0, m_Error));
	EXPECT_TRUE(m_Parser.AddStaticParameter("User", 0.0, m_Error));
}

TEST_F(StaticExpressionParser, TellsTheNamesThatAnExpressionUses)
{
	VSubjectParametrised subject;
	subject.m_StaticParameters = {Parameter("Arm", "1"), Parameter("rm", "1"), Parameter("Leg", "1")};
	subject.m_DynamicParameters = {{"GlobalScale", 1.0, 0.0, 1.0, false}, {"Other", 1.0, 0.0, 1.0, false}};
	subject.m_Segments.resize(2);
	subject.m_Segments[0].m_PreRotation[1] = "Arm-Arm";
	subject.m_Segments[1].m_PreTranslation[2] = "2*GlobalScale";
	subject.m_Segments[1].m_Bounds[0] = "rm";
	subject.m_Targets.resize(1);
	subject.m_Targets[0].m_StateExpressions = {"", "Leg"};
	std::vector<std::string> errors;
	ASSERT_TRUE(m_Parser.Initialise(subject, errors));

	VNames names{"kept"};
	EXPECT_TRUE(m_Parser.GetUsedParameters(subject, names));
	EXPECT_EQ(names, (VNames{"kept", "Arm", "GlobalScale", "Leg"}));
	subject.m_Targets[0].m_StateExpressions[0] = "Arm^2";
	EXPECT_FALSE(m_Parser.GetUsedParameters(subject, names));

	names.clear();
	EXPECT_FALSE(m_Parser.EvaluateChecked("Arm^2", names, m_Error));
	EXPECT_EQ(m_Error, "Parse Error at column 6: Power operator invalid for arguments");
	EXPECT_TRUE(m_Parser.EvaluateChecked("", names, m_Error));
	EXPECT_TRUE(names.empty());
	// Found in the text: the parameter whose name is a part of another's too, and no dynamic parameter.
	EXPECT_TRUE(m_Parser.EvaluateFull("tan(Arm)^2*GlobalScale", names));
	EXPECT_EQ(names, (VNames{"Arm", "rm"}));
	EXPECT_FALSE(m_Parser.EvaluateFull("Arm^", names) && m_Parser.EvaluateFull("Arm^ ", names));
}

TEST_F(StaticExpressionParser, ContextsDifferInWhatTheyTake)
{
	using enum EExpressionContext;
	ASSERT_TRUE(m_Parser.AddStaticParameter("Arm", 3.0, m_Error));
	m_Parser.SetVariable("GlobalScale", 2.0);
	const struct
	{
		const char* pExpression;
		EExpressionContext Context;
		/// Null if the value is 6.
		const char* pError;
	} rows[] = {{"2*Arm", EStatic, nullptr}, {"2*Arm", ELinear, nullptr}, {"2*Arm", EFull, nullptr},
	    {"GlobalScale*Arm", EStatic, "Parse Error at column 12: ID \"GlobalScale\" was referenced but never declared"},
	    {"GlobalScale*Arm", ELinear, nullptr}, {"GlobalScale*Arm", EFull, nullptr},
	    {"Arm^2-Arm*cos(0)", EStatic, nullptr},
	    {"Arm^2-Arm", ELinear, "Parse Error at column 7: Power operator invalid for arguments"},
	    {"2*Arm*cos(0)", ELinear, "Parse Error at column 10: Unknown function \"cos\""},
	    {"Arm^GlobalScale-Arm*cos(0)", EFull, nullptr}};
	for (const auto& rRow : rows)
	{
		double value = 7.0;
		EXPECT_EQ(m_Parser.Evaluate(rRow.pExpression, value, m_Error, rRow.Context), rRow.pError == nullptr);
		EXPECT_EQ(value, rRow.pError ? 0.0 : 6.0) << rRow.pExpression;
		EXPECT_EQ(m_Error, rRow.pError ? rRow.pError : "");
	}
}

TEST(SingleElementIVector, TakesOneNumber)
{
	const VAssertions assertions;
	VStaticExpressionParser::VSingleElementIVector vector(1.0);
	const double values[] = {2.0, 3.0};
	vector.Assign(values, 1);
	EXPECT_TRUE(assertions.Take().empty());
	vector.Assign(values + 1, 0);
	EXPECT_EQ(assertions.Take(), std::vector<std::string>{"i_Count == 1"});
	EXPECT_EQ(vector.Get(0), 2.0);
	EXPECT_EQ(vector.Size(), 1u);
}

} // namespace
