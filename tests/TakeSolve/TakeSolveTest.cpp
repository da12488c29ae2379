#include "Takes.h"

#include "../Allocations.h"

#include "CoreOrlexTypes/JointType.h"
#include "TakeSolve/SolveReport.h"
#include "TakeSolve/SolvedMotion.h"

#include <cmath>
#include <numbers>

using TakeSolve::VSolvedTake;
using VPoses = std::vector<Rotation::VPose<double>>;

namespace
{

constexpr double c_Degree = std::numbers::pi / 180.0;

/// A point and a rotation on each segment, which follow the performer's segment of the same name exactly.
VSubject Follower(VSubject i_Subject)
{
	i_Subject.m_Markers.clear();
	i_Subject.m_Targets.clear();
	for (std::uint32_t i = 0; i < i_Subject.m_Segments.size(); ++i)
	{
		i_Subject.m_Markers.emplace_back().m_Name = i_Subject.m_Segments[i].m_Name;
		i_Subject.m_Rotations.emplace_back().m_Name = i_Subject.m_Segments[i].m_Name;
		VSubject::VTarget target;
		target.m_SegmentIndices = {i};
		target.m_State.assign(3, 0.0);
		target.m_Type = VSubject::VTarget::ELocalPointToWorldPoint;
		target.m_MarkerIndices = {i};
		i_Subject.m_Targets.push_back(target);
		target.m_Type = VSubject::VTarget::ELocalRotationToWorldRotation;
		target.m_MarkerIndices.clear();
		target.m_RotationObservationIndices = {i};
		i_Subject.m_Targets.push_back(target);
	}
	return i_Subject;
}

struct VScene
{
	VScene() : m_pTake(ChestTake()), m_Performer(*m_pTake), m_Target(Follower(m_Performer.m_Subject))
	{
		std::string error;
		m_pMotion = TakeSolve::VSourceMotion::Make(m_Performer.m_Subject, m_Performer.m_BindPose, m_pTake, {}, error);
		EXPECT_TRUE(m_pMotion) << error;
	}

	/// A solve that has nothing to smooth.
	VSolvedTake Solved(std::size_t i_First, std::size_t i_Last, const TakeSolve::VSolveProgress& i_rProgress = {})
	{
		TakeSolve::VTakeSolve solve(m_Target, m_Performer.m_BindPose, m_pMotion, {0.0, 0.0, 0.0});
		VSolvedTake solved;
		m_bWhole = TakeSolve::SolveFrames(solve, i_First, i_Last, i_rProgress, solved);
		return solved;
	}
	TakeSolve::VSolveReport Report(const VSolvedTake& i_rSolved)
	{
		TakeSolve::VSolveReport report;
		std::size_t asked = 0;
		EXPECT_FALSE(TakeSolve::ReportOn(
		    m_Target, m_Performer.m_BindPose, *m_pMotion, i_rSolved,
		    [&](std::size_t i_Done, std::size_t i_Frames)
		    {
			    EXPECT_EQ(i_Frames, i_rSolved.m_Frames);
			    return (asked = i_Done) < 2;
		    },
		    report));
		EXPECT_EQ(asked, 2u) << "cancelled";
		EXPECT_TRUE(TakeSolve::ReportOn(m_Target, m_Performer.m_BindPose, *m_pMotion, i_rSolved, {}, report));
		return report;
	}
	/// Where the states of a segment begin.
	std::size_t State(const std::string& i_rName) const
	{
		std::size_t state = 0;
		for (const auto& rSegment : m_Target.m_Segments)
		{
			if (rSegment.m_Name == i_rName)
				return state;
			state += CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
		}
		ADD_FAILURE() << i_rName;
		return 0;
	}

	std::shared_ptr<const TakeIO::VTake> m_pTake;
	VTakePerformer m_Performer;
	VSubject m_Target;
	std::shared_ptr<const TakeSolve::VSourceMotion> m_pMotion;
	bool m_bWhole = false;
};

} // namespace

