#pragma once

#include "retarget/Session.h"

#include <optional>
#include <vector>

namespace CommandLine
{

/// How far a target is from what it asks for, in the bind poses of both subjects.
struct VResidual
{
	/// Of a point target: mm between the source segment and the stored point of the target segment.
	std::optional<double> m_Distance;
	/// Of a rotation target: radians between the source segment and the stored orientation of the target segment.
	std::optional<double> m_Angle;
};

/// One for each target; empty ones for targets of other types and where a segment is not there.
std::vector<VResidual> Residuals(
    const VRetargetSetup::VSubjectValues& i_rSource, const VRetargetSetup::VSubjectValues& i_rTarget);

} // namespace CommandLine
