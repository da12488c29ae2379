#pragma once

#include "TesselPluginInterface/IPreferenceFolders.h"

#include <map>

namespace InMemoryHost
{

/// Forgets with the process.
class VPreferenceFolders : public TesselPluginInterface::IPreferenceFolders
{
public:
	boost::filesystem::path Folder(const std::string& i_rKey) const override;
	std::int32_t Number(const std::string& i_rKey, std::int32_t i_Default) const override;
	NVX::VSignal<std::string>& ChangedSignal() override { return m_ChangedSignal; }

	/// Fires if the folder is another one than before.
	void SetFolder(const std::string& i_rKey, const boost::filesystem::path& i_rFolder);
	/// Fires.
	void SetNumber(const std::string& i_rKey, std::int32_t i_Number);

private:
	std::map<std::string, boost::filesystem::path> m_Folders;
	std::map<std::string, std::int32_t> m_Numbers;
	NVX::VSignal<std::string> m_ChangedSignal;
};

} // namespace InMemoryHost
