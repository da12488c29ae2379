#include "CoreOrlexTypesUtils/SubjectParametrisedConverter.h"

#include "DebugServices/GlobalLog.h"

#include <gtest/gtest.h>

namespace
{

using namespace CoreOrlexTypesUtils::SubjectParametrisedConverter;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypesUtils::VDynamicExpressionParserSimple;
using VTexts = std::vector<std::string>;
using VNumbers = std::vector<double>;

class SubjectParametrisedConverter : public testing::Test
{
protected:
	SubjectParametrisedConverter()
	{
		m_pSink = NVX::GlobalLog::AddSink(
		    [this](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
		    {
			    EXPECT_EQ(i_rCategory.Name(), "SubjectUtils");
			    EXPECT_EQ(i_Level, 2);
			    m_Log.push_back(i_rMessage);
		    });
		m_In.m_Name = "Template";
		m_In.m_SubjectId = 0x0FFFFFFF;
		m_In.m_StaticParameters.resize(1);
		m_In.m_StaticParameters[0].m_Name = "Arm";
		m_In.m_StaticParameters[0].m_DefaultExpression = "1/3";
		m_In.m_Segments.resize(2);
		m_In.m_Segments[0].m_Name = "Hips";
		m_In.m_Segments[1].m_Name = "Spine";
		m_In.m_Segments[1].m_SegmentIndex = 1;
		m_In.m_Segments[1].m_ParentSegmentIndex = 0;
		m_In.m_Segments[1].m_TreeDepth = 1;
		m_In.m_Markers = {{"Front", 17, true, 7.0, VSubjectParametrised::VMarker::EOptional, 0.5}};
		m_In.m_Rotations = {{"Turn", 5}};
		m_In.m_Targets.resize(2);
		for (auto& rTarget : m_In.m_Targets)
		{
			rTarget.m_Type = VSubjectParametrised::VTarget::ELocalPointToWorldPoint;
			rTarget.m_StateExpressions = {"2*Arm", "", "3"};
			rTarget.m_MarkerIndices = {0};
			rTarget.m_SegmentIndices = {1};
			rTarget.m_ViewNormals = {{0, 0, 1}};
		}
	}

	VSubjectParametrised m_In;
	VSubject m_Out;
	VTexts m_Log;
	std::shared_ptr<void> m_pSink;
};

TEST_F(SubjectParametrisedConverter, EvaluatesAndCopies)
{
	auto& rSegment = m_In.m_Segments[1];
	rSegment.m_PreTranslation = {"2*Arm", "", "-1"};
	rSegment.m_PreRotation = {"0.5", "Arm", "0"};
	rSegment.m_Bounds = {"1", "2", "3", "4", "5", "6*Arm"};
	rSegment.m_InversePostRotation = {1, 2, 3};
	rSegment.m_InversePostTranslation = {4, 5, 6};
	auto& rJoint = rSegment.m_Joint;
	rJoint = {"Joint", VSubjectParametrised::VJoint::EHinge, {7, 8, 9}, {1}, {2}, {3}, {4}, {5}, {6}, {7}, {8}, {9},
	    {10}, {11}};
	auto& rTarget = m_In.m_Targets[1];
	rTarget.m_Weight = 0.25;
	rTarget.m_RotationCalibrationBehaviour = VSubjectParametrised::VTarget::EHingeLike;
	rTarget.m_RotationTargetOrientation = {1, 2, 3};
	rTarget.m_NumberOfDegreesOfFreedom = 3;
	rTarget.m_RotationObservationIndices = {0};
	rTarget.m_Covariance = {1};
	rTarget.m_TemplateCovariance = {2};
	m_Out.m_Segments.resize(9);
	ASSERT_TRUE(ConvertSubject(m_In, m_Out));
	EXPECT_TRUE(m_Log.empty());

	VSubject expected;
	expected.m_Name = "Template";
	expected.m_SubjectId = 0x0FFFFFFF;
	expected.m_Segments.resize(2);
	expected.m_Segments[0].m_Name = "Hips";
	const double third = 1.0 / 3.0;
	expected.m_Segments[1] = {"Spine", 1, 0, 1, {0.5, third, 0}, {2 * third, 0, -1}, {1, 2, 3}, {4, 5, 6},
	    {1, 2, 3, 4, 5, 6 * third}, {"Joint", VSubjectParametrised::VJoint::EHinge, {7, 8, 9}, {1}, {2}, {5}, {6}}};
	expected.m_Markers = {{"Front", 17, 7.0, true, 0.5}};
	expected.m_Rotations = {{"Turn", 5}};
	VSubject::VTarget target;
	target.m_Type = VSubject::VTarget::ELocalPointToWorldPoint;
	target.m_State = {2 * third, 0, 3};
	target.m_MarkerIndices = {0};
	target.m_SegmentIndices = {1};
	target.m_ViewNormals = {{0, 0, 1}};
	expected.m_Targets = {target, target};
	expected.m_Targets[1].m_Weight = 0.25;
	expected.m_Targets[1].m_RotationCalibrationBehaviour = VSubject::VTarget::EHingeLike;
	expected.m_Targets[1].m_RotationTargetOrientation = {1, 2, 3};
	expected.m_Targets[1].m_NumberOfDegreesOfFreedom = 3;
	expected.m_Targets[1].m_RotationObservationIndices = {0};
	expected.m_Targets[1].m_Covariance = {1};
	EXPECT_TRUE(m_Out == expected);

	// With the template flag the other statistics are taken.
	VDynamicExpressionParserSimple parser;
	VTexts errors;
	ASSERT_TRUE(parser.Initialise(m_In, errors));
	VSubject::VSegment segment;
	EXPECT_TRUE(ConvertSegment(parser, rSegment, segment, true));
	EXPECT_EQ(segment.m_Joint.m_Covariance, VNumbers{7});
	EXPECT_EQ(segment.m_Joint.m_Mean, VNumbers{8});
	EXPECT_EQ(segment.m_Joint.m_RangeCentringState, VNumbers{9});
	EXPECT_EQ(segment.m_Joint.m_RangeMatrix, VNumbers{10});
	EXPECT_TRUE(ConvertTarget(parser, rTarget, target, true));
	EXPECT_EQ(target.m_Covariance, VNumbers{2});
}

TEST_F(SubjectParametrisedConverter, GoesBackToNumbersAsText)
{
	m_In.m_Segments[1].m_PreTranslation[0] = "2*Arm";
	m_In.m_Segments[1].m_Joint.m_JointType = VSubjectParametrised::VJoint::ESlider;
	m_In.m_Segments[1].m_Joint.m_Mean = {1};
	m_In.m_Segments[1].m_Joint.m_BindPose = {2};
	m_In.m_Targets[0].m_Covariance = VNumbers(9, 2.0);
	m_In.m_Targets[0].m_RotationCalibrationBehaviour =
	    VSubjectParametrised::VTarget::ERotationCalibrationBehaviourType(9);
	ASSERT_TRUE(ConvertSubject(m_In, m_Out));
	EXPECT_EQ(m_Out.m_Targets[0].m_RotationCalibrationBehaviour, VSubject::VTarget::EBadBehaviourType);

	VSubjectParametrised back;
	back.m_StaticParameters.resize(3);
	ConvertSubject(m_Out, back);
	EXPECT_TRUE(back.m_StaticParameters.empty());
	EXPECT_EQ(back.m_Segments[1].m_PreTranslation[0], "0.66666666666666663");
	EXPECT_EQ(back.m_Segments[1].m_PreTranslation[1], "0");
	EXPECT_EQ(back.m_Segments[1].m_Joint.m_Mean, VNumbers{1});
	EXPECT_EQ(back.m_Segments[1].m_Joint.m_TemplateMean, VNumbers{1});
	EXPECT_TRUE(back.m_Segments[1].m_Joint.m_BindPose.empty());
	EXPECT_EQ(back.m_Markers[0].m_Status, VSubjectParametrised::VMarker::ERequired);
	EXPECT_EQ(back.m_Targets[0].m_StateExpressions, (VTexts{"0.66666666666666663", "0", "3"}));
	EXPECT_EQ(back.m_Targets[0].m_TemplateCovariance, VNumbers(9, 2.0));
	VSubject again;
	ASSERT_TRUE(ConvertSubject(back, again));
	EXPECT_TRUE(again == m_Out);
}

TEST_F(SubjectParametrisedConverter, ABadSegmentExpressionLeavesZeroAndIsTold)
{
	m_In.m_Segments[0].m_PreTranslation = {"1", "x", "2"};
	m_In.m_Segments[0].m_PreRotation[2] = "Arm^2";
	m_In.m_Segments[1].m_Bounds[0] = "1 2 3";
	EXPECT_TRUE(ConvertSubject(m_In, m_Out));
	EXPECT_EQ(m_Out.m_Segments[0].m_PreTranslation, (std::array<double, 3>{1, 0, 2}));
	EXPECT_EQ(m_Log,
	    (VTexts{"Could not evaluate m_PreTranslation expressions in segment 'Hips'",
	        "Could not evaluate m_PreRotation expressions in segment 'Hips'",
	        "Could not evaluate m_Bounds expressions in segment 'Spine'"}));
}

TEST_F(SubjectParametrisedConverter, ABadTargetStateFailsAndStopsTheLaterTargets)
{
	m_In.m_Targets[0].m_StateExpressions = {"x", "5", "Arm^2"};
	EXPECT_FALSE(ConvertSubject(m_In, m_Out));
	EXPECT_EQ(m_Log,
	    (VTexts{"Parse Error at column 2: ID \"x\" was referenced but never declared",
	        "Parse Error at column 6: Power operator invalid for arguments"}));
	EXPECT_EQ(m_Out.m_Targets[0].m_State, (VNumbers{0, 5, 0}));
	ASSERT_EQ(m_Out.m_Targets.size(), 2u);
	EXPECT_TRUE(m_Out.m_Targets[1].m_State.empty());
}

TEST_F(SubjectParametrisedConverter, StatisticsAreEmptyOrOfTheirSize)
{
	using VJoint = VSubjectParametrised::VJoint;
	const struct
	{
		VNumbers VJoint::*pStatistic;
		std::size_t Size;
		bool bGood;
	} rows[] = {{&VJoint::m_Mean, 0, true}, {&VJoint::m_Mean, 3, true}, {&VJoint::m_Mean, 4, false},
	    {&VJoint::m_Covariance, 9, true}, {&VJoint::m_Covariance, 3, false}, {&VJoint::m_RangeCentringState, 2, false},
	    {&VJoint::m_RangeMatrix, 10, false}, {&VJoint::m_RangeMatrix, 9, true}, {&VJoint::m_TPoseMean, 4, true},
	    {&VJoint::m_TemplateMean, 4, true}};
	for (const auto& rRow : rows)
	{
		m_Log.clear();
		m_In.m_Segments[0].m_Joint = {};
		m_In.m_Segments[0].m_Joint.m_JointType = VJoint::EBall;
		m_In.m_Segments[0].m_Joint.*rRow.pStatistic = VNumbers(rRow.Size, 1.0);
		EXPECT_EQ(ConvertSubject(m_In, m_Out), rRow.bGood) << &rRow - rows;
		EXPECT_EQ(m_Log, rRow.bGood ? VTexts{} : VTexts{"Could not generate joint for segment 'Hips'"});
		// The list has its length, and what comes after the failure is default.
		ASSERT_EQ(m_Out.m_Segments.size(), 2u);
		EXPECT_EQ(m_Out.m_Segments[1].m_Name, rRow.bGood ? "Spine" : "");
		EXPECT_EQ(m_Out.m_Markers.at(0).m_Name, rRow.bGood ? "Front" : "");
	}
}

TEST_F(SubjectParametrisedConverter, AFailingStaticParameterLeavesAllElementsDefault)
{
	m_In.m_StaticParameters[0].m_DefaultExpression = "Leg";
	EXPECT_FALSE(ConvertSubject(m_In, m_Out));
	EXPECT_EQ(m_Log,
	    (VTexts{"Error parsing subject static parameter expressions",
	        "Validation of StaticParameter 'Arm' expression 'Leg' failed, Parse Error at column 4: ID \"Leg\" was "
	        "referenced but never declared."}));
	EXPECT_EQ(m_Out.m_Name, "Template");
	ASSERT_EQ(m_Out.m_Segments.size(), 2u);
	EXPECT_EQ(m_Out.m_Segments[0].m_Name, "");
	ASSERT_EQ(m_Out.m_Targets.size(), 2u);
	EXPECT_EQ(m_Out.m_Rotations.at(0).m_Name, "Turn");
}

} // namespace
