#include "TakeSolve/TakeSolve.h"

#include "CoreOrlexTypes/Subject.h"

#include <algorithm>
#include <chrono>
#include <limits>
#include <map>

namespace TakeSolve
{
namespace
{

using CoreOrlexTypes::VSubject;

/// Where a joint counts as at the end of its range, as a part of the way there.
constexpr double c_EndOfRange = 0.99;

/// By named things the segment of the same name, of several the first.
template <typename TNamed>
std::vector<std::int64_t> SegmentsOf(const std::vector<TNamed>& i_rNamed, const std::vector<std::string>& i_rSegments)
{
	std::map<std::string_view, std::int64_t> byName;
	for (std::size_t i = 0; i < i_rSegments.size(); ++i)
		byName.emplace(i_rSegments[i], std::int64_t(i));
	std::vector<std::int64_t> segments;
	for (const TNamed& rNamed : i_rNamed)
	{
		const auto found = byName.find(rNamed.m_Name);
		segments.push_back(found == byName.end() ? -1 : found->second);
	}
	return segments;
}

/// The first name that a target observes and the performer does not have; empty if it has all.
std::string Unobserved(const VSubject& i_rTarget, const VSubject::VTarget& i_rObserving,
    const std::vector<std::int64_t>& i_rMarkers, const std::vector<std::int64_t>& i_rRotations)
{
	for (const std::uint32_t marker : i_rObserving.m_MarkerIndices)
		if (marker < i_rMarkers.size() && i_rMarkers[marker] < 0)
			return i_rTarget.m_Markers[marker].m_Name;
	for (const std::uint32_t rotation : i_rObserving.m_RotationObservationIndices)
		if (rotation < i_rRotations.size() && i_rRotations[rotation] < 0)
			return i_rTarget.m_Rotations[rotation].m_Name;
	return {};
}

} // namespace

VTakeSolve::VTakeSolve(const VSubject& i_rTarget, std::span<const double> i_BindPose,
    std::shared_ptr<const VSourceMotion> i_pSource, const ComputeSubject::VSolveScales& i_rScales)
    : m_pSource(std::move(i_pSource)), m_Solver(i_rTarget, i_BindPose, i_rScales),
      m_MarkerSegments(SegmentsOf(i_rTarget.m_Markers, m_pSource->SegmentNames())),
      m_RotationSegments(SegmentsOf(i_rTarget.m_Rotations, m_pSource->SegmentNames())),
      m_Positions(3 * i_rTarget.m_Markers.size(), std::numeric_limits<double>::quiet_NaN()),
      m_Rotations(9 * i_rTarget.m_Rotations.size(), std::numeric_limits<double>::quiet_NaN())
{
	for (std::size_t i = 0; i < i_rTarget.m_Targets.size(); ++i)
	{
		const std::string missing = Unobserved(i_rTarget, i_rTarget.m_Targets[i], m_MarkerSegments, m_RotationSegments);
		m_Observed.push_back(missing.empty());
		const std::string& rReason = m_Solver.LeftOut(i);
		if (!rReason.empty() || !missing.empty())
			m_Findings.push_back({"left-out",
			    "Target #" + std::to_string(i) + " is left out of the solve. "
			        + (rReason.empty() ? "The performer has no segment \"" + missing + "\" that it could follow."
			                           : rReason)});
	}
}

const ComputeSubject::VSolvedFrame& VTakeSolve::Solve(std::size_t i_Frame)
{
	m_pSource->Poses(i_Frame, m_JointPoses, m_SourcePoses);
	for (std::size_t i = 0; i < m_MarkerSegments.size(); ++i)
		if (m_MarkerSegments[i] >= 0)
			std::ranges::copy(m_SourcePoses[std::size_t(m_MarkerSegments[i])].t, &m_Positions[3 * i]);
	for (std::size_t i = 0; i < m_RotationSegments.size(); ++i)
		if (m_RotationSegments[i] >= 0)
			std::ranges::copy(m_SourcePoses[std::size_t(m_RotationSegments[i])].R, &m_Rotations[9 * i]);
	return m_Solver.Solve({m_Positions, m_Rotations});
}

bool SolveFrames(VTakeSolve& io_rSolve, std::size_t i_First, std::size_t i_Last, const VSolveProgress& i_rProgress,
    VSolvedTake& o_rSolved)
{
	const std::size_t count = i_Last + 1 - i_First;
	o_rSolved = {};
	o_rSolved.m_First = i_First;
	o_rSolved.m_NumberOfTargets = io_rSolve.NumberOfTargets();
	o_rSolved.m_Residuals.reserve(count * o_rSolved.m_NumberOfTargets);
	io_rSolve.Restart();
	for (std::size_t i = 0; i < count; ++i)
	{
		const auto begin = std::chrono::steady_clock::now();
		const ComputeSubject::VSolvedFrame& rFrame = io_rSolve.Solve(i_First + i);
		const std::chrono::duration<float, std::milli> took = std::chrono::steady_clock::now() - begin;
		if (i == 0)
		{
			o_rSolved.m_NumberOfStates = rFrame.m_States.size();
			o_rSolved.m_States.reserve(count * rFrame.m_States.size());
			o_rSolved.m_EndsOfRanges.assign(rFrame.m_RangeShares.size(), 0);
		}
		o_rSolved.m_States.insert(o_rSolved.m_States.end(), rFrame.m_States.begin(), rFrame.m_States.end());
		o_rSolved.m_Residuals.insert(o_rSolved.m_Residuals.end(), rFrame.m_Residuals.begin(), rFrame.m_Residuals.end());
		for (std::size_t k = 0; k < rFrame.m_RangeShares.size(); ++k)
			o_rSolved.m_EndsOfRanges[k] += rFrame.m_RangeShares[k] > c_EndOfRange;
		o_rSolved.m_Iterations.push_back(std::uint32_t(rFrame.m_Iterations));
		o_rSolved.m_Converged.push_back(rFrame.m_bConverged);
		o_rSolved.m_Milliseconds.push_back(took.count());
		o_rSolved.m_Frames = i + 1;
		if (i_rProgress && !i_rProgress(i + 1, count))
			return i + 1 == count;
	}
	return true;
}

} // namespace TakeSolve
