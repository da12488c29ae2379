#pragma once

#include "RetargetSetupCore/RetargetSetupCore.h"
#include "SetupReview/compare/Comparison.h"

#include <boost/filesystem/path.hpp>

#include <optional>
#include <string>
#include <vector>

namespace SetupReview
{

/// In what a document's target subject, as a save would write it now, differs from a file: the file is the earlier one.
/// What the reader tells of the file goes to the log.
/// @param i_rPath a skeleton file, or a legacy one (.qrx), which counts as it stands once it is loaded.
/// @param o_rReason why there is no answer, a sentence; empty if one of what the log tells.
std::optional<std::vector<VSetupChange>> ChangesSince(
    const VRetargetSetupCore& i_rDocument, const boost::filesystem::path& i_rPath, std::string& o_rReason);

} // namespace SetupReview
