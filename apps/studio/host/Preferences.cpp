#include "studio/host/Preferences.h"

#include "TesselDataStore/DataReader.h"
#include "TesselDataStore/DataWriter.h"
#include "TesselDataStore/TypedGet.h"
#include "TesselPluginInterface/IDataStore.h"

using TesselDataStore::VDataReader;
using TesselDataStore::VDataWriter;

namespace StudioHost
{

VPreferences::VPreferences(std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
    : m_pStore(std::move(i_pStore))
{
	// Keys with a path are the settings of panels.
	m_Connection = m_pStore->Subscribe(
	    {},
	    [this](const std::string& i_rKey)
	    {
		    if (i_rKey.find('/') == std::string::npos)
			    m_ChangedSignal.Fire(i_rKey);
	    },
	    std::move(i_pDispatcher));
}

VPreferences::~VPreferences()
{
	m_Connection.Disconnect();
}

boost::filesystem::path VPreferences::Folder(const std::string& i_rKey) const
{
	return TesselDataStore::TypedGetOr(VDataReader(m_pStore), i_rKey, boost::filesystem::path());
}

std::int32_t VPreferences::Number(const std::string& i_rKey, std::int32_t i_Default) const
{
	VDataReader(m_pStore).GetInt32(i_rKey, i_Default);
	return i_Default;
}

void VPreferences::SetFolder(const std::string& i_rKey, const boost::filesystem::path& i_rFolder)
{
	VDataWriter writer(m_pStore);
	if (i_rFolder.empty())
		writer.Remove(i_rKey);
	else
		writer.SetPath(i_rKey, i_rFolder);
}

void VPreferences::SetNumber(const std::string& i_rKey, std::int32_t i_Value)
{
	VDataWriter(m_pStore).SetInt32(i_rKey, i_Value);
}

} // namespace StudioHost
