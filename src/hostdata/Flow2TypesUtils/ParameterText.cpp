#include "Flow2TypesUtils/ParameterText.h"

#include "math/NumberText.h"

#include <charconv>
#include <cmath>
#include <string_view>

namespace Flow2Utils
{

namespace
{

std::string_view WithoutLeadingSpace(std::string_view i_Text)
{
	return i_Text.substr(std::min(i_Text.find_first_not_of(" \t\n\v\f\r"), i_Text.size()));
}

template <typename T>
bool ReadWhole(std::string_view i_Text, T& o_rValue)
{
	T value{};
	const auto result = std::from_chars(i_Text.data(), i_Text.data() + i_Text.size(), value);
	if (result.ec != std::errc() || result.ptr != i_Text.data() + i_Text.size())
		return false;
	o_rValue = value;
	return true;
}

template <typename T>
bool ReadInteger(std::string_view i_Text, T& o_rValue)
{
	i_Text = WithoutLeadingSpace(i_Text);
	if (i_Text.size() > 1 && i_Text[0] == '+' && i_Text[1] != '-')
		i_Text.remove_prefix(1);
	return ReadWhole(i_Text, o_rValue);
}

} // namespace

std::string ToText(bool i_Value)
{
	return i_Value ? "true" : "false";
}

std::string ToText(std::int32_t i_Value)
{
	return std::to_string(i_Value);
}

std::string ToText(std::uint32_t i_Value)
{
	return std::to_string(i_Value);
}

std::string ToText(float i_Value)
{
	return ToText(double(i_Value));
}

std::string ToText(double i_Value)
{
	// In the spelling that can be read back.
	if (std::isnan(i_Value))
		return "nan";
	if (std::isinf(i_Value))
		return i_Value < 0 ? "-inf" : "inf";
	std::string text;
	NumberText::AppendG(text, i_Value, 9);
	return text;
}

bool FromText(const std::string& i_rText, bool& o_rValue)
{
	const bool bTrue = i_rText == "true" || i_rText == "1";
	if (!bTrue && i_rText != "false" && i_rText != "0")
		return false;
	o_rValue = bTrue;
	return true;
}

bool FromText(const std::string& i_rText, std::int32_t& o_rValue)
{
	return ReadInteger(i_rText, o_rValue);
}

bool FromText(const std::string& i_rText, std::uint32_t& o_rValue)
{
	return ReadInteger(i_rText, o_rValue);
}

bool FromText(const std::string& i_rText, float& o_rValue)
{
	double wide = 0.0;
	if (!NumberText::ScanWholeReal(i_rText, wide))
		return false;
	// Rounded once where possible: by way of a double, a few texts would give the float beside the nearest.
	if (!ReadWhole(WithoutLeadingSpace(i_rText), o_rValue))
		o_rValue = float(wide);
	return true;
}

bool FromText(const std::string& i_rText, double& o_rValue)
{
	return NumberText::ScanWholeReal(i_rText, o_rValue);
}

bool FromText(const std::string& i_rText, std::string& o_rValue)
{
	o_rValue = i_rText;
	return true;
}

} // namespace Flow2Utils
