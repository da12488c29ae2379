#include "MessageLog.h"

#include "ComputeSubjectFK/BallJointPrior.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/joints/EulerToAngleAxis.h"
#include "CoreOrlexTypesUtils/joints/JointRange.h"
#include "CoreOrlexTypesUtils/joints/RestPose.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <random>

namespace
{

using namespace CoreOrlexTypesUtils;
using namespace CoreOrlexTypesUtils::TemplateSubjectUtils;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;
using VNumbers = std::vector<double>;
using VTexts = std::vector<std::string>;

void ExpectNear(const VNumbers& i_rA, const VNumbers& i_rB, double i_Tolerance)
{
	ASSERT_EQ(i_rA.size(), i_rB.size());
	for (std::size_t i = 0; i < i_rA.size(); ++i)
		EXPECT_NEAR(i_rA[i], i_rB[i], i_Tolerance) << i;
}

TEST(RestPose, StiffnessRunsWithTheLogarithmOfTheDeviation)
{
	const struct
	{
		const char* pName;
		VJoint::EJointType Type;
		VNumbers Covariance;
		VNumbers Stiffness;
	} rows[] = {{"hinge of variance 1", VJoint::EHinge, {1}, {(1 - 6.907755278982137 / 10.81977828441028) * 100}},
	    {"stiff hinge", VJoint::EHinge, {1e-6}, {100}}, {"soft hinge", VJoint::EHinge, {2500}, {0}},
	    {"stiffer than stiff", VJoint::EHinge, {0}, {100}}, {"softer than soft", VJoint::EHinge, {1e9}, {0}},
	    {"negative variance", VJoint::EHinge, {-1}, {100}},
	    {"two angles", VJoint::EHardySpicer, {1e-6, 7, 7, 2500}, {100, 0}},
	    {"slider of variance 1", VJoint::ESlider, {1}, {75}}, {"dummy", VJoint::EDummy, {}, {}}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.pName);
		const VNumbers mean(CoreOrlexTypes::StateSize(rRow.Type), 0.7);
		VNumbers restPose;
		VNumbers stiffness;
		ASSERT_TRUE(MeanCovarianceToRestPoseStiffness(rRow.Type, mean, rRow.Covariance, restPose, stiffness));
		EXPECT_EQ(restPose, mean);
		ExpectNear(stiffness, rRow.Stiffness, 1e-12);
	}
	VNumbers mean;
	VNumbers covariance;
	ASSERT_TRUE(RestPoseStiffnessToMeanCovariance(VJoint::EHardySpicer, {1, 2}, {150, -3}, mean, covariance));
	EXPECT_EQ(mean, (VNumbers{1, 2}));
	ExpectNear(covariance, {1e-6, 0, 0, 2500}, 1e-10);
}

TEST(RestPose, ThereAndBack)
{
	std::mt19937 generator(7);
	std::uniform_real_distribution<double> percent(0, 100);
	std::uniform_real_distribution<double> angle(-1.4, 1.4);
	for (const auto type :
	    {VJoint::EFree, VJoint::EBall, VJoint::EHardySpicer, VJoint::EHinge, VJoint::ESlider, VJoint::EDummy})
		for (int round = 0; round < 50; ++round)
		{
			VNumbers restPose(CoreOrlexTypes::StateSize(type));
			VNumbers stiffness(restPose.size());
			for (std::size_t i = 0; i < restPose.size(); ++i)
			{
				restPose[i] = angle(generator) * (i < 3 ? 1 : 700);
				stiffness[i] = round == 0 ? 100 : round == 1 ? 0 : percent(generator);
			}
			VNumbers mean;
			VNumbers covariance;
			VNumbers restPoseBack;
			VNumbers stiffnessBack;
			ASSERT_TRUE(RestPoseStiffnessToMeanCovariance(type, restPose, stiffness, mean, covariance));
			ASSERT_TRUE(MeanCovarianceToRestPoseStiffness(type, mean, covariance, restPoseBack, stiffnessBack));
			ExpectNear(restPoseBack, restPose, 1e-12);
			ExpectNear(stiffnessBack, stiffness, 1e-3);
		}
}

