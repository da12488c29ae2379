#include "TesselPluginRetargetSetup/ManipulatorMove.h"

#include "../LogRecorder.h"
#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "InMemoryHost/Application.h"
#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/Mirror.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupDocument/RetargetSetup.h"

#include <Eigen/Geometry>
#include <boost/filesystem/operations.hpp>
#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

constexpr double c_Quarter = std::numbers::pi / 2;

QMatrix4x4 Place(float i_X, float i_Y, float i_Z, float i_Degrees = 0.0f, QVector3D i_Axis = {0, 0, 1})
{
	QMatrix4x4 matrix;
	matrix.translate(i_X, i_Y, i_Z);
	matrix.rotate(i_Degrees, i_Axis);
	return matrix;
}

void ExpectNear(const std::vector<double>& i_rActual, const std::vector<double>& i_rExpected)
{
	ASSERT_EQ(i_rActual.size(), i_rExpected.size());
	for (std::size_t i = 0; i < i_rActual.size(); ++i)
		EXPECT_NEAR(i_rActual[i], i_rExpected[i], 1e-5) << i;
}

/// hips with two arms, one on each side.
VSubjectParametrised Subject()
{
	VSubjectParametrised subject;
	subject.m_Segments.resize(3);
	const char* const names[] = {"hips", "armLeft", "armRight"};
	for (std::size_t i = 0; i < 3; ++i)
	{
		subject.m_Segments[i].m_Name = names[i];
		subject.m_Segments[i].m_Joint.m_JointType =
		    i == 0 ? VSubjectParametrised::VJoint::EFree : VSubjectParametrised::VJoint::EBall;
		// That of the right arm is missing.
		subject.m_Segments[i].m_Joint.m_BindPose.assign(i == 0 ? 6 : i == 1 ? 3 : 0, 0.125);
	}
	return subject;
}

QMatrix4x4 Frame(std::size_t i_Segment)
{
	return i_Segment == 0 ? Place(0, 0, 1000) : Place(i_Segment == 1 ? 200.0f : -200.0f, 0, 1400);
}

TEST(ManipulatorMove, JointFrameIsTheParentsPlaceThenTheSegmentsOwn)
{
	VSubject::VSegment segment;
	segment.m_PreRotation = {0.0, 0.0, c_Quarter};
	segment.m_PreTranslation = {10.0, 20.0, 30.0};
	const QMatrix4x4 frame = RetargetSetup::JointFrame(Place(1, 2, 3, 90), segment);
	const QVector3D origin = frame.map(QVector3D(0, 0, 0));
	EXPECT_LT((origin - QVector3D(1 - 20, 2 + 10, 33)).length(), 1e-4f);
	EXPECT_LT((frame.mapVector(QVector3D(1, 0, 0)) - QVector3D(-1, 0, 0)).length(), 1e-5f) << "two quarter turns";
}

TEST(ManipulatorMove, TheRootMovesAndTurnsAndOthersOnlyTurn)
{
	VSubjectParametrised subject = Subject();
	EXPECT_TRUE(RetargetSetup::MoveSegment(subject, 0, Place(5, 6, 1007, 90), Frame(0), {}, Frame));
	ExpectNear(subject.m_Segments[0].m_Joint.m_BindPose, {0, 0, c_Quarter, 5, 6, 7});
	EXPECT_EQ(subject.m_Segments[0].m_Joint.m_Mean, subject.m_Segments[0].m_Joint.m_BindPose);
	ExpectNear(subject.m_Segments[1].m_Joint.m_BindPose, {0.125, 0.125, 0.125});

	EXPECT_TRUE(RetargetSetup::MoveSegment(subject, 1, Place(999, 6, 1007, 90, {1, 0, 0}), Frame(1), {}, Frame));
	ExpectNear(subject.m_Segments[1].m_Joint.m_BindPose, {c_Quarter, 0, 0});
	ExpectNear(subject.m_Segments[2].m_Joint.m_BindPose, {});

	EXPECT_FALSE(RetargetSetup::MoveSegment(subject, 3, {}, {}, {2}, Frame));
}

