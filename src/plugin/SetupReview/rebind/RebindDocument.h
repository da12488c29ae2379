#pragma once

#include "RetargetSetupCore/RetargetSetupCore.h"
#include "SetupReview/rebind/Rebind.h"

#include <optional>

namespace SetupReview
{

/// What would become of a document's target subject with the FBX file that was read last, or with its source as another
/// performer. Nothing if there are no two to hold against each other.
/// @param i_LeastScore of pairs that are matched as parts of a body
std::optional<VRebound> ReboundOf(
    const VRetargetSetupCore& i_rDocument, bool i_bPerformer, double i_LeastScore = SetupProposal::c_DefaultLeastScore);

/// The document takes it over in one step, which its recipes know.
/// @param i_rRebound of ReboundOf, not refused.
/// @param i_bMeasure measures the offsets of all targets anew, too.
/// @return false, with no change, if the host made no item.
bool TakeOver(VRetargetSetupCore& io_rDocument, const VRebound& i_rRebound, bool i_bPerformer, bool i_bMeasure);

} // namespace SetupReview
