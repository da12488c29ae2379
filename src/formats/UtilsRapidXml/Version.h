#pragma once

#include <cstdint>
#include <string>

namespace UtilsRapidXml
{

/// A format version. A pair with a negative half is unset; an unset bound does not gate.
struct VVersion
{
	std::int32_t m_Major = -1;
	std::int32_t m_Minor = -1;

	constexpr bool IsSet() const { return m_Major >= 0 && m_Minor >= 0; }
	auto operator<=>(const VVersion&) const = default;
};

/// True if a file of this version has what is declared for i_Minimum..i_Maximum; everything is in range of an unset
/// version.
constexpr bool InRange(VVersion i_Version, VVersion i_Minimum, VVersion i_Maximum)
{
	return !i_Version.IsSet()
	    || ((!i_Minimum.IsSet() || i_Minimum <= i_Version) && (!i_Maximum.IsSet() || i_Version <= i_Maximum));
}

/// "major.minor".
std::string ToText(VVersion i_Version);

} // namespace UtilsRapidXml
