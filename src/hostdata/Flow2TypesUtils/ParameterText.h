#pragma once

#include <cstdint>
#include <string>

/// The text form of a flow parameter's value, always in the C form.
namespace Flow2Utils
{

std::string ToText(bool i_Value);
std::string ToText(std::int32_t i_Value);
std::string ToText(std::uint32_t i_Value);
/// Nine significant digits, for both.
std::string ToText(float i_Value);
std::string ToText(double i_Value);
inline const std::string& ToText(const std::string& i_rValue)
{
	return i_rValue;
}

/// Numbers may have white space in front; nothing may stand behind them.
/// @return false, with the value untouched, if the whole text is no value of the type.
bool FromText(const std::string& i_rText, bool& o_rValue);
bool FromText(const std::string& i_rText, std::int32_t& o_rValue);
bool FromText(const std::string& i_rText, std::uint32_t& o_rValue);
bool FromText(const std::string& i_rText, float& o_rValue);
bool FromText(const std::string& i_rText, double& o_rValue);
bool FromText(const std::string& i_rText, std::string& o_rValue);

} // namespace Flow2Utils
