#include "RetargetSetupCore/Joints.h"

#include "TestSubjects.h"

#include <gtest/gtest.h>

#include <numbers>

namespace
{

using namespace RetargetSetup;
using CoreOrlexQRTIO::VSubjectQRTExtras;
using CoreOrlexTypes::c_NotSet;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

VSubjectParametrised Chain()
{
	return MakeSubject({{"Hips", -1}, {"Spine", 0, {"0", "0", "100"}}, {"Chest", 1, {"0", "0", "100"}},
	    {"Head", 2, {"0", "0", "100"}}});
}

void AddTargetOn(VSubjectParametrised& io_rSubject, std::vector<std::uint32_t> i_Segments)
{
	io_rSubject.m_Targets.emplace_back().m_SegmentIndices = std::move(i_Segments);
}

std::string JointTypes(const VSubjectParametrised& i_rSubject)
{
	std::string types;
	for (const auto& rSegment : i_rSubject.m_Segments)
		types += "FBAHSDx"[rSegment.m_Joint.m_JointType];
	return types;
}

void Prune(VSubjectParametrised& io_rSubject)
{
	VSubjectQRTExtras extras;
	RemoveJoints(io_rSubject, extras, JointsWithoutTargets(io_rSubject));
}

TEST(EnableJoint, LeavesAJointThatIsThere)
{
	VSubjectParametrised subject = Chain();
	subject.m_Segments[1].m_Joint.m_BindPose = {0.1, 0.2, 0.3};
	EnableJoint(subject, 1, {9, 9, 9});
	EXPECT_EQ(subject.m_Segments[1].m_Joint.m_BindPose, (std::vector<double>{0.1, 0.2, 0.3}));
}

TEST(RemoveJoints, OnlyATargetOfItsOwnKeepsAJoint)
{
	const struct
	{
		const char* m_pName;
		std::vector<std::vector<std::uint32_t>> m_Targets;
		const char* m_pExpected;
	} rows[] = {
	    {"no target anywhere keeps the root", {}, "FDDD"},
	    {"a target on the child does not keep the middle", {{3}}, "FDDB"},
	    {"a target on the middle does not keep the child", {{1}, {1}}, "FBDD"},
	    {"a target on two segments keeps none", {{2, 3}, {}}, "FDDD"},
	    {"an index beyond the list is skipped", {{77}, {2}}, "FDBD"},
	};
	for (const auto& rRow : rows)
	{
		VSubjectParametrised subject = Chain();
		for (const auto& rTarget : rRow.m_Targets)
			AddTargetOn(subject, rTarget);
		Prune(subject);
		EXPECT_EQ(JointTypes(subject), rRow.m_pExpected) << rRow.m_pName;
	}
}

TEST(RemoveJoints, BakesTheBindPoseBeforeThePreRotation)
{
	VSubjectParametrised subject = Chain();
	// Bind pose a quarter about X, pre-rotation a quarter about Z. X after Z takes X to Z, Y to -X and Z to -Y: a third
	// of a turn about (1, -1, 1) / sqrt 3. The other order would give the axis (1, 1, 1).
	subject.m_Segments[1].m_Joint.m_BindPose = {std::numbers::pi / 2, 0, 0};
	subject.m_Segments[1].m_PreRotation = {"0", "0", "1.5707963267948966"};
	subject.m_Segments[2].m_PreRotation = {"1+1", "0.25", "2x"};
	subject.m_Segments[3].m_Joint.m_JointType = VJoint::EFree;
	subject.m_Segments[3].m_Joint.m_BindPose = {1, 1, 1, 5, 5, 5};
	subject.m_Segments[3].m_PreRotation = {"0.5", "0", "0"};
	Prune(subject);
	EXPECT_EQ(subject.m_Segments[1].m_PreRotation, (std::array<std::string, 3>{"1.209200", "-1.209200", "1.209200"}));
	EXPECT_EQ(subject.m_Segments[2].m_PreRotation, (std::array<std::string, 3>{"0.000000", "0.250000", "0.000000"}))
	    << "what is no number counts as 0";
	EXPECT_EQ(subject.m_Segments[3].m_PreRotation[0], "0.5") << "only Ball joints are baked";
	for (std::size_t i = 1; i < 4; ++i)
	{
		const VJoint& rJoint = subject.m_Segments[i].m_Joint;
		EXPECT_EQ(rJoint.m_JointType, VJoint::EDummy);
		EXPECT_TRUE(rJoint.m_Mean.empty() && rJoint.m_BindPose.empty() && rJoint.m_Covariance.empty());
	}
}

TEST(RemoveJoints, AShortBindPoseCountsAsZeros)
{
	VSubjectParametrised subject = Chain();
	subject.m_Segments[1].m_Joint.m_BindPose = {0.5};
	subject.m_Segments[2].m_Joint.m_BindPose.clear();
	Prune(subject);
	EXPECT_EQ(subject.m_Segments[1].m_PreRotation[0], "0.500000");
	EXPECT_EQ(subject.m_Segments[2].m_PreRotation[0], "0.000000");
}

TEST(RemoveJoints, CreatingThemAgainGivesFreshOnes)
{
	VSubjectParametrised subject = Chain();
	subject.m_Segments[0].m_Joint.m_BindPose = {0, 0, 1, 2, 3, 4};
	subject.m_Segments[1].m_Joint.m_BindPose = {0.5, 0, 0};
	AddTargetOn(subject, {3});
	subject.m_Segments[3].m_Joint.m_BindPose = {0, 0.7, 0};
	Prune(subject);
	VSubjectQRTExtras extras;
	EnableAllJoints(subject, extras);
	EXPECT_EQ(JointTypes(subject), "FBBB");
	EXPECT_EQ(subject.m_Segments[0].m_Joint.m_BindPose.size(), 6u) << "the root is left as it is";
	EXPECT_EQ(subject.m_Segments[1].m_Joint.m_BindPose, std::vector<double>(3));
	EXPECT_EQ(subject.m_Segments[1].m_PreRotation[0], "0.500000") << "the old rotation stays in the segment";
	EXPECT_EQ(subject.m_Segments[3].m_Joint.m_BindPose[1], 0.7);
}

TEST(TPoseConstraints, StayInStepWithTheJoints)
{
	// Values tell whose share they are: the segment's index, then the place.
	const std::vector<double> every = {0, 1, 2, 3, 4, 5, 10, 11, 12, 20, 21, 22, 30, 31, 32};
	const std::vector<double> some = {10, 11, 12, 30, 31, 32};
	const struct
	{
		const char* m_pName;
		std::vector<double> m_List;
		std::vector<bool> m_HasT;
		std::vector<double> m_Pruned;
		std::vector<double> m_Restored;
	} rows[] = {
	    {"one share for every joint", every, {}, {0, 1, 2, 3, 4, 5, 30, 31, 32},
	        {0, 1, 2, 3, 4, 5, c_NotSet, c_NotSet, c_NotSet, c_NotSet, c_NotSet, c_NotSet, 30, 31, 32}},
	    {"shares of the joints that the file gave one", some, {false, true, false, true}, {30, 31, 32}, {30, 31, 32}},
	    {"a list that fits neither", {1, 2}, {false, true, false, true}, {1, 2}, {1, 2}},
	    {"no list", {}, {}, {}, {}},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VSubjectParametrised subject = Chain();
		subject.m_TPoseConstraints = rRow.m_List;
		AddTargetOn(subject, {3});
		VSubjectQRTExtras extras;
		for (std::size_t i = 0; i < rRow.m_HasT.size(); ++i)
		{
			extras.m_Segments.emplace_back().m_Name = subject.m_Segments[i].m_Name;
			extras.m_Segments.back().m_Joint.m_bHasT = rRow.m_HasT[i];
		}
		RemoveJoints(subject, extras, JointsWithoutTargets(subject));
		EXPECT_EQ(subject.m_TPoseConstraints, rRow.m_Pruned);
		EnableAllJoints(subject, extras);
		EXPECT_EQ(subject.m_TPoseConstraints, rRow.m_Restored);
	}
}

} // namespace
