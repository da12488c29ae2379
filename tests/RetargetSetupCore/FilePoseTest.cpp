#include "TestSubjects.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/FilePose.h"
#include "RetargetSetupCore/TargetConstruction.h"

#include <gtest/gtest.h>

#include <cmath>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;

/// A root at (10, 20, 30), turned, with an arm of two bones; the parent of the hand is scaled by 2, and its bones are
/// told apart from the file's globals by nothing but that.
FBXIO::VSkinSkeleton ScaledArm()
{
	FBXIO::VSkinSkeleton bones;
	FBXIO::VSkinBone root = MakeBone("root", -1);
	Move(root.m_Global, 10, 20, 30);
	Turn(root.m_Global, 90, 0, 0, 1);
	bones.push_back(root);

	FBXIO::VSkinBone arm = MakeBone("arm", 0, 100, 0, 0);
	Turn(arm.m_PreRotation, 40, 0, 1, 0);
	Turn(arm.m_Local, 25, 1, 0, 0);
	arm.m_Global = root.m_Global;
	Move(arm.m_Global, 100, 0, 0);
	Turn(arm.m_Global, 70, 0.6f, 0, 0.8f);
	Scale(arm.m_Global, 2, 2, 2);
	bones.push_back(arm);

	FBXIO::VSkinBone hand = MakeBone("hand", 1, 0, 50, 0);
	hand.m_Global = arm.m_Global;
	Move(hand.m_Global, 0, 50, 0);
	Turn(hand.m_Global, -30, 0, 1, 0);
	bones.push_back(hand);
	return bones;
}

VSubjectParametrised BuildScaled(const FBXIO::VSkinSkeleton& i_rBones, double i_Scale)
{
	VSubjectParametrised subject;
	CoreOrlexTypes::VSubjectApplicationData applicationData;
	RetargetSetup::BuildTargetSubject(i_rBones, subject, applicationData, 0);
	RetargetSetup::SetGlobalScale(subject, i_Scale);
	return subject;
}

std::vector<Rotation::VPose<double>> BindPoses(const VSubjectParametrised& i_rSubject)
{
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, subject);
	const auto pFK = RetargetSetup::KinematicsInBindPose(i_rSubject, subject, "target");
	return pFK ? RetargetSetup::SegmentPoses(*pFK) : std::vector<Rotation::VPose<double>>();
}

Rotation::VMatrix4 YUp()
{
	Rotation::VMatrix4 axis;
	Turn(axis, 90, 1, 0, 0);
	return axis;
}

TEST(FilePose, PosesAreTurnedToZUpAndScaledFromTheRoot)
{
	const auto poses = RetargetSetup::PosesInFile(ScaledArm(), YUp(), 3.0);
	ASSERT_EQ(poses.size(), 3u);
	// (10, 20, 30) with Y up is (10, -30, 20); the arm lies 100 along the file's Y, which is up.
	const Rotation::VVector3 expected[] = {{10, -30, 20}, {10, -30, 320}};
	for (std::size_t i = 0; i < 2; ++i)
		for (std::size_t axis = 0; axis < 3; ++axis)
			EXPECT_NEAR(poses[i].t[axis], expected[i][axis], 1e-3) << i << axis;
	EXPECT_NEAR(std::hypot(poses[2].t[0] - 10, poses[2].t[1] + 30, poses[2].t[2] - 320), 3.0 * 100.0, 1e-3)
	    << "50 in a bone scaled by 2";
	for (const auto& rPose : poses)
		EXPECT_NEAR(Rotation::Determinant(rPose.R), 1.0, 1e-12) << "no scale is left";
}

TEST(FilePose, AMirroredBoneKeepsItsFirstTwoAxes)
{
	FBXIO::VSkinSkeleton bones{MakeBone("root", -1)};
	Scale(bones[0].m_Global, 2, 3, -4);
	const auto poses = RetargetSetup::PosesInFile(bones, Rotation::VMatrix4(), 1.0);
	EXPECT_EQ(poses[0].R, Rotation::c_Identity3);
	Scale(bones[0].m_Global, 0, 1, 1);
	EXPECT_EQ(RetargetSetup::PosesInFile(bones, Rotation::VMatrix4(), 1.0)[0].R, Rotation::c_Identity3)
	    << "no direction at all";
}

TEST(FilePose, MatchingReachesPoseAndLengths)
{
	const FBXIO::VSkinSkeleton bones = ScaledArm();
	for (const double scale : {1.0, 0.25})
	{
		VSubjectParametrised subject = BuildScaled(bones, scale);
		const auto expected = RetargetSetup::PosesInFile(bones, YUp(), scale);
		ASSERT_TRUE(RetargetSetup::WorstPoseDifference(expected, BindPoses(subject)));
		const RetargetSetup::VFileMatch match = RetargetSetup::MatchFilePose(subject, bones, YUp());
		EXPECT_EQ(match.m_Lengths, std::vector<std::size_t>{2}) << "the arm's length was the file's";
		EXPECT_TRUE(match.m_PreRotations.empty());
		EXPECT_FALSE(RetargetSetup::WorstPoseDifference(expected, BindPoses(subject)));
		EXPECT_EQ(subject.m_Segments[1].m_PreTranslation[0], "100.000000*GlobalScale") << "as it was built";
		EXPECT_EQ(subject.m_Segments[2].m_PreTranslation[1].substr(0, 9), "100.00000") << "in single precision";
		for (const auto& rSegment : subject.m_Segments)
			EXPECT_EQ(rSegment.m_Joint.m_Mean, rSegment.m_Joint.m_BindPose);
	}
}

TEST(FilePose, MatchingTurnsSegmentsWithoutAJointByTheirPreRotation)
{
	const FBXIO::VSkinSkeleton bones = ScaledArm();
	VSubjectParametrised subject = BuildScaled(bones, 1.0);
	CoreOrlexQRTIO::VSubjectQRTExtras extras;
	subject.m_Targets.emplace_back().m_SegmentIndices = {2};
	RetargetSetup::RemoveJoints(subject, extras, RetargetSetup::JointsWithoutTargets(subject));
	const RetargetSetup::VFileMatch match = RetargetSetup::MatchFilePose(subject, bones, YUp());
	EXPECT_EQ(match.m_PreRotations, std::vector<std::size_t>{1});
	EXPECT_TRUE(subject.m_Segments[1].m_Joint.m_BindPose.empty());
	EXPECT_FALSE(RetargetSetup::WorstPoseDifference(RetargetSetup::PosesInFile(bones, YUp(), 1.0), BindPoses(subject)));
}

TEST(FilePose, MatchingAnotherSkeletonChangesNothing)
{
	VSubjectParametrised subject = BuildScaled(ScaledArm(), 1.0);
	const VSubjectParametrised before = subject;
	const RetargetSetup::VFileMatch match =
	    RetargetSetup::MatchFilePose(subject, {MakeBone("root", -1)}, Rotation::VMatrix4());
	EXPECT_TRUE(match.m_Lengths.empty());
	EXPECT_TRUE(subject == before);
}

} // namespace
