#include "TesselParametersGUI/FolderFiles.h"

#include "UtilsFileSystem/Paths.h"

#include <QRegularExpression>

#include <boost/filesystem/directory.hpp>

#include <algorithm>

namespace TesselParametersGUI
{

namespace
{

std::string LowerCase(std::string i_Text)
{
	for (char& rLetter : i_Text)
		if (rLetter >= 'A' && rLetter <= 'Z')
			rLetter += 'a' - 'A';
	return i_Text;
}

} // namespace

std::vector<VFolderFile> ListFiles(
    const VWatchedFolder& i_rFolder, const std::string& i_rExtension, const std::string& i_rNameExpression)
{
	const QRegularExpression expression(QString::fromStdString(i_rNameExpression));
	std::vector<VFolderFile> files;
	boost::system::error_code error;
	boost::filesystem::directory_iterator at(i_rFolder.m_Folder, error);
	for (; !error && at != boost::filesystem::directory_iterator(); at.increment(error))
	{
		const boost::filesystem::path& rPath = at->path();
		if (rPath.extension() != i_rExtension)
			continue;
		if (!i_rNameExpression.empty()
		    && !expression.match(QString::fromStdString(UtilsFileSystem::ToUtf8(rPath.filename()))).hasMatch())
			continue;
		boost::system::error_code statusError;
		if (at->status(statusError).type() == boost::filesystem::regular_file)
			files.push_back(
			    {UtilsFileSystem::ToUtf8(rPath.stem()), UtilsFileSystem::ToUtf8(rPath), i_rFolder.m_Priority});
	}
	return files;
}

std::vector<VFolderFile> OnePerName(std::vector<VFolderFile> i_Files)
{
	std::stable_sort(i_Files.begin(), i_Files.end(),
	    [](const VFolderFile& i_rLeft, const VFolderFile& i_rRight)
	    {
		    return i_rLeft.m_Name != i_rRight.m_Name ? i_rLeft.m_Name < i_rRight.m_Name
		                                             : i_rLeft.m_Priority > i_rRight.m_Priority;
	    });
	i_Files.erase(
	    std::unique(i_Files.begin(), i_Files.end(),
	        [](const VFolderFile& i_rLeft, const VFolderFile& i_rRight) { return i_rLeft.m_Name == i_rRight.m_Name; }),
	    i_Files.end());
	std::stable_sort(i_Files.begin(), i_Files.end(),
	    [](const VFolderFile& i_rLeft, const VFolderFile& i_rRight)
	    { return LowerCase(i_rLeft.m_Name) < LowerCase(i_rRight.m_Name); });
	return i_Files;
}

} // namespace TesselParametersGUI
