#pragma once

#include "UtilsRapidXml/Attributes.h"

#include <string_view>

/// The names, types, doc strings and version bounds of the skeleton format, once for reader, schema and writer.
/// Attributes and elements stand in the order in which they are declared and written. The odd spellings of some doc
/// strings are part of the published schema.
namespace CoreOrlexQRTIO::Format
{

using UtilsRapidXml::VAttribute;
using UtilsRapidXml::VVersion;

struct VElement
{
	std::string_view m_Name;
	std::string_view m_Doc;
	std::uint32_t m_MinimumCount = 0;
	std::uint32_t m_MaximumCount = UtilsRapidXml::c_Unbounded;
	VVersion m_Minimum{};
	VVersion m_Maximum{};
};

inline constexpr std::string_view c_String = "xsd:string";
inline constexpr std::string_view c_Double = "xsd:double";
inline constexpr std::string_view c_Id = "xsd:ID";
inline constexpr std::string_view c_IdRef = "xsd:IDREF";

inline constexpr VVersion c_1_0{1, 0};
inline constexpr VVersion c_2_0{2, 0};
inline constexpr VVersion c_2_1{2, 1};
inline constexpr VVersion c_2_5{2, 5};
inline constexpr VVersion c_2_6{2, 6};
inline constexpr VVersion c_3_0{3, 0};
inline constexpr VVersion c_3_1{3, 1};
inline constexpr VVersion c_3_2{3, 2};
inline constexpr VVersion c_3_3{3, 3};
inline constexpr VVersion c_3_4{3, 4};
inline constexpr VVersion c_3_5{3, 5};

} // namespace CoreOrlexQRTIO::Format
