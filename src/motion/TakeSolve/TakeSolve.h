#pragma once

#include "ComputeSubjectSolve/ComputeSubjectSolve.h"
#include "TakeSolve/Finding.h"
#include "TakeSolve/SourceMotion.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <span>
#include <vector>

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace TakeSolve
{

/// A character that follows a performer who moves by a take. Frames are solved in any order; each starts from the one
/// that was solved before. Not thread safe; several objects may run in parallel.
class VTakeSolve
{
public:
	/// @param i_BindPose the states of all joints in the order of the segments; missing ones count as 0.
	/// Throws ComputeSubject::VConstructionException for a joint of a type that has no class.
	VTakeSolve(const CoreOrlexTypes::VSubject& i_rTarget, std::span<const double> i_BindPose,
	    std::shared_ptr<const VSourceMotion> i_pSource, const ComputeSubject::VSolveScales& i_rScales = {});

	/// Poses the performer and solves. The results stay as they are until the next call. Allocates nothing after the
	/// first frame.
	const ComputeSubject::VSolvedFrame& Solve(std::size_t i_Frame);
	/// World poses of the performer's segments in the frame that was solved last.
	const std::vector<Rotation::VPose<double>>& SourcePoses() const { return m_SourcePoses; }

	const VSourceMotion& Source() const { return *m_pSource; }
	/// Targets that are left out, and why.
	const std::vector<VFinding>& Findings() const { return m_Findings; }
	/// By targets, whether it is solved for.
	bool IsSolved(std::size_t i_Target) const { return m_Solver.LeftOut(i_Target).empty() && m_Observed[i_Target]; }
	std::size_t NumberOfTargets() const { return m_Observed.size(); }
	std::size_t NumberOfActiveStates() const { return m_Solver.NumberOfActiveStates(); }

	/// The next frame has none before it; or it starts from these states.
	void Restart() { m_Solver.Restart(); }
	void StartFrom(std::span<const double> i_States) { m_Solver.StartFrom(i_States); }

private:
	std::shared_ptr<const VSourceMotion> m_pSource;
	ComputeSubject::VComputeSubjectSolve m_Solver;
	std::vector<VFinding> m_Findings;
	std::vector<bool> m_Observed;
	/// By markers and rotation observations the segment of the performer, -1 for none.
	std::vector<std::int64_t> m_MarkerSegments;
	std::vector<std::int64_t> m_RotationSegments;
	std::vector<double> m_Positions;
	std::vector<double> m_Rotations;
	std::vector<Rotation::VPose<double>> m_JointPoses;
	std::vector<Rotation::VPose<double>> m_SourcePoses;
};

/// Frames of a take that were solved one after the other. World poses follow from the states.
struct VSolvedTake
{
	std::size_t m_First = 0;
	std::size_t m_Frames = 0;
	/// Of a frame.
	std::size_t m_NumberOfStates = 0;
	std::size_t m_NumberOfTargets = 0;
	/// Frame after frame, as ComputeSubject::VSolvedFrame has them.
	std::vector<double> m_States;
	std::vector<double> m_Residuals;
	std::vector<std::uint32_t> m_Iterations;
	std::vector<std::uint8_t> m_Converged;
	/// By segments, in how many frames its joint was at the end of its range.
	std::vector<std::uint32_t> m_EndsOfRanges;
	/// What a frame took.
	std::vector<float> m_Milliseconds;

	std::span<const double> States(std::size_t i_Index) const
	{
		return std::span(m_States).subspan(i_Index * m_NumberOfStates, m_NumberOfStates);
	}
	std::span<const double> Residuals(std::size_t i_Index) const
	{
		return std::span(m_Residuals).subspan(i_Index * m_NumberOfTargets, m_NumberOfTargets);
	}
};

/// Called after each frame with how many are solved, and of how many; false cancels.
using VSolveProgress = std::function<bool(std::size_t i_Solved, std::size_t i_Frames)>;

/// Solves the frames from the first to the last, which is among them, from a new start. The same frames give the same
/// bytes, the times aside.
/// @return false if it was cancelled; what was solved until then stands in the result.
bool SolveFrames(VTakeSolve& io_rSolve, std::size_t i_First, std::size_t i_Last, const VSolveProgress& i_rProgress,
    VSolvedTake& o_rSolved);

} // namespace TakeSolve
