#pragma once

#include "ComputeSubjectSolve/SolveLinks.h"

#include <Eigen/Core>

#include <vector>

namespace ComputeSubject
{

using VMatrix6 = Eigen::Matrix<double, 6, 6>;
using VVector6 = Eigen::Matrix<double, 6, 1>;

/// What one link adds to half the cost, to second order. Twists are a rotation vector, then the velocity of the
/// reference point; points are vectors from there.
struct VLinkTerms
{
	/// Of what hangs on the link and on no later one: by its twist.
	VMatrix6 m_Hessian;
	VVector6 m_Gradient;
	/// What the bend of the links' circles needs: the sum of weighted points by residuals, and the residuals' weighted
	/// sums, of positions and of rotations (those times the squared length).
	Eigen::Matrix3d m_Moment;
	Eigen::Vector3d m_Force;
	Eigen::Vector3d m_Torque;
	/// Of the joint itself: by the link's own change.
	Eigen::Matrix3d m_OwnHessian;
	Eigen::Vector3d m_OwnGradient;

	void SetZero();
};

/// The changes of all links that minimise the second order model of half the cost, damped.
///
/// A link's change and its parent's twist give its own twist, so that the tree is eliminated like a chain: from the
/// leaves on, each link's change is expressed by its parent's twist, and what is left hangs on the parent; from the
/// root on, the changes follow (the recursion of R. Featherstone's articulated bodies, "Robot Dynamics Algorithms",
/// 1987, with Hessians for inertias). A link takes the same time in a tree of any size. The second derivatives of
/// the rotations fit in: a turn w below a turn u moves a point q from its centre by u x (w x q), whatever lies between.
class VLinkElimination
{
public:
	explicit VLinkElimination(std::size_t i_Links);

	/// To be filled by the caller.
	std::vector<VLinkTerms>& Terms() { return m_Terms; }

	/// @param i_Damping square millimetres for a squared radian and for the square of c_RotationLength.
	/// @param i_bBend whether the second derivatives of the rotations take part; without them no Hessian that is a sum
	/// of squares is refused.
	/// False if the model has no minimum.
	bool Solve(const VSolveLinks& i_rLinks, double i_Damping, bool i_bBend);

	/// By links; of one axis only the first value counts.
	const std::vector<Eigen::Vector3d>& Changes() const { return m_Changes; }

	/// By how much half the cost falls in the model, damping left out.
	double Promise() const { return m_Promise; }

private:
	/// Of a link, its parent's twist eliminated: its change is -(m_Solved' twist + m_Step).
	struct VEliminated
	{
		Eigen::Matrix<double, 6, 3> m_Solved;
		Eigen::Vector3d m_Step;
	};

	template <int t_Size>
	bool Eliminate(const VSolveLink& i_rLink, std::size_t i_Index, double i_Damping, bool i_bBend);

	std::vector<VLinkTerms> m_Terms;
	std::vector<VLinkTerms> m_Work;
	std::vector<VEliminated> m_Eliminated;
	std::vector<VVector6> m_Twists;
	std::vector<Eigen::Vector3d> m_Changes;
	double m_Promise = 0.0;
};

} // namespace ComputeSubject
