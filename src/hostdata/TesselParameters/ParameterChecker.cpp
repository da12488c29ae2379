#include "TesselParameters/ParameterChecker.h"

#include "TesselParameters/Attributes.h"
#include "TesselParameters/Enumeration.h"

#include "TesselDataStore/StoredValue.h"
#include "TesselPluginInterface/IDataReader.h"
#include "UtilsFileSystem/Paths.h"
#include "math/NumberText.h"

#include <boost/regex.hpp>

#include <algorithm>
#include <charconv>
#include <cmath>

namespace TesselParameters
{

using NVX::IO::VVariant;
using TesselPluginInterface::EValueKind;
using TesselPluginInterface::IDataReader;

namespace
{

std::string Print(bool i_bValue)
{
	return i_bValue ? "true" : "false";
}

std::string Print(std::int32_t i_Value)
{
	return std::to_string(i_Value);
}

std::string Print(std::uint32_t i_Value)
{
	return std::to_string(i_Value);
}

/// As short as reads back as the same number.
std::string Print(double i_Value)
{
	std::string text;
	double back = 0.0;
	for (const int digits : {15, 16})
	{
		text.clear();
		NumberText::AppendG(text, i_Value, digits);
		if (NumberText::ScanWholeReal(text, back) && back == i_Value)
			return text;
	}
	return NumberText::PrintG17(i_Value);
}

std::string Print(const std::string& i_rValue)
{
	return i_rValue;
}

std::string Print(const boost::filesystem::path& i_rValue)
{
	return UtilsFileSystem::ToUtf8(i_rValue);
}

bool Scan(const std::string& i_rText, bool& o_rbValue)
{
	o_rbValue = i_rText == "true" || i_rText == "1";
	return o_rbValue || i_rText == "false" || i_rText == "0";
}

template <std::integral T>
bool Scan(const std::string& i_rText, T& o_rValue)
{
	const char* const pEnd = i_rText.data() + i_rText.size();
	const auto [pRead, error] = std::from_chars(i_rText.data(), pEnd, o_rValue);
	return error == std::errc() && pRead == pEnd;
}

bool Scan(const std::string& i_rText, double& o_rValue)
{
	return NumberText::ScanWholeReal(i_rText, o_rValue) && std::isfinite(o_rValue);
}

bool Scan(const std::string& i_rText, std::string& o_rValue)
{
	o_rValue = i_rText;
	return true;
}

bool Scan(const std::string& i_rText, boost::filesystem::path& o_rValue)
{
	o_rValue = UtilsFileSystem::PathFromUtf8(i_rText);
	return true;
}

template <typename T>
constexpr EValueKind c_Kind = EValueKind::EInteger;
template <>
constexpr EValueKind c_Kind<bool> = EValueKind::EBool;
template <>
constexpr EValueKind c_Kind<double> = EValueKind::EReal;
template <>
constexpr EValueKind c_Kind<std::string> = EValueKind::EText;
template <>
constexpr EValueKind c_Kind<boost::filesystem::path> = EValueKind::EPath;

/// A limit of another schema, or one that was cut short, is none.
template <typename T>
bool ReadLimit(const IDataReader& i_rAttributes, const char* i_pKey, T& o_rLimit)
{
	VVariant value;
	return i_rAttributes.Get(i_pKey, TesselDataStore::SchemaOf<T>(), value)
	    && SameSchema(value.m_pSchema, TesselDataStore::SchemaOf<T>()) && TesselDataStore::FromVariant(value, o_rLimit);
}

/// "(?R)", "(?1)", "(?-1)", "(?&name)" or "(?P>name)": what a short one of these matches may take seconds to tell.
bool CallsItself(std::string_view i_Expression)
{
	static constexpr std::string_view c_Digits = "0123456789";
	for (std::size_t i = 0; i + 2 < i_Expression.size(); ++i)
	{
		if (i_Expression[i] == '\\')
			++i;
		// A set of letters, whose first may be the bracket that would close it.
		else if (i_Expression[i] == '[')
			i = std::min(i_Expression.find(']', i + 2), i_Expression.size());
		else if (i_Expression.substr(i, 2) == "(?")
		{
			std::string_view kind = i_Expression.substr(i + 2);
			if (kind.starts_with("R") || kind.starts_with("&") || kind.starts_with("P>"))
				return true;
			if (kind.starts_with("+") || kind.starts_with("-"))
				kind.remove_prefix(1);
			if (!kind.empty() && c_Digits.find(kind.front()) != c_Digits.npos)
				return true;
		}
	}
	return false;
}

bool Matches(const std::string& i_rText, const std::string& i_rExpression)
{
	if (CallsItself(i_rExpression))
		return false;
	try
	{
		return boost::regex_match(i_rText, boost::regex(i_rExpression));
	}
	catch (const std::runtime_error&)
	{
		// Either no expression, or one that takes too long on this text.
		return false;
	}
}

} // namespace

bool VParameterChecker::Accept(
    const std::string& i_rText, const IDataReader& i_rAttributes, VVariant& o_rValue, std::string& o_rMessage) const
{
	std::string expression;
	if (i_rAttributes.HasValue(AttributeKeys::c_ValidatorRegEx)
	    && i_rAttributes.GetString(AttributeKeys::c_ValidatorRegEx, expression) && !expression.empty()
	    && !Matches(i_rText, expression))
	{
		o_rMessage = "Value does not match the form \"" + expression + "\"";
		return false;
	}
	if (!FromText(i_rText, o_rValue))
	{
		switch (GetValueKind())
		{
		case EValueKind::EBool: o_rMessage = "Value is neither true nor false"; break;
		case EValueKind::EInteger: o_rMessage = "Value is not a whole number, or outside its range"; break;
		default: o_rMessage = "Value is not a number"; break;
		}
		return false;
	}
	return IsPermitted(o_rValue, i_rAttributes, o_rMessage);
}

template <typename T>
EValueKind VParameterCheckerTyped<T>::GetValueKind() const
{
	return c_Kind<T>;
}

template <typename T>
NVX::IO::VSchemaPointer VParameterCheckerTyped<T>::GetSchema() const
{
	return TesselDataStore::SchemaOf<T>();
}

template <typename T>
std::string VParameterCheckerTyped<T>::ToText(const VVariant& i_rValue) const
{
	T value{};
	return TesselDataStore::FromVariant(i_rValue, value) ? Print(value) : std::string();
}

template <typename T>
bool VParameterCheckerTyped<T>::FromText(const std::string& i_rText, VVariant& o_rValue) const
{
	T value{};
	if (!Scan(i_rText, value))
		return false;
	o_rValue = TesselDataStore::ToVariant(value);
	return true;
}

template <typename T>
bool VParameterCheckerTyped<T>::IsPermitted(
    const VVariant& i_rValue, const IDataReader& i_rAttributes, std::string& o_rMessage) const
{
	T value{};
	if (!TesselDataStore::FromVariant(i_rValue, value))
	{
		o_rMessage = "Value is of another type";
		return false;
	}
	T limit{};
	if (ReadLimit(i_rAttributes, AttributeKeys::c_Min, limit) && limit > value)
	{
		o_rMessage = "Value is less than permitted minimum";
		return false;
	}
	if (ReadLimit(i_rAttributes, AttributeKeys::c_Max, limit) && !(limit >= value))
	{
		o_rMessage = "Value is greater than permitted maximum";
		return false;
	}
	const std::vector<TesselPluginInterface::VEnumEntry> permitted = ReadEnumeration(i_rAttributes, GetSchema());
	if (!permitted.empty()
	    && std::none_of(permitted.begin(), permitted.end(),
	        [&i_rValue](const auto& i_rEntry) { return i_rEntry.m_Value == i_rValue; }))
	{
		o_rMessage = "Value is not one of the permitted values";
		return false;
	}
	return true;
}

template class VParameterCheckerTyped<bool>;
template class VParameterCheckerTyped<std::int32_t>;
template class VParameterCheckerTyped<std::uint32_t>;
template class VParameterCheckerTyped<double>;
template class VParameterCheckerTyped<std::string>;
template class VParameterCheckerTyped<boost::filesystem::path>;

} // namespace TesselParameters
