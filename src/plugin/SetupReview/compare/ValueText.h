#pragma once

#include "CoreOrlexTypes/Fields.h"
#include "math/NumberText.h"

#include <charconv>
#include <cmath>
#include <string>
#include <type_traits>
#include <vector>

namespace SetupReview
{

inline std::string FixedText(double i_Value, int i_Decimals)
{
	char text[64];
	const auto end = std::to_chars(text, text + sizeof(text), i_Value, std::chars_format::fixed, i_Decimals);
	return end.ec == std::errc() ? std::string(text, end.ptr) : NumberText::PrintShortest(i_Value);
}

template <typename T>
inline constexpr bool c_bList = false;
template <typename T>
inline constexpr bool c_bList<std::vector<T>> = true;
template <typename T, std::size_t N>
inline constexpr bool c_bList<std::array<T, N>> = true;

/// Fields that hold elements, and those that hold fields. A colour is a value.
template <typename T>
inline constexpr bool c_bFields = CoreOrlexTypes::CRecord<T> && !std::is_same_v<T, CoreOrlexTypes::VColour>;
template <typename T>
inline constexpr bool c_bElements = false;
template <typename T>
inline constexpr bool c_bElements<std::vector<T>> = c_bFields<T>;

/// One that tells any two values apart that SameValue does.
template <typename T>
std::string ValueText(const T& i_rValue)
{
	if constexpr (std::is_same_v<T, bool>)
		return i_rValue ? "yes" : "no";
	else if constexpr (std::is_same_v<T, double>)
		return i_rValue == CoreOrlexTypes::c_NotSet ? "not set" : NumberText::PrintShortest(i_rValue);
	else if constexpr (std::is_same_v<T, std::string>)
		return "\"" + i_rValue + "\"";
	else if constexpr (std::is_same_v<T, CoreOrlexTypes::VColour>)
	{
		std::string text = "#";
		for (const std::uint8_t part : {i_rValue.m_Red, i_rValue.m_Green, i_rValue.m_Blue, i_rValue.m_Alpha})
			for (const int digit : {part / 16, part % 16})
				text += "0123456789abcdef"[digit];
		return text;
	}
	else if constexpr (CoreOrlexTypes::CEnumeration<T>)
	{
		const std::string_view name = CoreOrlexTypes::EnumeratorName(i_rValue);
		return name.empty() ? std::to_string(std::int32_t(i_rValue)) : std::string(name);
	}
	else if constexpr (c_bList<T>)
	{
		std::string text;
		for (const auto& rItem : i_rValue)
			text += (text.empty() ? "" : ", ") + ValueText(rItem);
		return "[" + text + "]";
	}
	else
		return std::to_string(i_rValue);
}

/// Two NaNs are the same.
template <typename T>
bool SameValue(const T& i_rLeft, const T& i_rRight)
{
	if constexpr (std::is_same_v<T, double>)
		return i_rLeft == i_rRight || (std::isnan(i_rLeft) && std::isnan(i_rRight));
	else if constexpr (c_bList<T>)
	{
		if (i_rLeft.size() != i_rRight.size())
			return false;
		for (std::size_t i = 0; i < i_rLeft.size(); ++i)
			if (!SameValue(i_rLeft[i], i_rRight[i]))
				return false;
		return true;
	}
	else
		return i_rLeft == i_rRight;
}

} // namespace SetupReview
