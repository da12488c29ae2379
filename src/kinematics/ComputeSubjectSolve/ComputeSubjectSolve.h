#pragma once

#include "ComputeSubjectSolve/SolveObjective.h"
#include "numerics/Rotation.h"

#include <cstddef>
#include <memory>
#include <span>
#include <string>
#include <vector>

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace ComputeSubject
{

/// What was observed in a frame, by the indices of the subject's markers and rotation observations. An observation that
/// is not finite, or beyond the end, is missing.
struct VObservations
{
	/// World positions in mm, three values for each marker.
	std::span<const double> m_Positions;
	/// World rotations, nine values for each rotation observation, row by row.
	std::span<const double> m_Rotations;
};

struct VSolvedFrame
{
	/// All joints' states in the order of the segments (radians, mm), angle-axis vectors and angles of the revolution
	/// that is nearest to the frame before, in the first frame to the bind pose.
	std::vector<double> m_States;
	/// The segment frames in the world.
	std::vector<Rotation::VPose<double>> m_WorldPoses;
	/// For each of the subject's targets mm, of rotations radians; of a rigid body the largest of its markers. NaN for
	/// a target that is left out, or whose observation is missing.
	std::vector<double> m_Residuals;
	/// For each segment how far its joint is out in its range: 0 at the centring state, about 1 at the end. 0 without a
	/// range, and of joints that are not solved for.
	std::vector<double> m_RangeShares;
	/// What SolveObjective.h says, at the states.
	double m_Cost = 0.0;
	/// Steps that were tried, those from the seed included.
	std::size_t m_Iterations = 0;
	/// False if the states are only the best that was found.
	bool m_bConverged = false;
	/// Whether the states come from the seed, not from the frame before.
	bool m_bSeeded = false;
};

/// Inverse kinematics of a subject: the states that bring its targets nearest to what was observed, frame after frame.
/// A stand-in for the solver of a host, which may weigh things differently.
/// Newton's method with damping by Levenberg and Marquardt: rotations are changed in their tangent space, and the
/// linear system is eliminated from the leaves of the tree to its root, in time proportional to its size.
/// The same frames give the same bytes. Not thread safe; several objects may run in parallel.
class VComputeSubjectSolve
{
public:
	/// @param i_BindPose the states of all joints in the order of the segments; missing ones count as 0.
	/// Throws VConstructionException for a joint of a type that has no class.
	VComputeSubjectSolve(const CoreOrlexTypes::VSubject& i_rSubject, std::span<const double> i_BindPose,
	    const VSolveScales& i_rScales = {});
	~VComputeSubjectSolve();
	VComputeSubjectSolve(const VComputeSubjectSolve&) = delete;
	VComputeSubjectSolve& operator=(const VComputeSubjectSolve&) = delete;

	/// Why a target of the subject is not solved; empty if it is.
	const std::string& LeftOut(std::size_t i_Target) const;

	/// How many of the states are solved for.
	std::size_t NumberOfActiveStates() const;

	/// From the frame before; from the seed if there is none, or if it does not converge from there. The seed takes
	/// joints from the rotation observations of their segments, others from the bind pose, and moves the root by the
	/// mean of what the positions are off.
	/// The result stays as it is until the next call. Allocates nothing.
	const VSolvedFrame& Solve(const VObservations& i_rObservations);

	/// The next frame has none before it.
	void Restart();

	/// The next frame starts from these states, NumberOfStates of forward kinematics, as if they were the frame before.
	void StartFrom(std::span<const double> i_States);

private:
	struct VImplementation;
	std::unique_ptr<VImplementation> m_pImplementation;
};

} // namespace ComputeSubject
