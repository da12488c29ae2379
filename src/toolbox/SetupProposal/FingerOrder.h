#pragma once

#include "SetupProposal/BodyParts.h"

namespace SetupProposal
{

/// Where neither names nor the tree tell which finger a chain of joints on a hand is, the rest pose does: the thumb
/// begins nearest to the hand or farthest to the front, and the others follow by their distance from it. Changes
/// m_Likely and m_Part.
void TellFingersApart(const VRestSkeleton& i_rSkeleton, VBodyReading& io_rBody);

} // namespace SetupProposal