/// A character that is the performer again ends where the take's joints are, and is handed on as the same motion.
TEST(TakeSolve, FollowsExactly)
{
	VScene scene;
	const VSolvedTake solved = scene.Solved(0, scene.m_pTake->m_Frames - 1);
	ASSERT_EQ(solved.m_Frames, scene.m_pTake->m_Frames);
	for (std::size_t i = 0; i < solved.m_Frames; ++i)
	{
		EXPECT_TRUE(solved.m_Converged[i]) << i;
		for (const double residual : solved.Residuals(i))
			EXPECT_LT(residual, 1e-6) << i;
	}
	const TakeIO::VTake motion =
	    TakeSolve::MotionOf(scene.m_Target, scene.m_Performer.m_BindPose, solved, scene.m_pTake->m_Rate);
	VPoses expected;
	VPoses actual;
	for (std::size_t i = 0; i < solved.m_Frames; i += 10)
	{
		TakeIO::WorldPoses(*scene.m_pTake, i, expected);
		TakeIO::WorldPoses(motion, i, actual);
		for (std::size_t k = 0; k < expected.size(); ++k)
			ExpectPose(actual[k], expected[k].R, expected[k].t, 1e-8, motion.m_Joints[k].m_Name);
	}
	VPoses bind;
	TakeIO::WorldRestPoses(motion, bind);
	for (std::size_t k = 0; k < bind.size(); ++k)
		ExpectPose(bind[k], scene.m_pMotion->BindPoses()[k].R, scene.m_pMotion->BindPoses()[k].t, 1e-9, "bind");
}

TEST(TakeSolve, RangeCancelAndRepetition)
{
	VScene scene;
	const VSolvedTake part = scene.Solved(20, 29);
	EXPECT_TRUE(scene.m_bWhole);
	EXPECT_EQ(part.m_First, 20u);
	EXPECT_EQ(part.m_Frames, 10u);
	std::size_t calls = 0;
	const VSolvedTake cancelled = scene.Solved(20, 29,
	    [&](std::size_t i_Solved, std::size_t i_Frames)
	    {
		    EXPECT_EQ(i_Solved, ++calls);
		    EXPECT_EQ(i_Frames, 10u);
		    return i_Solved < 4;
	    });
	EXPECT_FALSE(scene.m_bWhole);
	EXPECT_EQ(cancelled.m_Frames, 4u);
	const VSolvedTake again = scene.Solved(20, 29);
	EXPECT_EQ(again.m_States, part.m_States);
	EXPECT_EQ(again.m_Residuals, part.m_Residuals);

	TakeSolve::VTakeSolve solve(scene.m_Target, scene.m_Performer.m_BindPose, scene.m_pMotion);
	solve.Solve(0);
#ifdef RETARGET_COUNTS_ALLOCATIONS
	const std::size_t before = AllocationCount();
	for (std::size_t i = 1; i < scene.m_pTake->m_Frames; ++i)
		solve.Solve(i);
	EXPECT_EQ(AllocationCount(), before);
#endif
}

/// A target that follows what the performer does not have, and one of no type.
TEST(TakeSolve, LeavesOutAndTells)
{
	VScene scene;
	scene.m_Target.m_Markers[3].m_Name = "Tail";
	scene.m_Target.m_Targets[0].m_Type = VSubject::VTarget::EBadTargetType;
	const TakeSolve::VTakeSolve solve(scene.m_Target, scene.m_Performer.m_BindPose, scene.m_pMotion);
	EXPECT_EQ(solve.Findings().size(), 2u);
	EXPECT_TRUE(Tells(solve.Findings(), "left-out", "Target #0"));
	EXPECT_TRUE(
	    Tells(solve.Findings(), "left-out", "#6 is left out of the solve. The performer has no segment \"Tail\""));
	const VSolvedTake solved = scene.Solved(0, 5);
	EXPECT_EQ(scene.Report(solved).m_Targets[6].m_Frames, 0u);
	EXPECT_EQ(scene.Report(solved).m_Targets[7].m_Frames, 6u);
}

