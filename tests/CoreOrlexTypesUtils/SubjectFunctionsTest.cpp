#include "../Assertions.h"

#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "CoreOrlexTypesUtils/observations/UnusedObservations.h"
#include "CoreOrlexTypesUtils/rigidbody/AxisOrientation.h"

#include <gtest/gtest.h>

#include <cmath>

namespace
{

using namespace CoreOrlexTypesUtils;
using CoreOrlexTypes::VColour;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VVector3;
using VIndices = std::vector<std::uint32_t>;

TEST(PoseVector, TakesOfEachJointItsDegreesOfFreedom)
{
	using VJoint = VSubjectParametrised::VJoint;
	const struct
	{
		VJoint::EJointType Type;
		std::vector<double> BindPose;
	} joints[] = {{VJoint::EFree, {1, 2, 3, 4}}, {VJoint::EBall, {5, 6, 7, 8}}, {VJoint::EDummy, {9}},
	    {VJoint::EHardySpicer, {}}, {VJoint::EHinge, {10}}, {VJoint::EBadJointType, {11}}, {VJoint::ESlider, {12}}};
	VSubjectParametrised subject;
	for (const auto& rJoint : joints)
	{
		auto& rSegment = subject.m_Segments.emplace_back();
		rSegment.m_Joint.m_JointType = rJoint.Type;
		rSegment.m_Joint.m_BindPose = rJoint.BindPose;
	}
	EXPECT_EQ(PoseVector(subject, &VJoint::m_BindPose), (std::vector<double>{1, 2, 3, 4, 0, 0, 5, 6, 7, 0, 0, 10, 12}));
	EXPECT_EQ(PoseVector(subject, &VJoint::m_TPoseMean), std::vector<double>(13, 0.0));
}

VVector3 Column(const Rotation::VMatrix3& i_rMatrix, std::size_t i_Column)
{
	return {i_rMatrix[i_Column], i_rMatrix[3 + i_Column], i_rMatrix[6 + i_Column]};
}

void ExpectNear(const VVector3& i_rA, const VVector3& i_rB)
{
	for (std::size_t i = 0; i < 3; ++i)
		EXPECT_NEAR(i_rA[i], i_rB[i], 1e-12);
}

TEST(AxisOrientation, PutsBothDirectionsOnTheirAxes)
{
	for (std::size_t first = 0; first < 3; ++first)
		for (std::size_t second = 0; second < 3; ++second)
		{
			if (first == second)
				continue;
			const Rotation::VMatrix3 matrix =
			    Rotation::RotationMatrixFromAngleAxis(TwoAxisOrientation({0, 3, 4}, {2, 3, 4}, first, second));
			ExpectNear(Column(matrix, first), {0, 0.6, 0.8});
			ExpectNear(Column(matrix, second), {1, 0, 0});
			EXPECT_NEAR(Rotation::Determinant(matrix), 1.0, 1e-12);
		}
	// The unit axes in their own places are no rotation.
	ExpectNear(TwoAxisOrientation({0, 0, 1}, {1, 0, 0}, 2, 0), {0, 0, 0});
	ExpectNear(TwoAxisOrientation({1, 0, 0}, {0, 0, -1}, 2, 0), {0, std::acos(-1.0) / 2, 0});
}

TEST(AxisOrientation, ChoosesTheSecondDirection)
{
	const double third = 1.0 / std::sqrt(3.0);
	const double half = 1.0 / std::sqrt(2.0);
	const struct
	{
		VVector3 Axis;
		VVector3 Next;
	} rows[] = {{{0, 0, 1}, {half, -half, 0}}, {{1, 0, 0}, {0, half, -half}}, {{0, -1, 0}, {half, 0, -half}},
	    // All components equal: (0, -z, y) less its part along the axis.
	    {{third, third, third}, {0, -half, half}}};
	for (const auto& rRow : rows)
		for (std::size_t first = 0; first < 3; ++first)
		{
			const Rotation::VMatrix3 matrix =
			    Rotation::RotationMatrixFromAngleAxis(SingleAxisOrientation(rRow.Axis, first));
			ExpectNear(Column(matrix, first), rRow.Axis);
			ExpectNear(Column(matrix, (first + 1) % 3), rRow.Next);
		}
}

TEST(AxisOrientation, RefusesAxesAndDirectionsThatDoNotFit)
{
	const VAssertions assertions;
	ExpectNear(TwoAxisOrientation({0, 1, 0}, {0, 0, 1}, 3, 0), {0, 0, 0});
	ExpectNear(TwoAxisOrientation({0, 1, 0}, {0, 0, 1}, 0, 3), {0, 0, 0});
	ExpectNear(TwoAxisOrientation({0, 1, 0}, {0, 0, 1}, 1, 1), {0, 0, 0});
	EXPECT_EQ(assertions.Take(),
	    (std::vector<std::string>{
	        "i_FirstDesiredAxis < 3", "i_SecondDesiredAxis < 3", "i_SecondDesiredAxis != i_FirstDesiredAxis"}));
	ExpectNear(TwoAxisOrientation({0, 0, 0}, {0, 0, 1}, 2, 0), {0, 0, 0});
	ExpectNear(TwoAxisOrientation({0, 2, 0}, {0, -1, 0}, 2, 0), {0, 0, 0});
}

/// Five markers with colours 0 to 4, sticks between them, and three rotations.
class UnusedObservations : public testing::Test
{
protected:
	UnusedObservations()
	{
		for (std::uint8_t i = 0; i < 5; ++i)
		{
			m_Subject.m_Markers.emplace_back().m_Name.append(1, 'M').append(std::to_string(i));
			m_Data.m_Markers.push_back({VColour{i, 0, 0, 0}});
		}
		m_Subject.m_Rotations = {{"R0", 0}, {"R1", 1}, {"R2", 2}};
		for (const auto& [a, b] : {std::pair<std::uint32_t, std::uint32_t>(1, 3), {0, 1}, {4, 1}, {3, 2}, {9, 1}})
			m_Data.m_Sticks.push_back({a, {}, b, {}});
		m_Subject.m_Targets.resize(2);
	}

