#include "../CoreOrlexTypes/Damage.h"
#include "CheckedSubject.h"
#include "RandomSubject.h"

#include "CoreOrlexTypesUtils/JointRange.h"
#include "CoreOrlexTypesUtils/PruneToActive.h"
#include "CoreOrlexTypesUtils/RestPose.h"
#include "CoreOrlexTypesUtils/RigidBodyAttachment.h"
#include "CoreOrlexTypesUtils/RigidBodyGuids.h"
#include "CoreOrlexTypesUtils/RigidBodyLayout.h"
#include "CoreOrlexTypesUtils/Scaling.h"
#include "CoreOrlexTypesUtils/SubjectCheck.h"
#include "CoreOrlexTypesUtils/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/TargetPerMarker.h"

#include <algorithm>

namespace
{

using namespace CoreOrlexTypesUtils;
using namespace CoreOrlexTypesUtils::SubjectParametrisedConverter;
using namespace CoreOrlexTypesUtils::SubjectParametrisedUtils;
using namespace CoreOrlexTypesUtils::RigidBodyUtils;
using CoreOrlexTypes::VSubjectApplicationData;

/// Sanitizers look at each; without them a part is enough.
#ifdef RETARGET_SANITIZED
constexpr int c_SubjectCount = 10000;
#else
constexpr int c_SubjectCount = 4000;
#endif

/// Random subjects, and rigid bodies for them, in which up to a few things are wrong.
class VBrokenSubjects
{
public:
	template <typename TSubject>
	TSubject Make()
	{
		m_Random.Make(m_Subject, m_Ignored);
		return Damaged<TSubject>(8);
	}

	template <typename TSubject>
	TSubject MakeBody()
	{
		m_Random.MakeBody(m_Subject, m_Ignored, m_Random.Below(3));
		return Damaged<TSubject>(4);
	}

private:
	template <typename TSubject>
	TSubject Damaged(std::size_t i_Limit)
	{
		TSubject subject;
		if constexpr (std::is_same_v<TSubject, VSubject>)
			ConvertSubject(m_Subject, subject);
		else
			subject = m_Subject;
		m_Damage.Change(subject, m_Damage.Below(i_Limit));
		return subject;
	}

	VRandomSubject m_Random{20240229};
	VDamage m_Damage{20240301};
	VSubjectParametrised m_Subject;
	VSubjectApplicationData m_Ignored;
};

TEST(BrokenSubjects, AreCheckedWithoutACrash)
{
	std::size_t messages = 0;
	const auto pSink = NVX::GlobalLog::AddSink(
	    [&](const NVX::VLogCategory& i_rCategory, int, const std::string& i_rMessage)
	    {
		    messages += i_rCategory.Name() == "SubjectCheck";
		    EXPECT_FALSE(i_rMessage.starts_with("Cannot Format")) << i_rMessage;
	    });
	VBrokenSubjects generator;
	std::size_t good = 0;
	for (int i = 0; i < c_SubjectCount; ++i)
	{
		const auto numbers = generator.Make<VSubject>();
		messages = 0;
		ASSERT_TRUE(CheckSubject(numbers) || messages > 0) << "subject " << i;
		ASSERT_FALSE(CheckTarget(numbers, numbers.m_Targets.size()));
		const auto subject = generator.Make<VSubjectParametrised>();
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
	VBrokenSubjects generator;
	std::size_t done = 0;
	for (int i = 0; i < c_SubjectCount / 5; ++i)
	{
		const auto subject = generator.Make<VSubjectParametrised>();
		auto body = generator.MakeBody<VSubjectParametrised>();
		AddGuids(body);
		done += UseTools(subject, body, std::uint32_t(i));
		done += UseTools(generator.Make<VSubject>(), generator.MakeBody<VSubject>(), std::uint32_t(i));
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
