#include "UtilsRapidXml/Attributes.h"

#include "math/NumberText.h"

#include <boost/format.hpp>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>

namespace UtilsRapidXml
{
namespace
{

bool IsSpace(char i_Byte)
{
	return i_Byte == ' ' || (i_Byte >= '\t' && i_Byte <= '\r');
}

/// Takes the next part off the text's front; empty at the end.
std::string_view TakePart(std::string_view& io_rText)
{
	const char* const pEnd = io_rText.data() + io_rText.size();
	const char* const pBegin = std::find_if_not(io_rText.data(), pEnd, IsSpace);
	const char* const pStop = std::find_if(pBegin, pEnd, IsSpace);
	io_rText = {pStop, pEnd};
	return {pBegin, pStop};
}

std::size_t CountParts(std::string_view i_Text)
{
	std::size_t count = 0;
	while (!TakePart(i_Text).empty())
		++count;
	return count;
}

template <typename T>
bool ToInteger(std::string_view i_Text, T& o_rValue)
{
	const char* const pEnd = i_Text.data() + i_Text.size();
	const char* p = std::find_if_not(i_Text.data(), pEnd, IsSpace);
	if (p != pEnd && *p == '+' && p + 1 != pEnd && p[1] != '-')
		++p;
	T value = 0;
	const auto result = std::from_chars(p, pEnd, value);
	if (result.ec != std::errc() || result.ptr != pEnd)
		return false;
	o_rValue = value;
	return true;
}

template <typename T>
bool ReadSingle(INode& io_rNode, const VAttribute& i_rAttribute, T& o_rValue)
{
	std::string text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	if (ToValue(text, o_rValue))
		return true;
	AddNotInterpreted(io_rNode, i_rAttribute.m_Name);
	return false;
}

/// @param i_rConvert called with each part and its index; false if the part does not convert.
template <typename TConvert>
bool ReadParts(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, const TConvert& i_rConvert)
{
	std::string text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	if (CountParts(text) != i_Count)
	{
		AddIncorrectCount(io_rNode, i_rAttribute.m_Name);
		return false;
	}
	std::string_view rest = text;
	for (std::size_t i = 0; i < i_Count; ++i)
		if (!i_rConvert(TakePart(rest), i))
		{
			AddNotInterpreted(io_rNode, i_rAttribute.m_Name);
			return false;
		}
	return true;
}

/// Values are gathered before the target is touched.
template <typename T, typename TConvert>
bool ReadInto(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, std::vector<T>& io_rTarget,
    std::size_t i_Offset, const TConvert& i_rConvert)
{
	std::vector<T> values(i_Count);
	if (!ReadParts(io_rNode, i_rAttribute, i_Count,
	        [&](std::string_view i_Part, std::size_t i_Index) { return i_rConvert(i_Part, i_Index, values[i_Index]); }))
		return false;
	if (i_Offset == 0 && io_rTarget.size() <= i_Count)
	{
		io_rTarget = std::move(values);
		return true;
	}
	io_rTarget.resize(std::max(io_rTarget.size(), i_Offset + i_Count));
	std::copy(values.begin(), values.end(), io_rTarget.begin() + i_Offset);
	return true;
}

} // namespace

bool ToValue(std::string_view i_Text, double& o_rValue)
{
	double value = 0.0;
	if (!NumberText::ScanWholeReal(i_Text, value) || !std::isfinite(value))
		return false;
	o_rValue = value;
	return true;
}

bool ToValue(std::string_view i_Text, std::int32_t& o_rValue)
{
	return ToInteger(i_Text, o_rValue);
}

bool ToValue(std::string_view i_Text, std::uint32_t& o_rValue)
{
	return ToInteger(i_Text, o_rValue);
}

bool ToValue(std::string_view i_Text, std::uint8_t& o_rValue)
{
	return ToInteger(i_Text, o_rValue);
}

bool ToValue(std::string_view i_Text, bool& o_rValue)
{
	if (i_Text != "true" && i_Text != "false")
		return false;
	o_rValue = i_Text == "true";
	return true;
}

bool ToValue(std::string_view i_Text, VVersion& o_rValue)
{
	const std::size_t dot = i_Text.find('.');
	if (dot == std::string_view::npos || i_Text.find_first_not_of("0123456789.") != std::string_view::npos)
		return false;
	VVersion version;
	if (!ToInteger(i_Text.substr(0, dot), version.m_Major) || !ToInteger(i_Text.substr(dot + 1), version.m_Minor))
		return false;
	o_rValue = version;
	return true;
}

std::vector<std::string_view> SplitBlanks(std::string_view i_Text)
{
	std::vector<std::string_view> parts;
	for (std::string_view part = TakePart(i_Text); !part.empty(); part = TakePart(i_Text))
		parts.push_back(part);
	return parts;
}

void AddNotInterpreted(INode& io_rNode, std::string_view i_Attribute)
{
	io_rNode.AddError(
	    (boost::format("%1% node's %2% attribute could not be interpreted") % io_rNode.GetName() % i_Attribute).str());
}

void AddIncorrectCount(INode& io_rNode, std::string_view i_Attribute)
{
	io_rNode.AddError((
	    boost::format("%1% node's %2% attribute had incorrect number of components") % io_rNode.GetName() % i_Attribute)
	                      .str());
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::string& o_rValue)
{
	return io_rNode.ProcessAttribute(i_rAttribute.m_Name, o_rValue, i_rAttribute.m_Doc, i_rAttribute.m_SchemaType,
	    i_rAttribute.m_bRequired, i_rAttribute.m_Minimum, i_rAttribute.m_Maximum);
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, double& o_rValue)
{
	return ReadSingle(io_rNode, i_rAttribute, o_rValue);
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::int32_t& o_rValue)
{
	return ReadSingle(io_rNode, i_rAttribute, o_rValue);
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::uint32_t& o_rValue)
{
	return ReadSingle(io_rNode, i_rAttribute, o_rValue);
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::uint8_t& o_rValue)
{
	return ReadSingle(io_rNode, i_rAttribute, o_rValue);
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, bool& o_rValue)
{
	return ReadSingle(io_rNode, i_rAttribute, o_rValue);
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, VVersion& o_rValue)
{
	return ReadSingle(io_rNode, i_rAttribute, o_rValue);
}

bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, std::vector<double>& io_rTarget,
    std::size_t i_Offset)
{
	return ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset,
	    [](std::string_view i_Part, std::size_t, double& o_rValue) { return ToValue(i_Part, o_rValue); });
}

bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<std::int32_t>& io_rTarget, std::size_t i_Offset)
{
	return ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset,
	    [](std::string_view i_Part, std::size_t, std::int32_t& o_rValue) { return ToValue(i_Part, o_rValue); });
}

bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, double* o_pTarget)
{
	std::vector<double> values;
	if (!ReadList(io_rNode, i_rAttribute, i_Count, values))
		return false;
	std::copy(values.begin(), values.end(), o_pTarget);
	return true;
}

bool ReadListWithPlaceholders(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<double>& io_rTarget, std::vector<bool>& o_rPlaceholders, std::size_t i_Offset)
{
	std::vector<bool> placeholders(i_Count);
	const auto convert = [&](std::string_view i_Part, std::size_t i_Index, double& o_rValue)
	{
		if (i_Part != "*" && i_Part != "?")
			return ToValue(i_Part, o_rValue);
		placeholders[i_Index] = true;
		o_rValue = std::numeric_limits<double>::max();
		return true;
	};
	if (!ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset, convert))
		return false;
	o_rPlaceholders = std::move(placeholders);
	return true;
}

} // namespace UtilsRapidXml
