#include "TesselParametersGUI/ParameterEnumFolderWatcher.h"

#include "DebugServices/GlobalLog.h"
#include "UtilsFileSystem/Paths.h"

#include <QDateTime>
#include <QFileInfo>
#include <QFileSystemWatcher>
#include <QPointer>
#include <QTimer>

#include <boost/filesystem/operations.hpp>

#include <algorithm>

namespace TesselParametersGUI
{

using TesselPluginInterface::VEnumEntry;

namespace
{

bool IsFolder(const boost::filesystem::path& i_rPath)
{
	boost::system::error_code error;
	return boost::filesystem::is_directory(i_rPath, error);
}

QString ToQString(const boost::filesystem::path& i_rPath)
{
	return QString::fromStdString(UtilsFileSystem::ToUtf8(i_rPath));
}

} // namespace

VParameterEnumFolderWatcher::VParameterEnumFolderWatcher(std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore,
    const std::string& i_rPath, std::string i_Name,
    std::shared_ptr<const TesselParameters::VParameterChecker> i_pChecker, std::string i_Extension,
    std::string i_NameExpression, VDelay i_Delay)
    : VParameter(std::move(i_pStore), i_rPath, std::move(i_Name), std::move(i_pChecker)),
      m_Extension(std::move(i_Extension)), m_NameExpression(std::move(i_NameExpression)), m_Delay(std::move(i_Delay)),
      m_pWatcher(std::make_shared<QFileSystemWatcher>())
{
	connect(m_pWatcher.get(), &QFileSystemWatcher::directoryChanged, this,
	    &VParameterEnumFolderWatcher::OnDirectoryChanged);
}

VParameterEnumFolderWatcher::~VParameterEnumFolderWatcher() = default;

void VParameterEnumFolderWatcher::AddFolder(
    const std::string& i_rLabel, const boost::filesystem::path& i_rFolder, int i_Priority)
{
	const VWatchedFolder folder{i_rLabel, i_rFolder, i_Priority};
	const auto found = std::find_if(m_Folders.begin(), m_Folders.end(),
	    [&i_rLabel](const VWatchedFolder& i_rKnown) { return i_rKnown.m_Label == i_rLabel; });
	if (found != m_Folders.end())
		*found = folder;
	else
		m_Folders.push_back(folder);
	if (m_bStarted)
		Refresh();
}

void VParameterEnumFolderWatcher::SetFolder(const std::string& i_rLabel, const boost::filesystem::path& i_rFolder)
{
	for (const VWatchedFolder& rFolder : m_Folders)
		if (rFolder.m_Label == i_rLabel && rFolder.m_Folder != i_rFolder)
			return AddFolder(i_rLabel, i_rFolder, rFolder.m_Priority);
}

void VParameterEnumFolderWatcher::Refresh()
{
	m_Missed.clear();
	// A path that was told before is told again: somebody has just set the folders.
	m_State.m_MissingFolders.clear();
	Accept(ReadFolders());
}

void VParameterEnumFolderWatcher::OnDirectoryChanged(const QString& i_rFolder)
{
	const boost::filesystem::path changed = UtilsFileSystem::PathFromUtf8(i_rFolder.toStdString());
	// Other things happen in the folders above, too.
	const bool bConcerns = std::any_of(m_Folders.begin(), m_Folders.end(),
	    [&](const VWatchedFolder& i_rWatched)
	    {
		    return !i_rWatched.m_Folder.empty()
		        && (UtilsFileSystem::Canonical(i_rWatched.m_Folder) == UtilsFileSystem::Canonical(changed)
		            || Stamp(i_rWatched.m_Folder) != m_Stamps[i_rWatched.m_Folder]);
	    });
	if (bConcerns)
		RefreshLater();
}

std::vector<VEnumEntry> VParameterEnumFolderWatcher::PermittedValues(std::vector<VEnumEntry> i_Files) const
{
	return i_Files;
}

void VParameterEnumFolderWatcher::RefreshLater()
{
	if (m_bPending)
		return;
	m_bPending = true;
	const QPointer<VParameterEnumFolderWatcher> pThis(this);
	const auto refresh = [pThis]
	{
		if (!pThis)
			return;
		pThis->m_bPending = false;
		pThis->RefreshSettled();
	};
	if (m_Delay)
		m_Delay(c_SettleTime, refresh);
	else
		QTimer::singleShot(c_SettleTime, this, refresh);
}

void VParameterEnumFolderWatcher::RefreshSettled()
{
	VFolderState found = ReadFolders();
	std::set<std::string> missed;
	for (const auto& [rPath, rFile] : m_State.m_Files)
		if (!found.m_Files.contains(rPath) && !m_Missed.contains(rPath))
			missed.insert(rPath);
	for (const std::string& rPath : missed)
		found.m_Files.emplace(rPath, m_State.m_Files.at(rPath));
	m_Missed = std::move(missed);
	if (!m_Missed.empty())
		RefreshLater();
	Accept(std::move(found));
}

VParameterEnumFolderWatcher::VFolderState VParameterEnumFolderWatcher::ReadFolders()
{
	// Before reading, so that no change falls between the two.
	Watch();
	VFolderState state;
	for (const VWatchedFolder& rFolder : m_Folders)
	{
		if (rFolder.m_Folder.empty())
			continue;
		if (!IsFolder(rFolder.m_Folder))
			state.m_MissingFolders.insert(rFolder.m_Folder);
		for (VFolderFile& rFile : ListFiles(rFolder, m_Extension, m_NameExpression))
			state.m_Files.emplace(rFile.m_Path, rFile);
	}
	return state;
}

void VParameterEnumFolderWatcher::Accept(VFolderState i_State)
{
	const VFolderState before = std::exchange(m_State, std::move(i_State));
	for (const boost::filesystem::path& rFolder : m_State.m_MissingFolders)
		if (!before.m_MissingFolders.contains(rFolder))
			NVX_LOG("Tessel", NVX::ELogError, "Folder [%s] does not exist", UtilsFileSystem::ToUtf8(rFolder));

	std::vector<VFolderFile> files;
	for (const auto& [rPath, rFile] : m_State.m_Files)
		files.push_back(rFile);
	files = OnePerName(std::move(files));
	std::vector<VEnumEntry> entries;
	entries.reserve(files.size());
	for (VFolderFile& rFile : files)
		entries.push_back({std::move(rFile.m_Name), TesselDataStore::ToVariant(rFile.m_Path)});
	SetEnumeration(PermittedValues(std::move(entries)));
	ClearVanishedValue(m_bStarted ? &before : nullptr);
	m_bStarted = true;
}

void VParameterEnumFolderWatcher::ClearVanishedValue(const VFolderState* i_pBefore)
{
	const std::string value = GetValueText();
	if (value.empty() || m_State.m_Files.contains(value) || (i_pBefore && !i_pBefore->m_Files.contains(value)))
		return;
	NVX_LOG("Tessel", NVX::ELogError, "%1%: value [%2%] is not valid, clearing selection", GetName(), value);
	ClearValue();
}

void VParameterEnumFolderWatcher::Watch()
{
	// A path that is watched may be another folder by now, and one folder under two names would count once for both.
	if (const QStringList watched = m_pWatcher->directories(); !watched.isEmpty())
		m_pWatcher->removePaths(watched);
	std::set<boost::filesystem::path> wanted;
	for (const VWatchedFolder& rFolder : m_Folders)
	{
		if (rFolder.m_Folder.empty())
			continue;
		m_Stamps[rFolder.m_Folder] = Stamp(rFolder.m_Folder);
		for (boost::filesystem::path path = rFolder.m_Folder; !path.empty(); path = path.parent_path())
			if (IsFolder(path))
				wanted.insert(UtilsFileSystem::Canonical(path));
	}
	std::set<boost::filesystem::path> closed;
	for (const boost::filesystem::path& rPath : wanted)
		if (!m_pWatcher->addPath(ToQString(rPath)))
			closed.insert(rPath);
	for (const VWatchedFolder& rFolder : m_Folders)
		// One above may be closed to this user.
		if (closed.contains(UtilsFileSystem::Canonical(rFolder.m_Folder)))
			NVX_LOG("Tessel", NVX::ELogWarning, "Folder [%s] cannot be watched for changes",
			    UtilsFileSystem::ToUtf8(rFolder.m_Folder));
}

VParameterEnumFolderWatcher::VStamp VParameterEnumFolderWatcher::Stamp(const boost::filesystem::path& i_rFolder)
{
	VStamp stamp{QFileInfo(ToQString(i_rFolder)).lastModified().toMSecsSinceEpoch()};
	for (boost::filesystem::path path = i_rFolder; !path.empty(); path = path.parent_path())
	{
		const QFileInfo info(ToQString(path));
		const QDateTime made = info.birthTime();
		stamp.push_back(!info.isDir() ? -1 : made.isValid() ? made.toMSecsSinceEpoch() : 0);
	}
	return stamp;
}

} // namespace TesselParametersGUI

#include "moc_ParameterEnumFolderWatcher.cpp"
