#pragma once

#include "TesselPluginInterface/IParameter.h"

namespace TesselPluginInterface
{
class IDataReader;
}

namespace TesselParameters
{

/// The permitted values among attributes; none if there is no such list for values of the schema.
std::vector<TesselPluginInterface::VEnumEntry> ReadEnumeration(
    const TesselPluginInterface::IDataReader& i_rAttributes, const NVX::IO::VSchemaPointer& i_rpValue);

/// @return false, with nothing made, if a value is of another schema.
bool EnumerationToVariant(const std::vector<TesselPluginInterface::VEnumEntry>& i_rEntries,
    const NVX::IO::VSchemaPointer& i_rpValue, NVX::IO::VVariant& o_rVariant);

} // namespace TesselParameters
