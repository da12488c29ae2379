#include "../Assertions.h"

#include "numerics/FindTransformBetweenPointsRobust.h"

#include "DebugServices/GlobalLog.h"
#include "math/NumberText.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace
{

using namespace Rotation;

const VPose<double> c_Pose = PoseFromAngleAxis({0.4, -1.1, 0.8}, {100, -200, 300});

struct VRow
{
	const char* m_pName;
	std::size_t m_Pairs;
	std::size_t m_Wrong;
	double m_Noise;
	double m_Tolerance;
};

const VRow c_Rows[] = {
    {"ThreePairs", 3, 0, 0.0, 1e-9},
    {"Exact", 20, 0, 0.0, 1e-9},
    {"OneOfFourWrong", 4, 1, 0.0, 1e-9},
    {"FourTenthsWrong", 30, 12, 0.0, 1e-9},
    // 0.5 mm of noise over 36 pairs and an arm of about 500 mm.
    {"NoisyAndFourTenthsWrong", 60, 24, 0.5, 1.0},
};

double Distance(const VVector3& a, const VVector3& b)
{
	return std::hypot(a[0] - b[0], a[1] - b[1], a[2] - b[2]);
}

TEST(FindTransformBetweenPointsRobust, WrongPairsDoNotMatter)
{
	for (const VRow& rRow : c_Rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		std::mt19937 random(41);
		std::uniform_real_distribution<double> place(-500, 500);
		std::normal_distribution<double> noise;
		std::vector<VVector3> points1;
		std::vector<VVector3> points2;
		for (std::size_t i = 0; i < rRow.m_Pairs; ++i)
		{
			points1.push_back({place(random), place(random), place(random)});
			points2.push_back(Apply(c_Pose, points1.back()));
			for (double& rValue : points2.back())
				rValue += i < rRow.m_Wrong ? place(random) : rRow.m_Noise * noise(random);
		}
		VPose<double> pose;
		ASSERT_TRUE(FindTransformBetweenPointsRobust(points1, points2, pose));
		EXPECT_TRUE(IsRotationMatrix(pose.R, 1e-12));
		for (std::size_t i = 0; i < rRow.m_Pairs; ++i)
			EXPECT_LT(Distance(Apply(pose, points1[i]), Apply(c_Pose, points1[i])), rRow.m_Tolerance) << i;
	}
}

TEST(FindTransformBetweenPointsRobust, TellsItsScore)
{
	NVX::VLogCategory& rCategory = NVX::GlobalLog::Category("System");
	std::vector<std::string> told;
	const auto pSink = NVX::GlobalLog::AddSink(
	    [&](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rText)
	    {
		    if (&i_rCategory == &rCategory && i_Level == NVX::ELogDetail)
			    told.push_back(i_rText);
	    });
	const int level = rCategory.Level();
	rCategory.SetLevel(NVX::ELogDetail);
	const std::vector<VVector3> triangle{{0, 0, 0}, {1, 0, 0}, {0, 1, 0}};
	VPose<double> pose;
	ASSERT_TRUE(FindTransformBetweenPointsRobust(triangle, triangle, pose));
	rCategory.SetLevel(level);
	const std::string words = "FindTransformBetweenPointsRobust Medsq ";
	ASSERT_EQ(told.size(), 1u);
	ASSERT_EQ(told[0].substr(0, words.size()), words);
	double score = 1.0;
	EXPECT_TRUE(NumberText::ScanWholeReal(told[0].substr(words.size()), score));
	EXPECT_LT(score, 1e-25);
}

TEST(FindTransformBetweenPointsRobust, MirroredPointsStillGiveARotation)
{
	const std::vector<VVector3> points1{{0, 0, 0}, {100, 0, 0}, {0, 100, 0}, {0, 0, 100}};
	std::vector<VVector3> points2 = points1;
	for (VVector3& rPoint : points2)
		rPoint[0] = -rPoint[0];
	VPose<double> pose;
	ASSERT_TRUE(FindTransformBetweenPointsRobust(points1, points2, pose));
	EXPECT_TRUE(IsRotationMatrix(pose.R, 1e-12));
}

TEST(FindTransformBetweenPointsRobust, WithoutATriangleThePoseStays)
{
	const double nan = std::nan("");
	const VAssertions assertions;
	const std::vector<VVector3> triangle{{0, 0, 0}, {1, 0, 0}, {0, 1, 0}};
	const std::vector<VVector3> line{{0, 0, 0}, {1, 1, 1}, {2, 2, 2}, {3, 3, 3}};
	const std::vector<VVector3> bad{{nan, 0, 0}, {nan, 0, 0}, {0, nan, 0}};
	VPose<double> pose = c_Pose;
	EXPECT_FALSE(FindTransformBetweenPointsRobust({}, {}, pose));
	EXPECT_FALSE(FindTransformBetweenPointsRobust({{1, 2, 3}, {4, 5, 6}}, {{1, 2, 3}, {4, 5, 6}}, pose));
	EXPECT_FALSE(FindTransformBetweenPointsRobust(line, line, pose));
	EXPECT_FALSE(FindTransformBetweenPointsRobust(bad, bad, pose));
	EXPECT_TRUE(assertions.Take().empty());
	EXPECT_FALSE(FindTransformBetweenPointsRobust(triangle, line, pose));
	EXPECT_EQ(assertions.Take(), std::vector<std::string>{"a_rPoints1.size() == a_rPoints2.size()"});
	EXPECT_EQ(pose.R, c_Pose.R);
	EXPECT_EQ(pose.t, c_Pose.t);
}

} // namespace
