#include "TesselDataStore/DataReader.h"

#include "TesselDataStore/TypedGet.h"

#include "DebugServices/Assert.h"
#include "TesselPluginInterface/IDataStore.h"

namespace TesselDataStore
{

using NVX::IO::VSchemaPointer;
using NVX::IO::VVariant;

void TellOtherType(const std::string& i_rKey)
{
	NVX_LOG("Store", NVX::ELogError,
	    "Failed getting value for store entry '%1%': the requested value type does not match the store value type.",
	    i_rKey);
}

VDataReader::VDataReader(std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore)
    : VDataReader(std::move(i_pDataStore), EAccess::ERead)
{
}

VDataReader::VDataReader(std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore, EAccess i_Access)
    : m_pDataStore(std::move(i_pDataStore)), m_Access(i_Access)
{
	if (!IsOpen())
		return;
	if (m_Access == EAccess::ERead)
		m_pDataStore->LockRead();
	else if (!m_pDataStore->LockWrite())
		m_pDataStore.reset();
}

VDataReader::~VDataReader()
{
	if (!m_pDataStore)
		return;
	if (m_Access == EAccess::ERead)
		m_pDataStore->UnlockRead();
	else
		m_pDataStore->UnlockWrite();
}

bool VDataReader::IsOpen() const
{
	NVX_ASSERT(m_pDataStore != nullptr);
	return m_pDataStore != nullptr;
}

bool VDataReader::HasEntry(const std::string& i_rKey) const
{
	return IsOpen() && m_pDataStore->Find(i_rKey);
}

bool VDataReader::HasValue(const std::string& i_rKey) const
{
	const VVariant* const pEntry = IsOpen() ? m_pDataStore->Find(i_rKey) : nullptr;
	return pEntry && !pEntry->IsEmpty();
}

VSchemaPointer VDataReader::GetSchema(const std::string& i_rKey) const
{
	const VVariant* const pEntry = IsOpen() ? m_pDataStore->Find(i_rKey) : nullptr;
	return pEntry ? pEntry->m_pSchema : VSchemaPointer();
}

std::vector<std::string> VDataReader::GetKeys(const std::string& i_rPrefix) const
{
	return IsOpen() ? m_pDataStore->GetKeys(i_rPrefix) : std::vector<std::string>();
}

bool VDataReader::Get(const std::string& i_rKey, const VSchemaPointer&, VVariant& o_rValue) const
{
	const VVariant* const pEntry = IsOpen() ? m_pDataStore->Find(i_rKey) : nullptr;
	if (pEntry)
		o_rValue = *pEntry;
	return pEntry != nullptr;
}

bool VDataReader::GetBool(const std::string& i_rKey, bool& o_rbValue) const
{
	return TypedGet(*this, i_rKey, o_rbValue);
}

bool VDataReader::GetInt32(const std::string& i_rKey, std::int32_t& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataReader::GetUInt32(const std::string& i_rKey, std::uint32_t& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataReader::GetInt64(const std::string& i_rKey, std::int64_t& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataReader::GetUInt64(const std::string& i_rKey, std::uint64_t& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataReader::GetFloat32(const std::string& i_rKey, float& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataReader::GetFloat64(const std::string& i_rKey, double& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataReader::GetString(const std::string& i_rKey, std::string& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataReader::GetPath(const std::string& i_rKey, boost::filesystem::path& o_rValue) const
{
	return TypedGet(*this, i_rKey, o_rValue);
}

bool VDataVerifyReader::Get(const std::string& i_rKey, const VSchemaPointer& i_rpSchema, VVariant& o_rValue) const
{
	return (!i_rpSchema || SameSchema(GetSchema(i_rKey), i_rpSchema)) && VDataReader::Get(i_rKey, i_rpSchema, o_rValue);
}

} // namespace TesselDataStore
