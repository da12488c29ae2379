#include "ReferenceFK.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/JointFKInterfaces.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"

#include <gtest/gtest.h>

#include <thread>

namespace
{

using namespace ComputeSubject;
using namespace Reference;
using VTarget = VSubject::VTarget;

struct VEmptyRow
{
	const char* m_pName;
	std::vector<std::uint32_t> m_Parents;
};

const VEmptyRow c_Empty[] = {
    {"NoSegments", {}},
    {"ParentPointsForward", {c_NoParent, 2, 0}},
    {"ParentIsItself", {c_NoParent, 1}},
    {"SecondRoot", {c_NoParent, 0, c_NoParent}},
};

TEST(SubjectFK, BrokenTreeIsEmpty)
{
	for (const VEmptyRow& rRow : c_Empty)
	{
		SCOPED_TRACE(rRow.m_pName);
		VSubject subject;
		for (const std::uint32_t parent : rRow.m_Parents)
			subject.m_Segments.push_back(Segment(parent, VJointTypes::EBall));
		subject.m_Targets = {Target(VTarget::ELocalPointToWorldPoint, 0, {1, 2, 3}, 0)};
		VComputeSubjectFK fk(subject);
		EXPECT_EQ(fk.NumberOfSegments(), 0u);
		EXPECT_EQ(fk.NumberOfStates(), 0u);
		EXPECT_EQ(fk.NumberOfTargets(), 0u);
		EXPECT_EQ(fk.NumberOfMarkers(), 0u);
		fk.Update(nullptr);
		fk.NormaliseState(nullptr);
		std::vector<Rotation::VVector3> markers(1);
		EXPECT_TRUE(fk.ComputeMarkers(markers));
		EXPECT_TRUE(markers.empty());
	}
}

TEST(SubjectFK, BadJointTypeIsAssertedAndRefused)
{
	for (const int type : {6, 7, -1})
	{
		const VAssertions assertions;
		VSubject subject;
		subject.m_Segments = {
		    Segment(c_NoParent, VJointTypes::EBall), Segment(0, static_cast<Reference::EJointType>(type))};
		EXPECT_THROW(VComputeSubjectFK{subject}, VConstructionException) << type;
		EXPECT_EQ(assertions.Take(), std::vector<std::string>{"m_pJoint"}) << type;
	}
}

TEST(SubjectFK, CountsAndIsValid)
{
	VSubject subject;
	subject.m_Segments = {Segment(c_NoParent, VJointTypes::EDummy)};
	const auto counts = [&](std::vector<VTarget> i_Targets, std::size_t i_Markers, std::size_t i_Rotations)
	{
		subject.m_Targets = std::move(i_Targets);
		const VComputeSubjectFK fk(subject);
		EXPECT_EQ(fk.NumberOfMarkers(), i_Markers);
		EXPECT_EQ(fk.NumberOfRotations(), i_Rotations);
		return fk.IsValid();
	};
	const auto point = [](std::uint32_t i_Marker) {
		return Target(VTarget::ELocalPointToWorldPoint, 0, {0, 0, 0}, i_Marker);
	};
	const auto rotation = [](std::uint32_t i_Rotation) {
		return Target(VTarget::ELocalRotationToWorldRotation, 0, {0, 0, 0}, i_Rotation);
	};
	EXPECT_TRUE(counts({}, 0, 0));
	EXPECT_TRUE(counts({point(0), point(1), point(0)}, 2, 0));
	EXPECT_FALSE(counts({point(0), point(2)}, 2, 0));
	EXPECT_TRUE(counts({point(0), rotation(0)}, 1, 1));
	// Rotation indices are held against the number of markers.
	EXPECT_FALSE(counts({rotation(0)}, 0, 1));
}

/// A subject with one target of each class on segments of a random tree.
VSubject WithTargets(std::mt19937& io_rRandom)
{
	VSubject subject = RandomSubject(io_rRandom, 20);
	subject.m_Targets = {Target(VTarget::ELocalPointToWorldPoint, 3, {1, 2, 3}, 0),
	    Target(VTarget::ERigidBody, 19, {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12}, 0),
	    Target(VTarget::ELocalRotationToWorldRotation, 7, {1, 2, 3}, 0),
	    Target(VTarget::ELocalLineToWorldPoint, 11, {1, 2, 3, 4, 5, 6}, 0),
	    Target(VTarget::ELocalPlaneToWorldPoint, 15, {1, 2, 3, 4, 5, 6}, 0)};
	subject.m_Targets[1].m_MarkerIndices = {1, 2};
	return subject;
}

struct VResults
{
	explicit VResults(const VComputeSubjectFK& i_rFK)
	{
		for (std::size_t i = 0; i < i_rFK.NumberOfSegments(); ++i)
		{
			m_Poses.push_back(i_rFK.Segment(i).WorldPose().R);
			Rotation::VPose<double> motion;
			i_rFK.Segment(i).JointBase().GetPose(motion);
			m_Poses.push_back(motion.R);
		}
		i_rFK.ComputeMarkers(m_Markers);
		i_rFK.ComputeRotations(m_Rotations);
	}
	bool operator==(const VResults&) const = default;

