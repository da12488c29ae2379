#include "CoreOrlexTypesUtils/ScaledExpression.h"

#include "math/NumberText.h"

#include <string_view>

namespace CoreOrlexTypesUtils
{

namespace
{

/// The length of "(...)" at the start, where that is one pair of parentheses; otherwise 0.
std::size_t ParenthesesAtStart(std::string_view i_Text)
{
	std::size_t depth = 0;
	bool bQuoted = false;
	for (std::size_t i = 0; i < i_Text.size(); ++i)
	{
		const char byte = i_Text[i];
		if (bQuoted && byte == '\\')
			++i;
		else if (byte == '\'')
			bQuoted = !bQuoted;
		else if (!bQuoted && byte == '(')
			++depth;
		else if (!bQuoted && byte == ')' && depth > 0 && --depth == 0)
			return i + 1;
		if (depth == 0)
			return 0;
	}
	return 0;
}

/// Words such as "inf" are names in an expression.
bool IsNumber(std::string_view i_Text, double& o_rNumber)
{
	return i_Text.find_first_not_of("0123456789.eE+-") == std::string_view::npos
	    && NumberText::ScanWholeReal(i_Text, o_rNumber);
}

} // namespace

std::string ScaledExpression(const std::string& i_rExpression, double i_Factor)
{
	if (i_rExpression.empty())
		return {};
	double number = 0.0;
	if (IsNumber(i_rExpression, number))
		return NumberText::PrintG17(number * i_Factor);
	const std::size_t length = ParenthesesAtStart(i_rExpression);
	if (length > 0 && length < i_rExpression.size() && i_rExpression[length] == '*'
	    && IsNumber(std::string_view(i_rExpression).substr(length + 1), number))
		return i_rExpression.substr(0, length + 1).append(NumberText::PrintG17(number * i_Factor));
	return std::string("(").append(i_rExpression).append(")*").append(NumberText::PrintG17(i_Factor));
}

} // namespace CoreOrlexTypesUtils
