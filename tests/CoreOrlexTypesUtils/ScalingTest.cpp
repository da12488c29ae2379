#include "MessageLog.h"
#include "RandomSubject.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"
#include "CoreOrlexTypesUtils/scale/ScaledExpression.h"
#include "CoreOrlexTypesUtils/scale/Scaling.h"

#include <gtest/gtest.h>

namespace
{

using namespace CoreOrlexTypesUtils;
using CoreOrlexTypes::c_NotSet;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = VSubjectParametrised::VJoint;
using VTarget = VSubjectParametrised::VTarget;
using VNumbers = std::vector<double>;
using VTexts = std::vector<std::string>;

TEST(ScaledExpression, MultipliesOrWraps)
{
	for (const auto& [text, scaled] : {std::pair{"10", "20"}, {"", ""}, {"-1.5e1", "-30"}, {"Arm", "(Arm)*2"},
	         {"12.5*GlobalScale", "(12.5*GlobalScale)*2"}, {"(A)*3", "(A)*6"}, {"(A)*(B)", "((A)*(B))*2"},
	         {"(A)*inf", "((A)*inf)*2"}, {"inf", "(inf)*2"}, {"('a)b')*0.5", "('a)b')*1"}, {"Arm+", "(Arm)*2"},
	         {"Arm Leg", "(Arm)*2"}, {"2E5", "4"}, {"2e5", "400000"}, {"1+GS)", "(1+GS)*2"}, {"(A)*3 B", "(A)*6"},
	         {"(A)*(B)^", "((A)*(B))*2"}})
		EXPECT_EQ(ScaledExpression(text, 2), scaled);
	for (const char* const pText : {"(A", "A+(B", "+", "A B C", "$"})
		EXPECT_EQ(ScaledExpression(pText, 2), std::nullopt) << pText;
}

TEST(ScaleJoint, ScalesWhatIsALength)
{
	VSubjectParametrised::VJoint joint;
	joint.m_JointType = VJoint::EFree;
	joint.m_Mean = joint.m_TPoseMean = {1, 2, 3, 4, 5, 6};
	joint.m_TPoseMean[4] = c_NotSet;
	joint.m_BindPose = {1, 2, 3, 4};
	joint.m_Covariance.assign(36, 1.0);
	joint.m_RangeMatrix.assign(9, 1.0);
	SubjectParametrisedUtils::ScaleJoint(joint, 10);
	EXPECT_EQ(joint.m_Mean, (VNumbers{1, 2, 3, 40, 50, 60}));
	EXPECT_EQ(joint.m_TPoseMean, (VNumbers{1, 2, 3, 40, c_NotSet, 60}));
	EXPECT_EQ(joint.m_BindPose, (VNumbers{1, 2, 3, 40}));
	EXPECT_EQ(joint.m_RangeMatrix, VNumbers(9, 1.0));
	for (std::size_t i = 0; i < 36; ++i)
		EXPECT_EQ(joint.m_Covariance[i], (i / 6 < 3 ? 1 : 10) * (i % 6 < 3 ? 1 : 10)) << i;

	VSubject::VJoint slider{"", VJoint::ESlider, {}, {2}, {3}, {4}, {5}};
	TemplateSubjectUtils::ScaleJoint(slider, 10);
	EXPECT_EQ(
	    (VNumbers{slider.m_Covariance[0], slider.m_Mean[0], slider.m_RangeCentringState[0], slider.m_RangeMatrix[0]}),
	    (VNumbers{200, 30, 40, 500}));
	VSubject::VJoint hinge{"", VJoint::EHinge, {}, {2}, {3}, {4}, {5}};
	TemplateSubjectUtils::ScaleJoint(hinge, 10);
	EXPECT_EQ(hinge.m_Mean[0] + hinge.m_Covariance[0], 5);
}

TEST(ScaleTarget, ScalesByType)
{
	const struct
	{
		VSubject::VTarget::ETargetType Type;
		std::size_t Markers;
		VNumbers State;
	} rows[] = {{VSubject::VTarget::ELocalPointToWorldPointGaussian, 1, {10, 10, 10}},
	    {VSubject::VTarget::ELocalPlaneToWorldPointGaussian, 1, {10, 10, 10, 1, 1, 1}},
	    {VSubject::VTarget::ELocalLineToWorldPointGaussian, 1, {10, 10, 10, 10, 10, 10}},
	    {VSubject::VTarget::ERigidBody, 3, {10, 10, 10, 1, 1, 1, 10, 10, 10, 10, 10, 10, 10, 10, 10}},
	    {VSubject::VTarget::ELocalRotationToWorldRotation, 0, {1, 1, 1}}};
	for (const auto& rRow : rows)
	{
		VSubject::VTarget target;
		target.m_Type = rRow.Type;
		target.m_MarkerIndices.resize(rRow.Markers);
		target.m_State.assign(rRow.State.size(), 1.0);
		target.m_Covariance.assign(rRow.Markers == 3 ? 63 : rRow.Markers, 1.0);
		TemplateSubjectUtils::ScaleTarget(target, 10);
		EXPECT_EQ(target.m_State, rRow.State) << rRow.Type;
		for (std::size_t i = 0; i < target.m_Covariance.size(); ++i)
			EXPECT_NEAR(target.m_Covariance[i],
			    rRow.Markers == 1 || i >= 36 ? 100 : (i / 6 < 3 ? 10 : 1) * (i % 6 < 3 ? 10 : 1), 1e-9);
	}
	VTarget target;
	target.m_Type = VTarget::ELocalPointToWorldPoint;
	target.m_StateExpressions = {"1", "Arm", ""};
	target.m_TemplateCovariance.assign(9, 1.0);
	target.m_PlacementCovariance = {1};
	SubjectParametrisedUtils::ScaleTarget(target, 3);
	EXPECT_EQ(target.m_StateExpressions, (VTexts{"3", "(Arm)*3", ""}));
	EXPECT_EQ(target.m_TemplateCovariance.size(), 9u);
	for (const double value : target.m_TemplateCovariance)
		EXPECT_NEAR(value, 9.0, 1e-12) << "of rank 1: rounding is taken off";
	EXPECT_EQ(target.m_PlacementCovariance, VNumbers{9});
}

TEST(Scaling, TellsWhatItCannotScale)
{
	VMessageLog log;
	VSubject::VJoint joint;
	VSubjectParametrised::VJoint parametrisedJoint;
	const std::string unknownOf[] = {"Cannot scale unknown joint", "Unknown joint type"};
	for (const auto type : {VJoint::EBadJointType, VJoint::EJointType(9)})
	{
		joint.m_JointType = parametrisedJoint.m_JointType = type;
		TemplateSubjectUtils::ScaleJoint(joint, 2);
		SubjectParametrisedUtils::ScaleJoint(parametrisedJoint, 2);
		const bool bBad = type == VJoint::EBadJointType;
		EXPECT_EQ(log.Take(),
		    (VTexts{"SubjectUtils 2 " + (bBad ? std::string("Cannot scale bad joint") : unknownOf[0]),
		        "SubjectParametrisedUtils 2 " + (bBad ? std::string("Cannot scale bad joint") : unknownOf[1])}));
	}
	const struct
	{
		int Type;
		VTexts Log;
	} rows[] = {{0, {"2 Cannot scale bad target", "2 Unsupported target type"}},
	    {1, {"4 LocalPointToWorldPoint targets have no stats to scale."}}, {2, {}},
	    {9, {"3 Target type not implemented yet. Scaling may be incorrect"}},
	    {10, {"2 Unknown target type", "2 Unsupported target type"}},
	    {-1, {"2 Unknown target type", "2 Unsupported target type"}}};
	for (const auto& rRow : rows)
	{
		VSubject::VTarget target;
		target.m_Type = VSubject::VTarget::ETargetType(rRow.Type);
		TemplateSubjectUtils::ScaleTarget(target, 2);
		VTarget parametrised;
		parametrised.m_Type = VTarget::ETargetType(rRow.Type);
		SubjectParametrisedUtils::ScaleTarget(parametrised, 2);
		VTexts expected;
		for (const char* pCategory : {"SubjectUtils ", "SubjectParametrisedUtils "})
			for (const std::string& rText : rRow.Log)
				expected.push_back(pCategory + rText);
		EXPECT_EQ(log.Take(), expected) << rRow.Type;
	}
}

/// A subject of one segment, whose pre-translation and point target are given as rows say.
class ScaleSubject : public testing::Test
{
protected:
	ScaleSubject()
	{
		m_Subject.m_Segments.resize(1);
		m_Subject.m_Targets.resize(1);
		m_Subject.m_Targets[0].m_Type = VTarget::ELocalPointToWorldPointGaussian;
	}

