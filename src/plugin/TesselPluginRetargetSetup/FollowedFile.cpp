#include "TesselPluginRetargetSetup/FollowedFile.h"

#include <QFileInfo>

namespace RetargetSetup
{
namespace
{

/// In milliseconds: a program that still writes has written more by then.
constexpr int c_SettleTime = 300;

} // namespace

VFollowedFile::VFollowedFile(std::function<void()> i_Changed) : m_Changed(std::move(i_Changed))
{
	m_Settle.setSingleShot(true);
	m_Settle.setInterval(c_SettleTime);
	QObject::connect(&m_Settle, &QTimer::timeout, [this] { Look(); });
	const auto settle = [this] { m_Settle.start(); };
	QObject::connect(&m_Watcher, &QFileSystemWatcher::fileChanged, &m_Settle, settle);
	QObject::connect(&m_Watcher, &QFileSystemWatcher::directoryChanged, &m_Settle, settle);
}

void VFollowedFile::Follow(const QString& i_rPath)
{
	if (const QStringList watched = m_Watcher.files() + m_Watcher.directories(); !watched.isEmpty())
		m_Watcher.removePaths(watched);
	m_Settle.stop();
	m_Path = i_rPath;
	m_Told = m_Seen = Stamp();
	if (m_Path.isEmpty())
		return;
	m_Watcher.addPath(m_Path);
	m_Watcher.addPath(QFileInfo(m_Path).absolutePath());
}

VFollowedFile::VStamp VFollowedFile::Stamp() const
{
	const QFileInfo file(m_Path);
	return file.isFile() ? VStamp(file.lastModified(), file.size()) : VStamp();
}

void VFollowedFile::Look()
{
	const VStamp stamp = Stamp();
	const bool bSettled = std::exchange(m_Seen, stamp) == stamp;
	if (stamp == VStamp() || stamp == m_Told)
		return;
	if (!bSettled)
		return m_Settle.start();
	m_Told = stamp;
	// A new file of the name is not watched yet.
	if (!m_Watcher.files().contains(m_Path))
		m_Watcher.addPath(m_Path);
	m_Changed();
}

} // namespace RetargetSetup