TEST(RestPose, BallCovarianceAgreesWithSamples)
{
	const VEulerToAABall::VState restPose{0.5, -0.8, 1.1};
	const VNumbers stiffness{60, 70, 55};
	VNumbers mean;
	VNumbers covariance;
	ASSERT_TRUE(RestPoseStiffnessToMeanCovariance(
	    VJoint::EBall, {restPose.begin(), restPose.end()}, stiffness, mean, covariance));
	const Rotation::VMatrix3 rest = Rotation::RotationMatrixFromEuler(restPose, Rotation::EXYZ);
	const Rotation::VVector3 expected = Rotation::AngleAxisFromRotationMatrix(rest);
	ExpectNear(mean, {expected.begin(), expected.end()}, 1e-12);

	std::mt19937 generator(11);
	std::normal_distribution<double> normal;
	VNumbers sums(9, 0.0);
	constexpr int c_Samples = 200000;
	for (int sample = 0; sample < c_Samples; ++sample)
	{
		Rotation::VVector3 angles = restPose;
		for (std::size_t i = 0; i < 3; ++i)
			angles[i] += normal(generator) * std::exp(3.912023005428146 - 10.819778284410283 * stiffness[i] * 0.01);
		const Rotation::VVector3 turn = Rotation::AngleAxisFromRotationMatrix(
		    Rotation::Product(Rotation::Transposed(rest), Rotation::RotationMatrixFromEuler(angles, Rotation::EXYZ)));
		for (std::size_t i = 0; i < 9; ++i)
			sums[i] += turn[i / 3] * turn[i % 3] / c_Samples;
	}
	for (std::size_t i = 0; i < 9; ++i)
		EXPECT_NEAR(covariance[i], sums[i], 0.01 * std::sqrt(sums[i / 3 * 4] * sums[i % 3 * 4])) << i;
}

/// What a solver makes of it: one angle that is off by its deviation costs one half.
TEST(RestPose, APriorMeasuresInTheSameAxes)
{
	const VEulerToAABall::VState restPose{0.5, -0.8, 1.1};
	const VNumbers stiffness{60, 70, 80};
	CoreOrlexTypes::VSubject::VSegment segment;
	segment.m_Joint.m_JointType = VJoint::EBall;
	ASSERT_TRUE(RestPoseStiffnessToMeanCovariance(VJoint::EBall, {restPose.begin(), restPose.end()}, stiffness,
	    segment.m_Joint.m_Mean, segment.m_Joint.m_Covariance));
	ComputeSubject::VBallJointPrior prior(segment);
	for (std::size_t i = 0; i < 3; ++i)
	{
		Rotation::VVector3 angles = restPose;
		angles[i] += std::exp(3.912023005428146 - 10.819778284410283 * stiffness[i] * 0.01);
		const Rotation::VVector3 state =
		    Rotation::AngleAxisFromRotationMatrix(Rotation::RotationMatrixFromEuler(angles, Rotation::EXYZ));
		const double* pState = state.data();
		prior.SetState(pState);
		EXPECT_NEAR(prior.Energy(), 0.5, 1e-9) << i;
	}
}

TEST(RestPose, GimbalLockKeepsTheMiddleAngle)
{
	VNumbers mean;
	VNumbers covariance;
	VNumbers restPose;
	VNumbers stiffness;
	ASSERT_TRUE(RestPoseStiffnessToMeanCovariance(
	    VJoint::EBall, {0.0, std::numbers::pi / 2, 0.7}, {50, 50, 50}, mean, covariance));
	ASSERT_TRUE(MeanCovarianceToRestPoseStiffness(VJoint::EBall, mean, covariance, restPose, stiffness));
	ExpectNear(restPose, {0, std::numbers::pi / 2, 0.7}, 1e-7);
	EXPECT_NEAR(stiffness[1], 50, 1e-6);
	// Positive definite although one direction is out of the reach of the angles.
	const auto& C = covariance;
	EXPECT_GT(Rotation::Determinant({C[0], C[1], C[2], C[3], C[4], C[5], C[6], C[7], C[8]}), 0.0);
}

