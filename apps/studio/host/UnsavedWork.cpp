#include "studio/host/UnsavedWork.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QJsonDocument>
#include <QJsonObject>
#include <QLockFile>
#include <QSaveFile>
#include <QUuid>

#include <algorithm>

namespace StudioHost
{
namespace
{

const QString c_NoteEnding = QStringLiteral(".json");
const QString c_LockEnding = QStringLiteral(".lock");
const QString c_CopyEndings[] = {QStringLiteral(".a.qrr"), QStringLiteral(".b.qrr")};

/// Nobody's note is larger, so nobody's time is lost on a file that is something else.
constexpr qint64 c_NoteBytes = 1 << 20;

QByteArray PrintNote(const VUnsavedWork& i_rWork)
{
	return QJsonDocument(QJsonObject{{"copy", QFileInfo(i_rWork.m_Copy).fileName()}, {"file", i_rWork.m_File},
	                         {"source", i_rWork.m_Source}, {"fbx", i_rWork.m_Fbx},
	                         {"time", i_rWork.m_Time.toString(Qt::ISODateWithMs)}, {"targets", i_rWork.m_Targets}})
	    .toJson();
}

/// What the files of one program have in common.
QString StemOf(const QString& i_rPath)
{
	const QFileInfo file(i_rPath);
	return file.dir().filePath(file.fileName().section('.', 0, 0));
}

/// @return false for a note that is none, or whose copy is gone.
bool ReadNote(const QFileInfo& i_rNote, VUnsavedWork& o_rWork)
{
	QFile file(i_rNote.filePath());
	if (!file.open(QIODevice::ReadOnly))
		return false;
	const QJsonObject note = QJsonDocument::fromJson(file.read(c_NoteBytes)).object();
	// The name alone: a note leads to no other folder.
	o_rWork.m_Copy = i_rNote.dir().filePath(QFileInfo(note["copy"].toString()).fileName());
	o_rWork.m_File = note["file"].toString();
	o_rWork.m_Source = note["source"].toString();
	o_rWork.m_Fbx = note["fbx"].toString();
	o_rWork.m_Time = QDateTime::fromString(note["time"].toString(), Qt::ISODateWithMs);
	o_rWork.m_Targets = note["targets"].toInt();
	// A note tells of the copies of its own program; others may be of one that runs.
	return o_rWork.m_Time.isValid() && StemOf(o_rWork.m_Copy) == StemOf(i_rNote.filePath())
	    && QFileInfo(o_rWork.m_Copy).isFile();
}

std::unique_ptr<QLockFile> MakeLock(const QString& i_rPath)
{
	auto pLock = std::make_unique<QLockFile>(i_rPath);
	// Held for as long as the process lives, however long that is.
	pLock->setStaleLockTime(0);
	return pLock;
}

void RemoveAll(const QString& i_rStem)
{
	// The note first: without it nobody takes a copy for whole.
	QFile::remove(i_rStem + c_NoteEnding);
	for (const QString& rEnding : c_CopyEndings)
		QFile::remove(i_rStem + rEnding);
}

} // namespace

VUnsavedWorkFolder::VUnsavedWorkFolder(const QString& i_rFolder)
    : m_Folder(i_rFolder), m_Name(QUuid::createUuid().toString(QUuid::WithoutBraces))
{
}

VUnsavedWorkFolder::~VUnsavedWorkFolder()
{
	Drop();
}

QString VUnsavedWorkFolder::Path(const QString& i_rEnding) const
{
	return QDir(m_Folder).filePath(m_Name + i_rEnding);
}

bool VUnsavedWorkFolder::IsLockThere() const
{
	return QFileInfo::exists(Path(c_LockEnding));
}

void VUnsavedWorkFolder::Unlock()
{
	// Else Qt would complain that it cannot remove what somebody else has removed.
	if (!IsLockThere())
	{
		QDir().mkdir(m_Folder);
		QFile(Path(c_LockEnding)).open(QIODevice::WriteOnly);
	}
	m_pLock.reset();
}

QString VUnsavedWorkFolder::NextCopy()
{
	if (m_pLock && !IsLockThere())
		Unlock();
	if (!m_pLock)
	{
		if (!QDir().mkpath(m_Folder))
			return {};
		std::unique_ptr<QLockFile> pLock = MakeLock(Path(c_LockEnding));
		if (!pLock->tryLock())
			return {};
		m_pLock = std::move(pLock);
	}
	return Path(c_CopyEndings[m_bSecond]);
}

bool VUnsavedWorkFolder::Keep(VUnsavedWork i_rWork)
{
	i_rWork.m_Copy = Path(c_CopyEndings[m_bSecond]);
	i_rWork.m_Time = QDateTime::currentDateTimeUtc();
	QSaveFile note(Path(c_NoteEnding));
	const QByteArray text = PrintNote(i_rWork);
	if (!note.open(QIODevice::WriteOnly) || note.write(text) != text.size() || !note.commit())
		return false;
	m_bSecond = !m_bSecond;
	return true;
}

void VUnsavedWorkFolder::Drop()
{
	if (!m_pLock)
		return;
	RemoveAll(Path({}));
	Unlock();
	// Only if nobody else keeps anything.
	QDir().rmdir(m_Folder);
}

std::vector<VUnsavedWork> VUnsavedWorkFolder::Left() const
{
	std::vector<VUnsavedWork> left;
	for (const QFileInfo& rNote : QDir(m_Folder).entryInfoList({'*' + c_NoteEnding}, QDir::Files))
	{
		VUnsavedWork work;
		if (StemOf(rNote.filePath()) != Path({}) && ReadNote(rNote, work)
		    && MakeLock(StemOf(rNote.filePath()) + c_LockEnding)->tryLock())
			left.push_back(work);
	}
	std::ranges::sort(left, std::greater(), &VUnsavedWork::m_Time);
	return left;
}

void VUnsavedWorkFolder::Discard(const VUnsavedWork& i_rWork)
{
	RemoveAll(StemOf(i_rWork.m_Copy));
	QDir().rmdir(QFileInfo(i_rWork.m_Copy).path());
}

} // namespace StudioHost
