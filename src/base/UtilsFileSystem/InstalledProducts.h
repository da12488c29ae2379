#pragma once

#include "UtilsFileSystem/Registry.h"

#include <boost/filesystem/path.hpp>

#include <string>

namespace TesselPluginInterface
{
class IPreferenceFolders;
}

namespace UtilsFileSystem
{

/// The installation folder of the newest installed version of a product, by the system's list of installed programs;
/// empty if there is none, and on a system without such a list. Programs count whose display name begins with the
/// product's name.
boost::filesystem::path FindInstallLocation(const std::string& i_rProductName);

/// The same, and where the system tells none, the folder that the user has set in the host under ProductFolderKey.
/// This is what panels ask. The folder need not be there.
boost::filesystem::path FindInstallLocation(
    const std::string& i_rProductName, const TesselPluginInterface::IPreferenceFolders& i_rPreferences);

/// The key of the folder preference for a product: "ProductFolderOrlexStage" for "Orlex Stage". A host offers it to the
/// user where the system has no list of installed programs.
std::string ProductFolderKey(const std::string& i_rProductName);

/// The walk through the list of installed programs.
/// @param i_rLocalMachine the root of the local machine. Entries that 64-bit programs see win over the others,
/// whatever their versions.
boost::filesystem::path FindInstallLocation(const IRegistryKey& i_rLocalMachine, const std::string& i_rProductName);

} // namespace UtilsFileSystem
