#include "CoreOrlexTypesUtils/scale/ScaledExpression.h"

#include "math/MathFactorySimple.h"
#include "math/MathNodeSimple.h"
#include "math/MathParser.h"
#include "math/MathTokenizer.h"
#include "math/NumberText.h"

#include <cmath>
#include <functional>
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

/// Words such as "inf" are names in an expression, and so is what follows the 2 in "2E5".
bool IsNumber(std::string_view i_Text, double& o_rNumber)
{
	return i_Text.find_first_not_of("0123456789.e+-") == std::string_view::npos
	    && NumberText::ScanWholeReal(i_Text, o_rNumber);
}

/// Knows every name, with a value that no other has.
class VAnyNameFactory final : public Math::VMathFactorySimple
{
public:
	VAnyNameFactory() { SetKeepsExpressions(false); }

	Math::VMathNodePointer GetVariable(std::string_view i_Name) override
	{
		return MakeVariable(i_Name, {1.0 + double(std::hash<std::string_view>()(i_Name) % 1000003) / 1000003});
	}
};

class VAnyValue final : public Math::IMathResult
{
public:
	void Receive(const Math::VMathNodePointer& i_rpNode) override { m_Value = Math::AsSimple(i_rpNode.get())->Value(); }

	double m_Value = 0.0;
};

std::optional<double> Value(const std::string& i_rText)
{
	VAnyNameFactory factory;
	VAnyValue result;
	std::string diagnostic;
	if (!Math::VMathParser(factory).Parse(i_rText, result, diagnostic))
		return std::nullopt;
	return result.m_Value;
}

std::string WithoutLastToken(const std::string& i_rText)
{
	Math::VMathCursor cursor(i_rText, ',');
	Math::VToken token;
	std::size_t end = 0;
	while (!cursor.AtEnd())
	{
		end = cursor.Position();
		cursor.Next(token);
	}
	return i_rText.substr(0, end);
}

/// The text as far as the parser heeds it; nothing if it does not parse.
std::optional<std::string> Heeded(const std::string& i_rText)
{
	const std::optional<double> value = Value(i_rText);
	if (!value)
		return std::nullopt;
	const auto standsInParentheses = [&](const std::string& i_rPart)
	{
		const std::optional<double> inParentheses = Value("(" + i_rPart + ")*1");
		return inParentheses && (*inParentheses == *value || (std::isnan(*inParentheses) && std::isnan(*value)));
	};
	if (standsInParentheses(i_rText))
		return i_rText;
	const std::string part = WithoutLastToken(i_rText);
	return standsInParentheses(part) ? std::optional(part) : std::nullopt;
}

} // namespace

std::optional<std::string> ScaledExpression(const std::string& i_rExpression, double i_Factor)
{
	double number = 0.0;
	if (i_rExpression.empty())
		return std::string();
	if (IsNumber(i_rExpression, number))
		return NumberText::PrintG17(number * i_Factor);
	const std::optional<std::string> heeded = Heeded(i_rExpression);
	if (!heeded)
		return std::nullopt;
	if (IsNumber(*heeded, number))
		return NumberText::PrintG17(number * i_Factor);
	const std::size_t length = ParenthesesAtStart(*heeded);
	if (length > 0 && length < heeded->size() && (*heeded)[length] == '*'
	    && IsNumber(std::string_view(*heeded).substr(length + 1), number))
		return heeded->substr(0, length + 1).append(NumberText::PrintG17(number * i_Factor));
	return "(" + *heeded + ")*" + NumberText::PrintG17(i_Factor);
}

} // namespace CoreOrlexTypesUtils
