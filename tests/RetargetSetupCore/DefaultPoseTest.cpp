#include "RetargetSetupCore/DefaultPose.h"

#include "TestSubjects.h"

#include <gtest/gtest.h>

namespace
{

using namespace RetargetSetup;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

TEST(ApplyDefaultPose, TurnsTheRootByWhereTheHeadLies)
{
	const struct
	{
		const char* m_pName;
		std::array<const char*, 3> m_Head;
		bool m_bTurned;
	} rows[] = {
	    {"head", {"0", "0", "10"}, false},
	    {"Head", {"0", "10", "0"}, true},
	    {"HEAD", {"0", "10", "10"}, true},
	    {"head", {"10", "10", "0"}, false},
	    {"head", {"10", "0", "0"}, false},
	    {"head", {"-10", "0", "-5"}, false},
	    {"head", {"-10", "-5", "-6"}, false},
	    {"head", {"-10", "5*GlobalScale", "4"}, true},
	    {"head", {"0", "oops", "0"}, false},
	    {"head2", {"0", "10", "0"}, false},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(std::string(rRow.m_pName) + " " + rRow.m_Head[0] + " " + rRow.m_Head[1] + " " + rRow.m_Head[2]);
		VSubjectParametrised subject = MakeSubject({{"Hips", -1}, {"Neck", 0}, {rRow.m_pName, 1, rRow.m_Head}});
		const VLogRecorder quiet;
		ApplyDefaultPose(subject);
		EXPECT_EQ(subject.m_Segments[0].m_Joint.m_TPoseMean,
		    (std::vector<double>{rRow.m_bTurned ? 1.5707963267948966 : 0.0, 0, 0, 0, 0, 1000}));
	}
}

TEST(ApplyDefaultPose, TheFirstHeadCountsAndOtherJointsKeepTheirs)
{
	VSubjectParametrised subject =
	    MakeSubject({{"Hips", -1}, {"head", 0, {"0", "0", "1"}}, {"Head", 1, {"0", "1", "0"}}, {"Knee", 0}});
	subject.m_Segments[1].m_Joint.m_TPoseMean = {1, 2, 3};
	subject.m_Segments[3].m_Joint.m_JointType = VJoint::EHinge;
	subject.m_Segments[3].m_Joint.m_TPoseMean = {0.4};
	subject.m_Segments[3].m_Joint.m_Mean.clear();
	subject.m_Segments[3].m_Joint.m_Covariance.clear();
	ApplyDefaultPose(subject);
	EXPECT_EQ(subject.m_Segments[0].m_Joint.m_TPoseMean[0], 0.0);
	EXPECT_EQ(subject.m_Segments[1].m_Joint.m_TPoseMean, std::vector<double>(3));
	EXPECT_EQ(subject.m_Segments[3].m_Joint.m_TPoseMean, std::vector<double>{0.4});
	VSubjectParametrised empty;
	ApplyDefaultPose(empty);
	EXPECT_EQ(empty, VSubjectParametrised());
}

TEST(AdoptTPose, MovesIt)
{
	VSubjectParametrised subject = MakeSubject({{"Hips", -1}, {"Neck", 0}});
	subject.m_Segments[0].m_Joint.m_TPoseMean = {1, 2, 3, 4, 5, 6};
	subject.m_Segments[0].m_Joint.m_TPoseCovariance = {7};
	AdoptTPoseAsBindPose(subject);
	EXPECT_EQ(subject.m_Segments[0].m_Joint.m_BindPose, (std::vector<double>{1, 2, 3, 4, 5, 6}));
	EXPECT_TRUE(subject.m_Segments[0].m_Joint.m_TPoseMean.empty());
	EXPECT_TRUE(subject.m_Segments[0].m_Joint.m_TPoseCovariance.empty());
	EXPECT_TRUE(subject.m_Segments[1].m_Joint.m_BindPose.empty()) << "replaced by a T-pose that there is not";
}

} // namespace
