#pragma once

#include "SetupProposal/RestSkeleton.h"
#include "TakeSolve/Finding.h"

#include <cstdint>
#include <string>
#include <vector>

namespace TakeSolve
{

/// A pair that the operator gives, by names.
struct VNamedPair
{
	std::string m_Joint;
	std::string m_Segment;
};

/// For each segment of a performer the joint of a take that drives it, -1 for none; a joint drives one at most.
/// Given pairs come first. Then names, namespace and case aside; where a name misleads, since the body's shape and the
/// other names tell another pair, that one is taken, and told. The rest are pairs as set-ups propose them. A pair of
/// which the tree of the take does not fit that of the performer is told, and so are segments without a joint.
/// @param i_rJoints, i_rSegments at rest.
/// @return false for a given pair that names nothing, or something twice; o_rError tells it.
bool PairJoints(const SetupProposal::VRestSkeleton& i_rJoints, const SetupProposal::VRestSkeleton& i_rSegments,
    const std::vector<VNamedPair>& i_rGiven, std::vector<std::int32_t>& o_rJointOfSegment,
    std::vector<VFinding>& io_rFindings, std::string& o_rError);

} // namespace TakeSolve
