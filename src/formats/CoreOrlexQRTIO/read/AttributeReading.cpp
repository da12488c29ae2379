#include "CoreOrlexQRTIO/read/AttributeReading.h"

#include "CoreOrlexQRTIO/values/ExpressionList.h"

#include "math/NumberText.h"

#include <boost/container/small_vector.hpp>

#include <algorithm>
#include <array>

namespace CoreOrlexQRTIO
{

using Format::VAttribute;
using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;

namespace
{

/// What stands between the values of a list, in the C form.
bool IsWhite(char i_Byte)
{
	return i_Byte == ' ' || (i_Byte >= '\t' && i_Byte <= '\r');
}

std::string_view AfterWhite(std::string_view i_Text)
{
	return {std::ranges::find_if_not(i_Text, IsWhite), i_Text.end()};
}

} // namespace

bool ReadExpressions(INode& io_rNode, const VAttribute& i_rAttribute, std::span<std::string> o_Expressions)
{
	std::string_view text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	boost::container::small_vector<std::string_view, 9> expressions;
	std::size_t count = 0;
	for (std::string_view rest = Trimmed(text); !rest.empty(); ++count)
	{
		const std::string_view expression = TakeExpression(rest);
		if (count < o_Expressions.size())
			expressions.push_back(expression);
	}
	if (count != o_Expressions.size())
	{
		UtilsRapidXml::AddIncorrectCount(io_rNode, i_rAttribute.m_Name);
		return false;
	}
	std::ranges::copy(expressions, o_Expressions.begin());
	return true;
}

bool ReadReals(INode& io_rNode, const VAttribute& i_rAttribute, std::vector<double>& o_rValues)
{
	std::string_view rest;
	if (!ReadAttribute(io_rNode, i_rAttribute, rest))
		return false;
	std::vector<double> values;
	std::array<double, 9> some;
	while (const std::size_t count = NumberText::ScanReals(rest, some))
		values.insert(values.end(), some.begin(), some.begin() + count);
	if (!rest.empty())
	{
		UtilsRapidXml::AddNotInterpreted(io_rNode, i_rAttribute.m_Name);
		return false;
	}
	o_rValues = std::move(values);
	return true;
}

bool ReadColour(INode& io_rNode, const VAttribute& i_rAttribute, CoreOrlexTypes::VColour& o_rColour)
{
	std::string_view rest;
	if (!ReadAttribute(io_rNode, i_rAttribute, rest))
		return false;
	std::uint8_t values[3];
	std::size_t count = 0;
	bool bConverted = true;
	for (; !(rest = AfterWhite(rest)).empty(); ++count)
	{
		const std::size_t end = std::ranges::find_if(rest, IsWhite) - rest.begin();
		std::uint32_t value = 0;
		bConverted = bConverted && UtilsRapidXml::ToValue(rest.substr(0, end), value);
		if (count < 3)
			values[count] = static_cast<std::uint8_t>(std::min(value, 255u));
		rest.remove_prefix(end);
	}
	if (count == 3 && bConverted)
	{
		o_rColour = {values[0], values[1], values[2], 255};
		return true;
	}
	(count == 3 ? UtilsRapidXml::AddNotInterpreted : UtilsRapidXml::AddIncorrectCount)(io_rNode, i_rAttribute.m_Name);
	return false;
}

bool ReadOpacity(INode& io_rNode, const VAttribute& i_rAttribute, std::uint8_t& o_rAlpha)
{
	double opacity = 0.0;
	if (!ReadAttribute(io_rNode, i_rAttribute, opacity))
		return false;
	o_rAlpha = static_cast<std::uint8_t>(std::clamp(opacity, 0.0, 255.0));
	return true;
}

bool ReadHidden(INode& io_rNode, const VAttribute& i_rAttribute, bool& o_rVisible)
{
	bool bHidden = false;
	if (!ReadAttribute(io_rNode, i_rAttribute, bHidden))
		return false;
	o_rVisible = !bHidden;
	return true;
}

} // namespace CoreOrlexQRTIO