	std::vector<Rotation::VMatrix3> m_Poses;
	std::vector<Rotation::VVector3> m_Markers;
	std::vector<Rotation::VMatrix3> m_Rotations;
};

TEST(SubjectFK, CopyIsDeep)
{
	std::mt19937 random(11);
	const VSubject subject = WithTargets(random);
	const std::vector<double> first = RandomState(random, subject, 1.0);
	const std::vector<double> second = RandomState(random, subject, 1.0);
	auto pOriginal = std::make_unique<VComputeSubjectFK>(subject);
	pOriginal->Update(first.data());
	const VResults atFirst(*pOriginal);

	const VAssertions assertions;
	VComputeSubjectFK copy(*pOriginal);
	EXPECT_TRUE(assertions.Take().empty());
	EXPECT_EQ(VResults(copy), atFirst);
	for (std::size_t i = 0; i < copy.NumberOfSegments(); ++i)
	{
		EXPECT_NE(&copy.Segment(i), &pOriginal->Segment(i));
		EXPECT_NE(&copy.Segment(i).Joint(), &pOriginal->Segment(i).Joint());
		EXPECT_EQ(copy.Segment(i).TreeDepth(), pOriginal->Segment(i).TreeDepth());
		if (i > 0)
		{
			EXPECT_EQ(copy.Segment(i).Parent(), &copy.Segment(subject.m_Segments[i].m_ParentSegmentIndex));
		}
	}
	pOriginal->Update(second.data());
	const VResults atSecond(*pOriginal);
	EXPECT_NE(atSecond, atFirst);
	EXPECT_EQ(VResults(copy), atFirst);

	// Nothing of the original is used any more: targets follow the copy's own segments.
	pOriginal.reset();
	copy.Update(second.data());
	EXPECT_EQ(VResults(copy), atSecond);
}

TEST(SubjectFK, CloneToAParentOfAnotherDepthIsAsserted)
{
	VSubject subject;
	subject.m_Segments = {Segment(c_NoParent, VJointTypes::EDummy), Segment(0, VJointTypes::EDummy)};
	const VComputeSubjectFK fk(subject);
	const VAssertions assertions;
	EXPECT_EQ(fk.Segment(1).Clone(&fk.Segment(0))->Parent(), &fk.Segment(0));
	EXPECT_TRUE(assertions.Take().empty());
	fk.Segment(0).Clone(&fk.Segment(1));
	fk.Segment(1).Clone(nullptr);
	EXPECT_EQ(assertions.Take(),
	    (std::vector<std::string>{"pCloneFK->m_Depth == i_pParent->TreeDepth() + 1", "pCloneFK->m_Depth == 1"}));
}

/// Whatever is wrong with a subject, it is refused or can be used; nothing out of range is ever followed.
TEST(SubjectFK, BrokenSubjectsAreRefusedOrUsable)
{
	std::mt19937 random(13);
	const auto below = [&](std::uint32_t i_Limit)
	{ return std::uniform_int_distribution<std::uint32_t>(0, i_Limit - 1)(random); };
	const VAssertions assertions;
	int refused = 0;
	int usable = 0;
	for (int i = 0; i < 5000; ++i)
	{
		VSubject subject = WithTargets(random);
		for (std::uint32_t damage = 1 + below(3); damage > 0; --damage)
		{
			VSubject::VSegment& rSegment = subject.m_Segments[below(20)];
			VTarget& rTarget = subject.m_Targets[below(5)];
			switch (below(9))
			{
			case 0: rSegment.m_ParentSegmentIndex = below(25); break;
			case 1: rSegment.m_Joint.m_JointType = static_cast<Reference::EJointType>(below(9)); break;
			case 2: rSegment.m_PreRotation[below(3)] = std::nan(""); break;
			case 3: rTarget.m_Type = static_cast<VTarget::ETargetType>(below(12)); break;
			case 4: rTarget.m_State.resize(below(14), 1e300); break;
			case 5: rTarget.m_MarkerIndices.assign(below(4), below(2) ? 0xFFFFFFFF : 1); break;
			case 6: rTarget.m_RotationObservationIndices.assign(below(3), below(2) ? 0xFFFFFFFF : 0); break;
			case 7: rTarget.m_SegmentIndices.assign(below(3), below(25)); break;
			default: rTarget.m_Weight = below(2) ? -1.0 : std::nan(""); break;
			}
		}
		try
		{
			VComputeSubjectFK fk(subject);
			std::vector<double> state(fk.NumberOfStates(), 1.0);
			fk.Update(state.data());
			fk.NormaliseState(state.data());
			const VResults results(VComputeSubjectFK{fk});
			EXPECT_EQ(results.m_Markers.size(), fk.NumberOfMarkers());
			EXPECT_EQ(results.m_Rotations.size(), fk.NumberOfRotations());
			++usable;
		}
		catch (const VConstructionException&)
		{
			++refused;
		}
	}
	// Both ways are really taken.
	EXPECT_GT(refused, 500);
	EXPECT_GT(usable, 500);
}

/// Run under ThreadSanitizer this shows that copies share nothing.
TEST(SubjectFK, CopiesRunInParallel)
{
	std::mt19937 random(5);
	const VSubject subject = WithTargets(random);
	const VComputeSubjectFK original(subject);
	std::vector<std::vector<double>> states;
	std::vector<std::unique_ptr<VComputeSubjectFK>> copies;
	for (int i = 0; i < 3; ++i)
	{
		states.push_back(RandomState(random, subject, 1.0));
		copies.push_back(std::make_unique<VComputeSubjectFK>(original));
	}
	std::vector<std::thread> threads;
	for (int i = 0; i < 3; ++i)
		threads.emplace_back(
		    [&, i]
		    {
			    for (int frame = 0; frame < 200; ++frame)
				    copies[i]->Update(states[i].data());
		    });
	for (std::thread& rThread : threads)
		rThread.join();
	for (int i = 0; i < 3; ++i)
	{
		VComputeSubjectFK alone(subject);
		alone.Update(states[i].data());
		EXPECT_EQ(VResults(*copies[i]), VResults(alone)) << i;
	}
}

} // namespace
