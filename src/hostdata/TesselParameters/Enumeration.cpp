#include "TesselParameters/Enumeration.h"

#include "TesselParameters/Attributes.h"

#include "TesselDataStore/BinaryWriter.h"
#include "TesselDataStore/SkipReaders.h"
#include "TesselPluginInterface/IDataReader.h"

#include <algorithm>

namespace TesselParameters
{

using NVX::IO::VVariant;
using TesselPluginInterface::VEnumEntry;

std::vector<VEnumEntry> ReadEnumeration(
    const TesselPluginInterface::IDataReader& i_rAttributes, const NVX::IO::VSchemaPointer& i_rpValue)
{
	std::vector<VEnumEntry> entries;
	if (!i_rAttributes.HasValue(AttributeKeys::c_Enum))
		return entries;
	const NVX::IO::VSchemaPointer pSchema = EnumerationSchema(i_rpValue);
	VVariant list;
	if (!i_rAttributes.Get(AttributeKeys::c_Enum, pSchema, list) || !SameSchema(list.m_pSchema, pSchema))
		return entries;

	// The list was written by EnumerationToVariant: its bytes are whole.
	const NVX::IO::VSkipReader pSkipValue = NVX::IO::MakeSkipReader(*i_rpValue);
	NVX::IO::VBinaryReader bytes(list.m_Bytes);
	entries.resize(bytes.Number<std::uint32_t>());
	for (VEnumEntry& rEntry : entries)
	{
		std::string_view name;
		(void)bytes.Text(name);
		rEntry.m_Name = name;
		const std::size_t begin = bytes.Position();
		(void)pSkipValue->Read(bytes, nullptr);
		rEntry.m_Value = {i_rpValue, list.m_Bytes.substr(begin, bytes.Position() - begin)};
	}
	return entries;
}

bool EnumerationToVariant(
    const std::vector<VEnumEntry>& i_rEntries, const NVX::IO::VSchemaPointer& i_rpValue, VVariant& o_rVariant)
{
	if (!std::all_of(i_rEntries.begin(), i_rEntries.end(),
	        [&](const VEnumEntry& i_rEntry) { return SameSchema(i_rEntry.m_Value.m_pSchema, i_rpValue); }))
		return false;
	o_rVariant = {EnumerationSchema(i_rpValue), {}};
	NVX::IO::VBinaryWriter bytes(o_rVariant.m_Bytes);
	bytes.Count(i_rEntries.size());
	for (const VEnumEntry& rEntry : i_rEntries)
	{
		bytes.Text(rEntry.m_Name);
		o_rVariant.m_Bytes += rEntry.m_Value.m_Bytes;
	}
	return true;
}

} // namespace TesselParameters
