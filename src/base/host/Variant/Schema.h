#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace NVX::IO
{

/// Supported types.
enum class EType : std::uint8_t
{
	EVoid,
	EBool,
	EInt8,
	EInt16,
	EInt32,
	EInt64,
	EUInt8,
	EUInt16,
	EUInt32,
	EUInt64,
	EFloat32,
	EFloat64,
	EString,
	EArray,
	EList,
	ETuple,
	ENamedTuple,
	EEnum8,
	EEnum16,
	EEnum32
};

/// The role of the type represented by the schema.
enum class ERole : std::uint8_t
{
	EValue,
	EFunction,
	ECallback,
	EInput,
	EInputOutput,
	EOutput,
	EReturn,
	EResult
};

struct ISchema;
using VSchemaPointer = std::shared_ptr<const ISchema>;

/// A member of a tuple or an enumerator.
struct VSchemaChild
{
	std::string m_Name;
	std::string m_Doc;
	/// Of an enumerator.
	std::int64_t m_Value = 0;
	/// Of a member; null for an enumerator.
	VSchemaPointer m_pSchema;
};

/// Tells what typed bytes mean. Plain values; those that GetUniquePodSchema and GetUniqueSchema hand out are shared,
/// and equal ones of them are one instance, so that they compare by pointer.
struct ISchema
{
	EType m_Type = EType::EVoid;
	ERole m_Role = ERole::EValue;
	/// Elements of an array.
	std::uint32_t m_Count = 0;
	/// Of the elements of an array or a list; null for all other types.
	VSchemaPointer m_pSubSchema;
	std::string m_Name;
	std::string m_Doc;
	/// Members of a tuple, enumerators of an enumeration.
	std::vector<VSchemaChild> m_Children;
};

/// By value through all levels; names and documentation take part.
bool operator==(const VSchemaChild& i_rLeft, const VSchemaChild& i_rRight);
bool operator==(const ISchema& i_rLeft, const ISchema& i_rRight);

/// By value; two null pointers are equal.
bool SameSchema(const VSchemaPointer& i_rpLeft, const VSchemaPointer& i_rpRight);

/// The shared schema of a plain type: from EVoid to EString. Null for others, which need more to be told.
const VSchemaPointer& GetUniquePodSchema(EType i_Type);

/// The one shared instance that equals the given schema. It lives as long as somebody holds it. Thread safe.
VSchemaPointer GetUniqueSchema(const ISchema& i_rSchema);

/// Bytes of a value of a type without parts: plain types but the text, and enumerations. 0 for all others.
std::size_t SizeOf(EType i_Type);

/// The schema of a list, or of an array with a fixed count of elements.
VSchemaPointer ListSchema(VSchemaPointer i_pElement);
VSchemaPointer ArraySchema(VSchemaPointer i_pElement, std::uint32_t i_Count);

/// The descriptions of the two enumerations above: "Schema.EType" and "Schema.ERole", as 8-bit enumerations.
const VSchemaPointer& TypeEnumerationSchema();
const VSchemaPointer& RoleEnumerationSchema();

/// "Float64". Empty for a value outside the enumeration.
std::string_view TypeName(EType i_Type);

} // namespace NVX::IO
