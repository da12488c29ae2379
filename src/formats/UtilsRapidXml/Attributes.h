#pragma once

#include "UtilsRapidXml/Node.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

namespace UtilsRapidXml
{

/// How an attribute stands in the format.
struct VAttribute
{
	std::string_view m_Name;
	std::string_view m_Doc;
	std::string_view m_SchemaType = "xsd:string";
	bool m_bRequired = false;
	VVersion m_Minimum = {};
	VVersion m_Maximum = {};
};

/// @name Text to value, without any locale. Each takes the whole text or nothing, and leaves the value alone then.
/// @{
/// As the scan format "%lf" reads, but a result that is not finite does not convert; 1e-400 is 0.
bool ToValue(std::string_view i_Text, double& o_rValue);
/// Decimal, with leading white space and a sign; a number outside of the type does not convert.
bool ToValue(std::string_view i_Text, std::int32_t& o_rValue);
bool ToValue(std::string_view i_Text, std::uint32_t& o_rValue);
bool ToValue(std::string_view i_Text, std::uint8_t& o_rValue);
/// "true" or "false".
bool ToValue(std::string_view i_Text, bool& o_rValue);
/// "major.minor", both decimal without a sign.
bool ToValue(std::string_view i_Text, VVersion& o_rValue);
/// @}

/// The parts between white space; they point into the text.
std::vector<std::string_view> SplitBlanks(std::string_view i_Text);

/// Adds "%1% node's %2% attribute could not be interpreted".
void AddNotInterpreted(INode& io_rNode, std::string_view i_Attribute);
/// Adds "%1% node's %2% attribute had incorrect number of components".
void AddIncorrectCount(INode& io_rNode, std::string_view i_Attribute);

/// All readers below return true if the attribute was present and converted; otherwise the value is left as it was,
/// and a text that does not convert has added an error.

/// The text as it stands in the document, which must outlive it.
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::string_view& o_rValue);
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::string& o_rValue);
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, double& o_rValue);
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::int32_t& o_rValue);
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::uint32_t& o_rValue);
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, std::uint8_t& o_rValue);
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, bool& o_rValue);
bool ReadAttribute(INode& io_rNode, const VAttribute& i_rAttribute, VVersion& o_rValue);

/// The table's name is the schema type, whatever the attribute says. The table is declared and must outlive the
/// document.
template <typename T>
bool ReadAttribute(INode& io_rNode, VAttribute i_Attribute, const VEnum<T>& i_rEnum, std::type_identity_t<T>& o_rValue)
{
	io_rNode.DeclareEnum(i_rEnum);
	i_Attribute.m_SchemaType = i_rEnum.GetName();
	std::string_view text;
	if (!ReadAttribute(io_rNode, i_Attribute, text))
		return false;
	if (i_rEnum.ToValue(text, o_rValue))
		return true;
	AddNotInterpreted(io_rNode, i_Attribute.m_Name);
	return false;
}

/// A list of exactly i_Count numbers between white space, put into io_rTarget from i_Offset on; the target grows as
/// needed.
bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, std::vector<double>& io_rTarget,
    std::size_t i_Offset = 0);
bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<std::int32_t>& io_rTarget, std::size_t i_Offset = 0);

/// The same into an array of the caller's that has room for i_Count values.
bool ReadList(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count, double* o_pTarget);

/// A list in which "*" and "?" stand for a value that is not given: the largest finite double in the target, and true
/// in o_rPlaceholders, which gets i_Count entries.
bool ReadListWithPlaceholders(INode& io_rNode, const VAttribute& i_rAttribute, std::size_t i_Count,
    std::vector<double>& io_rTarget, std::vector<bool>& o_rPlaceholders, std::size_t i_Offset = 0);

} // namespace UtilsRapidXml
