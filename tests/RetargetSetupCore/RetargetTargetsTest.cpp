#include "RetargetSetupCore/RetargetTargets.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "RetargetSetupCore/BindPose.h"
#include "TestSubjects.h"
#include "math/NumberText.h"

#include <gtest/gtest.h>

#include <numbers>

namespace
{

using namespace RetargetSetup;
using ComputeSubject::VComputeSubjectFK;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

std::unique_ptr<VComputeSubjectFK> KinematicsOf(const VSubjectParametrised& i_rSubject)
{
	CoreOrlexTypes::VSubject subject;
	EXPECT_TRUE(CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, subject));
	return KinematicsInBindPose(i_rSubject, subject, "test");
}

class RetargetTargets : public testing::Test
{
protected:
	void SetUp() override
	{
		// The source's arm is at (30, 0, 1000), the target's at (0, -100, 900) and turned a quarter about Z.
		m_Source = MakeSubject({{"Hips", -1}, {"LeftArm", 0, {"30", "0", "0"}}});
		m_Source.m_Segments[0].m_Joint.m_BindPose = {0, 0, 0, 0, 0, 1000};
		m_Target = MakeSubject({{"pelvis", -1}, {"arm_l", 0, {"100*GlobalScale", "0", "0"}}});
		m_Target.m_Segments[0].m_Joint.m_BindPose = {0, 0, -std::numbers::pi / 2, 0, 0, 900};
		m_Target.m_Segments[1].m_Joint.m_BindPose = {0, 0, std::numbers::pi};
		m_Data.m_Segments.resize(2);
	}

	void Add(std::size_t i_Source, std::size_t i_Target, bool i_bPosition)
	{
		AddTargetPair(*KinematicsOf(m_Source), *KinematicsOf(m_Target), i_Source, i_Target, i_bPosition, m_Source,
		    m_Target, m_Data);
	}

	VSubjectParametrised m_Source;
	VSubjectParametrised m_Target;
	VSubjectApplicationData m_Data;
};

TEST_F(RetargetTargets, APositionTarget)
{
	Add(1, 1, true);
	ASSERT_EQ(m_Target.m_Targets.size(), 1u);
	// From (0, -100, 900) to (30, 0, 1000) in axes turned by +90 degrees about Z: x' = y, y' = -x.
	VTarget expected;
	expected.m_Type = VTarget::ELocalPointToWorldPoint;
	expected.m_SegmentIndices = {1};
	expected.m_MarkerIndices = {0};
	expected.m_ViewNormals = {{0, 0, 0}};
	expected.m_StateExpressions = {"100.000000*GlobalScale", "-30.000000*GlobalScale", "100.000000*GlobalScale"};
	VSubjectParametrised wanted = m_Target;
	wanted.m_Targets = {expected};
	EXPECT_EQ(m_Target, wanted);

	ASSERT_EQ(m_Target.m_Markers.size(), 1u);
	EXPECT_EQ(m_Target.m_Markers[0].m_Name, "LeftArm");
	EXPECT_EQ(m_Target.m_Markers[0].m_MarkerId, CoreOrlexTypes::HashName("LeftArm"));
	EXPECT_EQ(m_Target.m_Markers[0].m_Radius, 10.0);
	ASSERT_EQ(m_Data.m_Markers.size(), 1u);
	EXPECT_EQ(m_Data.m_Markers[0].m_Colour, (CoreOrlexTypes::VColour{93, 93, 93, 255}));
	ASSERT_EQ(m_Data.m_Targets.size(), 1u);
	EXPECT_EQ(m_Data.m_Targets[0].m_Name, "LeftArm>arm_l");
	EXPECT_EQ(m_Data.m_Targets[0].m_Colour, (CoreOrlexTypes::VColour{255, 0, 255, 255}));
	EXPECT_TRUE(m_Data.m_Targets[0].m_Visible);
}

TEST_F(RetargetTargets, ARotationTarget)
{
	Add(1, 1, false);
	const VTarget& rTarget = m_Target.m_Targets.at(0);
	EXPECT_EQ(rTarget.m_Type, VTarget::ELocalRotationToWorldRotation);
	EXPECT_EQ(rTarget.m_RotationObservationIndices, std::vector<std::uint32_t>{0});
	EXPECT_TRUE(rTarget.m_MarkerIndices.empty() && rTarget.m_ViewNormals.empty());
	ASSERT_EQ(rTarget.m_StateExpressions.size(), 3u);
	double angle = 0.0;
	ASSERT_TRUE(NumberText::ScanWholeReal(rTarget.m_StateExpressions[2], angle));
	EXPECT_NEAR(angle, -std::numbers::pi / 2, 1e-12);
	EXPECT_GE(rTarget.m_StateExpressions[2].size(), 17u) << "angles keep all their digits";
	EXPECT_EQ(m_Target.m_Rotations.at(0).m_Name, "LeftArm");
	EXPECT_EQ(m_Target.m_Rotations.at(0).m_RotationId, CoreOrlexTypes::HashName("LeftArm"));
	EXPECT_EQ(m_Data.m_Targets.at(0).m_Name, "LeftArm}arm_l");
	EXPECT_TRUE(m_Data.m_Markers.empty());
}

