#include "UtilsRapidXml/Attributes.h"

#include "math/NumberText.h"

#include <boost/container/small_vector.hpp>
#include <boost/format.hpp>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <span>

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
	while (!i_Text.empty() && IsSpace(i_Text.front()))
		i_Text.remove_prefix(1);
	return i_Text;
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

/// Takes an integer off the text's front, and the white space behind it.
/// @return how many values were taken.
std::size_t TakeInteger(std::string_view& io_rText, std::span<std::int32_t> o_Values)
{
	std::string_view rest = io_rText;
	if (!ToValue(TakePart(rest), o_Values.front()))
		return 0;
	io_rText = AfterSpace(rest);
	return 1;
}

/// @param i_rTake takes values off the text's front, which is no white space, as many as it can and there is room for,
/// and the white space behind them.
/// @return false, with an error added, if the text is not one value for each place.
template <typename T, typename TTake>
bool TakeValues(INode& io_rNode, const VAttribute& i_rAttribute, std::string_view i_Text, std::span<T> o_Values,
    const TTake& i_rTake)
{
	bool bAllTaken = true;
	std::size_t count = 0;
	for (std::string_view rest = AfterSpace(i_Text); !rest.empty();)
	{
		const std::size_t taken = count < o_Values.size() ? i_rTake(rest, o_Values.subspan(count)) : 0;
		count += taken;
		if (taken > 0)
			continue;
		TakePart(rest);
		rest = AfterSpace(rest);
		bAllTaken = false;
		++count;
	}
	if (count == o_Values.size() && bAllTaken)
		return true;
	if (count != o_Values.size())
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
	std::string_view text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	std::vector<T> values(i_Count);
	if (!TakeValues(io_rNode, i_rAttribute, text, std::span(values), i_rTake))
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
	return ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset, NumberText::ScanReals);
}

bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<std::int32_t>& io_rTarget, std::size_t i_Offset)
{
	return ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset, TakeInteger);
}

bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, double* o_pTarget)
{
	std::string_view text;
	if (!ReadAttribute(io_rNode, i_rAttribute, text))
		return false;
	boost::container::small_vector<double, 9> values(i_Count);
	if (!TakeValues(io_rNode, i_rAttribute, text, std::span(values.data(), i_Count), NumberText::ScanReals))
		return false;
	std::copy(values.begin(), values.end(), o_pTarget);
	return true;
}

bool ReadListWithPlaceholders(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<double>& io_rTarget, std::vector<bool>& o_rPlaceholders, std::size_t i_Offset)
{
	std::vector<bool> placeholders;
	const auto take = [&](std::string_view& io_rText, std::span<double> o_Values)
	{
		std::string_view rest = io_rText;
		const std::string_view part = TakePart(rest);
		if (part != "*" && part != "?")
			return NumberText::ScanReals(io_rText, o_Values);
		placeholders.resize(i_Count);
		placeholders[i_Count - o_Values.size()] = true;
		o_Values.front() = std::numeric_limits<double>::max();
		io_rText = AfterSpace(rest);
		return std::size_t(1);
	};
	if (!ReadInto(io_rNode, i_rAttribute, i_Count, io_rTarget, i_Offset, take))
		return false;
	placeholders.resize(i_Count);
	o_rPlaceholders = std::move(placeholders);
	return true;
}

} // namespace UtilsRapidXml
