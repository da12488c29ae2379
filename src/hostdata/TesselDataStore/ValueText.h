#pragma once

#include "TesselDataStore/Limits.h"
#include "Variant/Variant.h"

namespace TesselDataStore
{

/// Shows a value to a person who looks for a fault: texts in double quotes, enumerations by their names, lists and
/// tuples in brackets, named tuples as name: value in braces. Bytes that do not fit the schema end the text with the
/// reason, and a text longer than i_MostBytes ends with dots.
std::string ValueText(const NVX::IO::VVariant& i_rValue, std::size_t i_MostBytes = c_MaxTextBytes);

} // namespace TesselDataStore
