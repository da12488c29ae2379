#pragma once

#include "retarget/text/Output.h"

#include "CoreOrlexTypes/Subject.h"
#include "TakeSolve/SolveReport.h"
#include "TakeSolve/TargetWords.h"

#include <string>
#include <vector>

/// A solved take in words and numbers.
namespace CommandLine
{

struct VSolveResult
{
	const CoreOrlexTypes::VSubject& m_rTarget;
	/// By targets.
	std::vector<std::string> m_TargetNames;
	const TakeSolve::VTakeSolve& m_rSolve;
	const TakeSolve::VSolvedTake& m_rSolved;
	const TakeSolve::VSolveReport& m_rReport;
};

using TakeSolve::IsRotationTarget;
using TakeSolve::SourceOf;
using TakeSolve::TargetOf;
using TakeSolve::UnitFactor;
using TakeSolve::UnitOf;

/// What an animator would look for, one sentence each, with words for scripts.
std::vector<TakeSolve::VFinding> FindingsOf(const VSolveResult& i_rResult);

VJson SolveToJson(const VSolveResult& i_rResult);
std::string SolveToText(const VSolveResult& i_rResult);
/// A line for each frame: its number, its time in seconds, whether it converged, the iterations, and the residual of
/// each target; empty where it has none.
std::string SolveToCsv(const VSolveResult& i_rResult);

} // namespace CommandLine