/// Around 2^50 the numbers lie a quarter apart on one side and an eighth on the other.
TEST(RestPose, AnAngleTooLargeForItsDeviationIsAsserted)
{
	VMessageLog log;
	VNumbers mean;
	VNumbers covariance;
	RestPoseStiffnessToMeanCovariance(VJoint::EBall, {std::exp2(50), 0, 0}, {0, 100, 100}, mean, covariance);
	EXPECT_EQ(log.TakeTroubles(), VTexts{"ASSERT AAMean.magnitude() < 1e-2"});
}

TEST(JointRange, OfOneAngleAndTwo)
{
	VNumbers centre;
	VNumbers matrix;
	VNumbers least;
	VNumbers greatest;
	ASSERT_TRUE(MinMaxToRange(VJoint::EHinge, {-1}, {3}, centre, matrix));
	EXPECT_EQ(centre, VNumbers{1});
	EXPECT_EQ(matrix, VNumbers{4});
	for (const auto type : {VJoint::EHinge, VJoint::ESlider, VJoint::EHardySpicer, VJoint::EDummy})
	{
		const std::size_t size = CoreOrlexTypes::StateSize(type);
		const VNumbers low(size, -0.75);
		VNumbers high(size, 2.5);
		if (size == 2)
			high[1] = 0.5;
		ASSERT_TRUE(MinMaxToRange(type, low, high, centre, matrix));
		ASSERT_TRUE(RangeToMinMax(type, centre, matrix, least, greatest));
		ExpectNear(least, low, 1e-15);
		ExpectNear(greatest, high, 1e-15);
	}
	EXPECT_EQ(matrix.size(), 0u);
	ASSERT_TRUE(MinMaxToRange(VJoint::EHardySpicer, {0, 1}, {2, 7}, centre, matrix));
	EXPECT_EQ(matrix, (VNumbers{1, 0, 0, 9}));
}

TEST(JointRange, OfBallAndFreeJointsByTheirBoundary)
{
	VNumbers least;
	VNumbers greatest;
	// About the axes themselves the angles are the axes' extents, beyond a quarter turn too.
	for (const double extent : {0.4, 2.0})
	{
		ASSERT_TRUE(
		    RangeToMinMax(VJoint::EBall, {0, 0, 0}, {0, 0, 0, 0, extent * extent, 0, 0, 0, 0}, least, greatest));
		ExpectNear(least, {0, -extent, 0}, 1e-12);
		ExpectNear(greatest, {0, extent, 0}, 1e-12);
	}
	// About the centre's axes, around its angle.
	ASSERT_TRUE(RangeToMinMax(VJoint::EBall, {3.0, 0, 0}, {0.25, 0, 0, 0, 0, 0, 0, 0, 0}, least, greatest));
	ExpectNear(least, {2.5, 0, 0}, 1e-12);
	ExpectNear(greatest, {3.5, 0, 0}, 1e-12);
	// A round range: the middle angle reaches its radius, the sample for it being one of the axes.
	VNumbers matrix(36, 0.0);
	for (std::size_t i = 0; i < 6; ++i)
		matrix[7 * i] = i < 3 ? 0.09 : 400;
	ASSERT_TRUE(RangeToMinMax(VJoint::EFree, {0, 0, 0, 5, 6, 7}, matrix, least, greatest));
	EXPECT_NEAR(greatest[1], 0.3, 1e-3);
	for (std::size_t i = 0; i < 3; ++i)
	{
		EXPECT_NEAR(least[i], -greatest[i], 1e-12);
		EXPECT_NEAR(least[3 + i], 5.0 + double(i) - 20, 1e-12);
		EXPECT_NEAR(greatest[3 + i], 5.0 + double(i) + 20, 1e-12);
	}
}

