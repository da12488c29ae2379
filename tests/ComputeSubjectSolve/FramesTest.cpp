#include "../Allocations.h"
#include "SolveSubjects.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace
{

using namespace ComputeSubject;
using namespace SolveSubjects;
using VTarget = VSubject::VTarget;

/// A motion, twice.
struct VTake
{
	VTake()
	{
		m_Subject = Tree(m_Random, 16, false);
		SetTargets(m_Random, ETargets::EMixed, m_Subject);
		const std::vector<double> from = Reference::RandomState(m_Random, m_Subject, 0.5);
		const std::vector<double> change = Reference::RandomState(m_Random, m_Subject, 0.05);
		for (int frame = 0; frame < 20; ++frame)
		{
			std::vector<double> states = from;
			for (std::size_t i = 0; i < states.size(); ++i)
				states[i] += frame * change[i];
			m_Frames.push_back(Observe(m_Subject, states));
			// What the targets cannot all follow.
			for (double& rValue : m_Frames.back().m_Positions)
				rValue += std::uniform_real_distribution<double>(-5.0, 5.0)(m_Random);
		}
	}

	std::mt19937 m_Random{3};
	VSubject m_Subject;
	std::vector<VExactObservations> m_Frames;
};

TEST(Frames, SameInputGivesSameBytesAndAllocatesNothing)
{
	const VTake take;
	VComputeSubjectSolve solve(take.m_Subject, {});
	VComputeSubjectSolve again(take.m_Subject, {});
	for (std::size_t i = 0; i < take.m_Frames.size(); ++i)
	{
		const std::size_t before = AllocationCount();
		const VSolvedFrame& rFrame = solve.Solve(take.m_Frames[i].Spans());
		EXPECT_TRUE(i == 0 || AllocationCount() == before) << i;
		EXPECT_TRUE(rFrame.m_bConverged) << i;
		EXPECT_EQ(rFrame.m_bSeeded, i == 0) << i;
		EXPECT_EQ(rFrame.m_States, again.Solve(take.m_Frames[i].Spans()).m_States) << i;
	}
	// A frame that begins from given states is the one that began there.
	const std::vector<double> last = solve.Solve(take.m_Frames[5].Spans()).m_States;
	const std::vector<double> next = solve.Solve(take.m_Frames[6].Spans()).m_States;
	again.StartFrom(last);
	EXPECT_EQ(again.Solve(take.m_Frames[6].Spans()).m_States, next);
}

TEST(Frames, ResultIsWhereTheStatesAre)
{
	const VTake take;
	VComputeSubjectSolve solve(take.m_Subject, {}, {0.0, 0.0, 0.0});
	const VSolvedFrame& rFrame = solve.Solve(take.m_Frames[0].Spans());
	const VExactObservations there = Observe(take.m_Subject, rFrame.m_States);
	for (std::size_t i = 0; i < rFrame.m_WorldPoses.size(); ++i)
		EXPECT_LT(
		    Reference::Difference(rFrame.m_WorldPoses[i], Reference::SegmentPose(take.m_Subject, rFrame.m_States, i)),
		    1e-9);
	double cost = 0.0;
	for (std::size_t i = 0; i < take.m_Subject.m_Targets.size(); ++i)
	{
		const VTarget& rTarget = take.m_Subject.m_Targets[i];
		double largest = 0.0;
		for (const std::uint32_t marker : rTarget.m_MarkerIndices)
		{
			const double off = (Eigen::Vector3d(&there.m_Positions[3 * marker])
			    - Eigen::Vector3d(&take.m_Frames[0].m_Positions[3 * marker]))
			                       .norm();
			largest = std::max(largest, off);
			cost += rTarget.m_Weight * off * off;
		}
		for (const std::uint32_t rotation : rTarget.m_RotationObservationIndices)
		{
			const Eigen::Map<const Eigen::Matrix3d> is(&there.m_Rotations[9 * rotation]);
			const Eigen::Map<const Eigen::Matrix3d> was(&take.m_Frames[0].m_Rotations[9 * rotation]);
			largest = Eigen::AngleAxisd(Eigen::Matrix3d(is * was.transpose())).angle();
			cost += rTarget.m_Weight * std::pow(largest * c_RotationLength, 2);
		}
		EXPECT_NEAR(rFrame.m_Residuals[i], largest, 1e-7) << i;
	}
	EXPECT_NEAR(rFrame.m_Cost, cost, 1e-6 * cost);
}

TEST(Frames, WhatIsNotSolvedIsToldAndStays)
{
	using Reference::VJointTypes;
	VSubject subject;
	subject.m_Segments = {Reference::Segment(CoreOrlexTypes::c_NoParent, VJointTypes::EFree),
	    Reference::Segment(0, VJointTypes::EBall, {0, 0, 300}), Reference::Segment(0, VJointTypes::EHinge, {90, 0, 0})};
	const auto point = VTarget::ELocalPointToWorldPoint;
	subject.m_Targets = {Reference::Target(point, 1, {0, 0, 100}, 0), Reference::Target(point, 2, {0, 50, 0}, 0),
	    Reference::Target(VTarget::ELocalDirectionToWorldDirection, 0, {0, 0, 1}, 0),
	    Reference::Target(VTarget::ELocalPlaneToWorldPoint, 0, {0, 0, 1, 0, 0, 0}, 0),
	    Reference::Target(point, 0, {0, 0}, 0), Reference::Target(point, 0, {0, 0, 0}, 7)};
	subject.m_Targets[1].m_Weight = 0.0;
	const std::vector<double> bindPose{0, 0, 0, 0, 0, 0, 0.1, 0.2, 0.3, 9.0};
	VComputeSubjectSolve solve(subject, bindPose);
	EXPECT_EQ(solve.LeftOut(0), "");
	for (std::size_t i = 1; i < 5; ++i)
		EXPECT_NE(solve.LeftOut(i), "") << i;
	EXPECT_EQ(solve.LeftOut(5), "");
	EXPECT_EQ(solve.NumberOfActiveStates(), 9u);

	std::vector<double> positions{100, 200, 500};
	const VSolvedFrame& rFrame = solve.Solve({positions, {}});
	EXPECT_TRUE(rFrame.m_bConverged);
	EXPECT_LT(rFrame.m_Residuals[0], 1e-3);
	EXPECT_EQ(rFrame.m_States[9], 9.0);
	// Left out, and without an observation.
	for (std::size_t i = 1; i < 6; ++i)
		EXPECT_TRUE(std::isnan(rFrame.m_Residuals[i])) << i;

	// A gap leaves everything where it was.
	const std::vector<double> before = rFrame.m_States;
	positions[1] = std::numeric_limits<double>::quiet_NaN();
	solve.Solve({positions, {}});
	EXPECT_TRUE(rFrame.m_bConverged);
	EXPECT_TRUE(std::isnan(rFrame.m_Residuals[0]));
	for (std::size_t i = 0; i < before.size(); ++i)
		EXPECT_NEAR(rFrame.m_States[i], before[i], 1e-2) << i;
	// An absurd one is marked, and does not spoil what follows.
	positions = {1e200, -1e200, 1e200};
	solve.Solve({positions, {}});
	EXPECT_FALSE(rFrame.m_bConverged);
	for (const double state : rFrame.m_States)
		EXPECT_TRUE(std::isfinite(state));
	positions = {100, 200, 500};
	solve.Solve({positions, {}});
	EXPECT_TRUE(rFrame.m_bConverged);
	EXPECT_LT(rFrame.m_Residuals[0], 1e-3);
}

TEST(Frames, StatesRunOnThroughWholeTurns)
{
	using Reference::VJointTypes;
	for (const auto type : {VJointTypes::EHinge, VJointTypes::EBall})
	{
		VSubject subject;
		subject.m_Segments = {Reference::Segment(CoreOrlexTypes::c_NoParent, type)};
		subject.m_Rotations.resize(1);
		subject.m_Targets = {Reference::Target(VTarget::ELocalRotationToWorldRotation, 0, {0, 0, 5.0}, 0)};
		VComputeSubjectSolve solve(subject, {});
		std::vector<double> states(type == VJointTypes::EHinge ? 1 : 3);
		for (int frame = 0; frame < 90; ++frame)
		{
			states.back() = 0.15 * frame;
			const VSolvedFrame& rFrame = solve.Solve(Observe(subject, states).Spans());
			EXPECT_NEAR(rFrame.m_States.back(), states.back(), 1e-2) << frame;
		}
	}
}

/// A knee that is asked to bend beyond its range stays within a degree of the end.
TEST(Frames, RangeHolds)
{
	using Reference::VJointTypes;
	VSubject subject;
	subject.m_Segments = {Reference::Segment(CoreOrlexTypes::c_NoParent, VJointTypes::EDummy),
	    Reference::Segment(0, VJointTypes::EHinge)};
	subject.m_Segments[1].m_Joint.m_RangeCentringState = {0.5};
	subject.m_Segments[1].m_Joint.m_RangeMatrix = {0.25};
	subject.m_Markers.resize(1);
	subject.m_Targets = {Reference::Target(VTarget::ELocalPointToWorldPoint, 1, {400, 0, 0}, 0)};
	for (const double asked : {0.7, 2.0})
	{
		const VSolvedFrame frame = VComputeSubjectSolve(subject, {}).Solve(Observe(subject, {0.0 + asked}).Spans());
		EXPECT_NEAR(frame.m_States[0], std::min(asked, 1.0), 0.018) << asked;
	}
}

} // namespace
