#include "ComputeSubjectSolve/ComputeSubjectSolve.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/NearestRevolution.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"
#include "ComputeSubjectSolve/JointTerms.h"
#include "ComputeSubjectSolve/LinkElimination.h"
#include "ComputeSubjectSolve/SolveLinks.h"
#include "ComputeSubjectSolve/SolveSeed.h"
#include "ComputeSubjectSolve/TargetTerms.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace ComputeSubject
{
namespace
{

using CoreOrlexTypes::VSubject;

/// Steps from one start. Frames that converge take a handful; what has not converged by then creeps.
constexpr std::size_t c_MostIterations = 100;
/// A step that promises less than this part of the cost is the last: Newton's steps square what is left.
constexpr double c_LastPromise = 1e-6;
/// The same in square millimetres for the largest weight, for targets that are met exactly: a nanometre before the last
/// step.
constexpr double c_LastSquaredMm = 1e-12;
/// Rounding of a cost, as a part of it.
constexpr double c_Rounding = 1e-13;

/// Damping in square millimetres for a squared radian, for each unit of the largest weight.
constexpr double c_LeastDamping = 1e-4;
constexpr double c_Raise = 10.0;
constexpr double c_MostDamping = 1e12;
/// Above this, what a step promises tells more of the damping than of how far the end is.
constexpr double c_DampingOfLastStep = 0.1;

/// The seeds that are tried, by what further targets count in them.
constexpr double c_SeedShares[] = {0.5, 0.2, 0.8};

/// The subject with those targets alone that are solved.
VSubject WithSolvedTargets(const VSubject& i_rSubject, const std::vector<std::string>& i_rLeftOut)
{
	VSubject subject = i_rSubject;
	subject.m_Targets.clear();
	for (std::size_t i = 0; i < i_rLeftOut.size(); ++i)
		if (i_rLeftOut[i].empty())
			subject.m_Targets.push_back(i_rSubject.m_Targets[i]);
	return subject;
}

/// For each segment whether it is at or above a target that is solved.
std::vector<bool> ActiveSegments(const VSubject& i_rSubject)
{
	std::vector<bool> active(i_rSubject.m_Segments.size(), false);
	for (const VSubject::VTarget& rTarget : i_rSubject.m_Targets)
		active[rTarget.m_SegmentIndices.front()] = true;
	for (std::size_t i = active.size(); i-- > 0;)
		if (active[i] && i_rSubject.m_Segments[i].m_ParentSegmentIndex != CoreOrlexTypes::c_NoParent)
			active[i_rSubject.m_Segments[i].m_ParentSegmentIndex] = true;
	return active;
}

} // namespace

struct VComputeSubjectSolve::VImplementation
{
	VImplementation(const VSubject& i_rSubject, std::span<const double> i_BindPose, const VSolveScales& i_rScales)
	    : m_LeftOut(TargetsLeftOut(i_rSubject)), m_Solved(WithSolvedTargets(i_rSubject, m_LeftOut)),
	      m_Kinematics(m_Solved), m_Links(MakeLinks(m_Solved, Active())), m_JointTerms(m_Solved, m_Links, i_rScales),
	      m_Elimination(m_Links.m_Links.size()), m_BindPose(m_Kinematics.NumberOfStates(), 0.0)
	{
		std::copy_n(i_BindPose.begin(), std::min(i_BindPose.size(), m_BindPose.size()), m_BindPose.begin());
		m_States = m_Trial = m_Best = m_BindPose;
		m_Frame.m_States = m_BindPose;
		m_Frame.m_WorldPoses.resize(m_Kinematics.NumberOfSegments());
		m_Frame.m_Residuals.resize(i_rSubject.m_Targets.size());
		m_Frame.m_RangeShares.resize(m_Kinematics.NumberOfSegments(), 0.0);
		std::size_t next = 0;
		for (std::size_t i = 0; i < m_LeftOut.size(); ++i)
			if (m_LeftOut[i].empty())
			{
				const VSubject::VTarget& rTarget = i_rSubject.m_Targets[i];
				m_Targets.push_back(
				    {i, rTarget.m_SegmentIndices.front(), rTarget.m_Weight, m_Kinematics.Target(next++)});
				m_DampingUnit = std::max(m_DampingUnit, rTarget.m_Weight);
			}
	}

	/// No segments where they make no tree.
	std::vector<bool> Active()
	{
		if (m_Kinematics.NumberOfSegments() == 0)
			m_Solved.m_Segments.clear();
		return ActiveSegments(m_Solved);
	}

	double HalfCost(const VObservations& i_rObservations, const std::vector<double>& i_rStates)
	{
		m_Kinematics.Update(i_rStates.data());
		double sum = m_JointTerms.HalfCost(i_rStates);
		for (const VSolvedTarget& rTarget : m_Targets)
			sum += ComputeSubject::HalfCost(rTarget, i_rObservations);
		return sum;
	}

	/// Of the states that the kinematics were updated to last.
	void MakeTerms(const VObservations& i_rObservations, bool i_bBend)
	{
		PlaceLinks(m_Kinematics, m_States, m_Links);
		for (VLinkTerms& rTerms : m_Elimination.Terms())
			rTerms.SetZero();
		for (const VSolvedTarget& rTarget : m_Targets)
			if (const std::size_t link = m_Links.m_LinkOfSegment[rTarget.m_Segment]; link != c_NoLink)
				AddTerms(rTarget, i_rObservations, m_Links.m_Reference, i_bBend, m_Elimination.Terms()[link]);
		m_JointTerms.AddTerms(m_States, m_Links, m_Elimination.Terms());
	}

	/// From m_States down to the states of a minimum, with half its cost. False if there was none within the
	/// iterations.
	bool Descend(const VObservations& i_rObservations, double& o_rHalfCost)
	{
		o_rHalfCost = HalfCost(i_rObservations, m_States);
		if (!std::isfinite(o_rHalfCost))
			return false;
		double damping = c_LeastDamping;
		bool bBend = true;
		MakeTerms(i_rObservations, bBend);
		for (std::size_t i = 0; i < c_MostIterations && damping < c_MostDamping; ++i)
		{
			++m_Frame.m_Iterations;
			bool bStep = m_Elimination.Solve(m_Links, damping * m_DampingUnit, bBend);
			if (!bStep && bBend)
			{
				bBend = false;
				m_Kinematics.Update(m_States.data());
				MakeTerms(i_rObservations, bBend);
				bStep = m_Elimination.Solve(m_Links, damping * m_DampingUnit, bBend);
			}
			const double promise = m_Elimination.Promise();
			if (!bStep || !std::isfinite(promise))
			{
				damping *= c_Raise;
				continue;
			}
			std::copy(m_States.begin(), m_States.end(), m_Trial.begin());
			for (std::size_t link = 0; link < m_Links.m_Links.size(); ++link)
				MoveLink(m_Links.m_Links[link], m_Elimination.Changes()[link], m_Trial.data());
			const double trial = HalfCost(i_rObservations, m_Trial);
			const bool bLast = damping <= c_DampingOfLastStep
			    && promise <= c_LastPromise * o_rHalfCost + c_LastSquaredMm * m_DampingUnit;
			if (trial <= o_rHalfCost)
			{
				const double gain = promise > 0.0 ? (o_rHalfCost - trial) / promise : 1.0;
				m_States.swap(m_Trial);
				o_rHalfCost = trial;
				if (bLast)
					return true;
				if (gain > 0.5)
					damping = std::max((gain > 0.9 ? 0.01 : 0.1) * damping, c_LeastDamping);
				else if (gain < 0.1)
					damping *= c_Raise;
				bBend = true;
				MakeTerms(i_rObservations, bBend);
			}
			else
			{
				if (bLast || promise <= c_Rounding * o_rHalfCost)
					return true;
				damping = std::max(damping, 1.0) * c_Raise;
			}
		}
		return false;
	}

	const VSolvedFrame& Solve(const VObservations& i_rObservations)
	{
		m_Frame.m_Iterations = 0;
		m_Frame.m_bSeeded = false;
		m_Frame.m_bConverged = false;
		double cost = std::numeric_limits<double>::infinity();
		if (m_bBefore)
		{
			std::copy(m_Frame.m_States.begin(), m_Frame.m_States.end(), m_Best.begin());
			m_JointTerms.PullTo(m_Best);
			m_States.swap(m_Best);
			m_Frame.m_bConverged = Descend(i_rObservations, cost);
			m_States.swap(m_Best);
		}
		if (!m_Frame.m_bConverged)
			SolveFromSeeds(i_rObservations, cost);
		if (std::isfinite(cost))
			TakeStates();
		m_Frame.m_Cost = 2.0 * cost;
		m_bBefore = m_bBefore || std::isfinite(cost);
		Report(i_rObservations);
		return m_Frame;
	}

	/// Puts the best end, of those that are minima if there is one, into m_Best, and half its cost.
	void SolveFromSeeds(const VObservations& i_rObservations, double& io_rHalfCost)
	{
		for (const double share : c_SeedShares)
		{
			std::copy(m_BindPose.begin(), m_BindPose.end(), m_States.begin());
			Seed(i_rObservations, m_Targets, share, m_Kinematics, m_Links, m_States);
			if (!m_bBefore && share == c_SeedShares[0])
				m_JointTerms.PullTo(m_States);
			double cost = 0.0;
			const bool bConverged = Descend(i_rObservations, cost);
			if (std::isfinite(cost)
			    && (bConverged > m_Frame.m_bConverged || (bConverged == m_Frame.m_bConverged && cost < io_rHalfCost)))
			{
				m_States.swap(m_Best);
				io_rHalfCost = cost;
				m_Frame.m_bConverged = bConverged;
				m_Frame.m_bSeeded = true;
			}
		}
	}

	/// The revolutions nearest to the frame before.
	void TakeStates()
	{
		std::size_t state = 0;
		for (const auto& rSegment : m_Solved.m_Segments)
		{
			using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;
			double* const pBefore = m_Frame.m_States.data() + state;
			const double* const pNow = m_Best.data() + state;
			const auto type = rSegment.m_Joint.m_JointType;
			const std::size_t size = CoreOrlexTypes::StateSize(type);
			std::size_t done = 0;
			if (type == VJoint::EFree || type == VJoint::EBall)
			{
				const auto turn = NearestRevolution({pNow[0], pNow[1], pNow[2]}, {pBefore[0], pBefore[1], pBefore[2]});
				std::copy(turn.begin(), turn.end(), pBefore);
				done = 3;
			}
			for (; done < size; ++done)
				if (type == VJoint::EHinge || type == VJoint::EHardySpicer)
					pBefore[done] += std::remainder(pNow[done] - pBefore[done], 2.0 * std::numbers::pi);
				else
					pBefore[done] = pNow[done];
			state += size;
		}
	}

	void Report(const VObservations& i_rObservations)
	{
		m_Kinematics.Update(m_Frame.m_States.data());
		for (std::size_t i = 0; i < m_Frame.m_WorldPoses.size(); ++i)
			m_Kinematics.Segment(i).SegmentPose(m_Frame.m_WorldPoses[i]);
		std::fill(m_Frame.m_Residuals.begin(), m_Frame.m_Residuals.end(), std::numeric_limits<double>::quiet_NaN());
		for (const VSolvedTarget& rTarget : m_Targets)
			m_Frame.m_Residuals[rTarget.m_Index] = Residual(rTarget, i_rObservations);
		m_JointTerms.RangeShares(m_Frame.m_States, m_Frame.m_RangeShares);
	}

	std::vector<std::string> m_LeftOut;
	VSubject m_Solved;
	VComputeSubjectFK m_Kinematics;
	VSolveLinks m_Links;
	VJointTerms m_JointTerms;
	VLinkElimination m_Elimination;
	std::vector<VSolvedTarget> m_Targets;
	double m_DampingUnit = 0.0;

	std::vector<double> m_BindPose;
	std::vector<double> m_States;
	std::vector<double> m_Trial;
	std::vector<double> m_Best;
	VSolvedFrame m_Frame;
	bool m_bBefore = false;
};

VComputeSubjectSolve::VComputeSubjectSolve(
    const VSubject& i_rSubject, std::span<const double> i_BindPose, const VSolveScales& i_rScales)
    : m_pImplementation(std::make_unique<VImplementation>(i_rSubject, i_BindPose, i_rScales))
{
}

VComputeSubjectSolve::~VComputeSubjectSolve() = default;

const std::string& VComputeSubjectSolve::LeftOut(std::size_t i_Target) const
{
	return m_pImplementation->m_LeftOut.at(i_Target);
}

std::size_t VComputeSubjectSolve::NumberOfActiveStates() const
{
	std::size_t count = 0;
	for (const VSolveLink& rLink : m_pImplementation->m_Links.m_Links)
		count += rLink.m_Size;
	return count;
}

const VSolvedFrame& VComputeSubjectSolve::Solve(const VObservations& i_rObservations)
{
	return m_pImplementation->Solve(i_rObservations);
}

void VComputeSubjectSolve::Restart()
{
	VImplementation& rThis = *m_pImplementation;
	rThis.m_Frame.m_States = rThis.m_BindPose;
	rThis.m_bBefore = false;
}

void VComputeSubjectSolve::StartFrom(std::span<const double> i_States)
{
	VImplementation& rThis = *m_pImplementation;
	std::copy_n(
	    i_States.begin(), std::min(i_States.size(), rThis.m_Frame.m_States.size()), rThis.m_Frame.m_States.begin());
	rThis.m_bBefore = true;
}

} // namespace ComputeSubject
