#pragma once

#include "TesselPluginInterface/IPreferenceFolders.h"

#include <memory>

namespace TesselPluginInterface
{
class IDataStore;
}

namespace StudioHost
{

/// Where takes are looked for: a folder of the preferences beside those that modules know.
inline constexpr const char* c_pTakesFolderKey = "FolderTakes";
/// The same of presets.
inline constexpr const char* c_pPresetsFolderKey = "FolderPresets";

/// The user's preferences as entries of the store, under their plain keys.
class VPreferences : public TesselPluginInterface::IPreferenceFolders
{
public:
	VPreferences(std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher);
	~VPreferences() override;

	boost::filesystem::path Folder(const std::string& i_rKey) const override;
	std::int32_t Number(const std::string& i_rKey, std::int32_t i_Default) const override;
	/// Fires through the dispatcher.
	NVX::VSignal<std::string>& ChangedSignal() override { return m_ChangedSignal; }

	/// An empty path leaves the key without a folder.
	void SetFolder(const std::string& i_rKey, const boost::filesystem::path& i_rFolder);
	void SetNumber(const std::string& i_rKey, std::int32_t i_Value);

private:
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pStore;
	NVX::VConnection m_Connection;
	NVX::VSignal<std::string> m_ChangedSignal;
};

} // namespace StudioHost
