#include "RetargetSetupCore/TargetConstruction.h"

#include "TestSubjects.h"

#include <gtest/gtest.h>

#include <numbers>

namespace
{

using namespace RetargetSetup;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using FBXIO::VSkinSkeleton;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

std::string NamesAndParents(const VSkinSkeleton& i_rSkeleton)
{
	std::string text;
	for (const FBXIO::VSkinBone& rBone : i_rSkeleton)
		text += rBone.m_Name + std::to_string(rBone.m_ParentIndex) + " ";
	return text;
}

TEST(ExtractSubtree, Rows)
{
	const VSkinSkeleton two = {MakeBone("a", -1), MakeBone("b", 0), MakeBone("c", 1), MakeBone("d", -1),
	    MakeBone("e", 0), MakeBone("f", 3), MakeBone("g", 1)};
	const VSkinSkeleton damaged = {
	    MakeBone("a", 0), MakeBone("b", 7), MakeBone("c", 0), MakeBone("d", 5), MakeBone("e", -9), MakeBone("f", 2)};
	const struct
	{
		const VSkinSkeleton& m_rSkeleton;
		std::size_t m_Root;
		const char* m_pExpected;
	} rows[] = {
	    {two, 0, "a-1 b0 c1 e0 g1 "},
	    {two, 1, "b-1 c0 g0 "},
	    {two, 3, "d-1 f0 "},
	    {two, 6, "g-1 "},
	    {two, 7, ""},
	    {two, std::size_t(-1), ""},
	    {damaged, 0, "a-1 c0 f1 "},
	};
	for (const auto& rRow : rows)
		EXPECT_EQ(NamesAndParents(ExtractSubtree(rRow.m_rSkeleton, rRow.m_Root)), rRow.m_pExpected) << rRow.m_Root;
}

TEST(ExtractSubtree, OnlyTheRootLosesItsPlace)
{
	const VSkinSkeleton subtree = ExtractSubtree({MakeBone("a", -1, 1), MakeBone("b", 0, 2), MakeBone("c", 1, 3)}, 1);
	EXPECT_EQ(subtree[0].m_Local, Rotation::VMatrix4());
	EXPECT_EQ(subtree[1].m_Local(0, 3), 3.0f);
}

TEST(StripNamespace, Rows)
{
	const std::pair<const char*, const char*> rows[] = {
	    {"Character1:Hips", "Hips"}, {"a:b:c", "c"}, {"ends:", ""}, {"plain", "plain"}, {"", ""}};
	for (const auto& [name, expected] : rows)
		EXPECT_EQ(StripNamespace(name), expected);
}

struct VBuilt
{
	VSubjectParametrised m_Subject;
	VSubjectApplicationData m_Data;
};

VBuilt Build(const VSkinSkeleton& i_rSkeleton, std::size_t i_Root = 0)
{
	VBuilt built;
	BuildTargetSubject(i_rSkeleton, built.m_Subject, built.m_Data, i_Root);
	return built;
}

TEST(BuildTargetSubject, SegmentsOfAChain)
{
	VSkinSkeleton bones = {
	    MakeBone("rig:Hips", -1, 5, 6, 7), MakeBone("rig:Spine", 0, 250, 0, -0.5f), MakeBone("Head", 1, 0, 12.25f, 0)};
	Turn(bones[0].m_PreRotation, 90, 0, 0, 1);
	Turn(bones[1].m_PreRotation, -90, 1, 0, 0);
	Turn(bones[1].m_Local, 90, 0, 1, 0);
	const auto [subject, data] = Build(bones);

	ASSERT_EQ(subject.m_Segments.size(), 3u);
	const auto& rSpine = subject.m_Segments[1];
	EXPECT_EQ(rSpine.m_Name, "Spine");
	EXPECT_EQ(rSpine.m_SegmentIndex, 1u);
	EXPECT_EQ(rSpine.m_ParentSegmentIndex, 0u);
	EXPECT_EQ(rSpine.m_TreeDepth, 1u);
	EXPECT_EQ(rSpine.m_PreTranslation,
	    (std::array<std::string, 3>{"250.000000*GlobalScale", "0.000000*GlobalScale", "-0.500000*GlobalScale"}));
	EXPECT_EQ(rSpine.m_PreRotation, (std::array<std::string, 3>{"-1.570796", "0.000000", "0.000000"}));
	EXPECT_EQ(rSpine.m_InversePostRotation, (std::array<double, 3>{}));
	EXPECT_EQ(rSpine.m_Joint.m_JointType, VJoint::EBall);
	ASSERT_EQ(rSpine.m_Joint.m_Mean.size(), 3u);
	EXPECT_NEAR(rSpine.m_Joint.m_Mean[1], std::numbers::pi / 2, 1e-6);
	EXPECT_EQ(rSpine.m_Joint.m_BindPose, rSpine.m_Joint.m_Mean);
	EXPECT_EQ(rSpine.m_Joint.m_Covariance, (std::vector<double>{10, 0, 0, 0, 10, 0, 0, 0, 10}));

	const auto& rRoot = subject.m_Segments[0];
	EXPECT_EQ(rRoot.m_ParentSegmentIndex, CoreOrlexTypes::c_NoParent);
	EXPECT_EQ(rRoot.m_Joint.m_JointType, VJoint::EFree);
	EXPECT_EQ(rRoot.m_Joint.m_Mean, std::vector<double>(6));
	EXPECT_EQ(rRoot.m_PreTranslation[0], "0.000000*GlobalScale");
	EXPECT_EQ(rRoot.m_PreRotation[2], "1.570796");
	EXPECT_EQ(subject.m_Segments[2].m_TreeDepth, 2u);

	ASSERT_EQ(data.m_Segments.size(), 3u);
	EXPECT_EQ(data.m_Segments[2].m_Colour, (CoreOrlexTypes::VColour{255, 0, 255, 255}));
}

TEST(BuildTargetSubject, LengthsGrowWithTheScaleAboveTheBone)
{
	VSkinSkeleton bones = {MakeBone("a", -1), MakeBone("b", 0, 100), MakeBone("c", 1, 100)};
	bones[0].m_AccumulatedScale = 2.5f;
	bones[1].m_AccumulatedScale = 5.0f;
	const auto [subject, data] = Build(bones);
	EXPECT_EQ(subject.m_Segments[1].m_PreTranslation[0], "250.000000*GlobalScale");
	EXPECT_EQ(subject.m_Segments[2].m_PreTranslation[0], "500.000000*GlobalScale");
}

TEST(BuildTargetSubject, TellsARotationThatIsLost)
{
	VSkinSkeleton bones = {MakeBone("a", -1), MakeBone("mirrored", 0, 3)};
	Scale(bones[1].m_Local, -1, 1, 1);
	VLogRecorder log;
	const auto [subject, data] = Build(bones);
	EXPECT_EQ(subject.m_Segments[1].m_Joint.m_BindPose, std::vector<double>(3));
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: The local transform of bone 'mirrored' is no rotation (negative or sheared "
	    "scale): it is lost and counts as none");
}

TEST(BuildTargetSubject, TwoBonesOfOneNameStayTwoAndARootOutOfRangeGivesNone)
{
	const VSkinSkeleton bones = {MakeBone("x:Hand", -1), MakeBone("y:Hand", 0)};
	EXPECT_EQ(Build(bones).m_Subject.m_Segments[1].m_Name, "Hand");
	EXPECT_EQ(Build(bones).m_Subject.m_Segments[0].m_Name, "Hand");
	EXPECT_TRUE(Build(bones, 2).m_Subject.m_Segments.empty());
	EXPECT_TRUE(Build(bones, 2).m_Data.m_Segments.empty());
}

} // namespace
