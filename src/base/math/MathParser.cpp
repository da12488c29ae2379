#include "math/MathParser.h"

#include "math/Limits.h"
#include "math/MathTokenizer.h"

namespace Math
{

namespace
{

/// One parse: recursive descent over one token of lookahead.
class VDescent
{
public:
	VDescent(IMathFactory& i_rFactory, std::string_view i_Text, char i_Delimiter)
	    : m_rFactory(i_rFactory), m_Cursor(i_Text, i_Delimiter)
	{
	}

	VMathNodePointer Run()
	{
		Next();
		if (Is(EToken::EEnd))
			m_Cursor.Fail("Empty expression");
		VMathNodePointer pNode = Additive();
		if (!m_Cursor.AtEnd())
			FailUnexpectedToken();
		return pNode;
	}

private:
	void Next() { m_Cursor.Next(m_Token); }
	bool Is(EToken i_Type) const { return m_Token.Type == i_Type; }

	[[noreturn]] void FailUnexpectedToken() const { m_Cursor.Fail("Unexpected token \"" + m_Token.Text + "\""); }

	VMathNodePointer Good(VMathNodePointer i_pNode, const char* i_pMessage) const
	{
		if (!i_pNode)
			m_Cursor.Fail(i_pMessage);
		return i_pNode;
	}

	VMathNodePointer Additive()
	{
		constexpr const char* c_pPlus = "Plus operator invalid for arguments";
		constexpr const char* c_pMinus = "Minus operator invalid for arguments";
		VMathNodePointer pLeft = Multiplicative();
		while (!m_Cursor.AtEnd() && (Is(EToken::EPlus) || Is(EToken::EMinus)))
		{
			const bool bMinus = Is(EToken::EMinus);
			Next();
			VMathNodePointer pRight = Multiplicative();
			if (bMinus)
				pRight = Good(m_rFactory.Negate(std::move(pRight)), c_pMinus);
			pLeft = Good(m_rFactory.Add(std::move(pLeft), std::move(pRight)), bMinus ? c_pMinus : c_pPlus);
		}
		return pLeft;
	}

	VMathNodePointer Multiplicative()
	{
		constexpr const char* c_pMultiply = "Multiply operator invalid for arguments";
		constexpr const char* c_pDivide = "Divide operator invalid for arguments";
		VMathNodePointer pLeft = Power();
		while (!m_Cursor.AtEnd() && (Is(EToken::EMultiply) || Is(EToken::EDivide)))
		{
			const bool bDivide = Is(EToken::EDivide);
			Next();
			VMathNodePointer pRight = Power();
			if (bDivide)
				pRight = Good(m_rFactory.Invert(std::move(pRight)), c_pDivide);
			pLeft = Good(m_rFactory.Multiply(std::move(pLeft), std::move(pRight)), bDivide ? c_pDivide : c_pMultiply);
		}
		return pLeft;
	}

	VMathNodePointer Power()
	{
		VMathNodePointer pLeft = Signed();
		while (!m_Cursor.AtEnd() && Is(EToken::EPower))
		{
			Next();
			VMathNodePointer pRight = Signed();
			pLeft = Good(m_rFactory.Power(std::move(pLeft), std::move(pRight)), "Power operator invalid for arguments");
		}
		return pLeft;
	}

	VMathNodePointer Signed()
	{
		const bool bMinus = Is(EToken::EMinus);
		if (bMinus || Is(EToken::EPlus))
			Next();
		VMathNodePointer pNode = Primary();
		return bMinus ? Good(m_rFactory.Negate(std::move(pNode)), "Minus operator invalid for argument") : pNode;
	}

	VMathNodePointer Primary()
	{
		VMathNodePointer pNode;
		switch (m_Token.Type)
		{
		case EToken::ENumber: pNode = Good(m_rFactory.MakeNumber(m_Token.Value), "Invalid number"); break;
		case EToken::ELeftParenthesis: pNode = Parenthesised(); break;
		case EToken::EQuotedIdentifier: pNode = Named(); break;
		case EToken::EIdentifier: pNode = m_Cursor.At('(') ? Call() : Named(); break;
		default: FailUnexpectedToken();
		}
		Next();
		return pNode;
	}

	VMathNodePointer Named()
	{
		VMathNodePointer pNode = m_rFactory.GetVariable(m_Token.Text);
		if (!pNode)
			pNode = m_rFactory.GetConstant(m_Token.Text);
		if (!pNode)
			m_Cursor.Fail("ID \"" + m_Token.Text + "\" was referenced but never declared");
		return pNode;
	}

	/// From the left parenthesis to the right one.
	VMathNodePointer Parenthesised()
	{
		Enter();
		Next();
		if (Is(EToken::ERightParenthesis))
			m_Cursor.Fail("Missing argument");
		VMathNodePointer pNode = Additive();
		Leave();
		return pNode;
	}

	/// From the name of the function to the right parenthesis.
	VMathNodePointer Call()
	{
		const std::string name = m_Token.Text;
		const VMathFunctionPointer pFunction = m_rFactory.GetFunction(name);
		const std::size_t required = pFunction ? pFunction->NumberOfArguments() : 0;
		if (required == 0)
			m_Cursor.Fail("Unknown function \"" + name + "\"");
		Enter();
		Next();
		std::vector<VMathNodePointer> arguments;
		do
		{
			Next();
			if (Is(EToken::EDelimiter) || Is(EToken::ERightParenthesis))
				m_Cursor.Fail("Missing argument(s) in function \"" + name + "\"");
			arguments.push_back(Additive());
		} while (!m_Cursor.AtEnd() && Is(EToken::EDelimiter));
		Leave();
		if (arguments.size() != required)
			m_Cursor.Fail("Cannot evaluate \"" + name + "\" for " + std::to_string(arguments.size())
			    + " input arguments (" + std::to_string(required) + " arguments required)");
		VMathNodePointer pNode = pFunction->Evaluate(arguments);
		if (!pNode)
			m_Cursor.Fail("Error in function \"" + name + "\"");
		return pNode;
	}

	void Enter()
	{
		if (++m_Depth > c_MaxExpressionDepth)
			m_Cursor.Fail("Expression is nested too deeply");
	}

	void Leave()
	{
		if (!Is(EToken::ERightParenthesis))
			m_Cursor.Fail("Unbalanced parentheses");
		--m_Depth;
	}

	IMathFactory& m_rFactory;
	VMathCursor m_Cursor;
	VToken m_Token;
	std::size_t m_Depth = 0;
};

} // namespace

bool VMathParser::Parse(
    std::string_view i_Text, IMathResult& o_rResult, std::string& o_rDiagnostic, char i_Delimiter) const
{
	VMathNodePointer pNode;
	try
	{
		pNode = VDescent(m_rFactory, i_Text, i_Delimiter).Run();
	}
	catch (const VMathParseException& rException)
	{
		o_rDiagnostic = "Parse Error at column " + std::to_string(rException.Column()) + ": " + rException.Message();
		return false;
	}
	o_rResult.Receive(pNode);
	o_rDiagnostic = "Parse Succeeded";
	return true;
}

} // namespace Math
