#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectRecord.h"
#include "TakeSolve/PosedSubject.h"
#include "TakeSolve/SolveReport.h"
#include "TakeSolve/TakeSolve.h"

#include <QObject>
#include <QPolygonF>
#include <QString>

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <thread>
#include <vector>

namespace StudioHost
{

/// What is to be solved. Nobody changes any of it afterwards.
struct VSolveTask
{
	std::shared_ptr<const TakeIO::VTake> m_pTake;
	/// Null where there is none: then a performer is made of the take.
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pSource;
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pTarget;
};

/// One frame of a take as it is shown.
struct VTakePicture
{
	std::size_t m_Frame = 0;
	/// What it was solved for: states and residuals are of these alone.
	VSolveTask m_Of;
	/// The performer on free joints (TakeSolve::WithFreeJoints), and his states; the same object from frame to frame.
	std::shared_ptr<const CoreOrlexTypes::VSubject> m_pSource;
	/// Of one that was made of the take; null otherwise.
	std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> m_pSourceData;
	std::vector<double> m_SourceStates;
	/// Of the character; its bind pose if there is nothing that it could follow. Empty without one.
	std::vector<double> m_TargetStates;
	/// As ComputeSubject::VSolvedFrame has them; empty if nothing was solved.
	std::vector<double> m_Residuals;
	bool m_bConverged = true;
};

/// All frames in sequence, as the command line solves them, and what is judged of them.
struct VJudgedTake
{
	VSolveTask m_Of;
	std::shared_ptr<const TakeSolve::VPosedSubject> m_pTarget;
	TakeSolve::VSolvedTake m_Solved;
	TakeSolve::VSolveReport m_Report;
	/// By targets, residuals over the frames for a plot: of a long take the least and the greatest of some thousand
	/// parts. A hundred thousand frames are more than a window gathers in passing.
	std::vector<QPolygonF> m_Curves;
};

/// Reads takes and solves them on a thread of its own, of less priority than the window's. What is asked for last
/// counts: a new task ends the one before, a picture that was asked for and not made yet gives way to the next one.
/// Between two frames of the sequence there is time for a picture. A file that is to be read ends the sequence. Signals
/// come on the thread that made this, and only of the task and the file that were asked for last.
class VTakeSolving : public QObject
{
	Q_OBJECT

public:
	VTakeSolving();
	/// Waits for what it is at.
	~VTakeSolving() override;

	void Read(const QString& i_rPath);
	/// The reading ends, and is not told of.
	void CancelReading();
	/// Begins with no picture; the sequence follows by itself.
	void Solve(VSolveTask i_Task);
	/// The sequence ends; pictures are still made.
	void CancelSequence();
	void Show(std::size_t i_Frame);

signals:
	/// @param i_Part how much of the file is read, from 0 to 1.
	void readOn(double i_Part);
	/// @param i_rError why there is none.
	void read(const QString& i_rPath, std::shared_ptr<const TakeIO::VTake> i_pTake, const QString& i_rError);
	/// @param i_rFindings what the operator ought to know of this performer and take together, once for them
	/// @param i_rError why it cannot be played; empty if it can.
	void prepared(const QStringList& i_rFindings, const QString& i_rError);
	void pictured(std::shared_ptr<const StudioHost::VTakePicture> i_pPicture);
	void progressed(int i_Solved, int i_Frames);
	void judged(std::shared_ptr<const StudioHost::VJudgedTake> i_pJudged);

private:
	/// What the thread is asked for; guarded by the mutex.
	struct VRequest
	{
		std::optional<QString> m_Path;
		std::optional<VSolveTask> m_Task;
		std::optional<std::size_t> m_Frame;
		bool m_bSequence = true;
	};

	void Run(std::stop_token i_Stop);
	void Answer(VRequest i_Request, std::uint64_t i_ReadNumber, std::uint64_t i_TaskNumber);
	void ReadFile(const QString& i_rPath, std::uint64_t i_Number);
	void Prepare(VSolveTask i_Task, std::uint64_t i_Number);
	void Judge();
	void MakePicture(std::size_t i_Frame);
	/// Makes the picture that is asked for.
	/// @return whether the sequence goes on.
	bool BetweenFrames();
	/// Runs it on the thread of this object, unless the number has been raised by then.
	template <typename TTell>
	void Tell(const std::atomic<std::uint64_t>& i_rLast, std::uint64_t i_Number, TTell i_Tell);

	std::mutex m_Mutex;
	std::condition_variable_any m_Wake;
	VRequest m_Request;
	/// What is told of others is out of date. Any thread.
	std::atomic<std::uint64_t> m_ReadNumber{0};
	std::atomic<std::uint64_t> m_TaskNumber{0};

	struct VPrepared;
	// Of the thread.
	std::unique_ptr<VPrepared> m_pPrepared;
	std::stop_token m_Stop;

	/// Last: it uses all the others.
	std::jthread m_Thread;
};

} // namespace StudioHost
