#pragma once

#include "TesselDataStore/DataReader.h"
#include "TesselPluginInterface/IDataWriter.h"

namespace TesselDataStore
{

/// Holds a store open for writing, alone. What has changed is told when it ends. Ends on the thread that made it.
/// Made while the thread holds a reader, it fails an assertion and stays without a store.
class VDataWriter : public VDataReader, public TesselPluginInterface::IDataWriter
{
public:
	explicit VDataWriter(std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore);

	/// The new value may be of another type than the old.
	bool Set(const std::string& i_rKey, const NVX::IO::VVariant& i_rValue) override;

	bool SetBool(const std::string& i_rKey, bool i_bValue) override;
	bool SetInt32(const std::string& i_rKey, std::int32_t i_Value) override;
	bool SetUInt32(const std::string& i_rKey, std::uint32_t i_Value) override;
	bool SetFloat64(const std::string& i_rKey, double i_Value) override;
	bool SetString(const std::string& i_rKey, const std::string& i_rValue) override;
	bool SetPath(const std::string& i_rKey, const boost::filesystem::path& i_rValue) override;
	bool Remove(const std::string& i_rKey) override;
};

/// Refuses to read or write a value whose schema is another than the entry's.
class VDataVerifyWriter : public VDataWriter
{
public:
	using VDataWriter::VDataWriter;
	bool Get(const std::string& i_rKey, const NVX::IO::VSchemaPointer& i_rpSchema,
	    NVX::IO::VVariant& o_rValue) const override;
	bool Set(const std::string& i_rKey, const NVX::IO::VVariant& i_rValue) override;
};

} // namespace TesselDataStore
