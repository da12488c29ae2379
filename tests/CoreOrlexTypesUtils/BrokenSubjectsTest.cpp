#include "CheckedSubject.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/joints/JointRange.h"
#include "CoreOrlexTypesUtils/joints/RestPose.h"
#include "CoreOrlexTypesUtils/observations/PruneToActive.h"
#include "CoreOrlexTypesUtils/observations/TargetPerMarker.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyAttachment.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyGuids.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyLayout.h"
#include "CoreOrlexTypesUtils/scale/Scaling.h"

#include <algorithm>
#include <random>

namespace
{

using namespace CoreOrlexTypesUtils;
using namespace CoreOrlexTypesUtils::SubjectParametrisedConverter;
using namespace CoreOrlexTypesUtils::SubjectParametrisedUtils;
using namespace CoreOrlexTypesUtils::RigidBodyUtils;
using CoreOrlexTypes::VSubjectApplicationData;

constexpr int c_SubjectCount = 20000;

/// Small subjects in which every size, index, type, number and expression may be wrong, and often is right.
class VSubjectGenerator
{
public:
	VSubjectParametrised Make()
	{
		VSubjectParametrised subject;
		subject.m_StaticParameters.resize(Below(3));
		for (auto& rParameter : subject.m_StaticParameters)
		{
			rParameter.m_Name = Pick({"a", "b", "", "a"});
			rParameter.m_DefaultExpression = Expression();
			rParameter.m_Prior = Number();
			if (Below(3) == 0)
				rParameter.m_UserValue = Number();
		}
		subject.m_DynamicParameters.resize(Below(2), {"b", 1, 0, 2, false});
		subject.m_Segments.resize(Below(4));
		for (std::size_t i = 0; i < subject.m_Segments.size(); ++i)
			Fill(subject.m_Segments[i], i);
		subject.m_Markers.resize(Below(5));
		for (std::size_t i = 0; i < subject.m_Markers.size(); ++i)
		{
			subject.m_Markers[i].m_MarkerId = Index(i);
			subject.m_Markers[i].m_Name = Below(8) ? std::to_string(i) : "";
		}
		subject.m_Rotations.resize(Below(3));
		subject.m_Targets.resize(Below(4));
		for (auto& rTarget : subject.m_Targets)
			Fill(rTarget);
		return subject;
	}

private:
	using VJoint = VSubjectParametrised::VJoint;
	using VTarget = VSubjectParametrised::VTarget;

	std::size_t Below(std::size_t i_Count) { return m_Engine() % i_Count; }

	std::string Pick(std::initializer_list<const char*> i_Texts) { return i_Texts.begin()[Below(i_Texts.size())]; }

	double Number()
	{
		static constexpr double c_Numbers[] = {0, 1, -1, 0.5, 1e-13, 1e308, -1e308, 5e-324, c_NaN, c_Infinity};
		return c_Numbers[Below(3) ? Below(2) : Below(std::size(c_Numbers))];
	}

	std::uint32_t Index(std::size_t i_Right)
	{
		return Below(12) ? std::uint32_t(i_Right) : std::uint32_t(Below(3) ? Below(5) : 0xFFFFFFFFu - Below(2));
	}

	std::string Expression()
	{
		return Below(4) ? Pick({"0", "1", "", "a"}) : Pick({"a*b", "1/0", "(", "x", "a^2", "'"});
	}

	/// Of the right size or one off, or empty; matrices are often diagonal.
	VNumbers Values(std::size_t i_Size, std::size_t i_Diagonal = 1)
	{
		if (Below(6) == 0)
			i_Size = i_Size + Below(3) - (i_Size > 0 ? 1 : 0);
		else if (Below(8) == 0)
			i_Size = 0;
		VNumbers values(i_Size, 0.0);
		for (std::size_t i = 0; i < i_Size; i += i_Diagonal)
			values[i] = 1.0;
		for (double& rValue : values)
			if (Below(40) == 0)
				rValue = Number();
		return values;
	}

	std::vector<std::uint32_t> Indices(std::size_t i_Count)
	{
		std::vector<std::uint32_t> indices(Below(12) ? i_Count : Below(5));
		for (std::uint32_t& rIndex : indices)
			rIndex = Index(0);
		return indices;
	}

	void Fill(VSubjectParametrised::VSegment& o_rSegment, std::size_t i_Index)
	{
		static constexpr std::size_t c_Sizes[] = {6, 3, 2, 1, 1, 0, 0, 0};
		o_rSegment.m_SegmentIndex = Index(i_Index);
		o_rSegment.m_ParentSegmentIndex = Index(i_Index == 0 ? 0xFFFFFFFFu : i_Index - 1);
		o_rSegment.m_TreeDepth = Index(i_Index);
		o_rSegment.m_Name = Pick({"s", "%1% %s", ""});
		std::ranges::generate(o_rSegment.m_PreRotation, [this] { return Expression(); });
		std::ranges::generate(o_rSegment.m_PreTranslation, [this] { return Expression(); });
		VJoint& rJoint = o_rSegment.m_Joint;
		const std::size_t type = Below(8);
		const std::size_t size = c_Sizes[type];
		rJoint.m_JointType = VJoint::EJointType(type == 7 ? -1 : int(type));
		for (VNumbers VJoint::*pVector : {&VJoint::m_Mean, &VJoint::m_RangeCentringState, &VJoint::m_TemplateMean,
		         &VJoint::m_TemplateRangeCentringState, &VJoint::m_BindPose})
			rJoint.*pVector = Values(size);
		for (VNumbers VJoint::*pMatrix : {&VJoint::m_Covariance, &VJoint::m_RangeMatrix, &VJoint::m_TemplateCovariance,
		         &VJoint::m_TemplateRangeMatrix})
			rJoint.*pMatrix = Values(size * size, size + 1);
	}

