#pragma once

#include "math/IMathFactory.h"

#include <string>
#include <string_view>

namespace Math
{

/// Where a parse delivers its node.
class IMathResult
{
public:
	virtual void Receive(const VMathNodePointer& i_rpNode) = 0;

protected:
	~IMathResult() = default;
};

/// Grammar of the expressions, from the loosest: "+" and "-"; "*" and "/"; "^"; one sign; numbers, names, names in
/// single quotes, calls and parentheses. Operators of one level group to the left, the power too, and a sign binds
/// tighter than the power. A name is looked up as a variable and then as a constant; it is a call only if "(" follows
/// without a blank. Once the last token of the text has been read it is not looked at any more: "1+" and "1)" are 1.
class VMathParser
{
public:
	/// The factory must outlive the parser.
	explicit VMathParser(IMathFactory& i_rFactory) : m_rFactory(i_rFactory) {}

	/// Delivers the node and says "Parse Succeeded", or says "Parse Error at column ", the column, ": " and what is
	/// wrong, and delivers nothing. The column is one-based and stands behind the token that was read last.
	/// Linear in the length of the text; nesting is bounded by c_MaxExpressionDepth.
	bool Parse(
	    std::string_view i_Text, IMathResult& o_rResult, std::string& o_rDiagnostic, char i_Delimiter = ',') const;

private:
	IMathFactory& m_rFactory;
};

} // namespace Math
