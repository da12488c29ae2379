#pragma once

#include "SetupProposal/RestSkeleton.h"

#include <cstdint>
#include <vector>

namespace SetupProposal
{

/// For each joint the one on the other side of the body by the tree alone: children of one parent whose bones and those
/// beneath them are as long, and the children of such a pair in turn. Whatever the names and however it is posed. -1
/// for none.
std::vector<std::int64_t> FindTwins(const VRestSkeleton& i_rSkeleton);

/// The child of each joint that most joints hang on, -1 without one.
std::vector<std::int64_t> MainChildren(const VRestSkeleton& i_rSkeleton);

} // namespace SetupProposal
