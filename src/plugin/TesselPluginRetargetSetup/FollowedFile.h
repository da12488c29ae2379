#pragma once

#include <QDateTime>
#include <QFileSystemWatcher>
#include <QString>
#include <QTimer>

#include <functional>
#include <utility>

namespace RetargetSetup
{

/// Tells when another program has written a file anew, in place or as a new file of its name, and has come to its end.
/// A file that goes is waited for. User interface thread only.
class VFollowedFile
{
public:
	explicit VFollowedFile(std::function<void()> i_Changed);

	/// From now on this file, as it is now. A change of the former one is told no more.
	void Follow(const QString& i_rPath);

private:
	/// Time of the last change and size; {} for no file.
	using VStamp = std::pair<QDateTime, qint64>;

	VStamp Stamp() const;
	void Look();

	const std::function<void()> m_Changed;
	QString m_Path;
	VStamp m_Told;
	VStamp m_Seen;
	QFileSystemWatcher m_Watcher;
	QTimer m_Settle;
};

} // namespace RetargetSetup