TEST(ManipulatorMove, TheOtherSideIsMirroredAcrossThePlaneBetweenTheJoints)
{
	struct VCase
	{
		const char* m_pName;
		QVector3D m_Axis;
		std::vector<double> m_Mirrored;
	};
	// The joints lie on the X axis of the world: a turn about it is the same on both sides, one across it turns round.
	const VCase cases[] = {
	    {"along the line", {1, 0, 0}, {c_Quarter, 0, 0}},
	    {"across the line", {0, 1, 0}, {0, -c_Quarter, 0}},
	    {"upright", {0, 0, 1}, {0, 0, -c_Quarter}},
	};
	for (const VCase& rCase : cases)
	{
		SCOPED_TRACE(rCase.m_pName);
		VSubjectParametrised subject = Subject();
		ASSERT_TRUE(
		    RetargetSetup::MoveSegment(subject, 1, Place(200, 0, 1400, 90, rCase.m_Axis), Frame(1), {2}, Frame));
		ExpectNear(subject.m_Segments[2].m_Joint.m_BindPose, rCase.m_Mirrored);
		EXPECT_EQ(subject.m_Segments[2].m_Joint.m_Mean, subject.m_Segments[2].m_Joint.m_BindPose);
	}
}

TEST(ManipulatorMove, TheMirrorIsMeasuredInTheOtherJointsOwnFrame)
{
	const auto turnedFrame = [](std::size_t i_Segment)
	{ return i_Segment == 2 ? Place(-200, 0, 1400, 90) : Frame(i_Segment); };
	VSubjectParametrised subject = Subject();
	ASSERT_TRUE(RetargetSetup::MoveSegment(subject, 1, Place(200, 0, 1400, 90, {1, 0, 0}), Frame(1), {2}, turnedFrame));
	// The world's X axis is the negative Y axis of a frame that is turned by a quarter about Z.
	ExpectNear(subject.m_Segments[2].m_Joint.m_BindPose, {0, -c_Quarter, 0});
}

TEST(ManipulatorMove, JointsInOnePlaceTurnTheRotationRound)
{
	VSubjectParametrised::VSegment mirror;
	mirror.m_Joint.m_BindPose = {0.0, 0.0};
	RetargetSetup::PoseMirrorSegment(mirror, {}, Place(0, 0, 0, 90, {0, 1, 0}), Place(0, 0.0009f, 0), {}, {});
	ExpectNear(mirror.m_Joint.m_BindPose, {0, -c_Quarter});
}

using Poses = std::vector<Rotation::VPose<double>>;

Poses PosesOf(const VSubjectParametrised& i_rSubject)
{
	VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, subject);
	return RetargetSetup::SegmentPoses(*RetargetSetup::KinematicsInBindPose(i_rSubject, subject, "target"));
}

Eigen::Isometry3d Isometry(const Rotation::VPose<double>& i_rPose)
{
	Eigen::Isometry3d isometry = Eigen::Isometry3d::Identity();
	isometry.linear() = Eigen::Matrix<double, 3, 3, Eigen::RowMajor>(i_rPose.R.data());
	isometry.translation() = Eigen::Map<const Eigen::Vector3d>(i_rPose.t.data());
	return isometry;
}

QMatrix4x4 ToQt(const Eigen::Isometry3d& i_rPose)
{
	const Eigen::Matrix4f columns = i_rPose.matrix().cast<float>();
	return QMatrix4x4(columns.data()).transposed();
}

