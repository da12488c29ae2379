#include "MessageLog.h"
#include "RandomSubject.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBody.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyAttachment.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyGuids.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyLayout.h"

#include <gtest/gtest.h>

#include <functional>

namespace
{

using namespace CoreOrlexTypesUtils;
using namespace CoreOrlexTypesUtils::RigidBodyUtils;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = VSubjectParametrised::VJoint;
using VTarget = VSubjectParametrised::VTarget;
using VTexts = std::vector<std::string>;

void ExpectSamePoints(
    const std::map<std::string, VPoints>& i_rExpected, const std::map<std::string, VPoints>& i_rActual, unsigned i_Seed)
{
	for (const auto& [name, points] : i_rExpected)
	{
		ASSERT_TRUE(i_rActual.count(name)) << name;
		ASSERT_EQ(i_rActual.at(name).size(), points.size());
		for (std::size_t i = 0; i < points.size(); ++i)
			for (std::size_t axis = 0; axis < 3; ++axis)
				EXPECT_NEAR(i_rActual.at(name)[i][axis], points[i][axis], 1e-9) << i_Seed << ' ' << name;
	}
}

void ExpectSameSights(const std::map<std::string, std::vector<double>>& i_rExpected,
    const std::map<std::string, std::vector<double>>& i_rActual, unsigned i_Seed, bool i_bPoses)
{
	for (const auto& [name, sight] : i_rExpected)
	{
		if (!i_bPoses && name.starts_with("pose of "))
			continue;
		ASSERT_TRUE(i_rActual.count(name)) << name;
		ASSERT_EQ(i_rActual.at(name).size(), sight.size());
		for (std::size_t i = 0; i < sight.size(); ++i)
			EXPECT_NEAR(i_rActual.at(name)[i], sight[i], 1e-9) << i_Seed << ' ' << name << ' ' << i;
	}
}

class RigidBody : public testing::Test
{
protected:
	RigidBody() { VRandomSubject(3).MakeBody(m_Body, m_AppData); }

	VTarget& Target() { return m_Body.m_Targets[0]; }