TEST_F(RetargetTargets, ThePairTwiceSharesOneMarker)
{
	Add(1, 1, true);
	Add(1, 1, true);
	Add(1, 0, false);
	Add(1, 1, false);
	EXPECT_EQ(m_Target.m_Targets.size(), 4u);
	EXPECT_EQ(m_Target.m_Markers.size(), 1u);
	EXPECT_EQ(m_Target.m_Rotations.size(), 1u);
	EXPECT_EQ(m_Target.m_Targets[0].m_StateExpressions, m_Target.m_Targets[1].m_StateExpressions);
}

TEST_F(RetargetTargets, TheScaleComesOutOfAPosition)
{
	SetGlobalScale(m_Target, 2.0);
	// The target's arm is at (0, -200, 900) now.
	Add(1, 1, true);
	EXPECT_EQ(m_Target.m_Targets.at(0).m_StateExpressions,
	    (std::vector<std::string>{"100.000000*GlobalScale", "-15.000000*GlobalScale", "50.000000*GlobalScale"}));
}

TEST_F(RetargetTargets, WithoutADynamicParameterTheOffsetStaysZeroAndIsTold)
{
	m_Target.m_DynamicParameters.clear();
	m_Target.m_Segments[1].m_PreTranslation[0] = "100";
	VLogRecorder log;
	Add(1, 1, true);
	EXPECT_EQ(m_Target.m_Targets.at(0).m_StateExpressions, (std::vector<std::string>(3, "0")));
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: The offset of target 'LeftArm>arm_l' stays 0: the target subject has no "
	    "dynamic parameter to scale it by");
}

TEST_F(RetargetTargets, UpdateRewritesOffsetsAlone)
{
	Add(1, 1, true);
	Add(1, 1, false);
	m_Target.m_Targets[0].m_Weight = 5.0;
	VSubjectParametrised wanted = m_Target;
	m_Target.m_Segments[0].m_Joint.m_BindPose[5] = 950;
	UpdateTargetStates(*KinematicsOf(m_Source), *KinematicsOf(m_Target), m_Source, m_Target);
	wanted.m_Segments = m_Target.m_Segments;
	wanted.m_Targets[0].m_StateExpressions[2] = "50.000000*GlobalScale";
	EXPECT_EQ(m_Target, wanted);
}

TEST_F(RetargetTargets, UpdateLeavesAloneWhatNamesNothing)
{
	const struct
	{
		const char* m_pName;
		void (*m_pDamage)(VSubjectParametrised& io_rTarget);
		const char* m_pTold;
	} rows[] = {
	    {"a source that the performer does not have",
	        [](VSubjectParametrised& io_rTarget) { io_rTarget.m_Markers[0].m_Name = "Tail"; },
	        "Target 0 keeps its offset: the source subject has no segment 'Tail'"},
	    {"no marker", [](VSubjectParametrised& io_rTarget) { io_rTarget.m_Targets[0].m_MarkerIndices.clear(); },
	        "Target 0 keeps its offset: it names no source, or no segment, that is there"},
	    {"a marker beyond the list",
	        [](VSubjectParametrised& io_rTarget) { io_rTarget.m_Targets[0].m_MarkerIndices = {1}; },
	        "Target 0 keeps its offset: it names no source, or no segment, that is there"},
	    {"no segment", [](VSubjectParametrised& io_rTarget) { io_rTarget.m_Targets[0].m_SegmentIndices.clear(); },
	        "Target 0 keeps its offset: it names no source, or no segment, that is there"},
	    {"a segment beyond the list",
	        [](VSubjectParametrised& io_rTarget) { io_rTarget.m_Targets[0].m_SegmentIndices = {0xFFFFFFFFu}; },
	        "Target 0 keeps its offset: it names no source, or no segment, that is there"},
	    {"another type, which goes by its rotation",
	        [](VSubjectParametrised& io_rTarget)
	        { io_rTarget.m_Targets[0].m_Type = VTarget::ELocalPointToWorldPointGaussian; },
	        "Target 0 keeps its offset: it names no source, or no segment, that is there"},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		SetUp();
		m_Target.m_Targets.clear();
		m_Target.m_Markers.clear();
		Add(1, 1, true);
		m_Target.m_Targets[0].m_StateExpressions[0] = "1*GlobalScale";
		rRow.m_pDamage(m_Target);
		const VSubjectParametrised before = m_Target;
		VLogRecorder log;
		UpdateTargetStates(*KinematicsOf(m_Source), *KinematicsOf(before), m_Source, m_Target);
		EXPECT_EQ(m_Target, before);
		EXPECT_EQ(log.Take(), std::string("3 RetargetSetup: ") + rRow.m_pTold);
	}
}