	VSubjectParametrised::VStaticParameter& Add(
	    const char* i_pName, const char* i_pExpression, double i_Prior = c_NotSet)
	{
		auto& rParameter = m_Subject.m_StaticParameters.emplace_back();
		rParameter.m_Name = i_pName;
		rParameter.m_DefaultExpression = i_pExpression;
		rParameter.m_Prior = i_Prior;
		return rParameter;
	}

	VMessageLog m_Log;
	VSubjectParametrised m_Subject;
};

TEST_F(ScaleSubject, MultipliesParametersWhereLengthsAllowIt)
{
	Add("Arm", "", 5).m_UserValue = 6;
	Add("Leg", "", 7);
	Add("Twice", "2*Leg+Leg");
	Add("Ten", "10");
	Add("Bent", "sin(Leg2)");
	m_Subject.m_StaticParameters.emplace(m_Subject.m_StaticParameters.begin());
	m_Subject.m_StaticParameters[0].m_Name = "Leg2";
	m_Subject.m_StaticParameters[0].m_UserValue = 1;
	m_Subject.m_Segments[0].m_PreTranslation = {"Arm*2", "Twice", "Ten"};
	m_Subject.m_Segments[0].m_Bounds[0] = "Leg";
	// A length has a parameter of a mass for itself only if the mass does not change with it.
	Add("Weight", "", 2);
	m_Subject.m_Segments[0].m_MassExpression = "Weight*0.1";
	m_Subject.m_Segments[0].m_Bounds[1] = "Weight";
	m_Subject.m_Segments[0].m_MassCentreExpressions[1] = "4";
	m_Subject.m_Segments[0].m_RadiusOfGyrationExpressions[2] = "5";
	m_Subject.m_Targets[0].m_StateExpressions = {"12", "Bent", "''"};
	ASSERT_TRUE(SubjectParametrisedUtils::ScaleSubject(m_Subject, 3));
	const auto& rParameters = m_Subject.m_StaticParameters;
	EXPECT_EQ(rParameters[0].m_UserValue, 1);
	EXPECT_EQ(rParameters[1].m_Prior, 15);
	EXPECT_EQ(rParameters[1].m_UserValue, 18);
	EXPECT_EQ(rParameters[2].m_Prior, 21);
	EXPECT_EQ(rParameters[2].m_UserValue, c_NotSet);
	EXPECT_EQ(rParameters[3].m_DefaultExpression, "2*Leg+Leg");
	EXPECT_EQ(rParameters[4].m_DefaultExpression, "30");
	EXPECT_EQ(rParameters[5].m_DefaultExpression, "(sin(Leg2))*3");
	EXPECT_EQ(rParameters[6].m_Prior, 2);
	EXPECT_EQ(m_Subject.m_Segments[0].m_MassExpression, "Weight*0.1");
	EXPECT_EQ(m_Subject.m_Segments[0].m_Bounds[1], "(Weight)*3");
	EXPECT_EQ(m_Subject.m_Segments[0].m_MassCentreExpressions[1], "12");
	EXPECT_EQ(m_Subject.m_Segments[0].m_RadiusOfGyrationExpressions[2], "15");
	EXPECT_EQ(m_Subject.m_Segments[0].m_PreTranslation, (std::array<std::string, 3>{"Arm*2", "Twice", "Ten"}));
	EXPECT_EQ(m_Subject.m_Targets[0].m_StateExpressions, (VTexts{"36", "Bent", "''"}));
}

TEST_F(ScaleSubject, TellsOfEveryLengthWhatHinders)
{
	m_Subject.m_DynamicParameters = {{"GlobalScale", 1, 0, 1, true}};
	const std::string good = "SubjectCalibrationAlgo 6 Math parser succeeded: ";
	const std::string own = "SubjectParametrisedUtils ";
	Add("Arm", "", 5);
	Add("Half", "Arm/2");
	const struct
	{
		const char* pName;
		const char* pRotation;
		const char* pLength;
		/// Of a pre-translation and of a state; %1 is what the messages call it.
		VTexts Log;
		const char* pScaled;
		double Arm;
	} rows[] = {{"multiple", "0", "Half*4", {good}, "Half*4", 10},
	    {"constant beside a parameter", "0", "Arm+1", {good, own + "3 Non zero %1 constant"}, "(Arm+1)*2", 5},
	    {"number", "0", "7", {good, own + "4 Non zero %1 constant"}, "14", 5},
	    {"shared", "Arm", "Arm", {good, own + "3 Shared rotation and %1 parameter"}, "(Arm)*2", 5},
	    {"both, through another parameter", "Half", "Arm-1",
	        {good, own + "3 Non zero %1 constant", own + "3 Shared rotation and %1 parameter"}, "(Arm-1)*2", 5},
	    {"dynamic", "0", "12.5*GlobalScale", {good}, "(12.5*GlobalScale)*2", 5},
	    {"product", "0", "Arm*GlobalScale",
	        {"SubjectCalibrationAlgo 3 Math parser failed: Parse Error at column 16: Multiply operator invalid for "
	         "arguments"},
	        "(Arm*GlobalScale)*2", 5},
	    {"unknown name", "0", "Leg",
	        {"SubjectCalibrationAlgo 3 Math parser failed: Parse Error at column 4: ID \"Leg\" was referenced but "
	         "never "
	         "declared"},
	        "Leg", 5}};
	for (const auto& rRow : rows)
		for (const bool bMarker : {false, true})
		{
			SCOPED_TRACE(rRow.pName);
			VSubjectParametrised subject = m_Subject;
			subject.m_Segments[0].m_PreRotation[1] = rRow.pRotation;
			subject.m_Segments[0].m_PreTranslation = {bMarker ? "" : rRow.pLength, "", ""};
			subject.m_Targets[0].m_StateExpressions = {bMarker ? rRow.pLength : ""};
			ASSERT_TRUE(SubjectParametrisedUtils::ScaleSubject(subject, 2));
			VTexts expected = rRow.Log;
			for (std::string& rText : expected)
				if (const std::size_t place = rText.find("%1"); place != std::string::npos)
					rText.replace(place, 2, bMarker ? "marker" : "translation");
			EXPECT_EQ(m_Log.Take(), expected);
			EXPECT_EQ(bMarker ? subject.m_Targets[0].m_StateExpressions[0] : subject.m_Segments[0].m_PreTranslation[0],
			    rRow.pScaled);
			EXPECT_EQ(subject.m_StaticParameters[0].m_Prior, rRow.Arm);
		}
}

TEST_F(ScaleSubject, RefusesWithNothingChanged)
{
	Add("Arm", "", 1e300);
	m_Subject.m_Segments[0].m_PreTranslation = {"Arm", "1+GS", ""};
	m_Subject.m_DynamicParameters = {{"GS", 1, 0, 1, true}};
	const VSubjectParametrised before = m_Subject;
	VSubject evaluated;
	evaluated.m_Segments.resize(1);
	evaluated.m_Segments[0].m_PreTranslation = {1, 2, 3};
	const VSubject evaluatedBefore = evaluated;
	for (const double factor : {0.0, -1.0, std::nan(""), HUGE_VAL})
	{
		EXPECT_FALSE(SubjectParametrisedUtils::ScaleSubject(m_Subject, factor));
		EXPECT_EQ(m_Log.TakeTroubles().size(), 1u);
		EXPECT_FALSE(TemplateSubjectUtils::ScaleSubject(evaluated, factor));
		EXPECT_EQ(m_Log.TakeTroubles().size(), 1u);
		EXPECT_TRUE(evaluated == evaluatedBefore);
	}
	EXPECT_FALSE(SubjectParametrisedUtils::ScaleSubject(m_Subject, 1e10));
	const VTexts log = m_Log.TakeTroubles();
	EXPECT_EQ(std::count(log.begin(), log.end(), "2 Cannot scale 'Arm': it would leave the range of numbers"), 1);
	EXPECT_TRUE(m_Subject == before);
	Add("Arm", "");
	EXPECT_FALSE(SubjectParametrisedUtils::ScaleSubject(m_Subject, 2));
	EXPECT_EQ(m_Log.TakeTroubles(),
	    (VTexts{"2 Error parsing subject static parameter expressions",
	        "2 Cannot add StaticParameter 'Arm', a StaticParameter with that name already exists."}));
}

TEST_F(ScaleSubject, MovesEveryPointAndTurnsNothing)
{
	for (unsigned seed = 0; seed < 300; ++seed)
	{
		VRandomSubject random(seed);
		VSubjectParametrised subject;
		VSubjectApplicationData appData;
		random.Make(subject, appData);
		subject.m_TPoseConstraints.assign(6, 1.0);
		VSubject evaluated;
		ASSERT_TRUE(SubjectParametrisedConverter::ConvertSubject(subject, evaluated));
		ASSERT_TRUE(CheckSubjectParametrised(subject));
		const auto before = WorldPoints(evaluated);
		ASSERT_GE(before.size(), 5u);
		const double factor = std::exp(random.Real(1));
		ASSERT_TRUE(TemplateSubjectUtils::ScaleSubject(evaluated, factor));
		ASSERT_TRUE(SubjectParametrisedUtils::ScaleSubject(subject, factor / 2));
		ASSERT_TRUE(SubjectParametrisedUtils::ScaleSubject(subject, 2));
		ASSERT_TRUE(CheckSubject(evaluated));
		ASSERT_TRUE(CheckSubjectParametrised(subject));
		for (const auto& after : {WorldPoints(evaluated), WorldPoints(subject)})
			for (const auto& [name, points] : before)
				for (std::size_t i = 0; i < points.size(); ++i)
					for (std::size_t axis = 0; axis < 3; ++axis)
						ASSERT_NEAR(after.at(name).at(i)[axis], points[i][axis] * (name[0] == 'R' ? 1 : factor), 1e-8)
						    << seed << ' ' << name;
	}
}

} // namespace
