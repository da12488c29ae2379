#include "retarget/subject/PlayedTake.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "CommandLineText/ProgressBar.h"
#include "retarget/subject/TakeFile.h"

#include "ComputeSubjectFK/ConstructionException.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "TakeSolve/Performer.h"
#include "TakeSolve/SolvedMotion.h"

#include <utility>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;

VSubjectParametrised PerformerOf(const VTakeToPlay& i_rWhat, VSession& io_rSession, const TakeIO::VTake& i_rTake)
{
	if (!i_rWhat.m_Source.empty())
		io_rSession.LoadSource(i_rWhat.m_Source);
	if (io_rSession.Document().SourceValues().m_pParametrised)
		return io_rSession.Source("posing it");
	std::vector<TakeSolve::VFinding> findings;
	const TakeSolve::VStandingPose pose = TakeSolve::StandingPose(i_rTake);
	auto record = TakeSolve::MakePerformer(i_rTake, pose, StemOf(i_rWhat.m_Take), findings);
	if (const std::string text = TextOf(pose, i_rTake); !text.empty())
		NVX_LOG(c_pCategory, NVX::ELogInformation, "%1%", text);
	for (const TakeSolve::VFinding& rFinding : findings)
		NVX_LOG(c_pCategory, NVX::ELogWarning, "%1%", rFinding.m_Message);
	return std::move(record.m_SubjectParametrised);
}

std::pair<std::size_t, std::size_t> FramesOrRefuse(const VTakeToPlay& i_rWhat, std::size_t i_Frames)
{
	const std::size_t first = i_rWhat.m_FirstFrame.value_or(0);
	const std::size_t last = i_rWhat.m_LastFrame.value_or(i_Frames - 1);
	if (first > last || last >= i_Frames)
		throw VCommandError(EWrongUsage,
		    "--frames: the take has the frames 0 to " + std::to_string(i_Frames - 1) + ", not " + std::to_string(first)
		        + " to " + std::to_string(last));
	return {first, last};
}

} // namespace

VPlayedTake::VPlayedTake(const VSubjectParametrised& i_rSource, const VSubjectParametrised& i_rTarget,
    std::shared_ptr<const TakeIO::VTake> i_pTake)
    : m_pTake(std::move(i_pTake)), m_Source(i_rSource), m_Target(i_rTarget)
{
}

std::unique_ptr<const VPlayedTake> PlayTake(VSession& io_rSession, const VTakeToPlay& i_rWhat)
{
	const TakeSolve::VSourceSettings pairs = ReadPairs(*i_rWhat.m_pPairs);
	return PlayTake(io_rSession, i_rWhat,
	    std::make_shared<const TakeIO::VTake>(ReadTakeFile(i_rWhat.m_Take, *i_rWhat.m_pTake)), pairs);
}

std::unique_ptr<const VPlayedTake> PlayTake(VSession& io_rSession, const VTakeToPlay& i_rWhat,
    const std::shared_ptr<const TakeIO::VTake>& i_rpTake, const TakeSolve::VSourceSettings& i_rPairs)
{
	const VSubjectParametrised performer = PerformerOf(i_rWhat, io_rSession, *i_rpTake);
	auto pPlayed = std::make_unique<VPlayedTake>(performer, io_rSession.Target(), i_rpTake);
	RequireNoErrors();
	const TakeSolve::VPosedSubject& rSource = pPlayed->m_Source;
	const TakeSolve::VPosedSubject& rTarget = pPlayed->m_Target;
	std::string error;
	const auto pMotion =
	    TakeSolve::VSourceMotion::Make(rSource.m_Subject, rSource.m_BindPose, i_rpTake, i_rPairs, error);
	if (!pMotion)
		throw VCommandError(EWrongUsage, error);
	const auto [first, last] = FramesOrRefuse(i_rWhat, i_rpTake->m_Frames);
	if (rTarget.m_Subject.m_Targets.empty())
		throw VCommandError(EBadInput, "\"" + i_rWhat.m_Subject + "\" has no targets: there is nothing to solve");
	try
	{
		pPlayed->m_Solve.emplace(rTarget.m_Subject, rTarget.m_BindPose, pMotion);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		throw VCommandError(
		    EBadInput, "\"" + i_rWhat.m_Subject + "\" has a joint without kinematics; retarget check tells which");
	}
	const TakeSolve::VTakeSolve& rSolve = *pPlayed->m_Solve;
	bool bAny = false;
	for (std::size_t i = 0; i < rSolve.NumberOfTargets(); ++i)
		bAny = bAny || rSolve.IsSolved(i);
	if (!bAny)
		throw VCommandError(
		    EBadInput, "No target can be solved with this performer. " + rSolve.Findings().front().m_Message);
	VProgressBar bar("Solving");
	const auto progress = [&bar](std::size_t i_Done, std::size_t i_Frames)
	{
		bar.Show(double(i_Done) / double(i_Frames));
		return true;
	};
	TakeSolve::SolveFrames(*pPlayed->m_Solve, first, last, progress, pPlayed->m_Solved);
	TakeSolve::ReportOn(
	    rTarget.m_Subject, rTarget.m_BindPose, *pMotion, pPlayed->m_Solved, progress, pPlayed->m_Report);
	const auto& rNamed = io_rSession.Document().TargetValues().m_pApplicationData->m_Targets;
	for (std::size_t i = 0; i < rTarget.m_Subject.m_Targets.size(); ++i)
		pPlayed->m_TargetNames.push_back(i < rNamed.size() ? rNamed[i].m_Name : std::string());
	return pPlayed;
}

void WriteSolvedMotion(const VSession& i_rSession, const VPlayedTake& i_rPlayed, VMotionOutput i_Output)
{
	i_Output.m_Scale = RetargetSetup::GetGlobalScale(i_rSession.Target());
	WriteMotionFile(TakeSolve::MotionOf(i_rPlayed.m_Target.m_Subject, i_rPlayed.m_Target.m_BindPose, i_rPlayed.m_Solved,
	                    i_rPlayed.m_pTake->m_Rate),
	    i_Output);
}

} // namespace CommandLine
