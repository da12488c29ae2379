#include "studio/host/StoreFile.h"

#include "DebugServices/GlobalLog.h"
#include "TesselDataStore/DataReader.h"
#include "TesselDataStore/DataWriter.h"
#include "TesselDataStore/StoredValue.h"
#include "TesselPluginInterface/IDataStore.h"
#include "math/NumberText.h"

#include <QByteArray>

#include <charconv>
#include <cmath>
#include <type_traits>

using NVX::IO::EType;
using NVX::IO::VVariant;

namespace StudioHost
{
namespace
{

/// Calls a function with a value of the C++ type that stands for a plain type. False for a type with parts.
template <typename TFunction>
bool WithTypeOf(EType i_Type, TFunction&& i_rFunction)
{
	switch (i_Type)
	{
	case EType::EBool: return i_rFunction(bool());
	case EType::EInt8: return i_rFunction(std::int8_t());
	case EType::EInt16: return i_rFunction(std::int16_t());
	case EType::EInt32: return i_rFunction(std::int32_t());
	case EType::EInt64: return i_rFunction(std::int64_t());
	case EType::EUInt8: return i_rFunction(std::uint8_t());
	case EType::EUInt16: return i_rFunction(std::uint16_t());
	case EType::EUInt32: return i_rFunction(std::uint32_t());
	case EType::EUInt64: return i_rFunction(std::uint64_t());
	case EType::EFloat32: return i_rFunction(float());
	case EType::EFloat64: return i_rFunction(double());
	case EType::EString: return i_rFunction(std::string());
	default: return false;
	}
}

QString Print(bool i_bValue)
{
	return i_bValue ? QStringLiteral("true") : QStringLiteral("false");
}
template <typename T>
requires std::is_arithmetic_v<T> QString Print(T i_Value)
{
	if constexpr (std::is_floating_point_v<T>)
	{
		// In the spelling that can be read back.
		if (!std::isfinite(i_Value))
			return std::isnan(i_Value) ? QStringLiteral("nan")
			    : i_Value < 0          ? QStringLiteral("-inf")
			                           : QStringLiteral("inf");
		return QString::fromStdString(NumberText::PrintG17(double(i_Value)));
	}
	else
		return QString::number(i_Value);
}
/// A text may hold any bytes, a settings file may not.
QString Print(const std::string& i_rValue)
{
	return QString::fromLatin1(QByteArray::fromStdString(i_rValue).toPercentEncoding(" !\"#$&'()*+,/:;<=>?@[\\]^`{|}"));
}

bool Parse(const std::string& i_rText, bool& o_rbValue)
{
	o_rbValue = i_rText == "true";
	return o_rbValue || i_rText == "false";
}
template <typename T>
requires std::is_arithmetic_v<T>
bool Parse(const std::string& i_rText, T& o_rValue)
{
	if constexpr (std::is_floating_point_v<T>)
	{
		double value = 0.0;
		const bool bRead = NumberText::ScanWholeReal(i_rText, value);
		o_rValue = T(value);
		return bRead && std::isinf(o_rValue) == std::isinf(value);
	}
	else
	{
		const char* const pEnd = i_rText.data() + i_rText.size();
		const auto [pRead, error] = std::from_chars(i_rText.data(), pEnd, o_rValue);
		return error == std::errc() && pRead == pEnd;
	}
}
bool Parse(const std::string& i_rText, std::string& o_rValue)
{
	o_rValue = QByteArray::fromPercentEncoding(QByteArray::fromStdString(i_rText)).toStdString();
	return true;
}

const QString c_Group = QStringLiteral("Store/");

} // namespace

QString PrintValue(const VVariant& i_rValue)
{
	QString text;
	if (i_rValue.IsEmpty())
		return text;
	WithTypeOf(i_rValue.m_pSchema->m_Type,
	    [&](auto i_Value)
	    {
		    if (!TesselDataStore::FromVariant(i_rValue, i_Value))
			    return false;
		    const std::string_view type = NVX::IO::TypeName(i_rValue.m_pSchema->m_Type);
		    text = QLatin1String(type.data(), int(type.size())) + QLatin1Char(' ') + Print(i_Value);
		    return true;
	    });
	return text;
}

bool ParseValue(const QString& i_rText, VVariant& o_rValue)
{
	const int split = i_rText.indexOf(QLatin1Char(' '));
	const std::string type = i_rText.left(split).toStdString();
	const std::string value = i_rText.mid(split + 1).toStdString();
	if (split < 0)
		return false;
	for (int i = 0; i <= int(EType::EString); ++i)
	{
		if (NVX::IO::TypeName(EType(i)) != type)
			continue;
		return WithTypeOf(EType(i),
		    [&](auto i_Value)
		    {
			    if (!Parse(value, i_Value))
				    return false;
			    o_rValue = TesselDataStore::ToVariant(i_Value);
			    return true;
		    });
	}
	return false;
}

VStoreFile::VStoreFile(QSettings& i_rSettings, std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
    : m_rSettings(i_rSettings), m_pStore(std::move(i_pStore))
{
	Load();
	m_Connection = m_pStore->Subscribe(
	    {}, [this](const std::string& i_rKey) { Save(i_rKey); }, std::move(i_pDispatcher));
}

VStoreFile::~VStoreFile()
{
	m_Connection.Disconnect();
	for (const std::string& rKey : TesselDataStore::VDataReader(m_pStore).GetKeys({}))
		m_Keys.insert(rKey);
	for (const std::string& rKey : std::set(m_Keys))
		Save(rKey);
}

void VStoreFile::Load()
{
	// Of all keys: of a group QSettings does not look at what stands in the file as a group of its own within it.
	const QStringList paths = m_rSettings.allKeys();
	TesselDataStore::VDataWriter writer(m_pStore);
	for (const QString& rPath : paths)
	{
		if (!rPath.startsWith(c_Group))
			continue;
		const std::string key = rPath.mid(c_Group.size()).toStdString();
		VVariant value;
		if (ParseValue(m_rSettings.value(rPath).toString(), value))
		{
			writer.Set(key, value);
			m_Keys.insert(key);
		}
		else
			NVX_LOG("Store", NVX::ELogWarning, "The settings' entry '%1%' cannot be read and is left out", key);
	}
}

void VStoreFile::Save(const std::string& i_rKey)
{
	m_Keys.insert(i_rKey);
	VVariant value;
	TesselDataStore::VDataReader(m_pStore).Get(i_rKey, nullptr, value);
	const QString key = c_Group + QString::fromStdString(i_rKey);
	const QString text = PrintValue(value);
	if (text.isEmpty())
		m_rSettings.remove(key);
	else if (m_rSettings.value(key).toString() != text)
		m_rSettings.setValue(key, text);
}

} // namespace StudioHost
