#include "ReferenceFK.h"

#include "ComputeSubjectFK/BallJointPrior.h"
#include "ComputeSubjectFK/ConstructionException.h"
#include "ComputeSubjectFK/JointFK.h"
#include "ComputeSubjectFK/JointSolveBall.h"
#include "ComputeSubjectFK/NearestRevolution.h"

#include <gtest/gtest.h>

#include <numbers>

namespace
{

using namespace ComputeSubject;
using namespace Reference;
using Eigen::Matrix3d;
using Eigen::Vector3d;
using Rotation::VVector3;

struct VRevolutionRow
{
	const char* m_pName;
	VVector3 m_State;
	VVector3 m_Previous;
	VVector3 m_Expected;
};

const VRevolutionRow c_Revolutions[] = {
    {"NoPreviousStays", {0, 0, 3}, {0, 0, 0}, {0, 0, 3}},
    {"NoPreviousWraps", {0, 0, 4}, {0, 0, 0}, {0, 0, 4 - 2 * c_Pi}},
    {"TinyPreviousIsNone", {0, 0, 4}, {0, 0, -1e-6}, {0, 0, 4 - 2 * c_Pi}},
    {"GoesOnBeyondHalfATurn", {0, 0, -3}, {0, 0, 3}, {0, 0, 2 * c_Pi - 3}},
    {"GoesOnBeyondATurn", {0.1, 0, 0}, {6.2, 0, 0}, {2 * c_Pi + 0.1, 0, 0}},
    {"GoesOnBackwards", {0, 1, 0}, {0, -12, 0}, {0, 1 - 4 * c_Pi, 0}},
    {"TakesTheAxisNotTheLength", {1, 0, 0}, {0, 20, 0}, {1, 0, 0}},
    {"ZeroNearNoTurn", {0, 0, 0}, {0, 0.5, 0}, {0, 0, 0}},
    {"ZeroTakesTheDirection", {0, 0, 0}, {0, -6, 0}, {0, -2 * c_Pi, 0}},
    {"AWholeTurnTakesTheDirection", {2 * c_Pi, 0, 0}, {0, 7, 0}, {0, 2 * c_Pi, 0}},
};

TEST(NearestRevolution, Rows)
{
	const VAssertions assertions;
	for (const VRevolutionRow& rRow : c_Revolutions)
	{
		const VVector3 nearest = NearestRevolution(rRow.m_State, rRow.m_Previous);
		EXPECT_LT(Difference(nearest, Vector3d(rRow.m_Expected.data())), 1e-14) << rRow.m_pName;
		EXPECT_LT(Difference(Rotation::RotationMatrixFromAngleAxis(nearest), Pose(rRow.m_State, {}).linear()), 1e-14)
		    << rRow.m_pName;
	}
	EXPECT_TRUE(assertions.Take().empty());
	NearestRevolution({std::nan(""), 0, 0}, {});
	EXPECT_EQ(assertions.Take(), std::vector<std::string>{"InputRAA.is_zero()"});
}

VSubject::VSegment Ball()
{
	VSubject::VSegment segment = Segment(4, VJointTypes::EBall);
	segment.m_SegmentIndex = 5;
	segment.m_Joint.m_Mean = {0.2, -0.1, 0.3};
	segment.m_Joint.m_Covariance = {0.04, 0.01, 0, 0.01, 0.09, 0, 0, 0, 0.25};
	return segment;
}

VSubject::VSegment BallWithRange()
{
	VSubject::VSegment segment = Ball();
	segment.m_Joint.m_RangeCentringState = {0.5, 0.2, -0.4};
	segment.m_Joint.m_RangeMatrix = {2, 0.1, 0, 0.1, 3, 0, 0, 0, 4};
	return segment;
}

/// The state as the difference in rotation to the centre, times the range matrix; both by Eigen.
Vector3d ExpectedRangeState(const VSubject::VSegment& i_rSegment, const VVector3& i_rState)
{
	const auto& c = i_rSegment.m_Joint.m_RangeCentringState;
	const Eigen::AngleAxisd turn(
	    Matrix3d(Pose({c[0], c[1], c[2]}, {}).linear().transpose() * Pose(i_rState, {}).linear()));
	return Eigen::Map<const Matrix3d>(i_rSegment.m_Joint.m_RangeMatrix.data()) * (turn.angle() * turn.axis());
}

TEST(BallJointRange, MapsThereAndBack)
{
	const VSubject::VSegment segment = BallWithRange();
	const VBallJointRange range(segment);
	for (const VVector3& rState : {VVector3{0, 0, 0}, VVector3{0.5, 0.2, -0.4}, VVector3{-1, 0.7, 1.5}})
	{
		const VVector3 inRange = range.RangeState(rState);
		EXPECT_LT(Difference(inRange, ExpectedRangeState(segment, rState)), 1e-13);
		EXPECT_LT(Difference(range.StateInRange(inRange), Vector3d(rState.data())), 1e-13);
	}
	std::unique_ptr<IComputeJointRange> pClone;
	std::make_unique<VBallJointRange>(segment)->Clone(pClone);
	const double state[] = {-1, 0.7, 1.5};
	VVector3 inClone{};
	pClone->RangeState(state, inClone);
	EXPECT_EQ(inClone, range.RangeState({-1, 0.7, 1.5}));
}

TEST(BallJointPrior, EnergyIsHalfTheSquaredMahalanobisDistance)
{
	const VSubject::VSegment segment = Ball();
	VBallJointPrior prior(segment);
	const Matrix3d covariance = Eigen::Map<const Matrix3d>(segment.m_Joint.m_Covariance.data());
	const Vector3d deviation(0.3, -0.2, 0.1);
	const Eigen::AngleAxisd turned(Matrix3d(Pose({0.2, -0.1, 0.3}, {}).linear() * Pose({0.3, -0.2, 0.1}, {}).linear()));
	// One more turn about the same axis is the same rotation.
	const Vector3d state = turned.angle() * turned.axis();
	for (const double factor : {1.0, 1.0 + 2 * c_Pi / state.norm()})
	{
		const Vector3d again = factor * state;
		const double* pState = again.data();
		prior.SetState(pState);
		EXPECT_EQ(pState, again.data() + 3);
		VVector3 told{};
		prior.Deviation(told);
		EXPECT_LT(Difference(told, deviation), 1e-14);
		EXPECT_NEAR(prior.Energy(), 0.5 * deviation.dot(covariance.inverse() * deviation), 1e-13);
	}
	const auto pClone = prior.Clone();
	EXPECT_EQ(pClone->SegmentIndex(), 5u);
	const double mean[] = {0.2, -0.1, 0.3};
	const double* pMean = mean;
	pClone->SetState(pMean);
	EXPECT_NEAR(pClone->Energy(), 0.0, 1e-28);
	EXPECT_GT(prior.Energy(), 0.0);
}

TEST(BallJointPrior, RangeNormalisedPriorIsTheSameNearTheMean)
{
	// The map into the range space is smooth: for a narrow prior, energies agree up to its curvature.
	VSubject::VSegment segment = BallWithRange();
	for (double& rValue : segment.m_Joint.m_Covariance)
		rValue *= 1e-6;
	VBallJointPrior plain(segment);
	VBallJointPriorRangeNormalised normalised(segment);
	const VVector3 mean{0.2, -0.1, 0.3};
	EXPECT_LT(Difference(normalised.DeviationOf(mean), Vector3d::Zero()), 1e-5);
	const VVector3 state{0.2004, -0.1003, 0.3002};
	for (VComputeJointPriorInterfaceForSegment* pPrior :
	    std::initializer_list<VComputeJointPriorInterfaceForSegment*>{&plain, &normalised})
	{
		const double* pState = state.data();
		pPrior->SetState(pState);
	}
	EXPECT_GT(plain.Energy(), 0.5);
	EXPECT_NEAR(normalised.Energy() / plain.Energy(), 1.0, 1e-2);
	const double before = normalised.Energy();
	EXPECT_EQ(normalised.Clone()->Energy(), before);
}

TEST(JointPrior, WithoutStatisticsNothingIsSaid)
{
	for (int type = VJointTypes::EFree; type <= VJointTypes::EDummy; ++type)
	{
		SCOPED_TRACE(type);
		const VSubject::VSegment segment = Segment(0, static_cast<Reference::EJointType>(type));
		const auto pPrior = CreateJointPrior(segment)->Clone();
		std::unique_ptr<IComputeJointRange> pRange;
		CreateJointRange(segment)->Clone(pRange);
		const std::size_t states =
		    JointFKFactory(segment.m_Joint.m_JointType)->Create(segment.m_Joint)->ComputeJointFK().NumberOfStates();
		EXPECT_EQ(pPrior->NumberOfStates(), states);
		EXPECT_EQ(pRange->NumberOfStates(), states);
		const std::vector<double> state(6, 0.7);
		const double* pState = state.data();
		pPrior->SetState(pState);
		EXPECT_EQ(pState, state.data() + states);
		EXPECT_EQ(pPrior->Energy(), 0.0);
		std::vector<double> zeros(states, 9.0);
		pRange->RangeState(std::span(state).first(states), zeros);
		EXPECT_EQ(zeros, std::vector<double>(states, 0.0));
	}
}

TEST(JointPrior, UnfitStatisticsAreRefused)
{
	VSubject::VSegment segment = BallWithRange();
	segment.m_Joint.m_Covariance.pop_back();
	EXPECT_THROW(CreateJointPrior(segment), VConstructionException);
	segment = BallWithRange();
	segment.m_Joint.m_RangeCentringState.clear();
	EXPECT_THROW(CreateJointRange(segment), VConstructionException);
	EXPECT_THROW(CreateJointPrior(segment), VConstructionException);
	segment = BallWithRange();
	segment.m_Joint.m_JointType = VJointTypes::EHinge;
	EXPECT_THROW(VBallJointPrior{segment}, VConstructionException);
	EXPECT_THROW(VJointSolveBall{segment}, VConstructionException);
}

TEST(JointSolveBall, FollowsItsStateAcrossTurnsAndClonesDeeply)
{
	VJointFK<VJointSolveBall> joint{VJointSolveBall(BallWithRange())};
	VJointSolveBall solve(BallWithRange());
	// Round about Z in steps of half a radian, each given by its shortest vector.
	for (int step = 1; step <= 30; ++step)
	{
		const VVector3 shortest = Rotation::CanonicalAngleAxis({0, 0, 0.5 * step});
		const double* pState = shortest.data();
		solve.SetState(pState);
		EXPECT_NEAR(solve.State()[2], 0.5 * step, 1e-12);
	}
	Rotation::VPose<double> pose;
	solve.GetPose(pose);
	EXPECT_LT(Difference(pose, Pose({0, 0, 15.0}, {})), 1e-12);
	EXPECT_GT(solve.Energy(), 0.0);
	const VJointSolveBall copy(solve);
	const double zero[] = {0, 0, 0};
	const double* pState = zero;
	const double before = solve.Energy();
	solve.SetState(pState);
	EXPECT_NE(solve.Energy(), before);
	EXPECT_EQ(copy.Energy(), before);
	EXPECT_EQ(joint.Clone()->ComputeJointFK().NumberOfStates(), 3u);
}

} // namespace
