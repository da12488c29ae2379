#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"
#include "numerics/Rotation.h"

#include <cstddef>
#include <functional>
#include <optional>

/// Where a target subject stands above the floor, which is the plane of height 0. The scale reaches every length, but
/// not the place of the root.
namespace RetargetSetup
{

/// Changes where the root stands in the world, in its bind pose and its mean. False, with no change, for a root that
/// has no place, or whose joint has an orientation of its own.
bool MoveRoot(CoreOrlexTypes::VSubjectParametrised& io_rSubject,
    const std::function<void(Rotation::VPose<double>& io_rWorld)>& i_rMove);

/// Multiplies the height of the root above the floor by a factor, in its bind pose and its mean. Does nothing to a root
/// that has no place.
void ScaleRootHeight(CoreOrlexTypes::VSubjectParametrised& io_rSubject, double i_Factor);

struct VLowestSegment
{
	std::size_t m_SegmentIndex = 0;
	/// Of its origin in the bind pose, in mm; negative below the floor.
	double m_Height = 0.0;
};

/// Nothing if the segments make no tree, which is told.
std::optional<VLowestSegment> FindLowestSegment(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// Warns of a subject that hangs above the floor or sinks below it since the root's height does not fit the scale: its
/// lowest segment is not where it is at scale 1, multiplied by the scale. For a root whose height is not scaled.
void TellLowestSegment(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

} // namespace RetargetSetup
