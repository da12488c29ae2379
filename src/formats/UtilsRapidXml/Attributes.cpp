#include "UtilsRapidXml/Attributes.h"

#include "math/NumberText.h"

#include <boost/container/small_vector.hpp>
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

std::string_view AfterSpace(std::string_view i_Text)
{
	return {std::find_if_not(i_Text.begin(), i_Text.end(), IsSpace), i_Text.end()};
}

/// Takes the next part off the text's front; empty at the end.
std::string_view TakePart(std::string_view& io_rText)
{
	io_rText = AfterSpace(io_rText);
	const auto stop = std::find_if(io_rText.begin(), io_rText.end(), IsSpace);
	const std::string_view part(io_rText.begin(), stop);
	io_rText = {stop, io_rText.end()};
	return part;
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
	std::string_view text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	if (ToValue(text, o_rValue))
		return true;
	AddNotInterpreted(io_rNode, i_rAttribute.m_Name);
	return false;
}

/// Takes the next real off the text's front, behind white space. The text is not cut first: lists of numbers are most
/// of a file.
bool TakeValue(std::string_view& io_rText, double& o_rValue)
{
	const std::size_t read = NumberText::ScanReal(io_rText, o_rValue);
	if (read == 0 || (read < io_rText.size() && !IsSpace(io_rText[read])) || !std::isfinite(o_rValue))
		return false;
	io_rText.remove_prefix(read);
	return true;
}

bool TakeValue(std::string_view& io_rText, std::int32_t& o_rValue)
{
	std::string_view rest = io_rText;
	if (!ToValue(TakePart(rest), o_rValue))
		return false;
	io_rText = rest;
	return true;
}

constexpr auto TakeReal = [](std::string_view& io_rText, std::size_t, double& o_rValue)
{ return TakeValue(io_rText, o_rValue); };

/// @param i_rTake takes a value off the text's front, or returns false without taking anything.
template <typename T, typename TTake>
bool ReadValues(
    INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, T* o_pValues, const TTake& i_rTake)
{
	std::string_view rest;
	if (!ReadAttribute(io_rNode, i_rAttribute, rest))
		return false;
	bool bAllTaken = true;
	std::size_t count = 0;
	while (!(rest = AfterSpace(rest)).empty())
	{
		if (count < i_Count && i_rTake(rest, count, o_pValues[count]))
			++count;
		else
		{
			TakePart(rest);
			bAllTaken = false;
			++count;
		}
	}
	if (count == i_Count && bAllTaken)
		return true;
	if (count != i_Count)
		AddIncorrectCount(io_rNode, i_rAttribute.m_Name);
	else
		AddNotInterpreted(io_rNode, i_rAttribute.m_Name);
	return false;
}

/// Values are gathered before the target is touched.
template <typename T, typename TTake>
bool ReadInto(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, std::vector<T>& io_rTarget,
    std::size_t i_Offset, const TTake& i_rTake)
{
	std::vector<T> values(i_Count);
	if (!ReadValues(io_rNode, i_rAttribute, i_Count, values.data(), i_rTake))
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

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::string_view& o_rValue)
{
	return io_rNode.ProcessAttribute(i_rAttribute.m_Name, o_rValue, i_rAttribute.m_Doc, i_rAttribute.m_SchemaType,
	    i_rAttribute.m_bRequired, i_rAttribute.m_Minimum, i_rAttribute.m_Maximum);
}

bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::string& o_rValue)
{
	std::string_view text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	o_rValue = text;
	return true;
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
	return ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset, TakeReal);
}

bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<std::int32_t>& io_rTarget, std::size_t i_Offset)
{
	return ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset,
	    [](std::string_view& io_rText, std::size_t, std::int32_t& o_rValue) { return TakeValue(io_rText, o_rValue); });
}

bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, double* o_pTarget)
{
	boost::container::small_vector<double, 9> values(i_Count);
	if (!ReadValues(io_rNode, i_rAttribute, i_Count, values.data(), TakeReal))
		return false;
	std::copy(values.begin(), values.end(), o_pTarget);
	return true;
}

bool ReadListWithPlaceholders(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<double>& io_rTarget, std::vector<bool>& o_rPlaceholders, std::size_t i_Offset)
{
	std::vector<bool> placeholders(i_Count);
	const auto take = [&](std::string_view& io_rText, std::size_t i_Index, double& o_rValue)
	{
		std::string_view rest = io_rText;
		const std::string_view part = TakePart(rest);
		if (part != "*" && part != "?")
			return TakeValue(io_rText, o_rValue);
		placeholders[i_Index] = true;
		o_rValue = std::numeric_limits<double>::max();
		io_rText = rest;
		return true;
	};
	if (!ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset, take))
		return false;
	o_rPlaceholders = std::move(placeholders);
	return true;
}

} // namespace UtilsRapidXml
