#include "CoreOrlexQRTIO/AttributeReading.h"

#include "CoreOrlexQRTIO/ExpressionList.h"

#include <algorithm>

namespace CoreOrlexQRTIO
{

using Format::VAttribute;
using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;

bool ReadExpressions(INode& io_rNode, const VAttribute& i_rAttribute, std::span<std::string> o_Expressions)
{
	std::string text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	const std::vector<std::string_view> tokens = CutExpressions(text);
	if (tokens.size() != o_Expressions.size())
	{
		UtilsRapidXml::AddIncorrectCount(io_rNode, i_rAttribute.m_Name);
		return false;
	}
	std::ranges::copy(tokens, o_Expressions.begin());
	return true;
}

bool ReadReals(INode& io_rNode, const VAttribute& i_rAttribute, std::vector<double>& o_rValues)
{
	std::string text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	const std::vector<std::string_view> parts = UtilsRapidXml::SplitBlanks(text);
	std::vector<double> values(parts.size());
	for (std::size_t i = 0; i < parts.size(); ++i)
		if (!UtilsRapidXml::ToValue(parts[i], values[i]))
		{
			UtilsRapidXml::AddNotInterpreted(io_rNode, i_rAttribute.m_Name);
			return false;
		}
	o_rValues = std::move(values);
	return true;
}

bool ReadColour(INode& io_rNode, const VAttribute& i_rAttribute, CoreOrlexTypes::VColour& o_rColour)
{
	std::string text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	const std::vector<std::string_view> parts = UtilsRapidXml::SplitBlanks(text);
	if (parts.size() != 3)
	{
		UtilsRapidXml::AddIncorrectCount(io_rNode, i_rAttribute.m_Name);
		return false;
	}
	std::uint32_t values[3];
	for (int i = 0; i < 3; ++i)
		if (!UtilsRapidXml::ToValue(parts[i], values[i]))
		{
			UtilsRapidXml::AddNotInterpreted(io_rNode, i_rAttribute.m_Name);
			return false;
		}
	const auto component = [&](int i_Index) { return static_cast<std::uint8_t>(std::min(values[i_Index], 255u)); };
	o_rColour = {component(0), component(1), component(2), 255};
	return true;
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
