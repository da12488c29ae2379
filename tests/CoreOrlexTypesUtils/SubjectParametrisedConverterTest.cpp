#include "../CoreOrlexTypes/RandomValue.h"
#include "MessageLog.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

#include <gtest/gtest.h>

#include <tuple>
#include <utility>

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
		m_In.m_Name = "Template";
		m_In.m_StaticParameters.emplace_back().m_Name = "Arm";
		m_In.m_StaticParameters[0].m_DefaultExpression = "1/3";
		m_In.m_Segments.resize(2);
		m_In.m_Segments[0].m_Name = "Hips";
		m_In.m_Segments[1].m_Name = "Spine";
		m_In.m_Markers.emplace_back().m_Name = "Front";
		m_In.m_Rotations = {{"Turn", 5}};
		m_In.m_Targets.resize(2);
		for (auto& rTarget : m_In.m_Targets)
			rTarget.m_StateExpressions = {"2*Arm", "", "3"};
	}

	VSubjectParametrised m_In;
	VSubject m_Out;
	VMessageLog m_Log;
};

/// Numbers of any kind in every field come back from the texts that they become.
TEST_F(SubjectParametrisedConverter, EveryFieldGoesThereAndBack)
{
	for (unsigned seed = 0; seed < 20; ++seed)
	{
		VSubject numbers;
		VRandomValue(seed).Fill(numbers);
		for (auto& rSegment : numbers.m_Segments)
		{
			auto& rJoint = rSegment.m_Joint;
			for (VNumbers* const pVector : {&rJoint.m_Mean, &rJoint.m_RangeCentringState})
				pVector->resize(StateSize(rJoint.m_JointType), 0.5);
			for (VNumbers* const pMatrix : {&rJoint.m_Covariance, &rJoint.m_RangeMatrix})
				pMatrix->resize(CovarianceSize(rJoint.m_JointType), 0.25);
		}
		VSubjectParametrised texts = m_In;
		ConvertSubject(numbers, texts);
		EXPECT_TRUE(texts.m_StaticParameters.empty());
		m_Out.m_Segments.resize(9);
		ASSERT_TRUE(ConvertSubject(texts, m_Out));
		EXPECT_TRUE(m_Out == numbers) << seed;
	}
}

TEST_F(SubjectParametrisedConverter, EvaluatesExpressions)
{
	auto& rSegment = m_In.m_Segments[1];
	rSegment.m_PreTranslation = {"2*Arm", "", "-1"};
	rSegment.m_PreRotation = {"0.5", "Arm", "0"};
	rSegment.m_Bounds = {"1", "2", "3", "4", "5", "6*Arm"};
	rSegment.m_Joint = {"Joint", VSubjectParametrised::VJoint::EHinge, {7, 8, 9}, {1}, {2}, {3}, {4}, {5}, {6}, {7},
	    {8}, {9}, {10}, {11}};
	auto& rTarget = m_In.m_Targets[0];
	rTarget.m_Covariance = {1};
	rTarget.m_TemplateCovariance = {2};
	rTarget.m_RotationCalibrationBehaviour = VSubjectParametrised::VTarget::ERotationCalibrationBehaviourType(9);
	ASSERT_TRUE(ConvertSubject(m_In, m_Out));
	EXPECT_EQ(m_Log.TakeTroubles(), VTexts());
	const double third = 1.0 / 3.0;
	EXPECT_EQ(m_Out.m_Segments[1].m_PreTranslation, (std::array<double, 3>{2 * third, 0, -1}));
	EXPECT_EQ(m_Out.m_Segments[1].m_PreRotation, (std::array<double, 3>{0.5, third, 0}));
	EXPECT_EQ(m_Out.m_Segments[1].m_Bounds, (std::array<double, 6>{1, 2, 3, 4, 5, 6 * third}));
	EXPECT_EQ(m_Out.m_Targets[0].m_State, (VNumbers{2 * third, 0, 3}));
	EXPECT_EQ(m_Out.m_Targets[0].m_RotationCalibrationBehaviour, VSubject::VTarget::EBadBehaviourType);
	const auto statistics = [](const VSubject::VJoint& i_rJoint)
	{
		return VNumbers{i_rJoint.m_Covariance.at(0), i_rJoint.m_Mean.at(0), i_rJoint.m_RangeCentringState.at(0),
		    i_rJoint.m_RangeMatrix.at(0)};
	};
	EXPECT_EQ(statistics(m_Out.m_Segments[1].m_Joint), (VNumbers{1, 2, 5, 6}));
	EXPECT_EQ(m_Out.m_Targets[0].m_Covariance, VNumbers{1});

	VSubjectParametrised back;
	ConvertSubject(m_Out, back);
	EXPECT_EQ(back.m_Segments[1].m_PreTranslation, (std::array<std::string, 3>{"0.66666666666666663", "0", "-1"}));
	EXPECT_EQ(back.m_Targets[0].m_StateExpressions, (VTexts{"0.66666666666666663", "0", "3"}));
	EXPECT_EQ(back.m_Segments[1].m_Joint.m_TemplateMean, VNumbers{2});
	EXPECT_TRUE(back.m_Segments[1].m_Joint.m_BindPose.empty());
	EXPECT_EQ(back.m_Targets[0].m_TemplateCovariance, VNumbers{1});
	EXPECT_EQ(back.m_Markers[0].m_Status, VSubjectParametrised::VMarker::ERequired);

	// With the template flag the other statistics are taken.
	VDynamicExpressionParserSimple parser;
	VTexts errors;
	ASSERT_TRUE(parser.Initialise(m_In, errors));
	EXPECT_TRUE(ConvertSegment(parser, rSegment, m_Out.m_Segments[1], true));
	EXPECT_EQ(statistics(m_Out.m_Segments[1].m_Joint), (VNumbers{7, 8, 9, 10}));
	EXPECT_TRUE(ConvertTarget(parser, rTarget, m_Out.m_Targets[0], true));
	EXPECT_EQ(m_Out.m_Targets[0].m_Covariance, VNumbers{2});
}

