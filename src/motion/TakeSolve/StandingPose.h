#pragma once

#include "SetupProposal/Side.h"
#include "TakeIO/Take.h"

#include <cstddef>
#include <string>
#include <vector>

namespace TakeSolve
{

/// A foot that was turned, by radians, to stand as it does in so many frames of the take, its ankle at this height in
/// mm; none if it never stands.
struct VStandingFoot
{
	std::size_t m_Joint = 0;
	SetupProposal::ESide m_Side = SetupProposal::ESide::None;
	double m_Turn = 0.0;
	double m_Height = 0.0;
	std::size_t m_Frames = 0;
};

/// A pose of a take's joints, each to its parent as VJoint::m_Rest is.
struct VStandingPose
{
	std::vector<Rotation::VPose<double>> m_Poses;
	std::vector<VStandingFoot> m_Feet;
};

/// The rest pose itself.
VStandingPose RestPose(const TakeIO::VTake& i_rTake);

/// The rest pose with the feet as they stand in the take. Feet at rest are what someone left them: with splayed legs
/// their soles often are, too, or they point down, and a character whose soles lie on the floor then gets the
/// difference in each frame. A foot, and its toe by itself, is turned by the shortest way that lets point up in the
/// pose what points up in the frames in which both stand: the median. The whole is raised or lowered to where the
/// ankles are in these.
VStandingPose StandingPose(const TakeIO::VTake& i_rTake);

/// What was done to the feet, as a sentence; empty for a skeleton without feet.
std::string TextOf(const VStandingPose& i_rPose, const TakeIO::VTake& i_rTake);

} // namespace TakeSolve
