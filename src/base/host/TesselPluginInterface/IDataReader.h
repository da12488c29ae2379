#pragma once

#include "Variant/Variant.h"

#include <boost/filesystem/path.hpp>

#include <string>
#include <vector>

namespace TesselPluginInterface
{

/// Reads the entries of an open store. The typed functions return false and leave the value alone if the entry does not
/// exist or holds another type; the latter is told in the log.
class IDataReader
{
public:
	virtual ~IDataReader() = default;

	/// True for an entry without value, too.
	virtual bool HasEntry(const std::string& i_rKey) const = 0;
	virtual bool HasValue(const std::string& i_rKey) const = 0;
	/// Null if there is no entry.
	virtual NVX::IO::VSchemaPointer GetSchema(const std::string& i_rKey) const = 0;
	/// The keys that begin with a text, in order.
	virtual std::vector<std::string> GetKeys(const std::string& i_rPrefix) const = 0;

	/// An entry as it is stored.
	/// @param i_rpSchema of the value that the caller wants; a verifying reader refuses an entry of another one.
	/// Null wants any.
	/// @return false if there is no entry or it is refused.
	virtual bool Get(
	    const std::string& i_rKey, const NVX::IO::VSchemaPointer& i_rpSchema, NVX::IO::VVariant& o_rValue) const = 0;

	virtual bool GetBool(const std::string& i_rKey, bool& o_rbValue) const = 0;
	virtual bool GetInt32(const std::string& i_rKey, std::int32_t& o_rValue) const = 0;
	virtual bool GetUInt32(const std::string& i_rKey, std::uint32_t& o_rValue) const = 0;
	virtual bool GetInt64(const std::string& i_rKey, std::int64_t& o_rValue) const = 0;
	virtual bool GetUInt64(const std::string& i_rKey, std::uint64_t& o_rValue) const = 0;
	virtual bool GetFloat32(const std::string& i_rKey, float& o_rValue) const = 0;
	virtual bool GetFloat64(const std::string& i_rKey, double& o_rValue) const = 0;
	virtual bool GetString(const std::string& i_rKey, std::string& o_rValue) const = 0;
	/// A path is a text in the store.
	virtual bool GetPath(const std::string& i_rKey, boost::filesystem::path& o_rValue) const = 0;
};

} // namespace TesselPluginInterface
