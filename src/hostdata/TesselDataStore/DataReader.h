#pragma once

#include "TesselPluginInterface/IDataReader.h"

#include <memory>

namespace TesselPluginInterface
{
class IDataStore;
}

namespace TesselDataStore
{

/// Holds a store open for reading: others may read meanwhile, none writes. Ends on the thread that made it.
class VDataReader : public virtual TesselPluginInterface::IDataReader
{
public:
	explicit VDataReader(std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore);
	~VDataReader() override;
	VDataReader(const VDataReader&) = delete;
	VDataReader& operator=(const VDataReader&) = delete;

	bool HasEntry(const std::string& i_rKey) const override;
	bool HasValue(const std::string& i_rKey) const override;
	NVX::IO::VSchemaPointer GetSchema(const std::string& i_rKey) const override;
	std::vector<std::string> GetKeys(const std::string& i_rPrefix) const override;
	bool Get(const std::string& i_rKey, const NVX::IO::VSchemaPointer& i_rpSchema,
	    NVX::IO::VVariant& o_rValue) const override;

	bool GetBool(const std::string& i_rKey, bool& o_rbValue) const override;
	bool GetInt32(const std::string& i_rKey, std::int32_t& o_rValue) const override;
	bool GetUInt32(const std::string& i_rKey, std::uint32_t& o_rValue) const override;
	bool GetInt64(const std::string& i_rKey, std::int64_t& o_rValue) const override;
	bool GetUInt64(const std::string& i_rKey, std::uint64_t& o_rValue) const override;
	bool GetFloat32(const std::string& i_rKey, float& o_rValue) const override;
	bool GetFloat64(const std::string& i_rKey, double& o_rValue) const override;
	bool GetString(const std::string& i_rKey, std::string& o_rValue) const override;
	bool GetPath(const std::string& i_rKey, boost::filesystem::path& o_rValue) const override;

protected:
	enum class EAccess : bool
	{
		ERead,
		EWrite
	};
	VDataReader(std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore, EAccess i_Access);

	/// False, with the assertion told, without a store.
	bool IsOpen() const;

	/// Null if none was given, or if its lock cannot be had: then all operations fail.
	std::shared_ptr<TesselPluginInterface::IDataStore> m_pDataStore;

private:
	const EAccess m_Access;
};

/// Refuses entries whose schema is another than the one that is asked for.
class VDataVerifyReader : public VDataReader
{
public:
	using VDataReader::VDataReader;
	bool Get(const std::string& i_rKey, const NVX::IO::VSchemaPointer& i_rpSchema,
	    NVX::IO::VVariant& o_rValue) const override;
};

} // namespace TesselDataStore
