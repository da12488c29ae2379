#pragma once

#include "NVX/Signal.h"
#include "Variant/Variant.h"

#include <QSettings>
#include <QString>

#include <memory>
#include <set>
#include <string>

namespace TesselPluginInterface
{
class IDataStore;
}

namespace StudioHost
{

/// The text of a value in a settings file: its type and the value, "Float64 1.5". Empty for a value of a type with
/// parts, which settings do not keep.
QString PrintValue(const NVX::IO::VVariant& i_rValue);

/// @return false, with the value untouched, for a text that PrintValue has not written.
bool ParseValue(const QString& i_rText, NVX::IO::VVariant& o_rValue);

/// Keeps the entries of a store in the group "Store" of settings: those of an earlier run are taken over at once, and
/// what changes later is written as it changes.
class VStoreFile
{
public:
	/// @param i_rSettings must outlive this.
	VStoreFile(QSettings& i_rSettings, std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher);
	/// Changes that are still on their way are written, too.
	~VStoreFile();
	VStoreFile(const VStoreFile&) = delete;
	VStoreFile& operator=(const VStoreFile&) = delete;

private:
	void Load();
	void Save(const std::string& i_rKey);

	QSettings& m_rSettings;
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pStore;
	/// Entries that are this one's to remove. What could not be read stays in the settings as it is.
	std::set<std::string> m_Keys;
	NVX::VConnection m_Connection;
};

} // namespace StudioHost
