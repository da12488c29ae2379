#include "ReferenceFK.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"

#include <gtest/gtest.h>

#include <numbers>

namespace
{

using namespace ComputeSubject;
using namespace Reference;
using VTarget = VSubject::VTarget;
using VNumbers = std::vector<double>;
using Eigen::Vector3d;

/// Two segments with everything set, so that a pose left out shows.
VSubject Skeleton()
{
	std::mt19937 random(99);
	VSubject subject = RandomSubject(random, 2);
	subject.m_Segments[0].m_Joint.m_JointType = VJointTypes::EFree;
	subject.m_Segments[1].m_Joint.m_JointType = VJointTypes::EBall;
	return subject;
}

const std::vector<double> c_State = {0.3, -0.7, 0.2, 100.0, 200.0, -50.0, 1.1, 0.4, -0.6};

/// What carries a point of the segment frame of segment 1 into the world: its world pose after its post pose.
struct VExpected
{
	explicit VExpected(const VSubject& i_rSubject) : m_World(WorldPose(i_rSubject, c_State, 1))
	{
		const VSubject::VSegment& rSegment = i_rSubject.m_Segments[1];
		m_Post = Pose(rSegment.m_InversePostRotation, rSegment.m_InversePostTranslation)
		    * Pose(rSegment.m_Joint.m_JointOrientation, {});
		m_FromSegment = m_World * m_Post;
	}
	Eigen::Isometry3d m_World;
	Eigen::Isometry3d m_Post;
	Eigen::Isometry3d m_FromSegment;
};

VComputeSubjectFK Updated(const VSubject& i_rSubject)
{
	VComputeSubjectFK fk(i_rSubject);
	fk.Update(c_State.data());
	return fk;
}

TEST(TargetFK, PointGoesThroughPostAndWorld)
{
	for (const auto type : {VTarget::ELocalPointToWorldPoint, VTarget::ELocalPointToWorldPointGaussian})
	{
		VSubject subject = Skeleton();
		subject.m_Targets = {Target(type, 1, {10, -20, 30}, 0)};
		const VComputeSubjectFK fk = Updated(subject);
		const ITargetFK& rTarget = *fk.Target(0);
		EXPECT_EQ(rTarget.ComputeTargetFK()->TargetType(), type);
		EXPECT_EQ(rTarget.SingleMarker()->MarkerIdx(), 0u);
		EXPECT_LT(Difference(
		              rTarget.FromLocalPoint()->WorldPoint(), VExpected(subject).m_FromSegment * Vector3d(10, -20, 30)),
		    1e-10);
		EXPECT_EQ(rTarget.SingleRotationObservation(), nullptr);
		EXPECT_EQ(rTarget.MarkerGroup(), nullptr);
		EXPECT_EQ(rTarget.FromLocalLine(), nullptr);
		EXPECT_EQ(rTarget.FromLocalPlane(), nullptr);
		EXPECT_EQ(rTarget.FromLocalRotation(), nullptr);
		EXPECT_EQ(rTarget.FromPointGroup(), nullptr);
	}
}

TEST(TargetFK, LineGivesBothPoints)
{
	VSubject subject = Skeleton();
	subject.m_Targets = {Target(VTarget::ELocalLineToWorldPointGaussian, 1, {1, 2, 3, -40, 50, 60}, 0)};
	const VComputeSubjectFK fk = Updated(subject);
	const auto& rLine = fk.Target(0)->FromLocalLine();
	ASSERT_TRUE(rLine);
	const VExpected expected(subject);
	EXPECT_LT(Difference(rLine->WorldPoint1(), expected.m_FromSegment * Vector3d(1, 2, 3)), 1e-10);
	EXPECT_LT(Difference(rLine->WorldPoint2(), expected.m_FromSegment * Vector3d(-40, 50, 60)), 1e-10);
}

TEST(TargetFK, PlaneHoldsItsPointsForANormalOfAnyLength)
{
	for (const double length : {1.0, 2.0, 1e-3})
	{
		VSubject subject = Skeleton();
		const Vector3d origin(5, 6, 7);
		const Vector3d normal = Vector3d(1, 2, 2) / 3.0;
		const Vector3d within = normal.unitOrthogonal();
		subject.m_Targets = {Target(VTarget::ELocalPlaneToWorldPoint, 1,
		    {5, 6, 7, length * normal[0], length * normal[1], length * normal[2]}, 0)};
		const VComputeSubjectFK fk = Updated(subject);
		const auto& rPlane = fk.Target(0)->FromLocalPlane();
		ASSERT_TRUE(rPlane);
		const VExpected expected(subject);
		EXPECT_LT(Difference(rPlane->WorldNormal(), expected.m_FromSegment.linear() * normal), 1e-12);
		const Vector3d worldNormal(rPlane->WorldNormal().data());
		const auto height = [&](const Vector3d& i_rPoint)
		{ return worldNormal.dot(expected.m_FromSegment * i_rPoint) + rPlane->WorldOffset(); };
		EXPECT_NEAR(height(origin), 0.0, 1e-10);
		EXPECT_NEAR(height(origin + 100.0 * within), 0.0, 1e-10);
		EXPECT_NEAR(height(origin + 10.0 * normal), 10.0, 1e-10);
	}
}

TEST(TargetFK, PlaneWithoutNormalStaysFinite)
{
	VSubject subject = Skeleton();
	subject.m_Targets = {Target(VTarget::ELocalPlaneToWorldPoint, 1, {5, 6, 7, 0, 0, 0}, 0)};
	const VComputeSubjectFK fk = Updated(subject);
	EXPECT_EQ(fk.Target(0)->FromLocalPlane()->WorldNormal(), (Rotation::VVector3{}));
	EXPECT_EQ(fk.Target(0)->FromLocalPlane()->WorldOffset(), 0.0);
}

TEST(TargetFK, RigidBodyCarriesItsMarkers)
{
	VSubject subject = Skeleton();
	subject.m_Targets = {Target(VTarget::ERigidBody, 1, {10, 20, 30, 0, 0, c_Pi / 2, 1, 0, 0, 0, 2, 0}, 0)};
	subject.m_Targets[0].m_MarkerIndices = {1, 0};
	const VComputeSubjectFK fk = Updated(subject);
	const ITargetFK& rTarget = *fk.Target(0);
	ASSERT_TRUE(rTarget.MarkerGroup() && rTarget.FromPointGroup());
	EXPECT_EQ(rTarget.SingleMarker(), nullptr);
	const VExpected expected(subject);
	// A quarter turn about Z carries (1, 0, 0) to (0, 1, 0) and (0, 2, 0) to (-2, 0, 0).
	const Vector3d points[] = {{10, 21, 30}, {8, 20, 30}};
	ASSERT_EQ(rTarget.FromPointGroup()->LocalPoints().size(), 2u);
	for (std::size_t i = 0; i < 2; ++i)
	{
		EXPECT_LT(Difference(rTarget.FromPointGroup()->LocalPoints()[i], Vector3d(expected.m_Post * points[i])), 1e-10);
		EXPECT_LT(Difference(rTarget.FromPointGroup()->WorldPoint(i), expected.m_FromSegment * points[i]), 1e-10);
	}
	EXPECT_LT(
	    Difference(rTarget.FromPointGroup()->WorldOrigin(), expected.m_FromSegment * Vector3d(10, 20, 30)), 1e-10);

	std::vector<Rotation::VVector3> markers;
	EXPECT_TRUE(fk.ComputeMarkers(markers));
	EXPECT_LT(Difference(markers[1], expected.m_FromSegment * points[0]), 1e-10);
	EXPECT_LT(Difference(markers[0], expected.m_FromSegment * points[1]), 1e-10);
}

TEST(TargetFK, RotationIsThePostTransposedTimesOrientationTimesState)
{
	for (const std::vector<double>& rOrientation : {std::vector<double>{}, std::vector<double>{0.5, 0.1, -0.9}})
	{
		VSubject subject = Skeleton();
		subject.m_Targets = {Target(VTarget::ELocalRotationToWorldRotation, 1, {0.2, -1.3, 0.4}, 0)};
		subject.m_Targets[0].m_RotationTargetOrientation = rOrientation;
		const VComputeSubjectFK fk = Updated(subject);
		const VExpected expected(subject);
		const Eigen::Matrix3d orientation = rOrientation.empty()
		    ? Eigen::Matrix3d(Eigen::Matrix3d::Identity())
		    : Pose({rOrientation[0], rOrientation[1], rOrientation[2]}, {}).linear();
		const Eigen::Matrix3d rotation = expected.m_World.linear() * expected.m_Post.linear().transpose() * orientation
		    * Pose({0.2, -1.3, 0.4}, {}).linear();
		EXPECT_LT(Difference(fk.Target(0)->FromLocalRotation()->WorldRotation(), rotation), 1e-13);
		std::vector<Rotation::VMatrix3> rotations;
		EXPECT_TRUE(fk.ComputeRotations(rotations));
		ASSERT_EQ(rotations.size(), 1u);
		EXPECT_LT(Difference(rotations[0], rotation), 1e-13);
	}
}

/// One segment at the origin that never moves: points are their states.
VSubject Still(std::vector<VTarget> i_Targets)
{
	VSubject subject;
	subject.m_Segments = {Segment(CoreOrlexTypes::c_NoParent, VJointTypes::EDummy)};
	subject.m_Targets = std::move(i_Targets);
	return subject;
}

VTarget Weighted(VTarget i_Target, double i_Weight)
{
	i_Target.m_Weight = i_Weight;
	return i_Target;
}

struct VMarkersRow
{
	const char* m_pName;
	std::vector<VTarget> m_Targets;
	bool m_bAllHaveWeight;
	std::vector<Rotation::VVector3> m_Positions;
	std::vector<std::string> m_Assertions;
};

constexpr auto c_Point = VTarget::ELocalPointToWorldPoint;
constexpr char c_MarkerInRange[] = "rTgtToPoint->MarkerIdx() < io_rPositions.size()";

const VMarkersRow c_MarkerRows[] = {
    {"NoTargets", {}, true, {}, {}},
    {"WeightedMean", {Weighted(Target(c_Point, 0, {0, 4, 8}, 0), 1.0), Weighted(Target(c_Point, 0, {4, 4, 0}, 0), 3.0)},
        true, {{3, 4, 2}}, {}},
    {"NoWeightStaysAtTheOrigin", {Weighted(Target(c_Point, 0, {1, 2, 3}, 0), 0.0), Target(c_Point, 0, {4, 5, 6}, 1)},
        false, {{0, 0, 0}, {4, 5, 6}}, {}},
    {"NotANumberIsNoWeight", {Weighted(Target(c_Point, 0, {1, 2, 3}, 0), std::nan(""))}, false, {{0, 0, 0}}, {}},
    {"PlaneAloneGivesNoPoint", {Target(VTarget::ELocalPlaneToWorldPoint, 0, {1, 2, 3, 0, 0, 1}, 0)}, false, {{0, 0, 0}},
        {}},
    {"PlaneHasNoShareInTheMean",
        {Target(c_Point, 0, {1, 2, 3}, 0), Target(VTarget::ELocalPlaneToWorldPoint, 0, {9, 9, 9, 0, 0, 1}, 0)}, true,
        {{1, 2, 3}}, {}},
    {"IndexBeyondTheListIsLeftOut", {Target(c_Point, 0, {1, 2, 3}, 0), Target(c_Point, 0, {4, 5, 6}, 7)}, false,
        {{1, 2, 3}, {0, 0, 0}}, {c_MarkerInRange, c_MarkerInRange}},
};

TEST(TargetFK, ComputeMarkers)
{
	for (const VMarkersRow& rRow : c_MarkerRows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VComputeSubjectFK fk(Still(rRow.m_Targets));
		fk.Update(nullptr);
		const VAssertions assertions;
		std::vector<Rotation::VVector3> positions(5, {7, 7, 7});
		EXPECT_EQ(fk.ComputeMarkers(positions), rRow.m_bAllHaveWeight);
		EXPECT_EQ(positions, rRow.m_Positions);
		EXPECT_EQ(assertions.Take(), rRow.m_Assertions);
	}
}

TEST(TargetFK, GroupIndexBeyondTheListIsLeftOut)
{
	VTarget body = Target(VTarget::ERigidBody, 0, {0, 0, 0, 0, 0, 0, 1, 2, 3, 4, 5, 6}, 0);
	body.m_MarkerIndices = {0, 9};
	VComputeSubjectFK fk(Still({body}));
	fk.Update(nullptr);
	EXPECT_FALSE(fk.IsValid());
	const VAssertions assertions;
	std::vector<Rotation::VVector3> positions;
	EXPECT_FALSE(fk.ComputeMarkers(positions));
	EXPECT_EQ(positions, (std::vector<Rotation::VVector3>{{1, 2, 3}, {0, 0, 0}}));
	EXPECT_EQ(assertions.Take(), (std::vector<std::string>(2, "rIdx < io_rPositions.size()")));
}

TEST(TargetFK, ComputeRotationsTakesTheLast)
{
	constexpr auto c_Rotation = VTarget::ELocalRotationToWorldRotation;
	VComputeSubjectFK fk(Still({Target(c_Rotation, 0, {1, 0, 0}, 0), Target(c_Rotation, 0, {0, 0, c_Pi / 2}, 0),
	    Target(c_Rotation, 0, {1, 1, 0}, 4)}));
	fk.Update(nullptr);
	std::vector<Rotation::VMatrix3> rotations;
	// Observation 4 lies beyond the two that are named, so that the second entry has no target.
	EXPECT_FALSE(fk.ComputeRotations(rotations));
	ASSERT_EQ(rotations.size(), 2u);
	EXPECT_LT(Difference(rotations[0], Pose({0, 0, c_Pi / 2}, {}).linear()), 1e-15);
	EXPECT_EQ(rotations[1], Rotation::c_Identity3);
}

const VTarget c_GoodPoint = Target(c_Point, 0, {1, 2, 3}, 0);
const VTarget c_GoodPlane = Target(VTarget::ELocalPlaneToWorldPoint, 0, {1, 2, 3, 0, 0, 1}, 0);
const VTarget c_GoodLine = Target(VTarget::ELocalLineToWorldPoint, 0, {1, 2, 3, 0, 0, 1}, 0);
const VTarget c_GoodRotation = Target(VTarget::ELocalRotationToWorldRotation, 0, {1, 2, 3}, 0);
const VTarget c_GoodBody = []
{
	VTarget body = Target(VTarget::ERigidBody, 0, VNumbers(12, 1.0), 0);
	body.m_MarkerIndices = {0, 1};
	return body;
}();

template <typename T>
VTarget With(VTarget i_Target, std::vector<T> VTarget::*i_pList, std::vector<std::type_identity_t<T>> i_Values)
{
	i_Target.*i_pList = std::move(i_Values);
	return i_Target;
}

const std::pair<const char*, VTarget> c_Refused[] = {
    {"PointStateShort", With(c_GoodPoint, &VTarget::m_State, {1, 2})},
    {"PointStateLong", With(c_GoodPoint, &VTarget::m_State, {1, 2, 3, 4})},
    {"PointNoSegment", With(c_GoodPoint, &VTarget::m_SegmentIndices, {})},
    {"PointTwoSegments", With(c_GoodPoint, &VTarget::m_SegmentIndices, {0, 0})},
    {"PointSegmentOutOfRange", With(c_GoodPoint, &VTarget::m_SegmentIndices, {1})},
    {"PointNoMarker", With(c_GoodPoint, &VTarget::m_MarkerIndices, {})},
    {"PointTwoMarkers", With(c_GoodPoint, &VTarget::m_MarkerIndices, {0, 1})},
    {"PlaneStateShort", With(c_GoodPlane, &VTarget::m_State, {1, 2, 3, 0, 0})},
    {"PlaneStateLong", With(c_GoodPlane, &VTarget::m_State, {1, 2, 3, 0, 0, 1, 0})},
    {"LineStateShort", With(c_GoodLine, &VTarget::m_State, {1, 2, 3})},
    {"BodyOfOneMarker", With(With(c_GoodBody, &VTarget::m_MarkerIndices, {0}), &VTarget::m_State, VNumbers(9))},
    {"BodyStateShort", With(c_GoodBody, &VTarget::m_State, VNumbers(11))},
    {"RotationWithMarker", With(c_GoodRotation, &VTarget::m_MarkerIndices, {0})},
    {"RotationWithTwoObservations", With(c_GoodRotation, &VTarget::m_RotationObservationIndices, {0, 1})},
    {"RotationWithoutObservation", With(c_GoodRotation, &VTarget::m_RotationObservationIndices, {})},
    {"RotationOrientationOfTwo", With(c_GoodRotation, &VTarget::m_RotationTargetOrientation, {0, 1})},
    {"RotationStateShort", With(c_GoodRotation, &VTarget::m_State, {1, 2})},
};

TEST(TargetFK, UnfitTargetsAreRefused)
{
	const VAssertions assertions;
	EXPECT_NO_THROW(VComputeSubjectFK(Still({c_GoodPoint, c_GoodPlane, c_GoodLine, c_GoodRotation, c_GoodBody})));
	for (const auto& [pName, target] : c_Refused)
		EXPECT_THROW(VComputeSubjectFK(Still({target})), VConstructionException) << pName;
	EXPECT_EQ(assertions.Take(), (std::vector<std::string>{"StateIter == i_rTarget.m_State.end()"}));
}

TEST(TargetFK, TypesWithoutAClassStayNullAndAreSkipped)
{
	for (const auto type : {VTarget::EBadTargetType, VTarget::ELocalDirectionToWorldDirection,
	         static_cast<VTarget::ETargetType>(10), static_cast<VTarget::ETargetType>(-1)})
	{
		SCOPED_TRACE(type);
		const VAssertions assertions;
		VComputeSubjectFK fk(Still({Target(type, 0, {}, 3), c_GoodPoint, c_GoodRotation}));
		EXPECT_EQ(assertions.Take(), std::vector<std::string>{"m_Targets.back()"});
		ASSERT_EQ(fk.NumberOfTargets(), 3u);
		EXPECT_EQ(fk.Target(0), nullptr);
		EXPECT_EQ(fk.NumberOfMarkers(), 1u);
		EXPECT_EQ(fk.NumberOfRotations(), 1u);
		EXPECT_TRUE(fk.IsValid());
		fk.Update(nullptr);
		std::vector<Rotation::VVector3> markers;
		std::vector<Rotation::VMatrix3> rotations;
		EXPECT_TRUE(fk.ComputeMarkers(markers));
		EXPECT_TRUE(fk.ComputeRotations(rotations));
		EXPECT_EQ(markers, (std::vector<Rotation::VVector3>{{1, 2, 3}}));
		const VComputeSubjectFK copy(fk);
		EXPECT_EQ(copy.Target(0), nullptr);
	}
}

} // namespace