/// A segment is turned by one degree. How far the other side is away from the mirror image of that turn, in degrees;
/// nothing if the two joints coincide.
double MissedMirror(
    const VRetargetSetup::VSubjectValues& i_rAtRest, std::size_t i_Segment, std::size_t i_Mirror, bool i_bByRule)
{
	const Poses atRest = PosesOf(*i_rAtRest.m_pParametrised);
	const Eigen::Isometry3d from = Isometry(atRest[i_Segment]);
	const Eigen::Isometry3d mirrorFrom = Isometry(atRest[i_Mirror]);
	const Eigen::Vector3d between = from.translation() - mirrorFrom.translation();
	if (between.norm() < 1.0)
		return 0.0;
	const Eigen::AngleAxisd turn(M_PI / 180.0, Eigen::Vector3d(1, 2, -3).normalized());
	Eigen::Isometry3d dragged = from;
	dragged.linear() = turn * from.linear();
	VSubjectParametrised subject = *i_rAtRest.m_pParametrised;
	const bool bMirrorsChange = i_bByRule
	    && !RetargetSetup::AreMirrorImages(*i_rAtRest.m_pParametrised, *i_rAtRest.m_pSubject, i_Segment, i_Mirror);
	RetargetSetup::MoveSegment(subject, i_Segment, ToQt(dragged), ToQt(from), {std::int32_t(i_Mirror), bMirrorsChange},
	    [&](std::size_t i_Index)
	    {
		    const VSubject::VSegment& rSegment = i_rAtRest.m_pSubject->m_Segments[i_Index];
		    const std::uint32_t parent = rSegment.m_ParentSegmentIndex;
		    return RetargetSetup::JointFrame(
		        parent == CoreOrlexTypes::c_NoParent ? QMatrix4x4() : ToQt(Isometry(atRest[parent])), rSegment);
	    });
	const Eigen::Vector3d normal = between.normalized();
	const Eigen::Matrix3d mirror = Eigen::Matrix3d::Identity() - 2.0 * normal * normal.transpose();
	const Eigen::Matrix3d expected = mirror * turn * mirror * mirrorFrom.linear();
	const Eigen::Matrix3d actual = Isometry(PosesOf(subject)[i_Mirror]).linear();
	return Eigen::AngleAxisd(actual * expected.transpose()).angle() * 180.0 / M_PI;
}

TEST(ManipulatorMove, OnEveryRigTheOtherSideFollowsASmallDrag)
{
	const VLogRecorder quiet;
	std::vector<std::string> files{RETARGET_SOURCE "/demo/character.fbx"};
	for (const auto& rEntry : boost::filesystem::directory_iterator(RETARGET_TEST_DATA "/fbx"))
		if (rEntry.path().extension() == ".fbx")
			files.push_back(rEntry.path().string());
	int jumpingRigs = 0;
	for (const std::string& rFile : files)
		for (const bool bPoseFromFile : {false, true})
		{
			SCOPED_TRACE(rFile);
			InMemoryHost::VPluginContext host;
			const auto pApplication = std::make_shared<InMemoryHost::VApplication>();
			pApplication->m_Rules.m_bPoseFromFile = bPoseFromFile;
			VRetargetSetup document(host.GetDispatcher(), host.GetFrameFactory(), host.GetItemFactory());
			document.SetHostRules(pApplication);
			if (!document.LoadTargetFBX(rFile))
				continue;
			document.CreateTargetSubject();
			double worst = 0.0, worstByPose = 0.0;
			const std::size_t size = document.TargetAtRest().m_pParametrised->m_Segments.size();
			for (std::size_t i = 0; i < size; ++i)
			{
				const std::int32_t mirror =
				    RetargetSetup::FindMirrorSegment(*document.TargetAtRest().m_pParametrised, i);
				if (mirror == -1)
					continue;
				worst = std::max(worst, MissedMirror(document.TargetAtRest(), i, std::size_t(mirror), true));
				worstByPose =
				    std::max(worstByPose, MissedMirror(document.TargetAtRest(), i, std::size_t(mirror), false));
			}
			EXPECT_LT(worst, 0.06);
			jumpingRigs += worstByPose > 1.0;
		}
	EXPECT_GE(jumpingRigs, 10) << "mirroring the pose itself turns the other side of some";
}

} // namespace