	std::string Markers() const
	{
		std::string names;
		for (std::size_t i = 0; i < m_Subject.m_Markers.size(); ++i)
			names += m_Subject.m_Markers[i].m_Name + ":" + std::to_string(m_Data.m_Markers.at(i).m_Colour.m_Red) + " ";
		return names;
	}

	VSubjectParametrised m_Subject;
	VSubjectApplicationData m_Data;
};

TEST_F(UnusedObservations, RenumbersMarkersTargetsAndSticks)
{
	m_Subject.m_Targets[0].m_MarkerIndices = {3};
	m_Subject.m_Targets[1].m_MarkerIndices = {4, 1, 77};
	RemoveUnusedMarkers(m_Subject, m_Data);
	EXPECT_EQ(Markers(), "M1:1 M3:3 M4:4 ");
	EXPECT_EQ(m_Data.m_Markers.size(), 3u);
	EXPECT_EQ(m_Subject.m_Targets[0].m_MarkerIndices, VIndices{1});
	EXPECT_EQ(m_Subject.m_Targets[1].m_MarkerIndices, (VIndices{2, 0, 77}));
	std::vector<std::pair<std::uint32_t, std::uint32_t>> sticks;
	for (const auto& rStick : m_Data.m_Sticks)
		sticks.emplace_back(rStick.m_MarkerIndexA, rStick.m_MarkerIndexB);
	EXPECT_EQ(sticks, (std::vector<std::pair<std::uint32_t, std::uint32_t>>{{0, 1}, {2, 0}, {9, 0}}));
	EXPECT_EQ(m_Subject.m_Rotations.size(), 3u);
}

TEST_F(UnusedObservations, WithoutTargetsNothingIsLeft)
{
	m_Subject.m_Targets.clear();
	m_Data.m_Markers.resize(2);
	RemoveUnusedMarkers(m_Subject, m_Data);
	RemoveUnusedRotations(m_Subject);
	EXPECT_TRUE(m_Subject.m_Markers.empty());
	EXPECT_TRUE(m_Data.m_Markers.empty());
	EXPECT_TRUE(m_Data.m_Sticks.empty());
	EXPECT_TRUE(m_Subject.m_Rotations.empty());
}

TEST_F(UnusedObservations, RenumbersRotations)
{
	m_Subject.m_Targets[0].m_RotationObservationIndices = {2, 0};
	m_Subject.m_Targets[1].m_RotationObservationIndices = {5};
	RemoveUnusedRotations(m_Subject);
	ASSERT_EQ(m_Subject.m_Rotations.size(), 2u);
	EXPECT_EQ(m_Subject.m_Rotations[0].m_Name, "R0");
	EXPECT_EQ(m_Subject.m_Rotations[1].m_Name, "R2");
	EXPECT_EQ(m_Subject.m_Targets[0].m_RotationObservationIndices, (VIndices{1, 0}));
	EXPECT_EQ(m_Subject.m_Targets[1].m_RotationObservationIndices, VIndices{5});
	EXPECT_EQ(m_Subject.m_Markers.size(), 5u);
}

} // namespace
