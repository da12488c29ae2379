#include "TesselDataStore/StoredValueOfFields.h"

#include "UtilsFileSystem/Paths.h"

namespace TesselDataStore
{

template <>
const NVX::IO::VSchemaPointer& SchemaOf<boost::filesystem::path>()
{
	return SchemaOf<std::string>();
}

template <>
NVX::IO::VVariant ToVariant(const boost::filesystem::path& i_rValue)
{
	return ToVariant(UtilsFileSystem::ToUtf8(i_rValue));
}

template <>
bool FromVariant(const NVX::IO::VVariant& i_rVariant, boost::filesystem::path& io_rValue)
{
	std::string text;
	if (!FromVariant(i_rVariant, text))
		return false;
	io_rValue = UtilsFileSystem::PathFromUtf8(text);
	return true;
}

} // namespace TesselDataStore

RETARGET_STORED_VALUE(bool)
RETARGET_STORED_VALUE(std::int8_t)
RETARGET_STORED_VALUE(std::int16_t)
RETARGET_STORED_VALUE(std::int32_t)
RETARGET_STORED_VALUE(std::int64_t)
RETARGET_STORED_VALUE(std::uint8_t)
RETARGET_STORED_VALUE(std::uint16_t)
RETARGET_STORED_VALUE(std::uint32_t)
RETARGET_STORED_VALUE(std::uint64_t)
RETARGET_STORED_VALUE(float)
RETARGET_STORED_VALUE(double)
RETARGET_STORED_VALUE(std::string)