	void Fill(VTarget& o_rTarget)
	{
		static constexpr std::size_t c_States[] = {0, 3, 3, 6, 6, 6, 6, 15, 3, 3};
		static constexpr std::size_t c_Covariances[] = {0, 0, 9, 0, 1, 0, 4, 63, 0, 0};
		static constexpr std::size_t c_Markers[] = {0, 1, 1, 1, 1, 1, 1, 3, 0, 0};
		const std::size_t type = Below(10);
		o_rTarget.m_Type = VTarget::ETargetType(Below(30) ? int(type) : Below(2) ? 10 : -5);
		o_rTarget.m_MarkerIndices = Indices(c_Markers[type]);
		o_rTarget.m_RotationObservationIndices = Indices(type >= 8);
		o_rTarget.m_SegmentIndices = Indices(1);
		o_rTarget.m_StateExpressions.resize(Below(12) ? c_States[type] : Below(5));
		for (std::string& rExpression : o_rTarget.m_StateExpressions)
			rExpression = Expression();
		o_rTarget.m_Covariance = Values(c_Covariances[type], type == 2 ? 4 : 1);
		o_rTarget.m_TemplateCovariance = Values(c_Covariances[type], type == 2 ? 4 : 1);
		o_rTarget.m_ViewNormals.resize(Below(12) ? o_rTarget.m_MarkerIndices.size() : Below(4));
		if (!o_rTarget.m_ViewNormals.empty())
			o_rTarget.m_ViewNormals[0][Below(3)] = Number();
		o_rTarget.m_Weight = Number();
		o_rTarget.m_CalibrationWeight = Number();
		o_rTarget.m_RotationCalibrationBehaviour =
		    VTarget::ERotationCalibrationBehaviourType(Below(4) ? VTarget::EOther : int(Below(6)) - 1);
		o_rTarget.m_RotationTargetOrientation = Below(4) ? VNumbers{} : Values(3);
	}

