#pragma once

#include "retarget/subject/Session.h"

#include <optional>
#include <vector>

namespace CommandLine
{

/// How far a target is from what it asks for, in the bind poses of both subjects.
struct VResidual
{
	/// Mm between the source segment's origin and the point, line or plane of the target; of a rigid body the largest
	/// of its markers.
	std::optional<double> m_Distance;
	/// Of a rotation target: radians between the source segment and the orientation of the target.
	std::optional<double> m_Angle;
};

struct VTargetResidual
{
	/// Of point and rotation targets: from the segment's pose, to which the editing tools store offsets; of the others
	/// the same as m_Target.
	VResidual m_Offset;
	/// From the target's own kinematics, as a solver sees it.
	VResidual m_Target;
};

/// What a target follows: the names of its markers, or of its rotation observations if it has none. Source segments
/// bear these names.
std::vector<std::string> FollowedNames(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rTarget);

/// One for each target; empty ones for direction targets, for targets that do not fit their type and where a segment is
/// not there.
std::vector<VTargetResidual> Residuals(
    const VRetargetSetupCore::VSubjectValues& i_rSource, const VRetargetSetupCore::VSubjectValues& i_rTarget);

/// The target whose two residuals differ most, if any differ by more than rounding.
std::optional<std::size_t> WorstDisagreement(const std::vector<VTargetResidual>& i_rResiduals);

} // namespace CommandLine
