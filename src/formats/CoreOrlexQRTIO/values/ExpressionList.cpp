#include "CoreOrlexQRTIO/values/ExpressionList.h"

#include <algorithm>

namespace CoreOrlexQRTIO
{

std::string_view Trimmed(std::string_view i_Text)
{
	const auto isBlank = [](char i_Byte) { return i_Byte == ' ' || i_Byte == '\t'; };
	const auto first = std::ranges::find_if_not(i_Text, isBlank);
	const auto last = std::find_if_not(i_Text.rbegin(), std::make_reverse_iterator(first), isBlank).base();
	return {first, last};
}

std::string_view TakeExpression(std::string_view& io_rText)
{
	if (io_rText.empty())
		return {};
	const std::size_t quote = io_rText.front() == '-' ? 1 : 0;
	std::size_t from = 0;
	if (quote < io_rText.size() && io_rText[quote] == '\'')
	{
		const std::size_t closing = io_rText.find('\'', quote + 1);
		if (closing != std::string_view::npos)
			from = closing + 1;
	}
	const std::size_t end = std::min(io_rText.find(' ', from), io_rText.size());
	const std::string_view token = io_rText.substr(0, end);
	io_rText.remove_prefix(std::min(io_rText.find_first_not_of(' ', end), io_rText.size()));
	return token;
}

std::vector<std::string_view> CutExpressions(std::string_view i_Text)
{
	std::vector<std::string_view> tokens;
	for (std::string_view rest = Trimmed(i_Text); !rest.empty();)
		tokens.push_back(TakeExpression(rest));
	return tokens;
}

bool IsPlainNumber(std::string_view i_Text)
{
	if (i_Text.starts_with('-'))
		i_Text.remove_prefix(1);
	std::size_t digits = 0;
	for (const char byte : i_Text)
		if (byte >= '0' && byte <= '9')
			++digits;
		else if (byte != '.')
			return false;
	return digits > 0 && digits + 1 >= i_Text.size();
}

bool JoinExpressions(std::span<const std::string> i_Expressions, std::string& o_rText)
{
	const auto isSpecial = [](char i_Byte) { return i_Byte == ' ' || i_Byte == '\t' || i_Byte == '\''; };
	o_rText.clear();
	bool bPlain = true;
	for (const std::string& rExpression : i_Expressions)
	{
		if (!o_rText.empty())
			o_rText += ' ';
		o_rText += rExpression.empty() ? std::string_view("0") : rExpression;
		bPlain = bPlain && std::ranges::none_of(rExpression, isSpecial);
	}
	if (bPlain)
		return true;
	return std::ranges::equal(CutExpressions(o_rText), i_Expressions,
	    [](std::string_view i_Token, const std::string& i_rExpression)
	    { return i_rExpression.empty() ? i_Token == "0" : i_Token == i_rExpression; });
}

} // namespace CoreOrlexQRTIO
