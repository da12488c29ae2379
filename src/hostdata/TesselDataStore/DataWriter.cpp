#include "TesselDataStore/DataWriter.h"

#include "TesselDataStore/StoredValue.h"

#include "TesselPluginInterface/IDataStore.h"

namespace TesselDataStore
{

using NVX::IO::VSchemaPointer;
using NVX::IO::VVariant;

VDataWriter::VDataWriter(std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore)
    : VDataReader(std::move(i_pDataStore), EAccess::EWrite)
{
}

bool VDataWriter::Set(const std::string& i_rKey, const VVariant& i_rValue)
{
	if (!IsOpen())
		return false;
	m_pDataStore->Set(i_rKey, i_rValue);
	return true;
}

bool VDataWriter::SetBool(const std::string& i_rKey, bool i_bValue)
{
	return Set(i_rKey, ToVariant(i_bValue));
}

bool VDataWriter::SetInt32(const std::string& i_rKey, std::int32_t i_Value)
{
	return Set(i_rKey, ToVariant(i_Value));
}

bool VDataWriter::SetUInt32(const std::string& i_rKey, std::uint32_t i_Value)
{
	return Set(i_rKey, ToVariant(i_Value));
}

bool VDataWriter::SetFloat64(const std::string& i_rKey, double i_Value)
{
	return Set(i_rKey, ToVariant(i_Value));
}

bool VDataWriter::SetString(const std::string& i_rKey, const std::string& i_rValue)
{
	return Set(i_rKey, ToVariant(i_rValue));
}

bool VDataWriter::SetPath(const std::string& i_rKey, const boost::filesystem::path& i_rValue)
{
	return Set(i_rKey, ToVariant(i_rValue));
}

bool VDataWriter::Remove(const std::string& i_rKey)
{
	return IsOpen() && m_pDataStore->Remove(i_rKey);
}

bool VDataVerifyWriter::Get(const std::string& i_rKey, const VSchemaPointer& i_rpSchema, VVariant& o_rValue) const
{
	return (!i_rpSchema || SameSchema(GetSchema(i_rKey), i_rpSchema)) && VDataWriter::Get(i_rKey, i_rpSchema, o_rValue);
}

bool VDataVerifyWriter::Set(const std::string& i_rKey, const VVariant& i_rValue)
{
	const VSchemaPointer pStored = GetSchema(i_rKey);
	return (!pStored || SameSchema(pStored, i_rValue.m_pSchema)) && VDataWriter::Set(i_rKey, i_rValue);
}

} // namespace TesselDataStore
