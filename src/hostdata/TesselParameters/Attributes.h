#pragma once

#include "Variant/Schema.h"

namespace TesselParameters
{

/// Where a parameter or a group keeps its attributes.
namespace AttributeKeys
{
inline constexpr const char* c_Category = "Attributes/Category";
inline constexpr const char* c_Display = "Attributes/Display";
inline constexpr const char* c_Description = "Attributes/Description";
inline constexpr const char* c_PresentationHint = "Attributes/PresentationHint";
inline constexpr const char* c_DataConversionHint = "Attributes/DataConversionHint";
inline constexpr const char* c_FileAccess = "Attributes/FileAccess";
inline constexpr const char* c_FileFilter = "Attributes/FileFilter";
inline constexpr const char* c_ValidatorRegEx = "Attributes/ValidatorRegEx";
inline constexpr const char* c_Hidden = "Attributes/Hidden";
inline constexpr const char* c_Advanced = "Attributes/Advanced";
inline constexpr const char* c_Dynamic = "Attributes/Dynamic";
inline constexpr const char* c_Default = "Attributes/Default";
inline constexpr const char* c_Min = "Attributes/Min";
inline constexpr const char* c_Max = "Attributes/Max";
/// A list of (Name, Value).
inline constexpr const char* c_Enum = "Attributes/Enum";
} // namespace AttributeKeys

/// The named tuple of all attributes, in the order above, of a parameter whose values have the given schema.
NVX::IO::VSchemaPointer AttributesSchema(const NVX::IO::VSchemaPointer& i_rpValue);

/// Of the list under c_Enum.
NVX::IO::VSchemaPointer EnumerationSchema(const NVX::IO::VSchemaPointer& i_rpValue);

} // namespace TesselParameters
