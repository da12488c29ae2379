#pragma once

#include "ComputeSubjectSolve/ComputeSubjectSolve.h"
#include "ComputeSubjectSolve/LinkElimination.h"

#include "CoreOrlexTypes/Subject.h"

#include <string>
#include <vector>

namespace ComputeSubject
{

class ITargetFK;
class VComputeSubjectFK;

/// A target that is solved.
struct VSolvedTarget
{
	/// Among those of the subject.
	std::size_t m_Index = 0;
	std::size_t m_Segment = 0;
	double m_Weight = 0.0;
	/// Of the kinematics, which must outlive this.
	const ITargetFK* m_pTarget = nullptr;
};

/// For each target why it is not solved, empty where it is.
/// Throws VConstructionException for a joint of a type that has no class.
std::vector<std::string> TargetsLeftOut(const CoreOrlexTypes::VSubject& i_rSubject);

/// Half of what the target adds to the cost; 0 without an observation.
double HalfCost(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations);

/// Mm, or radians; NaN without an observation.
double Residual(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations);

/// @param i_bBend for exact second derivatives; otherwise the Hessian is a sum of squares.
void AddTerms(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations, const Eigen::Vector3d& i_rReference,
    bool i_bBend, VLinkTerms& io_rTerms);

/// Sums over targets for the turn R and the move that bring them nearest to their observations: of positions where they
/// are and where they were observed, of rotations R' observed.
struct VAlignment
{
	Eigen::Matrix3d m_Rotations = Eigen::Matrix3d::Zero();
	Eigen::Matrix3d m_Products = Eigen::Matrix3d::Zero();
	Eigen::Vector3d m_Points = Eigen::Vector3d::Zero();
	Eigen::Vector3d m_Observed = Eigen::Vector3d::Zero();
	double m_Weight = 0.0;
};

/// Adds what the target has; of lines and planes the point of theirs that is nearest to the observation.
/// @param i_Share what the target counts beside others.
void AddAlignment(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations,
    const Eigen::Vector3d& i_rReference, double i_Share, VAlignment& io_rAlignment);

} // namespace ComputeSubject
