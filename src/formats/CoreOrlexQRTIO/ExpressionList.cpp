#include "CoreOrlexQRTIO/ExpressionList.h"

#include <algorithm>

namespace CoreOrlexQRTIO
{

std::string_view Trimmed(std::string_view i_Text)
{
	const std::size_t first = i_Text.find_first_not_of(" \t");
	if (first == std::string_view::npos)
		return {};
	return i_Text.substr(first, i_Text.find_last_not_of(" \t") + 1 - first);
}

std::vector<std::string_view> CutExpressions(std::string_view i_Text)
{
	std::vector<std::string_view> tokens;
	for (std::string_view rest = Trimmed(i_Text); !rest.empty();)
	{
		const std::size_t quote = rest.front() == '-' ? 1 : 0;
		std::size_t from = 0;
		if (quote < rest.size() && rest[quote] == '\'')
		{
			const std::size_t closing = rest.find('\'', quote + 1);
			if (closing != std::string_view::npos)
				from = closing + 1;
		}
		const std::size_t end = std::min(rest.find(' ', from), rest.size());
		tokens.push_back(rest.substr(0, end));
		rest.remove_prefix(std::min(rest.find_first_not_of(' ', end), rest.size()));
	}
	return tokens;
}

bool JoinExpressions(std::span<const std::string> i_Expressions, std::string& o_rText)
{
	o_rText.clear();
	bool bPlain = true;
	for (const std::string& rExpression : i_Expressions)
	{
		if (!o_rText.empty())
			o_rText += ' ';
		o_rText += rExpression.empty() ? "0" : rExpression;
		bPlain = bPlain && rExpression.find_first_of(" \t'") == std::string::npos;
	}
	if (bPlain)
		return true;
	return std::ranges::equal(CutExpressions(o_rText), i_Expressions,
	    [](std::string_view i_Token, const std::string& i_rExpression)
	    { return i_rExpression.empty() ? i_Token == "0" : i_Token == i_rExpression; });
}

} // namespace CoreOrlexQRTIO