/// Motion that is spoilt by known amounts.
TEST(SolveReport, TellsWhatWasSpoilt)
{
	VScene scene;
	const std::size_t frames = scene.m_pTake->m_Frames;
	const VSolvedTake exact = scene.Solved(0, frames - 1);
	const TakeSolve::VSolveReport fine = scene.Report(exact);
	ASSERT_EQ(fine.m_Feet.size(), 2u);
	ASSERT_EQ(fine.m_Bends.size(), 4u);
	for (const auto& rBend : fine.m_Bends)
		EXPECT_LT(rBend.m_Flexion + rBend.m_Axis, 1e-5) << rBend.m_Name;
	TakeSolve::VSolveReport none;
	EXPECT_TRUE(
	    TakeSolve::ReportOn(scene.m_Target, scene.m_Performer.m_BindPose, *scene.m_pMotion, VSolvedTake(), {}, none));
	EXPECT_TRUE(fine.m_Jumps.empty() && fine.m_NotConverged.empty() && fine.m_Ranges.empty() && fine.m_Sides.empty());
	for (const auto& rPose : fine.m_BindPoses)
		EXPECT_TRUE(rPose.m_bFine) << rPose.m_Message;

	VSolvedTake spoilt = exact;
	for (std::size_t i = 0; i < frames; ++i)
	{
		// The first target is off by 1, 2, 3... mm.
		spoilt.m_Residuals[i * spoilt.m_NumberOfTargets] = double(i + 1);
		double* const pStates = &spoilt.m_States[i * spoilt.m_NumberOfStates];
		// Nearer to the floor by 40 mm, and backwards by a millimetre a frame.
		pStates[5] -= 40.0;
		pStates[4] += double(i);
		// One knee bends by 25 degrees more about the axis across.
		const std::size_t knee = scene.State("LeftKnee");
		const auto bent = Rotation::AngleAxisFromRotationMatrix(Rotation::Product(
		    Rotation::RotationMatrixFromAngleAxis({pStates[knee], pStates[knee + 1], pStates[knee + 2]}),
		    Rotation::RotationMatrixFromAngleAxis({25.0 * c_Degree, 0.0, 0.0})));
		std::ranges::copy(bent, pStates + knee);
	}
	// The performer's own left sole turns to the other foot by 20 degrees; Y is the file's way ahead.
	VScene leaning;
	auto pLeaning = std::make_shared<TakeIO::VTake>(*scene.m_pTake);
	for (const TakeIO::VJoint& rJoint : pLeaning->m_Joints)
		if (rJoint.m_Name == "LeftAnkle")
			for (std::size_t k = 0; k < rJoint.m_Channels.size(); ++k)
				if (rJoint.m_Channels[k] == TakeIO::EChannel::YRotation)
					for (std::size_t i = 0; i < frames; ++i)
						pLeaning->m_Values[i * pLeaning->m_Channels + rJoint.m_FirstValue + k] += 20.0 * c_Degree;
	std::string error;
	leaning.m_pMotion =
	    TakeSolve::VSourceMotion::Make(scene.m_Performer.m_Subject, scene.m_Performer.m_BindPose, pLeaning, {}, error);
	const TakeSolve::VSolveReport leans = leaning.Report(exact);
	EXPECT_NEAR(leans.m_Feet[0].m_SourceLean, fine.m_Feet[0].m_SourceLean + 20.0 * c_Degree, 3.0 * c_Degree);
	EXPECT_EQ(leans.m_Feet[1].m_SourceLean, fine.m_Feet[1].m_SourceLean);

	// Frames are told by their numbers in the take.
	VSolvedTake part = scene.Solved(10, 20);
	part.m_States[4 * part.m_NumberOfStates + 5] -= 40.0;
	// In one of two frames the left foot's toes point down.
	for (const auto& [frame, degrees] : {std::pair(6, 60.0), std::pair(8, -60.0)})
		part.m_States[std::size_t(frame) * part.m_NumberOfStates + scene.State("LeftAnkle")] += degrees * c_Degree;
	const TakeSolve::VSolveReport ofPart = scene.Report(part);
	EXPECT_EQ(ofPart.m_Feet[1].m_LowestFrame, 14u);
	EXPECT_NE(ofPart.m_Feet[0].m_LowestFrame, 14u);
	EXPECT_LT(ofPart.m_Feet[0].m_Lowest, ofPart.m_Feet[1].m_Lowest - 20.0);

	// In one frame the head looks back.
	spoilt.m_States[30 * spoilt.m_NumberOfStates + scene.State("Head") + 2] += std::numbers::pi;
	spoilt.m_Converged[7] = 0;
	const TakeSolve::VSolveReport report = scene.Report(spoilt);

	const auto n = double(frames);
	EXPECT_NEAR(report.m_Targets[0].m_Rms, std::sqrt((n + 1.0) * (2.0 * n + 1.0) / 6.0), 1e-9);
	EXPECT_EQ(report.m_Targets[0].m_P95, std::ceil(0.95 * n));
	EXPECT_EQ(report.m_Targets[0].m_Max, n);
	EXPECT_EQ(report.m_Targets[0].m_MaxFrame, frames - 1);
	EXPECT_EQ(report.m_NotConverged, std::vector<std::size_t>{7});
	// The right foot, whose leg is as it was.
	EXPECT_NEAR(report.m_Feet[1].m_Lowest, fine.m_Feet[1].m_Lowest - 40.0, 1e-5);
	EXPECT_NEAR(report.m_Bends[0].m_Flexion, 25.0 * c_Degree, 1.0 * c_Degree);
	EXPECT_LT(report.m_Bends[2].m_Flexion, 1e-5);
	ASSERT_FALSE(report.m_Jumps.empty());
	EXPECT_TRUE(report.m_Jumps[0].m_Frame == 30 || report.m_Jumps[0].m_Frame == 31);
	EXPECT_EQ(scene.m_Target.m_Segments[report.m_Jumps[0].m_Segment].m_Name, "Head");
	EXPECT_EQ(report.m_Sides.size(), 0u);
}
