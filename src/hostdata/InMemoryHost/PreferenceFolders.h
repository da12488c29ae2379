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
	NVX::VSignal<std::string>& ChangedSignal() override { return m_ChangedSignal; }

	/// Fires if the folder is another one than before.
	void SetFolder(const std::string& i_rKey, const boost::filesystem::path& i_rFolder);

private:
	std::map<std::string, boost::filesystem::path> m_Folders;
	NVX::VSignal<std::string> m_ChangedSignal;
};

} // namespace InMemoryHost
