#pragma once

#include "SetupProposal/PoseCheck.h"
#include "SetupProposal/Side.h"
#include "TakeSolve/TakeSolve.h"

#include <cstddef>
#include <string>
#include <vector>

namespace TakeSolve
{

/// Over the frames in which a target has a residual; mm, of rotations radians. The 95th percentile is the value that no
/// more than a twentieth of the frames exceed.
struct VTargetQuality
{
	std::size_t m_Frames = 0;
	double m_Rms = 0.0;
	double m_P95 = 0.0;
	double m_Max = 0.0;
	std::size_t m_MaxFrame = 0;
};

/// A foot of the character while that of the performer stands: hardly moves, near to where it is lowest. Heights are of
/// whichever of ankle and toe is lower, over its own height in the bind pose, in which feet are taken to stand, and
/// over VSolveReport::m_Floor.
struct VFootQuality
{
	SetupProposal::ESide m_Side = SetupProposal::ESide::None;
	/// Segments: the performer's and the character's foot.
	std::size_t m_Source = 0;
	std::size_t m_Target = 0;
	std::size_t m_StandingFrames = 0;
	/// The furthest, in the plane of the floor, from where the foot came to stand, and what the performer's did
	/// meanwhile.
	double m_Slide = 0.0;
	double m_SourceSlide = 0.0;
	std::size_t m_SlideFrame = 0;
	/// How far the performer's sole is turned towards the other foot against its bind pose, about the way that the foot
	/// points, in radians: the median over the standing frames.
	double m_SourceLean = 0.0;
	/// Over the standing frames.
	double m_Highest = 0.0;
	std::size_t m_HighestFrame = 0;
	double m_LowestStanding = 0.0;
	/// Over all frames; negative is through the floor.
	double m_Lowest = 0.0;
	std::size_t m_LowestFrame = 0;
};

/// A knee or an elbow of the character against the performer's, in radians at the 95th percentile: by how much it is
/// bent, and the axis about which, the latter where the performer's is bent by 20 degrees and more.
struct VBendQuality
{
	std::string m_Name;
	SetupProposal::ESide m_Side = SetupProposal::ESide::None;
	double m_Flexion = 0.0;
	double m_Axis = 0.0;
	std::size_t m_AxisFrames = 0;
};

/// How often a joint is at the end of its range.
struct VRangeQuality
{
	std::size_t m_Segment = 0;
	std::size_t m_Frames = 0;
};

/// From a frame to the next a segment of the character turns by far more than any of the performer's: radians.
struct VJump
{
	std::size_t m_Frame = 0;
	std::size_t m_Segment = 0;
	double m_Angle = 0.0;
	double m_SourceAngle = 0.0;
};

/// Targets on both sides of the body, of which one is met much worse.
struct VUnequalSides
{
	std::size_t m_Better = 0;
	std::size_t m_Worse = 0;
};

struct VSolveReport
{
	/// Where performer and character do not stand alike in their bind poses: those that are not fine come first to mind
	/// when numbers are bad.
	std::vector<SetupProposal::VPoseFinding> m_BindPoses;
	/// By the subject's targets; one that is left out has no frames.
	std::vector<VTargetQuality> m_Targets;
	std::vector<VFootQuality> m_Feet;
	/// How high the performer's feet stand by the take over where they stand in the bind pose, in mm: the median over
	/// the frames. The floor of the take, or of the performer, is elsewhere then.
	double m_Floor = 0.0;
	std::vector<VBendQuality> m_Bends;
	std::vector<VRangeQuality> m_Ranges;
	/// The largest of each segment.
	std::vector<VJump> m_Jumps;
	std::vector<VUnequalSides> m_Sides;
	std::vector<std::size_t> m_NotConverged;
	/// Of a frame, in milliseconds.
	double m_MedianTime = 0.0;
	double m_P95Time = 0.0;
};

/// @param i_rTarget, i_BindPose as the frames were solved for. Which segments are feet, knees and elbows is told by
/// SetupProposal.
/// @return false if it was cancelled; there is no report then.
bool ReportOn(const CoreOrlexTypes::VSubject& i_rTarget, std::span<const double> i_BindPose,
    const VSourceMotion& i_rSource, const VSolvedTake& i_rSolved, const VSolveProgress& i_rProgress,
    VSolveReport& o_rReport);

} // namespace TakeSolve