	VMessageLog m_Log;
	VSubjectParametrised m_Body;
	VSubjectApplicationData m_AppData;
	Rotation::VPose<double> m_Pose;
	std::vector<Rotation::VVector3> m_Positions;
	VPoseCovariance m_PoseCovariance;
	std::vector<Rotation::VMatrix3> m_Covariance;
};

TEST_F(RigidBody, ReadsWhatItWrites)
{
	ASSERT_TRUE(ReadRigidBody(Target(), m_Pose, m_Positions, m_PoseCovariance, m_Covariance));
	EXPECT_EQ(m_Positions.size(), m_Body.m_Markers.size());
	VSubject evaluated;
	ASSERT_TRUE(SubjectParametrisedConverter::ConvertSubject(m_Body, evaluated));
	VSubject::VTarget copy = evaluated.m_Targets[0];
	ASSERT_TRUE(WriteRigidBody(copy, m_Pose, m_Positions, m_PoseCovariance, m_Covariance));
	ASSERT_EQ(copy.m_State.size(), evaluated.m_Targets[0].m_State.size());
	for (std::size_t i = 0; i < copy.m_State.size(); ++i)
		EXPECT_NEAR(copy.m_State[i], evaluated.m_Targets[0].m_State[i], 1e-14);
	EXPECT_EQ(copy.m_Covariance, evaluated.m_Targets[0].m_Covariance);
	ASSERT_TRUE(WriteRigidBody(Target(), m_Pose, m_Positions, m_PoseCovariance, m_Covariance));
	ASSERT_TRUE(SubjectParametrisedConverter::ConvertSubject(m_Body, evaluated));
	EXPECT_EQ(evaluated.m_Targets[0].m_State, copy.m_State);

	Target().m_MarkerIndices = {0, 1, 2};
	Target().m_StateExpressions.assign(15, "1");
	Target().m_Covariance.assign(63, 0.0);
	ASSERT_TRUE(ReadRigidBody(Target(), m_Pose, m_Positions, m_PoseCovariance, m_Covariance));
	EXPECT_EQ(m_Log.TakeTroubles(), VTexts(3, "3 Zero covariance on rigid body marker, filling up with default!"));
	EXPECT_EQ(m_Covariance, std::vector<Rotation::VMatrix3>(3, {5, 0, 0, 0, 5, 0, 0, 0, 5}));
}

TEST_F(RigidBody, ReadAndWriteRefuse)
{
	const std::string read = "2 Cannot read rigid body information, ";
	const std::string write = "2 Cannot write rigid body information, ";
	Target().m_StateExpressions[4] = "Arm";
	const auto refuses = [&](const std::string& i_rMessage)
	{
		EXPECT_FALSE(ReadRigidBody(Target(), m_Pose, m_Positions, m_PoseCovariance, m_Covariance));
		EXPECT_EQ(m_Log.TakeTroubles(), VTexts{i_rMessage});
	};
	refuses("2 Could not evaluate state expressions in target");
	Target().m_Covariance.pop_back();
	refuses(read + "Incorrect covariance size!");
	Target().m_StateExpressions.pop_back();
	refuses(read + "Incorrect state size!");
	Target().m_MarkerIndices = {0, 1};
	refuses(read + "the rigid body does not define a sufficient number of markers!");
	Target().m_Type = VTarget::ELocalPointToWorldPoint;
	refuses(read + "this target is not a rigid body!");

	const auto refusesWrite = [&](const std::string& i_rMessage)
	{
		const VSubjectParametrised before = m_Body;
		EXPECT_FALSE(WriteRigidBody(Target(), m_Pose, m_Positions, m_PoseCovariance, m_Covariance));
		EXPECT_EQ(m_Log.TakeTroubles(), VTexts{i_rMessage});
		EXPECT_TRUE(m_Body == before);
	};
	m_Positions.resize(2);
	m_Covariance.resize(1);
	refusesWrite(write + "this target is not a rigid body!");
	Target().m_Type = VTarget::ERigidBody;
	refusesWrite(write + "different number of marker positions and covariances!");
	m_Covariance.resize(2);
	refusesWrite(write + "the rigid body does not define a sufficient number of markers!");
}

TEST_F(RigidBody, ValidationInOrder)
{
	VRandomSubject(3).MakeBody(m_Body, m_AppData, 2);
	EXPECT_TRUE(ValidateRigidBody(m_Body));
	EXPECT_TRUE(ToPointTargets(m_Body));
	EXPECT_TRUE(ValidateRigidBody(m_Body));
	VRandomSubject(3).MakeBody(m_Body, m_AppData, 2);
	const std::string parents = "2 A rigid body target must have a single parent segment!";
	const std::string targets =
	    "2 In a rigid body there must be either one target of RigidBody type or several targets "
	    "parented to the root segment";
	const std::pair<std::function<void()>, std::string> rows[] = {{[&] { Target().m_SegmentIndices = {3}; }, parents},
	    {[&] {
		     Target().m_SegmentIndices = {0, 1};
	     },
	        parents},
	    {[&] { Target().m_Type = VTarget::ELocalPointToWorldPoint; }, targets},
	    {[&] { m_Body.m_Targets.resize(2, m_Body.m_Targets[0]); }, targets},
	    {[&] { m_Body.m_Targets.clear(); }, targets},
	    {[&] { m_Body.m_Segments[0].m_Joint.m_JointType = VJoint::EBall; },
	        "2 A rigid body must have a free joint as root!"},
	    {[&] { m_Body.m_Segments[2].m_Joint.m_JointType = VJoint::EBall; },
	        "2 All but the root segment must be of dummy type!"},
	    {[&] { m_Body.m_Segments.clear(); }, "2 A rigid body must have at least 1 segment!"},
	    {[&] { m_Body.m_Markers.resize(2); }, "2 A rigid body must have at least 3 markers!"}};
	for (const auto& [breakIt, message] : rows)
	{
		breakIt();
		EXPECT_FALSE(ValidateRigidBody(m_Body));
		EXPECT_EQ(m_Log.TakeTroubles(), VTexts{message});
		EXPECT_FALSE(ToRigidBodyTarget(m_Body));
		EXPECT_EQ(m_Log.TakeTroubles(), (VTexts{message, "2 Invalid input, subject Prop is not a rigid body!"}));
	}
}

TEST_F(RigidBody, LayoutsThereAndBack)
{
	for (unsigned seed = 0; seed < 200; ++seed)
	{
		VRandomSubject random(seed);
		random.MakeBody(m_Body, m_AppData, random.Below(3));
		VSubject evaluated;
		ASSERT_TRUE(SubjectParametrisedConverter::ConvertSubject(m_Body, evaluated));
		const auto before = WorldPoints(m_Body);
		const auto sights = WorldSights(evaluated);
		const auto expectSameSights = [&]
		{
			ExpectSameSights(sights, WorldSights(evaluated), seed, false);
			ExpectSameSights(sights, WorldSights(m_Body, false), seed, false);
			ExpectSameSights(sights, WorldSights(m_Body, true), seed, false);
		};
		ASSERT_TRUE(ToPointTargets(m_Body, m_AppData));
		ASSERT_TRUE(ToPointTargets(evaluated));
		expectSameSights();
		EXPECT_TRUE(CheckSubjectParametrised(m_Body));
		EXPECT_EQ(m_Body.m_Targets.size(), m_Body.m_Markers.size());
		EXPECT_EQ(m_AppData.m_Targets.size(), m_Body.m_Targets.size());
		EXPECT_EQ(m_AppData.m_Targets[1].m_Name, m_Body.m_Markers[1].m_Name);
		ExpectSamePoints(before, WorldPoints(m_Body), seed);
		ExpectSamePoints(before, WorldPoints(evaluated), seed);
		const VSubjectParametrised points = m_Body;
		ASSERT_TRUE(ToRigidBodyTarget(m_Body, m_AppData));
		ASSERT_TRUE(ToRigidBodyTarget(evaluated));
		EXPECT_TRUE(CheckSubjectParametrised(m_Body));
		EXPECT_EQ(m_AppData.m_Targets.size(), 1u);
		expectSameSights();
		ExpectSamePoints(before, WorldPoints(m_Body), seed);
		ExpectSamePoints(before, WorldPoints(evaluated), seed);
		ASSERT_TRUE(ToPointTargets(m_Body, m_AppData));
		EXPECT_TRUE(m_Body == points);
	}
}

TEST_F(RigidBody, ConversionTells)
{
	ASSERT_TRUE(ToRigidBodyTarget(m_Body));
	EXPECT_EQ(m_Log.Take(), VTexts{"RigidBodyUtils 4 No conversion needed for subject Prop!"});
	ASSERT_TRUE(ToPointTargets(m_Body));
	ASSERT_TRUE(ToPointTargets(m_Body));
	EXPECT_EQ(m_Log.Take(), VTexts{"RigidBodyUtils 4 No conversion needed for subject Prop!"});
	// Expressions survive.
	m_Body.m_StaticParameters.emplace_back().m_Name = "Arm";
	m_Body.m_Targets[1].m_StateExpressions[2] = "2*Arm";
	ASSERT_TRUE(ToRigidBodyTarget(m_Body));
	EXPECT_EQ(Target().m_StateExpressions[6 + 5], "2*Arm");
	ASSERT_TRUE(ToPointTargets(m_Body));
	EXPECT_EQ(m_Body.m_Targets[1].m_StateExpressions[2], "2*Arm");

	const VSubjectParametrised points = m_Body;
	ASSERT_TRUE(ToRigidBodyTarget(m_Body));
	Target().m_ViewNormals.pop_back();
	ASSERT_TRUE(ToPointTargets(m_Body));
	EXPECT_EQ(m_Log.TakeTroubles(), VTexts{"ASSERT rTgt.m_ViewNormals.size()==1"});
	EXPECT_EQ(m_Body.m_Targets.back().m_ViewNormals, (std::vector<std::array<double, 3>>(1)));
	m_Body.m_Targets.resize(2);
	EXPECT_FALSE(ToRigidBodyTarget(m_Body));
	EXPECT_EQ(m_Log.TakeTroubles(),
	    (VTexts{"2 Cannot write rigid body information, the rigid body does not define a sufficient number of markers!",
	        "2 Cannot write marker position and covariances to the rigid body target!"}));
	m_Body = points;
	m_Body.m_Targets[2].m_Type = VTarget::ELocalLineToWorldPoint;
	EXPECT_FALSE(ToRigidBodyTarget(m_Body));
	EXPECT_EQ(m_Log.TakeTroubles(), VTexts{"2 Unsupported target type in geometry calculation"});
}

TEST_F(RigidBody, GuidsGiveEveryComponentAParameter)
{
	auto& rArm = m_Body.m_StaticParameters.emplace_back();
	rArm.m_Name = "Arm";
	rArm.m_UserValue = 7;
	rArm.m_Visible = true;
	Target().m_StateExpressions[0] = "2*Arm";
	Target().m_StateExpressions[1] = "";
	const auto before = WorldPoints(m_Body);
	ASSERT_TRUE(AddGuids(m_Body));
	EXPECT_EQ(m_Log.Take(),
	    (VTexts{"RigidBodyUtils 4 Adding GUIDs to subject parameters for rigid body: Prop",
	        "RigidBodyUtils 4 Added GUIDs to subject parameters for rigid body: Prop"}));
	ExpectSamePoints(before, WorldPoints(m_Body), 0);
	const auto& rParameters = m_Body.m_StaticParameters;
	ASSERT_EQ(rParameters.size(), 1 + Target().m_StateExpressions.size());
	EXPECT_EQ(rParameters[1].m_DefaultExpression, "14");
	EXPECT_TRUE(rParameters[1].m_Visible);
	EXPECT_EQ(rParameters[1].m_Quantity, VSubjectParametrised::VStaticParameter::EQuantityLength);
	EXPECT_EQ(rParameters[4].m_Quantity, VSubjectParametrised::VStaticParameter::EQuantityAngle);
	EXPECT_EQ(Target().m_StateExpressions[0], "'" + rParameters[1].m_Name + "'");
	EXPECT_EQ(rParameters[1].m_Name.size(), 36u);
	const VSubjectParametrised once = m_Body;
	ASSERT_TRUE(AddGuids(m_Body));
	EXPECT_TRUE(m_Body == once);
}

TEST_F(RigidBody, GuidsRefuseWithNothingChanged)
{
	for (const char* pName : {"Arm", "Leg"})
		m_Body.m_StaticParameters.emplace_back().m_Name = pName;
	m_Body.m_DynamicParameters = {{"GlobalScale", 1, 0, 1, true}};
	for (const auto& [text, message] :
	    {std::pair<const char*, const char*>{"1+", nullptr}, {"x", "2 Could not evaluate state expressions in target"},
	        {"GlobalScale", "2 Missing parameter GlobalScale"}, {"Arm*GlobalScale", "2 Missing parameter GlobalScale"},
	        {"Arm+Leg", "2 Multiple parameters in target not handled."}})
	{
		VSubjectParametrised body = m_Body;
		body.m_Targets[0].m_StateExpressions[5] = text;
		const VSubjectParametrised before = body;
		EXPECT_EQ(AddGuids(body), message == nullptr) << text;
		EXPECT_EQ(m_Log.TakeTroubles(), message ? VTexts{message} : VTexts());
		EXPECT_EQ(body == before, message != nullptr);
	}
	m_Body.m_StaticParameters[1].m_Name = "Arm";
	EXPECT_FALSE(AddGuids(m_Body));
	EXPECT_EQ(m_Log.TakeTroubles(),
	    (VTexts{"2 Error parsing subject static parameter expressions",
	        "2 Cannot add StaticParameter 'Arm', a StaticParameter with that name already exists."}));
}

TEST_F(RigidBody, AttachAndRemoveOverRandomSubjects)
{
	for (unsigned seed = 0; seed < 300; ++seed)
	{
		VRandomSubject random(seed);
		VSubjectParametrised subject;
		VSubjectApplicationData appData;
		random.Make(subject, appData);
		random.MakeBody(m_Body, m_AppData, random.Below(3));
		if (seed % 3 == 0)
			AddGuids(m_Body);
		ASSERT_TRUE(seed % 2 ? ToPointTargets(m_Body, m_AppData) : ToRigidBodyTarget(m_Body, m_AppData));
		const VSubjectParametrised before = subject;
		const VSubjectApplicationData appDataBefore = appData;
		auto points = WorldPoints(subject);
		const auto bodyPoints = WorldPoints(m_Body);
		VSubject evaluated;
		VSubject evaluatedBody;
		ASSERT_TRUE(SubjectParametrisedConverter::ConvertSubject(subject, evaluated));
		ASSERT_TRUE(SubjectParametrisedConverter::ConvertSubject(m_Body, evaluatedBody));
		VSubjectApplicationData evaluatedAppData = appData;
		auto sights = WorldSights(evaluated);
		sights.merge(WorldSights(evaluatedBody));

		const std::uint32_t segment = random.Below(std::uint32_t(subject.m_Segments.size()));
		const std::string name = subject.m_Segments[segment].m_Name;
		ASSERT_TRUE(AttachRigidBody(subject, appData, m_Body, m_AppData, name));
		ASSERT_TRUE(AttachRigidBody(evaluated, evaluatedAppData, evaluatedBody, m_AppData, name));
		EXPECT_TRUE(CheckSubjectParametrised(subject));
		EXPECT_TRUE(CheckSubject(evaluated));
		points.insert(bodyPoints.begin(), bodyPoints.end());
		ExpectSamePoints(points, WorldPoints(subject), seed);
		ExpectSamePoints(points, WorldPoints(evaluated), seed);
		ExpectSameSights(sights, WorldSights(evaluated), seed, true);
		ExpectSameSights(sights, WorldSights(subject, false), seed, true);
		ExpectSameSights(sights, WorldSights(subject, true), seed, true);
		EXPECT_EQ(subject.m_Targets.back().m_SegmentIndices, std::vector<std::uint32_t>{segment});
		EXPECT_EQ(appData.m_Markers.size(), subject.m_Markers.size());
		EXPECT_EQ(appData.m_Targets.size(), subject.m_Targets.size());
		EXPECT_EQ(appData.m_Sticks.size(), appDataBefore.m_Sticks.size() + 5);
		for (std::size_t i = 0; i < subject.m_Markers.size(); ++i)
		{
			EXPECT_EQ(subject.m_Markers[i].m_MarkerId, CoreOrlexTypes::HashName(subject.m_Markers[i].m_Name));
			EXPECT_EQ(appData.m_Markers[i].m_Colour,
			    CoreOrlexTypes::ColourFromPattern(CoreOrlexTypes::HashName(subject.m_Markers[i].m_Name)));
		}
		ASSERT_TRUE(RemoveRigidBody(subject, appData, subject.m_Targets.size() - 1));
		EXPECT_TRUE(subject == before) << seed;
		EXPECT_TRUE(appData == appDataBefore);
	}
}

TEST_F(RigidBody, AttachRefusesInOrderWithNothingChanged)
{
	VSubjectParametrised subject;
	VSubjectApplicationData appData;
	VRandomSubject(5).Make(subject, appData);
	std::string segment = "Nowhere";
	appData.m_Targets.pop_back();
	m_AppData.m_Markers.pop_back();
	m_Body.m_StaticParameters = {subject.m_StaticParameters[0]};
	m_Body.m_DynamicParameters = subject.m_DynamicParameters;
	m_Body.m_Markers[1].m_Name = "M2";
	subject.m_Markers[3].m_MarkerId = CoreOrlexTypes::HashName("P2");
	Target().m_StateExpressions.pop_back();
	const std::string invalid = "2 Invalid inptut, subject Prop is not a rigid body!";
	const auto refuses = [&](const VTexts& i_rLog)
	{
		const VSubjectParametrised before = subject;
		const VSubjectApplicationData appDataBefore = appData;
		EXPECT_FALSE(AttachRigidBody(subject, appData, m_Body, m_AppData, segment));
		EXPECT_EQ(m_Log.TakeTroubles(), i_rLog);
		EXPECT_TRUE(subject == before);
		EXPECT_TRUE(appData == appDataBefore);
	};
	refuses({"2 Cannot read rigid body information, Incorrect state size!", invalid});
	Target().m_StateExpressions.push_back("1");
	Target().m_SegmentIndices = {};
	refuses({"2 A rigid body target must have a single parent segment!", invalid});
	Target().m_SegmentIndices = {0};
	const VSubjectParametrised good = m_Body;
	const std::string freeRoot = "ASSERT rRigidBodySegment.m_Joint.m_JointType == TSubjectType::VJoint::EFree";
	const std::string oneTarget = "ASSERT RigidBody.m_Targets.size() == 1";
	const std::string bodyTarget = "ASSERT rRigidBodyTgt.m_Type == TSubjectType::VTarget::ERigidBody";
	m_Body.m_Segments[0].m_Joint.m_JointType = VJoint::EBall;
	refuses({"2 A rigid body must have a free joint as root!", freeRoot, invalid});
	m_Body = good;
	m_Body.m_Targets.push_back(Target());
	const std::string targets = "2 In a rigid body there must be either one target of RigidBody type or several "
	                            "targets parented to the root segment";
	refuses({targets, oneTarget, invalid});
	m_Body = good;
	Target().m_Type = VTarget::ELocalPointToWorldPoint;
	refuses({targets, bodyTarget, invalid});
	m_Body.m_Segments.clear();
	m_Body.m_Targets.clear();
	refuses({"2 A rigid body must have at least 1 segment!", freeRoot, oneTarget, bodyTarget, invalid});
	m_Body = good;
	refuses({"2 RigidBodyAppData does not match RigidBody for cluster Prop"});
	m_AppData.m_Markers.emplace_back();
	refuses({"2 SubjectAppData does not match Subject for Performer"});
	appData.m_Targets.emplace_back();
	refuses({"2 Cannot attach rigid body to segment Nowhere the segment does not exist!"});
	segment = "S0";
	refuses({"2 Rigid body static parameter name clash: Arm"});
	m_Body.m_StaticParameters[0].m_Name = "GlobalScale";
	refuses({"2 Rigid body static parameter name clash: GlobalScale"});
	m_Body.m_StaticParameters.clear();
	refuses({"2 Rigid body dynamic parameter name clash: GlobalScale"});
	m_Body.m_DynamicParameters[0].m_Name = "Arm";
	refuses({"2 Rigid body dynamic parameter name clash: Arm"});
	m_Body.m_DynamicParameters.clear();
	refuses({"2 Cannot add this marker, duplicate name: M2"});
	m_Body.m_Markers[1].m_Name = "P1";
	refuses({"2 Cannot add this marker, hash collision for name: P2"});
	subject.m_Markers[3].m_MarkerId = 1;
	subject.m_Segments[0].m_Joint.m_JointType = VJoint::EBadJointType;
	subject.m_Segments[0].m_Joint.m_Mean = {1};
	EXPECT_FALSE(AttachRigidBody(subject, appData, m_Body, m_AppData, segment));
	EXPECT_EQ(m_Log.TakeTroubles().back(), "2 Cannot compute the pose of subject Performer");
}

TEST_F(RigidBody, RemoveKeepsParametersThatAreUsedElsewhere)
{
	using VSegment = VSubjectParametrised::VSegment;
	for (std::string& (*const pText)(VSegment&) :
	    std::initializer_list<std::string& (*)(VSegment&)>{[](VSegment& i_r) -> std::string&
	        { return i_r.m_PreTranslation[0]; },
	        [](VSegment& i_r) -> std::string& { return i_r.m_Bounds[5]; },
	        [](VSegment& i_r) -> std::string& { return i_r.m_MassExpression; },
	        [](VSegment& i_r) -> std::string& { return i_r.m_MassCentreExpressions[0]; },
	        [](VSegment& i_r) -> std::string& { return i_r.m_RadiusOfGyrationExpressions[0]; },
	        [](VSegment& i_r) -> std::string& { return i_r.m_Name; }})
	{
		VSubjectParametrised subject;
		VSubjectApplicationData appData;
		VRandomSubject(5).Make(subject, appData);
		subject.m_StaticParameters.emplace_back().m_Name = "Shared";
		const auto body = std::ranges::find(subject.m_Targets, VTarget::ERigidBody, &VTarget::m_Type);
		body->m_StateExpressions[0] = "Shared";
		std::erase_if(subject.m_Targets,
		    [](const VTarget& i_r) { return i_r.m_Type != VTarget::ERigidBody && !i_r.m_MarkerIndices.empty(); });
		appData.m_Targets.resize(subject.m_Targets.size());
		pText(subject.m_Segments[0]) = "Shared*2";
		const bool bName = subject.m_Segments[0].m_Name == "Shared*2";
		const auto index = std::ranges::find(subject.m_Targets, VTarget::ERigidBody, &VTarget::m_Type);
		ASSERT_TRUE(RemoveRigidBody(subject, appData, std::size_t(index - subject.m_Targets.begin())));
		EXPECT_EQ(subject.m_StaticParameters.back().m_Name == "Shared", !bName) << "a name is no use of it";
	}
}

TEST_F(RigidBody, RemoveLeavesASegmentThatAnotherTargetFollows)
{
	VTarget& rOther = m_Body.m_Targets.emplace_back();
	rOther.m_Type = VTarget::ELocalPointToWorldPoint;
	rOther.m_SegmentIndices = {0};
	m_AppData.m_Targets.resize(2);
	ASSERT_TRUE(RemoveRigidBody(m_Body, m_AppData, 0));
	ASSERT_EQ(m_Body.m_Segments.size(), 1u);
	ASSERT_EQ(m_Body.m_Targets.size(), 1u);
	EXPECT_EQ(m_Body.m_Targets[0].m_SegmentIndices, std::vector<std::uint32_t>{0});
}

TEST_F(RigidBody, RemoveRefusesInOrder)
{
	const auto refuses = [&](std::size_t i_Target, const VTexts& i_rLog)
	{
		const VSubjectParametrised before = m_Body;
		EXPECT_FALSE(RemoveRigidBody(m_Body, m_AppData, i_Target));
		EXPECT_EQ(m_Log.TakeTroubles(), i_rLog);
		EXPECT_TRUE(m_Body == before);
	};
	refuses(1, {"2 Cannot remove ERigidBody target, out of range target index!"});
	m_Body.m_Segments.push_back(m_Body.m_Segments[0]);
	m_Body.m_Segments[1].m_Name = "Hand";
	m_Body.m_Segments[1].m_SegmentIndex = 1;
	m_Body.m_Segments[1].m_ParentSegmentIndex = 0;
	VTarget& rOther = m_Body.m_Targets.emplace_back();
	rOther.m_Type = VTarget::ELocalPointToWorldPoint;
	rOther.m_MarkerIndices = {77, 1};
	rOther.m_SegmentIndices = {1};
	refuses(1, {"2 Cannot remove a non RigidBody target!"});
	refuses(0,
	    {"ASSERT MarkerIndicesMap.find(rOtherTgt.m_MarkerIndices[j]) != MarkerIndicesMap.end()",
	        "2 No other target should be associated with a target that is part of a RigidBody!"});
	m_Body.m_Targets[1].m_MarkerIndices.clear();
	refuses(0, {"2 No other segment should be parented to a RigidBody segment!"});

	// Its own segment goes with it, and what stands behind moves up.
	m_Body.m_Segments[1].m_ParentSegmentIndex = CoreOrlexTypes::c_NoParent;
	m_Body.m_TPoseConstraints = {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11};
	m_AppData.m_Segments.resize(2);
	ASSERT_TRUE(RemoveRigidBody(m_Body, m_AppData, 0));
	ASSERT_EQ(m_Body.m_Segments.size(), 1u);
	EXPECT_EQ(m_AppData.m_Segments.size(), 1u);
	EXPECT_EQ(m_Body.m_Segments[0].m_Name, "Hand");
	EXPECT_EQ(m_Body.m_Segments[0].m_SegmentIndex, 0u);
	EXPECT_EQ(m_Body.m_Targets[0].m_SegmentIndices, std::vector<std::uint32_t>{0});
	EXPECT_EQ(m_Body.m_TPoseConstraints, (std::vector<double>{6, 7, 8, 9, 10, 11}));
	EXPECT_TRUE(m_Body.m_Markers.empty());
	EXPECT_TRUE(m_AppData.m_Sticks.empty());
}

} // namespace
