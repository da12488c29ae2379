#pragma once

#include "RetargetSetupCore/RetargetSetupCore.h"

#include <cstddef>
#include <string>
#include <vector>

namespace SetupReview
{

/// Two targets of which one is missed because of the other while the performer goes through the range of one joint
/// after the other.
struct VRangeConflict
{
	/// Index of the one that is missed.
	std::size_t m_Target = 0;
	/// Mm, of rotations radians: as it stands at rest, and where it is missed most.
	double m_AtRest = 0.0;
	double m_AtWorst = 0.0;
	bool m_bRotation = false;
	/// Where: the performer's segment, its axis 0 to 2, and how far it turned from the bind pose, in radians.
	std::size_t m_SourceSegment = 0;
	std::size_t m_Axis = 0;
	double m_Angle = 0.0;
	/// The one that pulls against it, without which the first is missed by m_Without.
	std::size_t m_Against = 0;
	double m_Without = 0.0;
	/// Both by number and name, for the operator, and what happens to the first, as the rest of a sentence.
	std::string m_TargetName;
	std::string m_AgainstName;
	std::string m_Words;
};

struct VRangeOfMotion
{
	/// Those of one target that pulls against others stand together. Of two that pull against each other only one is
	/// told: the one that is missed because of what pulls against more.
	std::vector<VRangeConflict> m_Conflicts;
	/// Targets that are missed as well, with no single one against them: lengths differ, or joints are missing.
	std::size_t m_Unopposed = 0;
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
/// pose. A conflict is a target that is missed by 10 mm or 5 degrees more than at rest, and by at most a quarter of
/// that without another.
VRangeOfMotion GoThroughRange(
    const VRetargetSetupCore::VSubjectValues& i_rSource, const VRetargetSetupCore::VSubjectValues& i_rTarget);

} // namespace SetupReview
