// The derivatives and the end of a solve, held against the cost itself.
#include "SolveSubjects.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectSolve/JointTerms.h"
#include "ComputeSubjectSolve/LinkElimination.h"
#include "ComputeSubjectSolve/TargetTerms.h"

#include "CoreOrlexTypes/JointType.h"

#include <Eigen/Dense>

#include <gtest/gtest.h>

namespace
{

using namespace ComputeSubject;
using namespace SolveSubjects;
using VTarget = VSubject::VTarget;

/// A tree with targets of all types that are solved, priors and ranges, away from any minimum.
struct VProblem
{
	explicit VProblem(const VSolveScales& i_rScales)
	{
		m_Subject = Tree(m_Random, 9, false);
		m_Subject.m_Segments[3].m_Joint.m_JointType = Reference::VJointTypes::EHardySpicer;
		m_Subject.m_Segments[4].m_Joint.m_JointType = Reference::VJointTypes::ESlider;
		m_Subject.m_Segments[5].m_Joint.m_JointType = Reference::VJointTypes::EBall;
		m_Subject.m_Segments[6].m_Joint.m_JointType = Reference::VJointTypes::EHinge;
		SetTargets(m_Random, ETargets::EMixed, m_Subject);
		for (const auto type : {VTarget::ELocalLineToWorldPoint, VTarget::ELocalPlaneToWorldPointGaussian})
			for (const std::uint32_t segment : {3u, 8u})
				m_Subject.m_Targets.push_back(Reference::Target(type, segment, {20, 30, -50, 90, 10, 40}, segment));
		for (auto& rSegment : m_Subject.m_Segments)
		{
			auto& rJoint = rSegment.m_Joint;
			const std::size_t size = CoreOrlexTypes::StateSize(rJoint.m_JointType);
			rJoint.m_Mean.assign(size, 0.2);
			rJoint.m_RangeCentringState.assign(size, -0.1);
			rJoint.m_Covariance.assign(size * size, 0.0);
			rJoint.m_RangeMatrix = rJoint.m_Covariance;
			for (std::size_t i = 0; i < size; ++i)
			{
				rJoint.m_Covariance[i * (size + 1)] = 1e-4 * double(1 + i);
				rJoint.m_RangeMatrix[i * (size + 1)] = 0.02 * double(1 + i);
			}
		}
		m_States = Reference::RandomState(m_Random, m_Subject, 0.6);
		m_Exact = Observe(m_Subject, Reference::RandomState(m_Random, m_Subject, 0.6));
		m_pKinematics = std::make_unique<VComputeSubjectFK>(m_Subject);
		m_Links = MakeLinks(m_Subject, std::vector<bool>(m_Subject.m_Segments.size(), true));
		m_pJoints = std::make_unique<VJointTerms>(m_Subject, m_Links, i_rScales);
		m_pJoints->PullTo(Reference::RandomState(m_Random, m_Subject, 0.6));
		for (std::size_t i = 0; i < m_Subject.m_Targets.size(); ++i)
			m_Targets.push_back(
			    {i, m_Subject.m_Targets[i].m_SegmentIndices.front(), 0.5 + 0.1 * double(i), m_pKinematics->Target(i)});
		m_pKinematics->Update(m_States.data());
		PlaceLinks(*m_pKinematics, m_States, m_Links);
		for (std::size_t i = 0; i < m_Links.m_Links.size(); ++i)
			for (int axis = 0; axis < m_Links.m_Links[i].m_Size; ++axis)
				m_Axes.emplace_back(i, axis);
	}

	/// Half the cost where the links have changed, all at once.
	double HalfCost(const Eigen::VectorXd& i_rChanges)
	{
		std::vector<double> states = m_States;
		std::vector<Eigen::Vector3d> changes(m_Links.m_Links.size(), Eigen::Vector3d::Zero());
		for (std::size_t i = 0; i < m_Axes.size(); ++i)
			changes[m_Axes[i].first][m_Axes[i].second] = i_rChanges[i];
		for (std::size_t i = 0; i < changes.size(); ++i)
			MoveLink(m_Links.m_Links[i], changes[i], states.data());
		m_pKinematics->Update(states.data());
		double sum = m_pJoints->HalfCost(states);
		for (const VSolvedTarget& rTarget : m_Targets)
			sum += ComputeSubject::HalfCost(rTarget, m_Exact.Spans());
		return sum;
	}