TEST_F(SubjectParametrisedConverter, ABadSegmentExpressionLeavesZeroAndIsTold)
{
	m_In.m_Segments[0].m_PreTranslation = {"1", "x", "2"};
	m_In.m_Segments[0].m_PreRotation[2] = "Arm^2";
	m_In.m_Segments[1].m_Bounds[0] = "1 2 3";
	EXPECT_TRUE(ConvertSubject(m_In, m_Out));
	EXPECT_EQ(m_Out.m_Segments[0].m_PreTranslation, (std::array<double, 3>{1, 0, 2}));
	EXPECT_EQ(m_Log.TakeTroubles(),
	    (VTexts{"2 Could not evaluate m_PreTranslation expressions in segment 'Hips'",
	        "2 Could not evaluate m_PreRotation expressions in segment 'Hips'",
	        "2 Could not evaluate m_Bounds expressions in segment 'Spine'"}));
}

/// The same numbers and messages, whatever was edited; the mark shows that what stands as it did is taken over.
TEST_F(SubjectParametrisedConverter, AnEditedSubjectBecomesWhatItWouldAnew)
{
	using VEdit = void (*)(VSubjectParametrised&);
	const std::tuple<const char*, VEdit, bool> c_Rows[] = {
	    {"nothing", [](auto&) {}, true},
	    {"an expression", [](auto& io_rSubject) { io_rSubject.m_Segments[1].m_Bounds[4] = "Arm"; }, true},
	    {"a parameter", [](auto& io_rSubject) { io_rSubject.m_StaticParameters[0].m_UserValue = 5; }, false},
	    {"its expression", [](auto& io_rSubject) { io_rSubject.m_StaticParameters[0].m_DefaultExpression = "2"; },
	        false},
	    {"a scale", [](auto& io_rSubject) { io_rSubject.m_DynamicParameters[0].m_Value = 3; }, false},
	    {"a segment less", [](auto& io_rSubject) { io_rSubject.m_Segments.pop_back(); }, false},
	    {"a segment more", [](auto& io_rSubject) { io_rSubject.m_Segments.emplace_back(); }, true},
	    {"the order", [](auto& io_rSubject) { std::swap(io_rSubject.m_Segments[0], io_rSubject.m_Segments[1]); },
	        false},
	};
	m_In.m_DynamicParameters.push_back({"Scale", 1.0, 0.0, 2.0, true});
	m_In.m_Segments[0].m_PreTranslation = {"2*Arm", "Arm-1/3", "1 2 3"};
	m_In.m_Segments[0].m_PreRotation = {"x", "0.5", "3*Scale"};
	m_In.m_Segments[1].m_Bounds = {"1", "2*Scale", "Arm", "0", "4", "5"};
	VSubject before;
	ConvertSubject(m_In, before);
	for (const auto& [pName, edit, bTakenOver] : c_Rows)
	{
		VSubjectParametrised edited = m_In;
		edit(edited);
		VSubject expected;
		m_Log.Take();
		const bool bExpected = ConvertSubject(edited, expected);
		const VTexts messages = m_Log.Take();
		EXPECT_EQ(ConvertEditedSubject(edited, m_In, before, m_Out), bExpected) << pName;
		EXPECT_EQ(m_Log.Take(), messages) << pName;
		EXPECT_TRUE(m_Out == expected) << pName;
		VSubject marked = before;
		marked.m_Segments[1].m_Bounds[0] = 7;
		ConvertEditedSubject(edited, m_In, marked, m_Out);
		EXPECT_EQ(m_Out.m_Segments.size() > 1 && m_Out.m_Segments[1].m_Bounds[0] == 7, bTakenOver) << pName;
	}
}

TEST_F(SubjectParametrisedConverter, ABadTargetStateFailsAndStopsTheLaterTargets)
{
	m_In.m_Targets[0].m_StateExpressions = {"x", "5", "Arm^2"};
	EXPECT_FALSE(ConvertSubject(m_In, m_Out));
	EXPECT_EQ(m_Log.TakeTroubles(),
	    (VTexts{"2 Parse Error at column 2: ID \"x\" was referenced but never declared",
	        "2 Parse Error at column 6: Power operator invalid for arguments"}));
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
		m_In.m_Segments[0].m_Joint = {};
		m_In.m_Segments[0].m_Joint.m_JointType = VJoint::EBall;
		m_In.m_Segments[0].m_Joint.*rRow.pStatistic = VNumbers(rRow.Size, 1.0);
		EXPECT_EQ(ConvertSubject(m_In, m_Out), rRow.bGood) << &rRow - rows;
		EXPECT_EQ(
		    m_Log.TakeTroubles(), rRow.bGood ? VTexts{} : VTexts{"2 Could not generate joint for segment 'Hips'"});
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
	EXPECT_EQ(m_Log.TakeTroubles(),
	    (VTexts{"2 Error parsing subject static parameter expressions",
	        "2 Validation of StaticParameter 'Arm' expression 'Leg' failed, Parse Error at column 4: ID \"Leg\" was "
	        "referenced but never declared."}));
	EXPECT_EQ(m_Out.m_Name, "Template");
	ASSERT_EQ(m_Out.m_Segments.size(), 2u);
	EXPECT_EQ(m_Out.m_Segments[0].m_Name, "");
	ASSERT_EQ(m_Out.m_Targets.size(), 2u);
	EXPECT_EQ(m_Out.m_Rotations.at(0).m_Name, "Turn");
}

} // namespace
