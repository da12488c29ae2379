#pragma once

#include <QObject>
#include <QString>

#include <atomic>
#include <cstddef>
#include <memory>
#include <thread>

namespace StudioHost
{

struct VJudgedTake;

/// What of a solved take is written, and how.
struct VMotionExportTask
{
	std::shared_ptr<const VJudgedTake> m_pJudged;
	std::size_t m_First = 0;
	std::size_t m_Last = 0;
	/// The extension tells the form: .bvh, .glb or .fbx.
	QString m_Path;
	/// The FBX file that the last two hold; empty for none.
	QString m_Character;
	/// The take's file, which is never replaced.
	QString m_TakePath;
};

/// Writes the character's motion to a file on a thread of its own, one file at a time. A file that could not be written
/// whole is as it was.
class VMotionExport : public QObject
{
	Q_OBJECT

public:
	/// Ends what is being written.
	~VMotionExport() override;

	/// @return a sentence that tells why not; empty if it is under way.
	QString Begin(VMotionExportTask i_Task);
	void Cancel();
	bool IsRunning() const { return m_bRunning; }
	/// From 0 to 1.
	double Part() const { return m_Part; }

signals:
	void progressed();
	/// @param i_rError why it is not written; empty if it is, or if it was cancelled.
	void done(const QString& i_rPath, const QString& i_rError);

private:
	/// Why not; empty if it is written, or was cancelled.
	QString Write(const VMotionExportTask& i_rTask);

	bool m_bRunning = false;
	double m_Part = 0.0;
	std::atomic<bool> m_bCancelled{false};
	/// Last: it uses all the others.
	std::jthread m_Thread;
};

} // namespace StudioHost
