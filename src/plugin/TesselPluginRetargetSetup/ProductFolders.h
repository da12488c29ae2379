#pragma once

#include <boost/filesystem/path.hpp>

#include <array>
#include <functional>
#include <string>
#include <vector>

namespace RetargetSetup
{

/// The products that bring model templates and skins of their own, first that which counts more.
inline constexpr std::array<const char*, 2> c_ProductNames = {"Orlex Rally", "Orlex Stage"};

/// Adds the folders of a product's model templates and skins, each only if it is there. Nothing for an empty root.
void CollectProductFolders(const boost::filesystem::path& i_rProductRoot,
    std::vector<boost::filesystem::path>& io_rModelFolders, std::vector<boost::filesystem::path>& io_rSkinFolders);

struct VProductFolders
{
	std::vector<boost::filesystem::path> m_Models;
	std::vector<boost::filesystem::path> m_Skins;
};

/// The folders of all products.
/// @param i_rFindInstallation gives the folder that a product of some name is installed in, an empty path if it is not.
VProductFolders InstalledFolders(const std::function<boost::filesystem::path(const std::string&)>& i_rFindInstallation);

} // namespace RetargetSetup
