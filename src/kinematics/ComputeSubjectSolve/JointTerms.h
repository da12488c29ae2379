#pragma once

#include "ComputeSubjectSolve/LinkElimination.h"
#include "ComputeSubjectSolve/SolveObjective.h"

#include <span>
#include <vector>

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace ComputeSubject
{

/// What the joints themselves add to the cost: priors, ranges and the pull to the frame before.
class VJointTerms
{
public:
	VJointTerms(const CoreOrlexTypes::VSubject& i_rSubject, const VSolveLinks& i_rLinks, const VSolveScales& i_rScales);

	/// The frame before, as states of all joints.
	void PullTo(std::span<const double> i_States);

	double HalfCost(std::span<const double> i_States) const;

	/// By segments how far the joint is out in its range: 0 at the centring state, 1 at the end. Joints that have none,
	/// or are not solved for, are left as they are.
	void RangeShares(std::span<const double> i_States, std::vector<double>& io_rShares) const;

	/// Adds to the links' own Hessians and gradients, of which the first are sums of squares. What a prior or a range
	/// says about two links of a joint together is left out of the Hessian, not of the gradient.
	void AddTerms(
	    std::span<const double> i_States, const VSolveLinks& i_rLinks, std::vector<VLinkTerms>& io_rTerms) const;

private:
	/// From where a joint's state is measured, and the weights of what is measured, in the order of the state.
	struct VMeasure
	{
		bool m_bUsed = false;
		VVector6 m_Origin = VVector6::Zero();
		Rotation::VMatrix3 m_InverseRotation = Rotation::c_Identity3;
		VMatrix6 m_Weights = VMatrix6::Zero();
	};
	struct VJoint
	{
		std::size_t m_Segment = 0;
		std::size_t m_State = 0;
		std::size_t m_Size = 0;
		/// Whether it begins with an angle-axis vector, and whether all else are angles.
		bool m_bRotation = false;
		bool m_bAngles = false;
		/// The links of the joint in the order of its state.
		std::size_t m_Links[2] = {c_NoLink, c_NoLink};
		VMeasure m_Prior;
		VMeasure m_Range;
		VMeasure m_Pull;
	};
	/// Half a cost and its derivatives by a deviation.
	struct VTerm
	{
		double m_HalfCost = 0.0;
		VVector6 m_Gradient = VVector6::Zero();
		VMatrix6 m_Hessian = VMatrix6::Zero();
	};

	static void SetOrigin(const VJoint& i_rJoint, const double* i_pState, VMeasure& o_rMeasure);
	static VVector6 Deviation(const VJoint& i_rJoint, const VMeasure& i_rMeasure, const double* i_pState);
	VTerm RangeTerm(const VJoint& i_rJoint, const VVector6& i_rDeviation) const;

	/// Calls i_rVisit(joint, measure, deviation, term) for each part of the cost.
	template <typename TVisitor>
	void ForEachTerm(std::span<const double> i_States, const TVisitor& i_rVisit) const;

	std::vector<VJoint> m_Joints;
	double m_RangeScale;
};

} // namespace ComputeSubject