	std::mt19937 m_Engine{20240229};
};

/// As broken as the subject, where the conversion would end or leave elements out.
VSubject Numbers(const VSubjectParametrised& i_rSubject)
{
	VSubject numbers;
	const VDynamicExpressionParserSimple parser;
	std::vector<std::string> ignored;
	for (const auto& rSegment : i_rSubject.m_Segments)
		ConvertSegment(parser, rSegment, numbers.m_Segments.emplace_back(), false, ignored);
	for (const auto& rMarker : i_rSubject.m_Markers)
		ConvertMarker(rMarker, numbers.m_Markers.emplace_back());
	numbers.m_Rotations.resize(i_rSubject.m_Rotations.size());
	for (const auto& rTarget : i_rSubject.m_Targets)
		ConvertTarget(parser, rTarget, numbers.m_Targets.emplace_back(), false, ignored);
	return numbers;
}

TEST(BrokenSubjects, AreCheckedWithoutACrash)
{
	std::size_t messages = 0;
	const auto pSink = NVX::GlobalLog::AddSink(
	    [&](const NVX::VLogCategory& i_rCategory, int, const std::string& i_rMessage)
	    {
		    messages += i_rCategory.Name() == "SubjectCheck";
		    EXPECT_FALSE(i_rMessage.starts_with("Cannot Format")) << i_rMessage;
	    });
	VSubjectGenerator generator;
	std::size_t good = 0;
	for (int i = 0; i < c_SubjectCount; ++i)
	{
		const VSubjectParametrised subject = generator.Make();
		messages = 0;
		const VSubject numbers = Numbers(subject);
		ASSERT_TRUE(CheckSubject(numbers) || messages > 0) << "subject " << i;
		ASSERT_FALSE(CheckTarget(numbers, numbers.m_Targets.size()));
		messages = 0;
		const bool bGood = CheckSubjectParametrised(subject);
		const std::size_t told = messages;
		const std::vector<VSubjectFinding> findings = FindSubjectFaults(subject);
		ASSERT_EQ(messages, told) << "the list tells the log nothing";
		// The list and the check are of one opinion.
		ASSERT_EQ(std::ranges::all_of(findings, &VSubjectFinding::m_bTolerated), bGood) << "subject " << i;
		for (const VSubjectFinding& rFinding : findings)
			ASSERT_FALSE(rFinding.m_Message.empty() || rFinding.m_Remedy.empty()) << "subject " << i;
		good += bGood;
	}
	// The generator reaches what lies behind the first checks.
	EXPECT_GT(good, c_SubjectCount / 100u);
	EXPECT_LT(good, c_SubjectCount / 2u);
}

/// As it is, but for what every rigid body needs.
VSubjectParametrised AsBody(VSubjectParametrised i_Subject)
{
	using VJoint = VSubjectParametrised::VJoint;
	using VTarget = VSubjectParametrised::VTarget;
	i_Subject.m_Name = "Body";
	i_Subject.m_Segments.resize(std::max<std::size_t>(i_Subject.m_Segments.size(), 1));
	for (auto& rSegment : i_Subject.m_Segments)
		rSegment.m_Joint = {};
	i_Subject.m_Segments[0].m_Joint.m_JointType = VJoint::EFree;
	i_Subject.m_Markers.resize(std::max<std::size_t>(i_Subject.m_Markers.size(), 3));
	for (auto& rTarget : i_Subject.m_Targets)
		rTarget.m_SegmentIndices = {0};
	if (i_Subject.m_Targets.size() == 1)
		i_Subject.m_Targets[0].m_Type = VTarget::ERigidBody;
	return i_Subject;
}

template <typename TSubject>
void ExpectInStep(const TSubject& i_rSubject, const VSubjectApplicationData& i_rAppData)
{
	ASSERT_EQ(i_rSubject.m_Segments.size(), i_rAppData.m_Segments.size());
	ASSERT_EQ(i_rSubject.m_Markers.size(), i_rAppData.m_Markers.size());
	ASSERT_EQ(i_rSubject.m_Targets.size(), i_rAppData.m_Targets.size());
}

template <typename TSubject>
VSubjectApplicationData DataOf(const TSubject& i_rSubject)
{
	VSubjectApplicationData appData;
	appData.m_Segments.resize(i_rSubject.m_Segments.size());
	appData.m_Markers.resize(i_rSubject.m_Markers.size());
	appData.m_Targets.resize(i_rSubject.m_Targets.size());
	appData.m_Sticks = {{0, {}, 1, {}}, {77, {}, 2, {}}};
	return appData;
}

template <typename TSubject>
std::size_t UseTools(TSubject i_Subject, TSubject i_Body, std::uint32_t i_Round)
{
	VSubjectApplicationData appData = DataOf(i_Subject);
	VSubjectApplicationData bodyData = DataOf(i_Body);
	std::size_t done = ToPointTargets(i_Body, bodyData);
	ExpectInStep(i_Body, bodyData);
	done += ToRigidBodyTarget(i_Body, bodyData);
	ExpectInStep(i_Body, bodyData);
	const TSubject before = i_Subject;
	if (AttachRigidBody(i_Subject, appData, i_Body, bodyData, "s"))
		done += RemoveRigidBody(i_Subject, appData, i_Subject.m_Targets.size() - 1);
	else
		EXPECT_TRUE(i_Subject == before);
	ExpectInStep(i_Subject, appData);
	MakeOneTargetPerMarker(i_Subject, appData);
	ExpectInStep(i_Subject, appData);
	CheckCalibration(i_Subject);
	done += PruneToActive(i_Subject, appData, {i_Round % 5, 2, 1}, {0});
	ExpectInStep(i_Subject, appData);
	if constexpr (std::is_same_v<TSubject, VSubject>)
		done += TemplateSubjectUtils::ScaleSubject(i_Subject, 2);
	else
		done += SubjectParametrisedUtils::ScaleSubject(i_Subject, 2);
	return done;
}

TEST(BrokenSubjects, AreWorkedOnWithoutACrash)
{
	const auto pSink = NVX::GlobalLog::AddSink([](const NVX::VLogCategory&, int, const std::string&) {});
	VSubjectGenerator generator;
	std::size_t done = 0;
	for (int i = 0; i < c_SubjectCount / 5; ++i)
	{
		const VSubjectParametrised subject = generator.Make();
		VSubjectParametrised body = AsBody(generator.Make());
		AddGuids(body);
		done += UseTools(subject, body, std::uint32_t(i)) + UseTools(Numbers(subject), Numbers(body), std::uint32_t(i));
		for (const auto& rSegment : subject.m_Segments)
		{
			const auto& rJoint = rSegment.m_Joint;
			VNumbers first;
			VNumbers second;
			TemplateSubjectUtils::MeanCovarianceToRestPoseStiffness(
			    rJoint.m_JointType, rJoint.m_Mean, rJoint.m_Covariance, first, second);
			TemplateSubjectUtils::RestPoseStiffnessToMeanCovariance(
			    rJoint.m_JointType, rJoint.m_Mean, rJoint.m_RangeCentringState, first, second);
			TemplateSubjectUtils::RangeToMinMax(
			    rJoint.m_JointType, rJoint.m_RangeCentringState, rJoint.m_RangeMatrix, first, second);
		}
	}
	// All tools of both subject types do their work on some.
	EXPECT_GT(done, c_SubjectCount / 5u);
}

} // namespace