TEST_F(RetargetTargets, RemovalTakesWhatNothingUsesAnyMore)
{
	Add(0, 0, true);
	Add(1, 1, true);
	Add(1, 0, true);
	Add(1, 1, false);
	m_Data.m_Sticks.push_back({0, {}, 1, {}});
	RemoveTarget(m_Target, m_Data, 2);
	EXPECT_EQ(m_Target.m_Markers.size(), 2u) << "one of two users is left";
	RemoveTarget(m_Target, m_Data, 0);
	ASSERT_EQ(m_Target.m_Markers.size(), 1u);
	EXPECT_EQ(m_Target.m_Markers[0].m_Name, "LeftArm");
	EXPECT_EQ(m_Target.m_Targets[0].m_MarkerIndices, std::vector<std::uint32_t>{0});
	EXPECT_EQ(m_Data.m_Markers.size(), 1u);
	EXPECT_TRUE(m_Data.m_Sticks.empty());
	ASSERT_EQ(m_Data.m_Targets.size(), 2u);
	EXPECT_EQ(m_Data.m_Targets[0].m_Name, "LeftArm>arm_l");
	EXPECT_EQ(m_Data.m_Targets[1].m_Name, "LeftArm}arm_l");
	RemoveTarget(m_Target, m_Data, 1);
	EXPECT_TRUE(m_Target.m_Rotations.empty());
}

TEST(SideNeutralName, Rows)
{
	const std::pair<const char*, const char*> rows[] = {{"LeftArm", "Arm"}, {"RightArm", "Arm"}, {"arm_l", "arm_"},
	    {"L_Hand", "_Hand"}, {"R_Hand", "_Hand"}, {"Roll", "o"}, {"Spine", "Spine"}, {"bright_leftleft", "b_"},
	    {"lLrR", ""}, {"LEFT", "EFT"}, {"", ""}, {"LeLeftft", "eft"}};
	for (const auto& [name, expected] : rows)
		EXPECT_EQ(SideNeutralName(name), expected) << name;
}

TEST(FindMirrorSegment, TheFirstOtherOfTheSameNeutralName)
{
	const VSubjectParametrised subject = MakeSubject({{"Spine", -1}, {"LeftArm", 0}, {"Arm", 0}, {"RightArm", 0}});
	const std::int32_t expected[] = {-1, 2, 1, 1};
	for (std::size_t i = 0; i < 4; ++i)
		EXPECT_EQ(FindMirrorSegment(subject, i), expected[i]) << i;
	EXPECT_EQ(FindMirrorSegment(subject, 4), -1);
}

TEST(KinematicsInBindPose, WhatIsNoTreeCountsAsMissing)
{
	VSubjectParametrised forward = MakeSubject({{"a", -1}, {"b", 0}});
	forward.m_Segments[1].m_ParentSegmentIndex = 1;
	for (const VSubjectParametrised& rSubject : {forward, VSubjectParametrised(), MakeSubject({{"a", -1}, {"b", -1}})})
	{
		VLogRecorder log;
		EXPECT_EQ(KinematicsOf(rSubject), nullptr);
		EXPECT_EQ(log.Take(),
		    "3 RetargetSetup: The segments of the test subject make no tree with joints, so their poses "
		    "are not known");
	}
}

TEST(WorstPoseDifference, DistanceComesBeforeAngle)
{
	using Rotation::PoseFromAngleAxis;
	const std::vector<Rotation::VPose<double>> rest(3);
	EXPECT_FALSE(WorstPoseDifference(rest, rest));
	EXPECT_FALSE(WorstPoseDifference(rest, {PoseFromAngleAxis({0, 5e-5, 0}, {0.02, 0, 0})}));
	const auto turned =
	    WorstPoseDifference(rest, {PoseFromAngleAxis({0, 0, 0.1}, {}), PoseFromAngleAxis({0, -3.0, 0}, {0.02, 0, 0})});
	ASSERT_TRUE(turned);
	EXPECT_EQ(turned->m_SegmentIndex, 1u);
	EXPECT_NEAR(turned->m_Angle, 3.0, 1e-9);
	const auto moved = WorstPoseDifference(
	    rest, {PoseFromAngleAxis({0, 0, 3.0}, {}), PoseFromAngleAxis({}, {3, 0, 4}), PoseFromAngleAxis({}, {0, 1, 0})});
	ASSERT_TRUE(moved);
	EXPECT_EQ(moved->m_SegmentIndex, 1u);
	EXPECT_EQ(moved->m_Distance, 5.0);
}

} // namespace
