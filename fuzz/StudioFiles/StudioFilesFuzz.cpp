// What the studio finds in its own files and is given by other programs: settings with the store in them, notes of
// unsaved work, texts that are dropped.
#include "../Require.h"

#include "DebugServices/GlobalLog.h"
#include "InMemoryHost/Dispatcher.h"
#include "TesselDataStore/DataReader.h"
#include "TesselDataStore/DataStore.h"
#include "studio/host/StoreFile.h"
#include "studio/host/UnsavedWork.h"
#include "studio/panel/FileKind.h"
#include "studio/panel/RecentFiles.h"

#include <QFile>
#include <QMimeData>
#include <QSettings>
#include <QTemporaryDir>
#include <QUrl>

#include <map>

namespace
{

using namespace StudioHost;
using VEntries = std::map<std::string, NVX::IO::VVariant>;

/// Of one run of the studio.
struct VRun
{
	VEntries m_Entries;
	QStringList m_Recent;
};

VRun RunWith(const QString& i_rPath, bool i_bChange)
{
	QSettings settings(i_rPath, QSettings::IniFormat);
	const auto pStore = std::make_shared<TesselDataStore::VDataStore>();
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	VRun run;
	const VStoreFile file(settings, pStore, pDispatcher);
	const TesselDataStore::VDataReader reader(pStore);
	for (const std::string& rKey : reader.GetKeys({}))
		Require(reader.Get(rKey, nullptr, run.m_Entries[rKey]), "an entry has a value");
	VRecentFiles recent(settings);
	Require(recent.Files().size() <= VRecentFiles::c_Count, "ten files at most");
	if (i_bChange)
		recent.Add(recent.Files().value(1, "/a.qrs"));
	run.m_Recent = recent.Files();
	return run;
}

/// What a run takes over, the next one takes over as well.
void LookAtSettings(const QTemporaryDir& i_rFolder, const QByteArray& i_rBytes)
{
	// A file of the same name and size is not read again at once.
	static int s_Count = 0;
	const QString path = i_rFolder.filePath(QString::number(++s_Count) + ".ini");
	QFile file(path);
	Require(file.open(QIODevice::WriteOnly) && file.write(i_rBytes) == i_rBytes.size(), "the settings are written");
	file.close();
	const VRun first = RunWith(path, true);
	const VRun second = RunWith(path, false);
	Require(first.m_Entries == second.m_Entries, "the store comes back equal");
	Require(first.m_Recent == second.m_Recent, "so do recent files");
	QFile::remove(path);
}

void LookAtValue(const QByteArray& i_rBytes)
{
	NVX::IO::VVariant value;
	if (!ParseValue(QString::fromUtf8(i_rBytes), value))
		return;
	NVX::IO::VVariant again;
	Require(ParseValue(PrintValue(value), again), "what is printed can be read");
	Require(PrintValue(again) == PrintValue(value), "as the same value");
}

/// A note leads to no other folder.
void LookAtNote(const QTemporaryDir& i_rFolder, const QByteArray& i_rBytes)
{
	const QString folder = i_rFolder.filePath("unsaved");
	QDir().mkpath(folder);
	for (const char* const pName : {"/x.a.qrr", "/x.json"})
	{
		QFile file(folder + pName);
		Require(file.open(QIODevice::WriteOnly) && file.write(i_rBytes) == i_rBytes.size(), "the note is written");
	}
	const VUnsavedWorkFolder unsaved(folder);
	for (const VUnsavedWork& rWork : unsaved.Left())
		Require(QFileInfo(rWork.m_Copy).absolutePath() == folder, "the copy is in the folder");
}

void LookAtDrop(const QByteArray& i_rBytes)
{
	QMimeData data;
	data.setData("text/uri-list", i_rBytes);
	QStringList paths;
	for (const QUrl& rUrl : data.urls())
		paths << rUrl.toLocalFile();
	const int count = paths.size();
	SortByKind(paths);
	Require(paths.size() == count, "no file is lost");
	for (int i = 1; i < count; ++i)
		Require(KindOf(paths[i - 1]) <= KindOf(paths[i]), "files stand by their kinds");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static const auto s_pSilence = NVX::GlobalLog::AddSink([](const NVX::VLogCategory&, int, const std::string&) {});
	static const QTemporaryDir s_Folder;
	if (i_Size == 0)
		return 0;
	const QByteArray bytes(reinterpret_cast<const char*>(i_pData) + 1, int(i_Size) - 1);
	switch (i_pData[0])
	{
	case 'n': LookAtNote(s_Folder, bytes); break;
	case 'd': LookAtDrop(bytes); break;
	case 'v': LookAtValue(bytes); break;
	default: LookAtSettings(s_Folder, bytes); break;
	}
	return 0;
}
