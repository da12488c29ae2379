#pragma once

#include "SetupReview/compare/Comparison.h"

#include <map>
#include <string>

namespace SetupReview
{

/// Old names and new ones.
using VRenames = std::map<std::string, std::string>;

/// What the editing tools call a target; empty for one that ties no two segments.
std::string TargetName(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::size_t i_Target);

/// The names of all targets that are called by what they tie, as they are now; others are empty.
std::vector<std::string> StandardTargetNames(const VSetup& i_rSetup);

/// Calls the targets that had a standard name by what they tie now, and takes their extras along.
/// @param i_rBefore from StandardTargetNames, before targets tied something else.
void RenameTargets(VSetup& io_rSetup, const std::vector<std::string>& i_rBefore);

} // namespace SetupReview
