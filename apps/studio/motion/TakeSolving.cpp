#include "studio/motion/TakeSolving.h"

#include "ComputeSubjectFK/ConstructionException.h"
#include "DebugServices/GlobalLog.h"
#include "TakeIO/ReadTake.h"
#include "TakeSolve/FreePose.h"
#include "TakeSolve/Performer.h"

#include <QStringList>

#include <algorithm>
#include <cmath>
#include <new>
#include <sys/resource.h>
#include <unistd.h>
#include <utility>

namespace StudioHost
{
namespace
{

/// How often the progress of a sequence is told.
constexpr std::size_t c_ProgressSteps = 200;
/// Of the thread. A core that it wants alone is its own; of one that the window wants, too, it gets a quarter.
constexpr int c_Niceness = 5;
/// Its name is shown over it.
constexpr const char* c_pMadePerformer = "Performer";

/// More than a screen has columns: of a longer take each gets the least and the greatest of its frames.
constexpr std::size_t c_Bins = 2000;

QPolygonF CurveOf(const TakeSolve::VSolvedTake& i_rSolved, std::size_t i_Target)
{
	const auto value = [&](std::size_t i_Frame)
	{ return i_rSolved.m_Residuals[i_Frame * i_rSolved.m_NumberOfTargets + i_Target]; };
	const std::size_t frames = i_rSolved.m_Frames;
	const std::size_t bins = std::min(frames, c_Bins);
	QPolygonF points;
	points.reserve(int(2 * bins));
	for (std::size_t bin = 0; bin < bins; ++bin)
	{
		const std::size_t first = bin * frames / bins;
		const std::size_t end = (bin + 1) * frames / bins;
		std::size_t least = first, greatest = first;
		// Frames without a residual are none that is less.
		for (std::size_t frame = first + 1; frame < end; ++frame)
		{
			least = value(frame) < value(least) || std::isnan(value(least)) ? frame : least;
			greatest = value(frame) > value(greatest) || std::isnan(value(greatest)) ? frame : greatest;
		}
		if (std::isnan(value(least)))
			continue;
		points << QPointF(double(std::min(least, greatest)), value(std::min(least, greatest)));
		if (least != greatest)
			points << QPointF(double(std::max(least, greatest)), value(std::max(least, greatest)));
	}
	return points;
}

} // namespace

struct VTakeSolving::VPrepared
{
	VSolveTask m_Task;
	std::uint64_t m_Number = 0;
	/// Null if the performer cannot be posed.
	std::shared_ptr<const TakeSolve::VSourceMotion> m_pMotion;
	std::shared_ptr<const CoreOrlexTypes::VSubject> m_pFreeSource;
	std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> m_pSourceData;
	std::shared_ptr<const TakeSolve::VPosedSubject> m_pTarget;
	/// Null if there is nothing to solve. Each for itself, so that the sequence is what it is without pictures.
	std::unique_ptr<TakeSolve::VTakeSolve> m_pForPictures;
	std::unique_ptr<TakeSolve::VTakeSolve> m_pForSequence;
	/// As far as it was solved.
	std::shared_ptr<VJudgedTake> m_pSequence = std::make_shared<VJudgedTake>();
	std::vector<Rotation::VPose<double>> m_JointPoses;
	std::vector<Rotation::VPose<double>> m_SourcePoses;
};

VTakeSolving::VTakeSolving() : m_Thread([this](std::stop_token i_Stop) { Run(std::move(i_Stop)); }) {}

VTakeSolving::~VTakeSolving()
{
	m_Thread.request_stop();
	m_Thread.join();
}

void VTakeSolving::Read(const QString& i_rPath)
{
	const std::lock_guard lock(m_Mutex);
	++m_ReadNumber;
	m_Request.m_Path = i_rPath;
	m_Wake.notify_one();
}

void VTakeSolving::CancelReading()
{
	const std::lock_guard lock(m_Mutex);
	++m_ReadNumber;
	m_Request.m_Path.reset();
}

void VTakeSolving::Solve(VSolveTask i_Task)
{
	const std::lock_guard lock(m_Mutex);
	++m_TaskNumber;
	m_Request.m_Task = std::move(i_Task);
	m_Request.m_Frame.reset();
	m_Request.m_bSequence = true;
	m_Wake.notify_one();
}

void VTakeSolving::CancelSequence()
{
	const std::lock_guard lock(m_Mutex);
	m_Request.m_bSequence = false;
}

void VTakeSolving::Show(std::size_t i_Frame)
{
	const std::lock_guard lock(m_Mutex);
	m_Request.m_Frame = i_Frame;
	m_Wake.notify_one();
}

template <typename TTell>
void VTakeSolving::Tell(const std::atomic<std::uint64_t>& i_rLast, std::uint64_t i_Number, TTell i_Tell)
{
	QMetaObject::invokeMethod(
	    this,
	    [&i_rLast, i_Number, tell = std::move(i_Tell)]
	    {
		    if (i_Number == i_rLast)
			    tell();
	    },
	    Qt::QueuedConnection);
}

void VTakeSolving::Run(std::stop_token i_Stop)
{
	m_Stop = std::move(i_Stop);
	// The window draws, in software with threads of its own, what this solves beside it; a refusal changes nothing.
	setpriority(PRIO_PROCESS, id_t(gettid()), c_Niceness);
	std::unique_lock lock(m_Mutex);
	while (m_Wake.wait(lock, m_Stop, [this] { return m_Request.m_Path || m_Request.m_Task || m_Request.m_Frame; }))
	{
		VRequest request = std::exchange(m_Request, {{}, {}, {}, m_Request.m_bSequence});
		const std::uint64_t readNumber = m_ReadNumber, taskNumber = m_TaskNumber;
		lock.unlock();
		Answer(std::move(request), readNumber, taskNumber);
		lock.lock();
	}
}

void VTakeSolving::Answer(VRequest i_Request, std::uint64_t i_ReadNumber, std::uint64_t i_TaskNumber)
{
	try
	{
		if (i_Request.m_Path)
			ReadFile(*i_Request.m_Path, i_ReadNumber);
		if (i_Request.m_Task)
			Prepare(std::move(*i_Request.m_Task), i_TaskNumber);
		if (i_Request.m_Frame)
			MakePicture(*i_Request.m_Frame);
		if (i_Request.m_Task)
			Judge();
	}
	catch (const std::bad_alloc&)
	{
		m_pPrepared.reset();
		Tell(m_TaskNumber, i_TaskNumber,
		    [this] { emit prepared({}, tr("There is not enough memory to play the take")); });
	}
}

void VTakeSolving::ReadFile(const QString& i_rPath, std::uint64_t i_Number)
{
	const auto pTake = std::make_shared<TakeIO::VTake>();
	std::string error;
	TakeIO::VTakeSettings settings;
	int told = 0;
	settings.m_Progress = [&](double i_Part)
	{
		if (const int step = int(i_Part * c_ProgressSteps); step != std::exchange(told, step))
			Tell(m_ReadNumber, i_Number, [this, i_Part] { emit readOn(i_Part); });
		return i_Number == m_ReadNumber && !m_Stop.stop_requested();
	};
	try
	{
		if (TakeIO::ReadTake(i_rPath.toStdString(), settings, *pTake, error) && pTake->m_Frames == 0)
			error = "The take has no frames";
	}
	catch (const std::bad_alloc&)
	{
		error = "There is not enough memory for the take";
	}
	Tell(m_ReadNumber, i_Number,
	    [this, i_rPath, error, pTake = error.empty() ? std::shared_ptr<const TakeIO::VTake>(pTake) : nullptr]
	    { emit read(i_rPath, pTake, QString::fromStdString(error)); });
}

void VTakeSolving::Prepare(VSolveTask i_Task, std::uint64_t i_Number)
{
	const auto pBefore = std::exchange(m_pPrepared, std::make_unique<VPrepared>());
	VPrepared& rNow = *m_pPrepared;
	rNow.m_Number = i_Number;
	std::string error;
	QStringList findings;
	try
	{
		// Most edits are of the character.
		if (pBefore && pBefore->m_Task.m_pTake == i_Task.m_pTake && pBefore->m_Task.m_pSource == i_Task.m_pSource)
		{
			rNow.m_pMotion = pBefore->m_pMotion;
			rNow.m_pFreeSource = pBefore->m_pFreeSource;
			rNow.m_pSourceData = pBefore->m_pSourceData;
		}
		else if (i_Task.m_pTake)
		{
			CoreOrlexTypes::VSubjectRecord made;
			if (!i_Task.m_pSource)
			{
				std::vector<TakeSolve::VFinding> ofMaking;
				const TakeSolve::VStandingPose pose = TakeSolve::StandingPose(*i_Task.m_pTake);
				made = TakeSolve::MakePerformer(*i_Task.m_pTake, pose, c_pMadePerformer, ofMaking);
				if (const std::string text = TextOf(pose, *i_Task.m_pTake); !text.empty())
					NVX_LOG("Motion", NVX::ELogInformation, "%1%", text);
				for (const TakeSolve::VFinding& rFinding : ofMaking)
					findings << QString::fromStdString(rFinding.m_Message);
				rNow.m_pSourceData = std::make_shared<const CoreOrlexTypes::VSubjectApplicationData>(
				    std::move(made.m_SubjectApplicationData));
			}
			const TakeSolve::VPosedSubject source(i_Task.m_pSource ? *i_Task.m_pSource : made.m_SubjectParametrised);
			rNow.m_pMotion =
			    TakeSolve::VSourceMotion::Make(source.m_Subject, source.m_BindPose, i_Task.m_pTake, {}, error);
			rNow.m_pFreeSource =
			    std::make_shared<const CoreOrlexTypes::VSubject>(TakeSolve::WithFreeJoints(source.m_Subject));
			if (rNow.m_pMotion)
				for (const TakeSolve::VFinding& rFinding : rNow.m_pMotion->Findings())
					findings << QString::fromStdString(rFinding.m_Message);
		}
		if (i_Task.m_pTarget)
			rNow.m_pTarget = std::make_shared<const TakeSolve::VPosedSubject>(*i_Task.m_pTarget);
		if (rNow.m_pMotion && rNow.m_pTarget && !rNow.m_pTarget->m_Subject.m_Targets.empty())
			for (auto* const ppSolve : {&rNow.m_pForPictures, &rNow.m_pForSequence})
				*ppSolve = std::make_unique<TakeSolve::VTakeSolve>(
				    rNow.m_pTarget->m_Subject, rNow.m_pTarget->m_BindPose, rNow.m_pMotion);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		error = "The retarget subject has a joint without kinematics; retarget check tells which";
		rNow.m_pForPictures.reset();
	}
	rNow.m_Task = std::move(i_Task);
	Tell(m_TaskNumber, i_Number,
	    [this, findings, text = QString::fromStdString(error)] { emit prepared(findings, text); });
}

void VTakeSolving::MakePicture(std::size_t i_Frame)
{
	if (!m_pPrepared || !m_pPrepared->m_pMotion || i_Frame >= m_pPrepared->m_Task.m_pTake->m_Frames)
		return;
	VPrepared& rNow = *m_pPrepared;
	const auto pPicture = std::make_shared<VTakePicture>();
	pPicture->m_Frame = i_Frame;
	pPicture->m_Of = rNow.m_Task;
	pPicture->m_pSource = rNow.m_pFreeSource;
	pPicture->m_pSourceData = rNow.m_pSourceData;
	rNow.m_pMotion->Poses(i_Frame, rNow.m_JointPoses, rNow.m_SourcePoses);
	TakeSolve::FreeStates(*rNow.m_pFreeSource, rNow.m_SourcePoses, pPicture->m_SourceStates);
	const TakeSolve::VSolvedTake& rSolved = rNow.m_pSequence->m_Solved;
	if (i_Frame < rSolved.m_Frames)
	{
		const auto states = rSolved.States(i_Frame);
		const auto residuals = rSolved.Residuals(i_Frame);
		pPicture->m_TargetStates.assign(states.begin(), states.end());
		pPicture->m_Residuals.assign(residuals.begin(), residuals.end());
		pPicture->m_bConverged = rSolved.m_Converged[i_Frame] != 0;
	}
	else if (rNow.m_pForPictures)
	{
		const ComputeSubject::VSolvedFrame& rFrame = rNow.m_pForPictures->Solve(i_Frame);
		pPicture->m_TargetStates = rFrame.m_States;
		pPicture->m_Residuals = rFrame.m_Residuals;
		pPicture->m_bConverged = rFrame.m_bConverged;
	}
	else if (rNow.m_pTarget)
		pPicture->m_TargetStates = rNow.m_pTarget->m_BindPose;
	Tell(m_TaskNumber, rNow.m_Number, [this, pPicture] { emit pictured(pPicture); });
}

void VTakeSolving::Judge()
{
	VPrepared& rNow = *m_pPrepared;
	if (!rNow.m_pForSequence || !rNow.m_pForPictures)
		return;
	VJudgedTake& rJudged = *rNow.m_pSequence;
	rJudged.m_Of = rNow.m_Task;
	rJudged.m_pTarget = rNow.m_pTarget;
	const auto solving = [this](std::size_t i_Solved, std::size_t i_Frames)
	{
		if (i_Solved % std::max<std::size_t>(1, i_Frames / c_ProgressSteps) == 0)
			Tell(m_TaskNumber, m_pPrepared->m_Number,
			    [this, i_Solved, i_Frames] { emit progressed(int(i_Solved), int(i_Frames)); });
		return BetweenFrames();
	};
	const auto judging = [this](std::size_t, std::size_t) { return BetweenFrames(); };
	if (!TakeSolve::SolveFrames(*rNow.m_pForSequence, 0, rNow.m_Task.m_pTake->m_Frames - 1, solving, rJudged.m_Solved)
	    || !TakeSolve::ReportOn(rNow.m_pTarget->m_Subject, rNow.m_pTarget->m_BindPose, *rNow.m_pMotion,
	        rJudged.m_Solved, judging, rJudged.m_Report))
		return;
	for (std::size_t i = 0; i < rJudged.m_Solved.m_NumberOfTargets && BetweenFrames(); ++i)
		rJudged.m_Curves.push_back(CurveOf(rJudged.m_Solved, i));
	if (rJudged.m_Curves.size() < rJudged.m_Solved.m_NumberOfTargets)
		return;
	Tell(m_TaskNumber, rNow.m_Number,
	    [this, pJudged = std::shared_ptr<const VJudgedTake>(rNow.m_pSequence)] { emit judged(pJudged); });
}

bool VTakeSolving::BetweenFrames()
{
	std::unique_lock lock(m_Mutex);
	const bool bOther = m_Request.m_Path || m_Request.m_Task;
	const std::optional<std::size_t> frame = bOther ? std::nullopt : std::exchange(m_Request.m_Frame, std::nullopt);
	const bool bGoesOn = !bOther && m_Request.m_bSequence && !m_Stop.stop_requested();
	lock.unlock();
	if (frame)
		MakePicture(*frame);
	return bGoesOn;
}

} // namespace StudioHost

#include "moc_TakeSolving.cpp"
