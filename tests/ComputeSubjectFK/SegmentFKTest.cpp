#include "ReferenceFK.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/JointFKInterfaces.h"

#include <gtest/gtest.h>

#include <numbers>

namespace
{

using namespace ComputeSubject;
using namespace Reference;

TEST(SegmentFK, FreeRootAtZeroIsExactlyTheIdentity)
{
	VSubject subject;
	subject.m_Segments = {Segment(c_NoParent, VJointTypes::EFree)};
	VComputeSubjectFK fk(subject);
	ASSERT_EQ(fk.NumberOfStates(), 6u);
	const double state[6]{};
	fk.Update(state);
	EXPECT_EQ(fk.Segment(0).WorldPose().R, Rotation::c_Identity3);
	EXPECT_EQ(fk.Segment(0).WorldPose().t, (Rotation::VVector3{}));
}

TEST(SegmentFK, HingeTurnsAboutTheAxisThatZTurnsInto)
{
	// A quarter turn about X carries Z to -Y, so that the hinge turns X towards Z.
	VSubject subject;
	subject.m_Segments = {Segment(c_NoParent, VJointTypes::EHinge)};
	subject.m_Segments[0].m_Joint.m_JointOrientation = {c_Pi / 2, 0, 0};
	VComputeSubjectFK fk(subject);
	const double state[] = {c_Pi / 2};
	fk.Update(state);
	const Rotation::VVector3 turned = Rotation::Apply(fk.Segment(0).SegmentPose(), {1, 0, 0});
	EXPECT_LT(Difference(turned, Eigen::Vector3d(0, 0, 1)), 1e-15);
	const Rotation::VVector3 axis = Rotation::Apply(fk.Segment(0).SegmentPose(), {0, 1, 0});
	EXPECT_LT(Difference(axis, Eigen::Vector3d(0, 1, 0)), 1e-15);
}

TEST(SegmentFK, ArmOfTwoHinges)
{
	// 300 mm along X, then 200 mm: shoulder up by 90 degrees, elbow back down by 90.
	VSubject subject;
	subject.m_Segments = {Segment(c_NoParent, VJointTypes::EHinge), Segment(0, VJointTypes::EHinge, {300, 0, 0}),
	    Segment(1, VJointTypes::EDummy, {200, 0, 0})};
	VComputeSubjectFK fk(subject);
	ASSERT_EQ(fk.NumberOfStates(), 2u);
	const double state[] = {c_Pi / 2, -c_Pi / 2};
	fk.Update(state);
	EXPECT_LT(Difference(fk.Segment(1).SegmentPose().t, Eigen::Vector3d(0, 300, 0)), 1e-12);
	EXPECT_LT(Difference(fk.Segment(2).SegmentPose().t, Eigen::Vector3d(200, 300, 0)), 1e-12);
}

TEST(SegmentFK, TreeLinks)
{
	VSubject subject;
	subject.m_Segments = {Segment(5, VJointTypes::EDummy), Segment(0, VJointTypes::EDummy),
	    Segment(1, VJointTypes::EDummy), Segment(0, VJointTypes::EDummy)};
	const VComputeSubjectFK fk(subject);
	ASSERT_EQ(fk.NumberOfSegments(), 4u);
	// The root has no parent whatever its index says.
	EXPECT_EQ(fk.Segment(0).Parent(), nullptr);
	EXPECT_EQ(fk.Segment(2).Parent(), &fk.Segment(1));
	EXPECT_EQ(fk.Segment(3).ParentBase(), &fk.Segment(0));
	const std::uint32_t depths[] = {1, 2, 3, 2};
	for (std::size_t i = 0; i < 4; ++i)
		EXPECT_EQ(fk.Segment(i).TreeDepth(), depths[i]) << i;
	EXPECT_THROW(fk.Segment(4), std::out_of_range);
}

/// Random trees of all joint types against the naive evaluation, with the relations between the poses of a segment.
TEST(SegmentFK, RandomTreesAgreeWithHomogeneousMatrices)
{
	std::mt19937 random(20240607);
	for (int tree = 0; tree < 100; ++tree)
	{
		const VSubject subject = RandomSubject(random, 1 + tree % 23);
		const std::vector<double> state = RandomState(random, subject, 4.0);
		VComputeSubjectFK fk(subject);
		ASSERT_EQ(fk.NumberOfStates(), state.size());
		fk.Update(state.data());
		for (std::size_t i = 0; i < subject.m_Segments.size(); ++i)
		{
			SCOPED_TRACE(std::to_string(tree) + ": " + std::to_string(i));
			const IComputeSegmentFK& rSegment = fk.Segment(i);
			const Eigen::Isometry3d world = WorldPose(subject, state, i);
			ASSERT_LT(Difference(rSegment.WorldPose(), world), 1e-9);
			ASSERT_LT(Difference(rSegment.SegmentPose(), SegmentPose(subject, state, i)), 1e-9);
			Rotation::VPose<double> inPlace;
			rSegment.SegmentPose(inPlace);
			EXPECT_EQ(inPlace.R, rSegment.SegmentPose().R);
			EXPECT_EQ(inPlace.t, rSegment.SegmentPose().t);

			const Eigen::Isometry3d parentWorld = rSegment.Parent()
			    ? WorldPose(subject, state, subject.m_Segments[i].m_ParentSegmentIndex)
			    : Eigen::Isometry3d::Identity();
			Rotation::VPose<double> motion;
			rSegment.JointBase().GetPose(motion);
			ASSERT_LT(Difference(Rotation::Compose(rSegment.JointBasePose(), motion), world), 1e-9);
			ASSERT_LT(Difference(rSegment.LocalPose(), parentWorld.inverse() * world), 1e-9);
			const Rotation::VPose<double> base = rSegment.Parent()
			    ? Rotation::Compose(rSegment.Parent()->WorldPose(), rSegment.JointBasePoseInParent())
			    : rSegment.JointBasePoseInParent();
			ASSERT_LT(Difference(Rotation::Compose(base, motion), world), 1e-9);
		}
	}
}

/// Many frames at once are the same numbers as one after the other, also where an angle is nothing or beyond half a
/// turn, where a frame is left over, and on several threads.
TEST(SegmentFK, ManyFramesAreEachAsAlone)
{
	std::mt19937 random(20241122);
	for (const auto& [segments, frames, threads] : {std::array<unsigned, 3>{9, 1, 1}, {23, 7, 1}, {23, 401, 3}})
	{
		const VSubject subject = RandomSubject(random, segments);
		VComputeSubjectFK fk(subject);
		std::vector<double> states(fk.NumberOfStates(), 0.0);
		while (states.size() < frames * fk.NumberOfStates())
			for (const double value : RandomState(random, subject, 4.0))
				states.push_back(value);
		std::vector<Rotation::VPose<double>> poses(frames * segments + 1);
		fk.UpdateMany(states, poses, threads);
		for (std::size_t frame = 0; frame < frames; ++frame)
		{
			fk.Update(&states[frame * fk.NumberOfStates()]);
			for (std::size_t i = 0; i < segments; ++i)
			{
				ASSERT_EQ(poses[frame * segments + i].R, fk.Segment(i).SegmentPose().R) << frame << ": " << i;
				ASSERT_EQ(poses[frame * segments + i].t, fk.Segment(i).SegmentPose().t) << frame << ": " << i;
			}
		}
		EXPECT_EQ(poses.back().R, Rotation::c_Identity3) << "what is beyond the last whole frame stays";
	}
}

TEST(SegmentFK, NormaliseStateKeepsThePoses)
{
	std::mt19937 random(3);
	for (int tree = 0; tree < 20; ++tree)
	{
		const VSubject subject = RandomSubject(random, 12);
		std::vector<double> state = RandomState(random, subject, 20.0);
		VComputeSubjectFK fk(subject);
		fk.Update(state.data());
		const VComputeSubjectFK before(fk);
		fk.NormaliseState(state.data());
		fk.Update(state.data());
		for (std::size_t i = 0; i < subject.m_Segments.size(); ++i)
			for (int k = 0; k < 9; ++k)
				ASSERT_NEAR(fk.Segment(i).WorldPose().R[k], before.Segment(i).WorldPose().R[k], 1e-12);
		const std::vector<double> once = state;
		fk.NormaliseState(state.data());
		for (std::size_t i = 0; i < state.size(); ++i)
			ASSERT_NEAR(state[i], once[i], 1e-14);
	}
}

} // namespace
