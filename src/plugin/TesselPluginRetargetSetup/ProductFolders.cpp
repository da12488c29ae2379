#include "TesselPluginRetargetSetup/ProductFolders.h"

#include <boost/filesystem/operations.hpp>

namespace RetargetSetup
{

void CollectProductFolders(const boost::filesystem::path& i_rProductRoot,
    std::vector<boost::filesystem::path>& io_rModelFolders, std::vector<boost::filesystem::path>& io_rSkinFolders)
{
	if (i_rProductRoot.empty())
		return;
	const auto addIfThere = [&i_rProductRoot](const char* i_pName, std::vector<boost::filesystem::path>& io_rFolders)
	{
		const boost::filesystem::path folder = i_rProductRoot / "Configuration" / i_pName;
		boost::system::error_code error;
		if (boost::filesystem::exists(folder, error))
			io_rFolders.push_back(folder);
	};
	addIfThere("ModelTemplates", io_rModelFolders);
	addIfThere("Skins", io_rSkinFolders);
}

VProductFolders InstalledFolders(const std::function<boost::filesystem::path(const std::string&)>& i_rFindInstallation)
{
	VProductFolders folders;
	for (const char* const pName : c_ProductNames)
		CollectProductFolders(i_rFindInstallation(pName), folders.m_Models, folders.m_Skins);
	return folders;
}

} // namespace RetargetSetup
