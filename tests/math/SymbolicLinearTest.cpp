#include "math/MathFactorySimple.h"
#include "math/MathFactorySymbolicLinear.h"
#include "math/MathParser.h"

#include <gtest/gtest.h>

namespace
{

using namespace Math;

class VTwoNumbers final : public IVector
{
public:
	explicit VTwoNumbers(double i_Value) : m_Value(i_Value) {}
	std::size_t Size() const override { return 2; }
	double Get(std::size_t i_Index) const override { return i_Index ? 99.0 : m_Value; }
	void Assign(const double*, std::size_t) override {}

private:
	double m_Value;
};

class VKeep final : public IMathResult
{
public:
	void Receive(const VMathNodePointer& i_rpNode) override { m_pNode = i_rpNode; }
	VMathNodePointer m_pNode;
};

/// Over the variables x, y and z, and the constant c = 5.
class SymbolicLinear : public testing::Test
{
protected:
	SymbolicLinear()
	{
		for (const char* pName : {"x", "y", "z"})
			m_Factory.SetVariable(pName, VTwoNumbers(1000));
		m_Factory.SetConstant("c", VTwoNumbers(5));
	}

	bool Parse(std::string_view i_Text) { return VMathParser(m_Factory).Parse(i_Text, m_Result, m_Diagnostic); }

	VMathFactorySymbolicLinear<1> m_Factory;
	VKeep m_Result;
	std::string m_Diagnostic;
};

TEST_F(SymbolicLinear, GivesTheForm)
{
	const struct
	{
		const char* pText;
		double Constant;
		std::map<std::string, double> Factors;
	} rows[] = {{"3", 3, {}}, {"c/2-1", 1.5, {}}, {"x", 0, {{"x", 1}}}, {"2*(x+10)-y/4", 20, {{"x", 2}, {"y", -0.25}}},
	    {"x*c", 0, {{"x", 5}}}, {"c*x+x", 0, {{"x", 6}}}, {"x-x", 0, {{"x", 0}}},
	    {"-(x+y)-z", 0, {{"x", -1}, {"y", -1}, {"z", -1}}}, {"z+(x+y+1)", 1, {{"x", 1}, {"y", 1}, {"z", 1}}},
	    {"component(vector(2*x+3),0)", 3, {{"x", 2}}}, {"COMPONENT(VECTOR(x),1.9)+y", 0, {{"x", 0}, {"y", 1}}},
	    {"component(vector(x),-0.5)", 0, {{"x", 1}}}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.pText);
		ASSERT_TRUE(Parse(rRow.pText)) << m_Diagnostic;
		const auto* const pNode = dynamic_cast<const VMathNodeSymbolicLinear<1>*>(m_Result.m_pNode.get());
		ASSERT_TRUE(pNode);
		EXPECT_EQ(pNode->m_Constant[0], rRow.Constant);
		std::map<std::string, double> factors;
		for (const auto& [name, matrix] : pNode->m_Matrices)
			factors[name] = matrix.at(0);
		EXPECT_EQ(factors, rRow.Factors);
	}
	ASSERT_TRUE(Parse("vector(x+2)"));
	const auto* const pVector = dynamic_cast<const VMathNodeSymbolicLinear<3>*>(m_Result.m_pNode.get());
	ASSERT_TRUE(pVector);
	EXPECT_EQ(pVector->m_Constant, (std::array<double, 3>{2, 0, 0}));
	EXPECT_EQ(pVector->m_Matrices.at("x"), (std::vector<double>{1, 0, 0}));
}

TEST_F(SymbolicLinear, RefusesWhatIsNotLinear)
{
	const struct
	{
		const char* pText;
		const char* pDiagnostic;
	} rows[] = {{"x*y", "Parse Error at column 4: Multiply operator invalid for arguments"},
	    {"x*(y-y)", "Parse Error at column 8: Multiply operator invalid for arguments"},
	    {"1/x", "Parse Error at column 4: Divide operator invalid for arguments"},
	    {"2^2", "Parse Error at column 4: Power operator invalid for arguments"},
	    {"vector(x)+1", "Parse Error at column 12: Plus operator invalid for arguments"},
	    {"1-vector(x)", "Parse Error at column 12: Minus operator invalid for arguments"},
	    {"-vector(x)", "Parse Error at column 11: Minus operator invalid for argument"},
	    {"vector(vector(x))", "Parse Error at column 18: Error in function \"vector\""},
	    {"component(x,0)", "Parse Error at column 15: Error in function \"component\""},
	    {"component(vector(x),y)", "Parse Error at column 23: Error in function \"component\""},
	    {"component(vector(x),3)", "Parse Error at column 23: Error in function \"component\""},
	    {"component(vector(x),0-1)", "Parse Error at column 25: Error in function \"component\""},
	    {"component(vector(x))",
	        "Parse Error at column 21: Cannot evaluate \"component\" for 1 input arguments (2 arguments required)"},
	    {"sin(x)", "Parse Error at column 4: Unknown function \"sin\""}};
	for (const auto& rRow : rows)
	{
		EXPECT_FALSE(Parse(rRow.pText)) << rRow.pText;
		EXPECT_EQ(m_Diagnostic, rRow.pDiagnostic);
	}
}

/// An operand that somebody else holds is not written to.
TEST_F(SymbolicLinear, LeavesHeldOperandsAlone)
{
	const VMathNodePointer pX = m_Factory.GetVariable("x");
	const VMathNodePointer pSum = m_Factory.Add(pX, m_Factory.MakeNumber(1));
	const VMathNodePointer pDouble = m_Factory.Add(pSum, pSum);
	m_Factory.Negate(pDouble);
	m_Factory.Multiply(m_Factory.MakeNumber(7), pDouble);
	VMathNodeSymbolicLinear<1> copy;
	ASSERT_TRUE(copy.Assign(*pDouble));
	EXPECT_EQ(copy.m_Constant[0], 2);
	EXPECT_EQ(copy.m_Matrices.at("x").at(0), 2);
	ASSERT_TRUE(copy.Assign(*pX));
	EXPECT_EQ(copy.m_Matrices.at("x").at(0), 1);
	copy.Reset();
	EXPECT_TRUE(copy.m_Matrices.empty());
	EXPECT_FALSE(copy.Assign(VMathNodeSimple()));
	// Nodes of another factory fit nowhere.
	VMathFactorySimple simple;
	EXPECT_FALSE(m_Factory.Add(pX, simple.MakeNumber(1)));
	EXPECT_FALSE(simple.Multiply(simple.MakeNumber(1), pX));
	EXPECT_FALSE(simple.Negate(pX));
}

TEST_F(SymbolicLinear, LongSums)
{
	std::string text = "0";
	for (int i = 0; i < 30000; ++i)
	{
		std::string name = std::to_string(i);
		name.insert(name.begin(), 'p');
		m_Factory.SetVariable(name, VTwoNumbers(0));
		text.append("+2*").append(name);
	}
	ASSERT_TRUE(Parse(text)) << m_Diagnostic;
	const auto* const pNode = dynamic_cast<const VMathNodeSymbolicLinear<1>*>(m_Result.m_pNode.get());
	ASSERT_TRUE(pNode);
	EXPECT_EQ(pNode->m_Matrices.size(), 30000u);
}

} // namespace
