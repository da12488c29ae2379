#pragma once

#include "RetargetSetupCore/RetargetSetupCore.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace SetupReview
{

/// A target that is missed while the performer goes through the range of one joint after the other.
struct VRangeConflict
{
	/// Index of the target.
	std::size_t m_Target = 0;
	/// Mm, of rotations radians: as it stands at rest, and where it is missed most.
	double m_AtRest = 0.0;
	double m_AtWorst = 0.0;
	bool m_bRotation = false;
	/// Where: the performer's segment, its axis 0 to 2, and how far it turned from the bind pose, in radians.
	std::size_t m_SourceSegment = 0;
	std::size_t m_Axis = 0;
	double m_Angle = 0.0;
	/// The target that pulls against it: without it the first is missed by m_Without. None if no single one does: then
	/// lengths or missing joints do.
	std::optional<std::size_t> m_Against;
	double m_Without = 0.0;
	/// A sentence for the operator.
	std::string m_Words;
};

struct VRangeOfMotion
{
	/// In the order of the targets.
	std::vector<VRangeConflict> m_Conflicts;
	std::size_t m_Poses = 0;
	/// Poses in which the solve found only the best it could.
	std::size_t m_NotConverged = 0;
	/// There were more poses or conflicts than are looked at.
	bool m_bCutShort = false;
	/// Why nothing was solved, a sentence; empty if it was.
	std::string m_Refusal;
};

/// Turns each joint of the performer that carries what a target follows, or stands above it, about its axes through its
/// range, of the file where it tells one and otherwise 45 degrees to either side, and solves the character in each
/// pose. A conflict is a target that is missed by 10 mm or 5 degrees more than at rest.
VRangeOfMotion GoThroughRange(
    const VRetargetSetupCore::VSubjectValues& i_rSource, const VRetargetSetupCore::VSubjectValues& i_rTarget);

} // namespace SetupReview
