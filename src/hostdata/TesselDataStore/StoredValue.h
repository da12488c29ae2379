#pragma once

#include "Variant/Variant.h"

#include <boost/filesystem/path.hpp>

#include <string>

/// Values of C++ types as typed bytes. This is for: bool, the sized integers, float, double, std::string, which may
/// hold any bytes, boost::filesystem::path, which is stored as UTF-8 text, and the subject types VSubject,
/// VSubjectParametrised, VSubjectApplicationData and VSubjectRecord of CoreOrlexTypes. Other types that
/// CoreOrlexTypes/Fields.h can describe join by StoredValueOfFields.h.
namespace TesselDataStore
{

template <typename T>
const NVX::IO::VSchemaPointer& SchemaOf();

template <typename T>
NVX::IO::VVariant ToVariant(const T& i_rValue);

inline NVX::IO::VVariant ToVariant(const char* i_pText)
{
	return ToVariant(std::string(i_pText));
}

/// Reads a value by the schema that came with it. Named tuples match by the names of their members: those that T does
/// not have are stepped over, those that are missing keep the value of a new T. Enumerations match by the names of
/// their enumerators. All else must be of the same type.
/// @return false, with the value untouched, if the bytes are no such value, or bytes are missing or left over.
template <typename T>
[[nodiscard]] bool FromVariant(const NVX::IO::VVariant& i_rVariant, T& io_rValue);

template <>
const NVX::IO::VSchemaPointer& SchemaOf<boost::filesystem::path>();
template <>
NVX::IO::VVariant ToVariant(const boost::filesystem::path& i_rValue);
template <>
bool FromVariant(const NVX::IO::VVariant& i_rVariant, boost::filesystem::path& io_rValue);

} // namespace TesselDataStore
