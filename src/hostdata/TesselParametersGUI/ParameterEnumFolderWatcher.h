#pragma once

#include "TesselParametersGUI/FolderFiles.h"

#include "TesselParameters/Parameter.h"

#include <QObject>

#include <chrono>
#include <map>
#include <set>

class QFileSystemWatcher;

namespace TesselParametersGUI
{

/// A parameter whose permitted values are the files of folders: the name is the file's without its extension, the value
/// the full path. The list follows the disk. Lives on a thread with a Qt event loop.
class VParameterEnumFolderWatcher : public QObject, public TesselParameters::VParameter
{
	Q_OBJECT

public:
	/// Runs a callback on this thread after a time.
	using VDelay = std::function<void(std::chrono::milliseconds i_Time, std::function<void()> i_Callback)>;

	/// How long changes of a folder are collected before it is read again. A file that is gone leaves the list when it
	/// is missed a second time, since editors save by renaming.
	static constexpr std::chrono::milliseconds c_SettleTime{150};

	/// The first parameters are those of VParameter; the checker is one of texts or paths.
	/// @param i_Extension of the files with its dot, compared exactly.
	/// @param i_NameExpression a regular expression that file names must contain; empty takes all.
	/// @param i_Delay for tests; a timer of Qt if empty.
	VParameterEnumFolderWatcher(std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore, const std::string& i_rPath,
	    std::string i_Name, std::shared_ptr<const TesselParameters::VParameterChecker> i_pChecker,
	    std::string i_Extension, std::string i_NameExpression = {}, VDelay i_Delay = {});
	~VParameterEnumFolderWatcher() override;

	/// Folders are added before the first Refresh; from then on an added folder is read at once.
	/// A folder with the label of another one replaces it.
	void AddFolder(const std::string& i_rLabel, const boost::filesystem::path& i_rFolder, int i_Priority);
	/// Replaces the folder of a label and keeps its priority. A label that is not there changes nothing.
	void SetFolder(const std::string& i_rLabel, const boost::filesystem::path& i_rFolder);
	const std::vector<VWatchedFolder>& GetFolders() const { return m_Folders; }

	/// Reads the folders and replaces the permitted values. A folder that does not exist is told in the log; it is
	/// watched as soon as it appears. The first time, a value that is none of them is cleared and told; later only one
	/// that was in the folders and is there no more, so that a value from elsewhere stays.
	void Refresh();

public slots:
	void OnDirectoryChanged(const QString& i_rFolder);

protected:
	/// What is permitted, from the files in the order of their names.
	virtual std::vector<TesselPluginInterface::VEnumEntry> PermittedValues(
	    std::vector<TesselPluginInterface::VEnumEntry> i_Files) const;

private:
	struct VFolderState
	{
		/// By path.
		std::map<std::string, VFolderFile> m_Files;
		std::set<boost::filesystem::path> m_MissingFolders;
	};

	void RefreshLater();
	void RefreshSettled();
	VFolderState ReadFolders();
	void Accept(VFolderState i_State);
	/// @param i_pBefore null at the first time.
	void ClearVanishedValue(const VFolderState* i_pBefore);
	/// The folders, and all above them: there they are renamed, and there one that is gone would appear again.
	void Watch();

	const std::string m_Extension;
	const std::string m_NameExpression;
	const VDelay m_Delay;
	const std::shared_ptr<QFileSystemWatcher> m_pWatcher;
	std::vector<VWatchedFolder> m_Folders;
	VFolderState m_State;
	/// Missed once, still offered.
	std::set<std::string> m_Missed;
	/// When a folder was last changed, and when it and each above it was made: to see that another one stands in its
	/// place, or that the way to it has grown.
	using VStamp = std::vector<qint64>;
	static VStamp Stamp(const boost::filesystem::path& i_rFolder);
	std::map<boost::filesystem::path, VStamp> m_Stamps;
	bool m_bStarted = false;
	bool m_bPending = false;
};

} // namespace TesselParametersGUI
