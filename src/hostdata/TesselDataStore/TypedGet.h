#pragma once

#include "TesselDataStore/StoredValue.h"

#include "DebugServices/GlobalLog.h"
#include "TesselPluginInterface/IDataReader.h"

namespace TesselDataStore
{

/// Tells in the log that an entry holds another type than the one that was asked for.
void TellOtherType(const std::string& i_rKey);

/// Reads an entry of any type that StoredValue.h knows.
/// @return false, with the value untouched, if there is no value, or one of another type, which is told in the log.
template <typename T>
bool TypedGet(const TesselPluginInterface::IDataReader& i_rReader, const std::string& i_rKey, T& io_rValue)
{
	if (!i_rReader.HasValue(i_rKey))
		return false;
	NVX::IO::VVariant value;
	if (i_rReader.Get(i_rKey, SchemaOf<T>(), value) && FromVariant(value, io_rValue))
		return true;
	TellOtherType(i_rKey);
	return false;
}

/// The value of an entry; the default if there is none or one of another type. Either is told in the log.
template <typename T>
T TypedGetOr(const TesselPluginInterface::IDataReader& i_rReader, const std::string& i_rKey, T i_Default)
{
	if (!i_rReader.HasValue(i_rKey))
		NVX_LOG("Store", NVX::ELogInformation, "Store entry '%1%' has no value, returning the default value.", i_rKey);
	else
		(void)TypedGet(i_rReader, i_rKey, i_Default);
	return i_Default;
}

} // namespace TesselDataStore
