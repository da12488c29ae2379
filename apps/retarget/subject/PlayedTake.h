#pragma once

#include "retarget/subject/Session.h"
#include "retarget/subject/SolveText.h"
#include "retarget/subject/TakeFile.h"
#include "retarget/text/MotionFile.h"

#include "TakeIO/ReadTake.h"
#include "TakeSolve/PosedSubject.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace CommandLine
{

/// Which take is played, and with whom.
struct VTakeToPlay
{
	/// The retarget subject as the command line names it, for messages.
	std::string m_Subject;
	std::string m_Take;
	/// The performer's skeleton; empty: the session's, or where it has none one that is made of the take.
	std::string m_Source;
	std::shared_ptr<TakeIO::VTakeSettings> m_pTake = std::make_shared<TakeIO::VTakeSettings>();
	std::shared_ptr<VPairSettings> m_pPairs = std::make_shared<VPairSettings>();
	std::optional<std::size_t> m_FirstFrame;
	std::optional<std::size_t> m_LastFrame;
};

/// A take that was played through the target subject of a session. Its parts refer to each other: it stays where it is.
struct VPlayedTake
{
	VPlayedTake(const CoreOrlexTypes::VSubjectParametrised& i_rSource,
	    const CoreOrlexTypes::VSubjectParametrised& i_rTarget, std::shared_ptr<const TakeIO::VTake> i_pTake);
	VPlayedTake(const VPlayedTake&) = delete;
	VPlayedTake& operator=(const VPlayedTake&) = delete;

	VSolveResult Result() const { return {m_Target.m_Subject, m_TargetNames, *m_Solve, m_Solved, m_Report}; }

	std::shared_ptr<const TakeIO::VTake> m_pTake;
	TakeSolve::VPosedSubject m_Source;
	TakeSolve::VPosedSubject m_Target;
	std::optional<TakeSolve::VTakeSolve> m_Solve;
	TakeSolve::VSolvedTake m_Solved;
	TakeSolve::VSolveReport m_Report;
	/// By targets.
	std::vector<std::string> m_TargetNames;
};

/// Throws VCommandError where a file is no good, frames are none of the take's, or there is nothing to solve.
/// A bar shows how far it is.
std::unique_ptr<const VPlayedTake> PlayTake(VSession& io_rSession, const VTakeToPlay& i_rWhat);
/// The same with a take and its pairs that are there already.
std::unique_ptr<const VPlayedTake> PlayTake(VSession& io_rSession, const VTakeToPlay& i_rWhat,
    const std::shared_ptr<const TakeIO::VTake>& i_rpTake, const TakeSolve::VSourceSettings& i_rPairs);

/// Writes the character's motion as WriteMotionFile does, at the size of the session's subject.
void WriteSolvedMotion(const VSession& i_rSession, const VPlayedTake& i_rPlayed, VMotionOutput i_Output);

} // namespace CommandLine
