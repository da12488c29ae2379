#pragma once

#include "retarget/text/Output.h"

#include "CoreOrlexTypes/Subject.h"
#include "TakeSolve/SolveReport.h"

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

bool IsRotationTarget(const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
/// The residuals' unit, and what they are multiplied by for it.
const char* UnitOf(const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
double UnitFactor(const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
/// What a target follows, and the segment of the character that it stands on.
std::string SourceOf(const CoreOrlexTypes::VSubject& i_rSubject, const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
std::string TargetOf(const CoreOrlexTypes::VSubject& i_rSubject, const CoreOrlexTypes::VSubject::VTarget& i_rTarget);

/// What an animator would look for, one sentence each, with words for scripts.
std::vector<TakeSolve::VFinding> FindingsOf(const VSolveResult& i_rResult);

VJson SolveToJson(const VSolveResult& i_rResult);
std::string SolveToText(const VSolveResult& i_rResult);
/// A line for each frame: its number, its time in seconds, whether it converged, the iterations, and the residual of
/// each target; empty where it has none.
std::string SolveToCsv(const VSolveResult& i_rResult);

} // namespace CommandLine
