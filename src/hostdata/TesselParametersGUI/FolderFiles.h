#pragma once

#include <boost/filesystem/path.hpp>

#include <string>
#include <vector>

namespace TesselParametersGUI
{

/// A folder whose files an enumeration offers.
struct VWatchedFolder
{
	/// By which the folder is replaced.
	std::string m_Label;
	/// Empty for one that is not set: it has no files, and nobody is told.
	boost::filesystem::path m_Folder;
	/// Of two files with one name the one of the folder with the higher priority is offered.
	int m_Priority = 0;
};

struct VFolderFile
{
	/// The file name without its extension, as UTF-8.
	std::string m_Name;
	/// The full path, as UTF-8.
	std::string m_Path;
	int m_Priority = 0;
};

/// The regular files of a folder with an extension (".fbx", compared exactly) and a file name in which the regular
/// expression is found; an empty expression takes all.
std::vector<VFolderFile> ListFiles(
    const VWatchedFolder& i_rFolder, const std::string& i_rExtension, const std::string& i_rNameExpression);

/// One file for each name: of the highest priority, the first of equal ones. Sorted by name without regard to the case
/// of ASCII letters.
std::vector<VFolderFile> OnePerName(std::vector<VFolderFile> i_Files);

} // namespace TesselParametersGUI
