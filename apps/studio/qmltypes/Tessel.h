#pragma once

#include <QObject>
#include <QUrl>

#include <functional>

namespace StudioHost
{

/// Runs a named command on the host's panels. False if none knows it.
using VCommandRunner = std::function<bool(const QString&)>;

/// The singleton "Tessel" of "TesselQML": the host's commands, and files by URL and by path.
class VTessel : public QObject
{
	Q_OBJECT

public:
	explicit VTessel(VCommandRunner i_RunCommand, QObject* i_pParent = nullptr);

	Q_INVOKABLE bool execute(const QString& i_rCommand) const;

	/// What stands behind the last "/", without escapes, as it is shown.
	Q_INVOKABLE static QString fileName(const QUrl& i_rUrl);
	/// A name as it is shown: what is invisible in it, or turns the direction of writing, stands as its number.
	Q_INVOKABLE static QString visible(const QString& i_rText);
	/// The path of a local file's URL, empty for any other.
	Q_INVOKABLE static QString localPath(const QUrl& i_rUrl);
	/// The URL of a path, empty for an empty one.
	Q_INVOKABLE static QUrl fileUrl(const QString& i_rPath);
	/// The URL of the folder that a path stands in, empty for an empty one.
	Q_INVOKABLE static QUrl folderUrl(const QString& i_rPath);

private:
	const VCommandRunner m_RunCommand;
};

} // namespace StudioHost
