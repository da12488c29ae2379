#pragma once

#include "CoreOrlexTypes/Subject.h"

#include <memory>
#include <span>
#include <vector>

/// The same cost as ComputeSubjectSolve/SolveObjective.h, written down a second time for Ceres: a quaternion for each
/// rotation, a block of residuals for each target, prior and pull. For a free root with ball joints below it, point and
/// rotation targets, and means of 0.
class VCeresPeer
{
public:
	VCeresPeer(const CoreOrlexTypes::VSubject& i_rSubject, bool i_bAnalytic);
	~VCeresPeer();

	/// Solves a frame from the states of the frame before, to which it is pulled.
	/// @param i_Tolerance of the cost, as a part of it.
	/// @return the cost as SolveObjective.h has it.
	double Solve(std::span<const double> i_Positions, std::span<const double> i_Rotations,
	    std::span<const double> i_Before, double i_Tolerance);

	int Iterations() const;

private:
	struct VImplementation;
	std::unique_ptr<VImplementation> m_pImplementation;
};