	/// By central differences.
	Eigen::VectorXd Gradient()
	{
		const double h = 1e-5;
		Eigen::VectorXd gradient(m_Axes.size());
		for (Eigen::Index i = 0; i < gradient.size(); ++i)
		{
			const Eigen::VectorXd step = h * Eigen::VectorXd::Unit(gradient.size(), i);
			gradient[i] = (HalfCost(step) - HalfCost(-step)) / (2.0 * h);
		}
		return gradient;
	}
	Eigen::MatrixXd Hessian()
	{
		const double h = 1e-3;
		const auto size = Eigen::Index(m_Axes.size());
		Eigen::MatrixXd hessian(size, size);
		for (Eigen::Index i = 0; i < size; ++i)
			for (Eigen::Index j = 0; j < size; ++j)
			{
				const Eigen::VectorXd a = h * Eigen::VectorXd::Unit(size, i);
				const Eigen::VectorXd b = h * Eigen::VectorXd::Unit(size, j);
				hessian(i, j) =
				    (HalfCost(a + b) - HalfCost(a - b) - HalfCost(b - a) + HalfCost(-a - b)) / (4.0 * h * h);
			}
		return hessian;
	}

	/// The elimination's step, by the terms of the code.
	Eigen::VectorXd Step(double i_Damping, bool i_bBend)
	{
		HalfCost(Eigen::VectorXd::Zero(m_Axes.size()));
		VLinkElimination elimination(m_Links.m_Links.size());
		for (VLinkTerms& rTerms : elimination.Terms())
			rTerms.SetZero();
		for (const VSolvedTarget& rTarget : m_Targets)
			AddTerms(rTarget, m_Exact.Spans(), m_Links.m_Reference, i_bBend,
			    elimination.Terms()[m_Links.m_LinkOfSegment[rTarget.m_Segment]]);
		m_pJoints->AddTerms(m_States, m_Links, elimination.Terms());
		EXPECT_TRUE(elimination.Solve(m_Links, i_Damping, i_bBend));
		Eigen::VectorXd step(m_Axes.size());
		for (std::size_t i = 0; i < m_Axes.size(); ++i)
			step[i] = elimination.Changes()[m_Axes[i].first][m_Axes[i].second];
		return step;
	}

	/// What the damping is for each axis.
	Eigen::VectorXd Scale() const
	{
		Eigen::VectorXd scale(m_Axes.size());
		for (std::size_t i = 0; i < m_Axes.size(); ++i)
			scale[i] = m_Links.m_Links[m_Axes[i].first].m_bTurn ? 1.0 : 1.0 / (c_RotationLength * c_RotationLength);
		return scale;
	}

	std::mt19937 m_Random{5};
	VSubject m_Subject;
	VExactObservations m_Exact;
	std::vector<double> m_States;
	std::unique_ptr<VComputeSubjectFK> m_pKinematics;
	VSolveLinks m_Links;
	std::unique_ptr<VJointTerms> m_pJoints;
	std::vector<VSolvedTarget> m_Targets;
	std::vector<std::pair<std::size_t, int>> m_Axes;
};

/// With so much damping that nothing else counts, the step is the gradient.
TEST(Objective, GradientIsThatOfTheCost)
{
	VProblem problem({1.0, 100.0, 1e4});
	const Eigen::VectorXd gradient = problem.Gradient();
	const double damping = 1e16;
	const Eigen::VectorXd scaled = -damping * problem.Scale().cwiseProduct(problem.Step(damping, false));
	EXPECT_LT((scaled - gradient).norm(), 1e-6 * gradient.norm());
	for (Eigen::Index i = 0; i < gradient.size(); ++i)
		EXPECT_NEAR(scaled[i], gradient[i], 1e-5 * std::abs(gradient[i]) + 1.0) << i;
}

TEST(Objective, StepIsNewtons)
{
	VProblem problem({0.0, 0.0, 0.0});
	// Enough that the model has a minimum here.
	const double damping = 1e8;
	Eigen::MatrixXd hessian = problem.Hessian();
	hessian.diagonal() += damping * problem.Scale();
	const Eigen::VectorXd expected = -hessian.ldlt().solve(problem.Gradient());
	EXPECT_LT((problem.Step(damping, true) - expected).norm(), 1e-4 * expected.norm());
	// Without the bends it is another.
	EXPECT_GT((problem.Step(damping, false) - expected).norm(), 1e-2 * expected.norm());
}

} // namespace
