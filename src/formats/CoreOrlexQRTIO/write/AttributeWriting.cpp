#include "CoreOrlexQRTIO/write/AttributeWriting.h"

#include "CoreOrlexQRTIO/values/ExpressionList.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "math/NumberText.h"

#include <boost/format.hpp>

#include <algorithm>
#include <cmath>

namespace CoreOrlexQRTIO
{

using Format::VAttribute;
using UtilsRapidXml::VWriterNode;

namespace
{

void WriteRealList(
    VWriterNode& io_rNode, const VAttribute& i_rAttribute, std::span<const double> i_Values, bool i_bPlaceholders)
{
	if ((i_Values.empty() && !i_rAttribute.m_bRequired) || !IsInVersion(io_rNode, i_rAttribute))
		return;
	if (!std::ranges::all_of(i_Values, [](double i_Value) { return std::isfinite(i_Value); }))
		return AddNotStringified(io_rNode, i_rAttribute);
	io_rNode.WriteAttributeInPlace(i_rAttribute.m_Name,
	    [&](std::string& io_rText)
	    {
		    for (const double& rValue : i_Values)
		    {
			    if (&rValue != i_Values.data())
				    io_rText += ' ';
			    if (i_bPlaceholders && rValue == CoreOrlexTypes::c_NotSet)
				    io_rText += '*';
			    else
				    NumberText::AppendG17(io_rText, rValue);
		    }
	    });
}

} // namespace

void AddNotStringified(VWriterNode& io_rNode, const VAttribute& i_rAttribute)
{
	io_rNode.AddError((
	    boost::format("Could not stringify %1% node's %2% attribute value.") % io_rNode.GetName() % i_rAttribute.m_Name)
	                      .str());
}

bool IsInVersion(const VWriterNode& i_rNode, const VAttribute& i_rAttribute)
{
	return UtilsRapidXml::InRange(i_rNode.GetVersion(), i_rAttribute.m_Minimum, i_rAttribute.m_Maximum);
}

bool IsInVersion(const VWriterNode& i_rNode, const Format::VElement& i_rElement)
{
	return UtilsRapidXml::InRange(i_rNode.GetVersion(), i_rElement.m_Minimum, i_rElement.m_Maximum);
}

void WriteRaw(VWriterNode& io_rNode, const VAttribute& i_rAttribute, std::string_view i_Text)
{
	io_rNode.WriteAttribute(i_rAttribute.m_Name, i_Text, i_rAttribute.m_Minimum, i_rAttribute.m_Maximum);
}

void WriteText(VWriterNode& io_rNode, const VAttribute& i_rAttribute, std::string_view i_Text)
{
	const std::string_view text = Trimmed(i_Text);
	if (!text.empty() || i_rAttribute.m_bRequired)
		WriteRaw(io_rNode, i_rAttribute, text);
}

void WriteReal(VWriterNode& io_rNode, const VAttribute& i_rAttribute, double i_Value)
{
	WriteRealList(io_rNode, i_rAttribute, {&i_Value, 1}, false);
}

void WriteRealIfSet(VWriterNode& io_rNode, const VAttribute& i_rAttribute, double i_Value)
{
	if (i_Value != CoreOrlexTypes::c_NotSet)
		WriteReal(io_rNode, i_rAttribute, i_Value);
}

void WriteReals(VWriterNode& io_rNode, const VAttribute& i_rAttribute, std::span<const double> i_Values)
{
	WriteRealList(io_rNode, i_rAttribute, i_Values, false);
}

void WriteRealsWithPlaceholders(VWriterNode& io_rNode, const VAttribute& i_rAttribute, std::span<const double> i_Values)
{
	WriteRealList(io_rNode, i_rAttribute, i_Values, true);
}

void WriteBool(VWriterNode& io_rNode, const VAttribute& i_rAttribute, bool i_bValue)
{
	WriteRaw(io_rNode, i_rAttribute, i_bValue ? "true" : "false");
}

void WriteColour(VWriterNode& io_rNode, const VAttribute& i_rAttribute, const CoreOrlexTypes::VColour& i_rColour)
{
	if (i_rColour != CoreOrlexTypes::c_ColourZero)
		WriteRaw(io_rNode, i_rAttribute,
		    std::to_string(i_rColour.m_Red) + ' ' + std::to_string(i_rColour.m_Green) + ' '
		        + std::to_string(i_rColour.m_Blue));
}

void WriteExpressions(VWriterNode& io_rNode, const VAttribute& i_rAttribute, std::span<const std::string> i_Expressions)
{
	if (!IsInVersion(io_rNode, i_rAttribute)
	    || (!i_rAttribute.m_bRequired && std::ranges::all_of(i_Expressions, &std::string::empty)))
		return;
	std::string text;
	if (JoinExpressions(i_Expressions, text))
		return WriteRaw(io_rNode, i_rAttribute, text);
	const auto isCutApart = [](const std::string& i_rExpression)
	{
		const std::vector<std::string_view> tokens = CutExpressions(i_rExpression);
		return !i_rExpression.empty() && (tokens.size() != 1 || tokens.front() != i_rExpression);
	};
	const auto culprit = std::ranges::find_if(i_Expressions, isCutApart);
	io_rNode.AddError((boost::format("Node %1% attribute value %2% contains spaces.") % io_rNode.GetName()
	    % (culprit == i_Expressions.end() ? text : *culprit))
	                      .str());
}

} // namespace CoreOrlexQRTIO
