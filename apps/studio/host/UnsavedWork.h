#pragma once

#include <QDateTime>
#include <QString>

#include <memory>
#include <vector>

class QLockFile;

namespace StudioHost
{

/// Work on a retarget subject that was in no file when a program ended, and what it was done with.
struct VUnsavedWork
{
	/// The subject as it was kept.
	QString m_Copy;
	/// What "Save" would have written, empty for no file.
	QString m_File;
	/// Performer and character that were chosen, empty for none.
	QString m_Source;
	QString m_Fbx;
	/// When it was kept.
	QDateTime m_Time;
	int m_Targets = 0;
};

/// A folder in which programs keep their unsaved work. Each has a copy of its own there, under a lock that ends with
/// the process; what a process that is gone has left can be taken over by another.
class VUnsavedWorkFolder
{
public:
	/// @param i_rFolder is made when there is something to keep.
	explicit VUnsavedWorkFolder(const QString& i_rFolder);
	/// A clean end: nothing stays of what this one kept.
	~VUnsavedWorkFolder();
	VUnsavedWorkFolder(const VUnsavedWorkFolder&) = delete;
	VUnsavedWorkFolder& operator=(const VUnsavedWorkFolder&) = delete;

	/// Makes folder and lock, again if somebody took them away: without its lock the copy would be anybody's.
	/// @return where the next copy is to be written, one of two in turn so that the last one stays whole until Keep is
	/// done; empty if the folder cannot be made or written to.
	QString NextCopy();

	/// That copy is written: it counts from now on.
	/// @param i_rWork m_Copy and m_Time are set here.
	/// @return false, with the copy before still counting, if it could not be noted.
	bool Keep(VUnsavedWork i_rWork);

	/// Nothing is unsaved any more.
	void Drop();

	/// What programs that are gone have left, latest first.
	std::vector<VUnsavedWork> Left() const;

	const QString& Folder() const { return m_Folder; }

	/// Removes what was left, whether it was taken over or is not wanted.
	static void Discard(const VUnsavedWork& i_rWork);

private:
	QString Path(const QString& i_rEnding) const;
	bool IsLockThere() const;
	void Unlock();

	const QString m_Folder;
	const QString m_Name;
	std::unique_ptr<QLockFile> m_pLock;
	bool m_bSecond = false;
};

} // namespace StudioHost
