#pragma once

#include "TesselPluginInterface/IDataReader.h"

namespace TesselPluginInterface
{

/// Reads and writes the entries of an open store. An entry is made by its first write.
class IDataWriter : public virtual IDataReader
{
public:
	/// @return false, with nothing changed, if the value is refused: a verifying writer takes only the schema that the
	/// entry has.
	virtual bool Set(const std::string& i_rKey, const NVX::IO::VVariant& i_rValue) = 0;

	virtual bool SetBool(const std::string& i_rKey, bool i_bValue) = 0;
	virtual bool SetInt32(const std::string& i_rKey, std::int32_t i_Value) = 0;
	virtual bool SetUInt32(const std::string& i_rKey, std::uint32_t i_Value) = 0;
	virtual bool SetFloat64(const std::string& i_rKey, double i_Value) = 0;
	virtual bool SetString(const std::string& i_rKey, const std::string& i_rValue) = 0;
	virtual bool SetPath(const std::string& i_rKey, const boost::filesystem::path& i_rValue) = 0;

	/// @return false if there was no such entry.
	virtual bool Remove(const std::string& i_rKey) = 0;
};

} // namespace TesselPluginInterface
