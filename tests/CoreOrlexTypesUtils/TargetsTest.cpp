#include "MessageLog.h"
#include "RandomSubject.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"
#include "CoreOrlexTypesUtils/joints/JointParameters.h"
#include "CoreOrlexTypesUtils/observations/PruneToActive.h"
#include "CoreOrlexTypesUtils/observations/TargetPerMarker.h"

#include <gtest/gtest.h>

namespace Targets
{

using namespace CoreOrlexTypesUtils::SubjectParametrisedUtils;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypesUtils::ESubjectParametrisedPoseType;
namespace SubjectParametrisedConverter = CoreOrlexTypesUtils::SubjectParametrisedConverter;
using VJoint = VSubjectParametrised::VJoint;
using VTarget = VSubjectParametrised::VTarget;
using VIndices = std::vector<std::uint32_t>;
using VTexts = std::vector<std::string>;

VTarget Target(VTarget::ETargetType i_Type, VIndices i_Markers)
{
	VTarget target;
	target.m_Type = i_Type;
	target.m_MarkerIndices = std::move(i_Markers);
	return target;
}

constexpr auto c_Point = VTarget::ELocalPointToWorldPoint;

TEST(MakeOneTargetPerMarker, OrdersByMarkerAndKeepsTheFirst)
{
	VMessageLog log;
	VSubjectParametrised subject;
	subject.m_Name = "Kim";
	subject.m_Markers.resize(3);
	subject.m_Targets = {Target(VTarget::ELocalRotationToWorldRotation, {}), Target(c_Point, {2}),
	    Target(VTarget::ELocalPointToWorldPointGaussian, {0}), Target(c_Point, {2}), Target(c_Point, {1, 2})};
	VSubjectApplicationData appData;
	for (const char* pName : {"turn", "two", "", "two again"})
		appData.m_Targets.emplace_back().m_Name = pName;
	MakeOneTargetPerMarker(subject, appData);
	EXPECT_EQ(log.Take(),
	    (VTexts{"SubjectParametrisedUtils 3 Subject Kim target 0, labelers do not support non-point targets",
	        "SubjectParametrisedUtils 3 Subject Kim marker 2, labelers do not support multiple targets per marker",
	        "ASSERT rTgt.m_MarkerIndices.size() == 1",
	        "ASSERT MarkerIndexToOldTargetIndex.size() + MarkerLessTargetIndex.size() == io_rSubject.m_Targets.size()",
	        "ASSERT io_rSubject.m_Targets.size() == NewTargets.size()",
	        "ASSERT io_rAppData.m_Targets.size() == NewTargetData.size()"}));
	ASSERT_EQ(subject.m_Targets.size(), 4u);
	VTexts names;
	for (const auto& rTarget : appData.m_Targets)
		names.push_back(rTarget.m_Name);
	EXPECT_EQ(names, (VTexts{"Target_0", "two", "turn", "Target_3"}));
	EXPECT_EQ(subject.m_Targets[0].m_MarkerIndices, VIndices{0});
	EXPECT_EQ(subject.m_Targets[1].m_MarkerIndices, VIndices{2});
	EXPECT_EQ(subject.m_Targets[3].m_MarkerIndices, (VIndices{1, 2}));

	// In order already: a second run changes nothing.
	const VSubjectParametrised before = subject;
	MakeOneTargetPerMarker(subject, appData);
	EXPECT_TRUE(subject == before);
	EXPECT_EQ(log.TakeTroubles(),
	    (VTexts{"3 Subject Kim target 2, labelers do not support non-point targets",
	        "ASSERT rTgt.m_MarkerIndices.size() == 1"}));
}

TEST(CheckCalibration, TellsEveryKindOfFault)
{
	VMessageLog log;
	const VTexts two = {"2 The calibrator can only use subjects with one target per marker.",
	    "2 There cannot be more than one target per marker"};
	const VTexts none = {two[0], "2 Cannot calibrate all the markers, some markers have no associated target"};
	const std::string type = "2 Cannot calibrate target type";
	const struct
	{
		std::vector<VTarget> Targets;
		VTexts Log;
	} rows[] = {{{Target(c_Point, {0}), Target(c_Point, {1})}, {}},
	    {{Target(c_Point, {0}), Target(c_Point, {1}), Target(c_Point, {0})}, two},
	    {{Target(c_Point, {0}), Target(c_Point, {9})}, none},
	    {{Target(c_Point, {0}), Target(c_Point, {0})}, {two[0], two[1], none[1]}},
	    {{Target(c_Point, {0}), Target(VTarget::ELocalLineToWorldPoint, {1})}, {type}}};
	for (const auto& rRow : rows)
	{
		VSubjectParametrised subject;
		subject.m_Markers.resize(2);
		subject.m_Targets = rRow.Targets;
		EXPECT_EQ(CheckCalibration(subject), rRow.Log.empty());
		EXPECT_EQ(log.TakeTroubles(), rRow.Log);
	}
}

TEST(PruneToActive, KeepsTheGivenObservationsInPlace)
{
	VMessageLog log;
	VSubjectParametrised subject;
	VSubjectApplicationData none;
	EXPECT_FALSE(PruneToActive(subject, none, {}, {}));
	EXPECT_EQ(log.Take(), VTexts{"SubjectParametrisedUtils 2 The input subject has no segments"});
	VSubject evaluated;
	EXPECT_FALSE(PruneToActive(evaluated, {}, {}));
	EXPECT_EQ(log.Take(), VTexts{"SubjectUtils 2 The input subject has no segments"});

	for (unsigned seed = 0; seed < 300; ++seed)
	{
		VRandomSubject random(seed);
		random.Make(subject, none);
		const VSubjectParametrised before = subject;
		const VSubjectApplicationData appDataBefore = none;
		VIndices active;
		for (std::uint32_t i = random.Below(4) != 0; i < subject.m_Markers.size(); ++i)
			if (i < 4 || random.Below(2))
				active.push_back(i);
		const VIndices rotations{random.Below(2)};
		ASSERT_TRUE(SubjectParametrisedConverter::ConvertSubject(before, evaluated));
		const auto pointsBefore = WorldPoints(before);
		ASSERT_TRUE(PruneToActive(subject, none, active, rotations));
		ASSERT_TRUE(PruneToActive(evaluated, active, rotations));
		EXPECT_EQ(log.TakeTroubles(),
		    VTexts(active.size() == before.m_Markers.size() ? 2 : 0,
		        "ASSERT ActiveMarkerIdxs.size()<i_rSubject.m_Markers.size()"));

		EXPECT_TRUE(CoreOrlexTypesUtils::CheckSubjectParametrised(subject));
		ASSERT_EQ(subject.m_Markers.size(), active.size());
		ASSERT_EQ(none.m_Markers.size(), active.size());
		ASSERT_EQ(none.m_Targets.size(), subject.m_Targets.size());
		ASSERT_EQ(subject.m_Rotations.size(), 1u);
		const auto pointsAfter = WorldPoints(subject);
		EXPECT_EQ(WorldPoints(evaluated), pointsAfter);
		for (std::size_t i = 0; i < active.size(); ++i)
		{
			const std::string& rName = before.m_Markers[active[i]].m_Name;
			ASSERT_EQ(subject.m_Markers[i].m_Name, rName);
			ASSERT_EQ(none.m_Markers[i].m_Colour, appDataBefore.m_Markers[active[i]].m_Colour);
			ASSERT_EQ(pointsAfter.count(rName), pointsBefore.count(rName));
			if (pointsBefore.count(rName))
			{
				EXPECT_EQ(pointsAfter.at(rName), pointsBefore.at(rName)) << seed;
			}
		}
		EXPECT_EQ(pointsAfter.at(subject.m_Rotations[0].m_Name), pointsBefore.at(subject.m_Rotations[0].m_Name));
		for (std::size_t i = 0; i < subject.m_Targets.size(); ++i)
		{
			const VTarget& rTarget = subject.m_Targets[i];
			EXPECT_EQ(none.m_Targets[i].m_FillGaps, rTarget.m_Type == VTarget::ERigidBody);
			EXPECT_EQ(rTarget.m_ViewNormals.size(), rTarget.m_MarkerIndices.size());
			if (rTarget.m_Type == VTarget::ERigidBody)
			{
				EXPECT_EQ(rTarget.m_TemplateCovariance.size(), 36 + 9 * rTarget.m_MarkerIndices.size());
			}
		}
		for (const auto& rStick : none.m_Sticks)
			EXPECT_LT(std::max(rStick.m_MarkerIndexA, rStick.m_MarkerIndexB), active.size());
	}
}

TEST(PruneToActive, DropsABodyOfTooFewMarkersAndExpectsFewerRotations)
{
	VMessageLog log;
	VSubjectParametrised subject;
	VSubjectApplicationData appData;
	VRandomSubject(1).MakeBody(subject, appData);
	subject.m_Rotations = {{"R0", 0}};
	EXPECT_TRUE(PruneToActive(subject, appData, {1, 2, 1, 99}, {0}));
	EXPECT_EQ(log.Take(), VTexts{"ASSERT ActiveRotationIdxs.size() < i_rSubject.m_Rotations.size()"});
	EXPECT_EQ(subject.m_Markers.size(), 2u);
	EXPECT_TRUE(subject.m_Targets.empty());
	EXPECT_TRUE(appData.m_Targets.empty());
}

TEST(TargetOrder, StaysInStepOverRandomSubjects)
{
	VMessageLog log;
	for (unsigned seed = 0; seed < 200; ++seed)
	{
		VRandomSubject random(seed);
		VSubjectParametrised subject;
		VSubjectApplicationData appData;
		random.Make(subject, appData);
		for (std::size_t i = 0; i < subject.m_Targets.size(); ++i)
			subject.m_Targets[i].m_NumberOfDegreesOfFreedom = std::uint32_t(i),
			appData.m_Targets[i].m_Name = std::to_string(i);
		const VSubjectParametrised before = subject;
		MakeOneTargetPerMarker(subject, appData);
		EXPECT_TRUE(CoreOrlexTypesUtils::CheckSubjectParametrised(subject));
		ASSERT_EQ(appData.m_Targets.size(), subject.m_Targets.size());
		for (std::size_t i = 0; i < subject.m_Targets.size(); ++i)
		{
			const std::uint32_t old = subject.m_Targets[i].m_NumberOfDegreesOfFreedom;
			EXPECT_EQ(appData.m_Targets[i].m_Name, std::to_string(old));
			EXPECT_EQ(subject.m_Targets[i].m_StateExpressions, before.m_Targets[old].m_StateExpressions);
		}
		std::vector<std::pair<std::uint32_t, std::uint32_t>> firsts;
		for (const VTarget& rTarget : subject.m_Targets)
			if (rTarget.m_Type <= VTarget::ELocalPointToWorldPointGaussian)
				firsts.emplace_back(rTarget.m_MarkerIndices[0], rTarget.m_NumberOfDegreesOfFreedom);
		EXPECT_TRUE(std::is_sorted(firsts.begin(), firsts.end()));
		for (const VTarget& rTarget : before.m_Targets)
		{
			const auto isItsFirst = [&](const auto& i_rFirst) {
				return i_rFirst.first == rTarget.m_MarkerIndices[0]
				    && i_rFirst.second <= rTarget.m_NumberOfDegreesOfFreedom;
			};
			const bool bPoint = rTarget.m_Type <= VTarget::ELocalPointToWorldPointGaussian;
			EXPECT_EQ(bPoint ? std::count_if(firsts.begin(), firsts.end(), isItsFirst) : 1, 1);
		}
	}
}

TEST(JointParameters, CarryStatisticsByName)
{
	VMessageLog log;
	VSubjectParametrised from;
	from.m_Segments.resize(4);
	const char* const names[] = {"A", "B", "A", "D"};
	for (std::size_t i = 0; i < 4; ++i)
	{
		from.m_Segments[i].m_Joint.m_Name = names[i];
		from.m_Segments[i].m_Joint.m_JointType = i == 3 ? VJoint::EDummy : VJoint::EHinge;
		from.m_Segments[i].m_Joint.m_TPoseMean = {double(i)};
	}
	const VJointParameters parameters = GatherJointParameters(from, ESubjectParametrisedPoseType::ETPose);
	EXPECT_EQ(log.Take(),
	    (VTexts{"ASSERT JointIt == JointParams.m_SubjectDynamicParameters.end()",
	        "ASSERT i_rJoint.m_TPoseCovariance.empty() && i_rJoint.m_TPoseMean.empty()"}));
	VSubjectParametrised to;
	to.m_Segments.resize(3);
	for (std::size_t i = 0; i < 3; ++i)
	{
		to.m_Segments[i].m_Joint.m_Name = i == 0 ? "B" : "A";
		to.m_Segments[i].m_Joint.m_JointType = i == 2 ? VJoint::EBall : VJoint::ESlider;
	}
	ApplyJointParameters(parameters, ESubjectParametrisedPoseType::ETemplate, to);
	EXPECT_EQ(to.m_Segments[0].m_Joint.m_TemplateMean, std::vector<double>{1});
	EXPECT_EQ(to.m_Segments[1].m_Joint.m_TemplateMean, std::vector<double>{0});
	EXPECT_TRUE(to.m_Segments[2].m_Joint.m_TemplateMean.empty());
	ApplyJointParameters(parameters, ESubjectParametrisedPoseType::EMean, to);
	EXPECT_EQ(to.m_Segments[0].m_Joint.m_Mean, std::vector<double>{1});
}

} // namespace Targets
