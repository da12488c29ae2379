#pragma once

#include <QFile>
#include <QProcess>
#include <QString>
#include <QTemporaryDir>

/// Files of the demo in a folder of their own, which goes with this object: performer.qrs, character.fbx and walk.bvh
/// as they stand in the tree, and kestrel.qrr, which the command line makes of the first two.
class VDemoFiles
{
public:
	/// @return false if the command line did not make its file.
	bool Make() const
	{
		for (const char* const pName : {"performer.qrs", "character.fbx", "walk.bvh"})
			QFile::copy(QStringLiteral(RETARGET_DEMO "/") + pName, Path(pName));
		return QProcess::execute(RETARGET_PROGRAM,
		           {"create", "-q", "--fbx", Path("character.fbx"), "--source", Path("performer.qrs"), "--edits",
		               RETARGET_DEMO "/mapping.json", "--prune-joints", "--match-file-pose", "--update-targets", "-o",
		               Path("kestrel.qrr")})
		    == 0;
	}

	QString Folder() const { return m_Folder.path(); }
	QString Path(const char* i_pName) const { return m_Folder.filePath(QLatin1String(i_pName)); }

private:
	QTemporaryDir m_Folder;
};