TEST(JointStatistics, RefuseWhatDoesNotFit)
{
	VMessageLog log;
	VNumbers a;
	VNumbers b;
	const auto bad = VJoint::EBadJointType;
	const double nan = std::nan("");
	const struct
	{
		bool (*pConvert)(VJoint::EJointType, const VNumbers&, const VNumbers&, VNumbers&, VNumbers&);
		VJoint::EJointType Type;
		VNumbers First;
		VNumbers Second;
		VTexts Log;
	} rows[] = {{MeanCovarianceToRestPoseStiffness, VJoint::EBall, {1}, {1},
	                {"ASSERT Dof == i_rMeanPose.size()", "ASSERT ( Dof*Dof ) == i_rCovariance.size()",
	                    "ASSERT i_rMean.size() == 3", "ASSERT i_rCovariance.size() == 9"}},
	    {MeanCovarianceToRestPoseStiffness, VJoint::EFree, {1}, {1},
	        {"ASSERT Dof == i_rMeanPose.size()", "ASSERT ( Dof*Dof ) == i_rCovariance.size()",
	            "ASSERT i_rMean.size() == 6", "ASSERT i_rCovariance.size() == 36"}},
	    {MeanCovarianceToRestPoseStiffness, VJoint::EHinge, {}, {},
	        {"ASSERT Dof == i_rMeanPose.size()", "ASSERT ( Dof*Dof ) == i_rCovariance.size()"}},
	    {MeanCovarianceToRestPoseStiffness, bad, {}, {}, {"2 Cannot convert statistics: unsupported joint type"}},
	    {MeanCovarianceToRestPoseStiffness, VJoint::EHinge, {0}, {nan},
	        {"2 Cannot convert statistics: a value is not finite"}},
	    {RestPoseStiffnessToMeanCovariance, VJoint::EFree, {1}, {1},
	        {"ASSERT i_rRestPose.size() == DoF", "ASSERT i_rStiffness.size() == DoF", "ASSERT i_rRestPose.size() == 6",
	            "ASSERT i_rStiffness.size() == 6"}},
	    {RestPoseStiffnessToMeanCovariance, VJoint::EBall, {0, 0, nan}, {1},
	        {"ASSERT i_rStiffness.size() == DoF", "ASSERT i_rStiffness.size() == 3"}},
	    {RestPoseStiffnessToMeanCovariance, VJoint::EBall, {0}, {1, 2, 3},
	        {"ASSERT i_rRestPose.size() == DoF", "ASSERT i_rRestPose.size() == 3"}},
	    {RestPoseStiffnessToMeanCovariance, VJoint::ESlider, {}, {},
	        {"ASSERT i_rRestPose.size() == DoF", "ASSERT i_rStiffness.size() == DoF"}},
	    {RestPoseStiffnessToMeanCovariance, VJoint::EJointType(77), {}, {},
	        {"2 Cannot convert stats: unsupported joint type"}},
	    {RangeToMinMax, VJoint::EHinge, {}, {1, 2},
	        {"ASSERT DoF == i_rRangeCenteringState.size()", "ASSERT ( DoF*DoF ) == i_rRangeMatrix.size()"}},
	    {RangeToMinMax, VJoint::EHardySpicer, {0, 0}, {1, 1},
	        {"ASSERT ( DoF*DoF ) == i_rRangeMatrix.size()", "ASSERT i_rEllipseMat.size() == 4"}},
	    {RangeToMinMax, bad, {}, {}, {"2 Cannot convert ranges: unsupported joint type"}},
	    {RangeToMinMax, VJoint::EBall, {0, 0, nan}, VNumbers(9, 1.0),
	        {"2 Cannot convert ranges: a value is not finite"}},
	    {MinMaxToRange, VJoint::ESlider, {}, {1, 2},
	        {"ASSERT i_rMin.size() == DoFCount", "ASSERT i_rMax.size() == DoFCount"}},
	    {MinMaxToRange, VJoint::EBall, {0, 0, 0}, {1, 1, 1},
	        {"ASSERT !\"Range conversion from MinMax to axis angle not supported on a ball joint\"",
	            "2 Range conversion from MinMax to axis angle not supported on a ball joint"}},
	    {MinMaxToRange, VJoint::EFree, VNumbers(6, 0.0), VNumbers(6, 1.0),
	        {"ASSERT !\"Range conversion from MinMax to axis angle not supported on a free joint\"",
	            "2 Range conversion from MinMax to axis angle not supported on a free joint"}},
	    {MinMaxToRange, bad, {}, {}, {"2 Cannot convert ranges: unsupported joint type"}}};
	for (const auto& rRow : rows)
	{
		EXPECT_FALSE(rRow.pConvert(rRow.Type, rRow.First, rRow.Second, a, b));
		EXPECT_EQ(log.TakeTroubles(), rRow.Log);
	}
}

} // namespace
