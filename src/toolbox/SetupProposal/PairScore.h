#pragma once

#include "SetupProposal/BodyParts.h"

#include <string>
#include <vector>

namespace SetupProposal
{

/// How well two joints fit as the same part, from 0 to 1: how likely both are it, whether they are of one side, where
/// along a chain and where in the body they stand, and how alike their names are.
double PairScore(const VBodyReading& i_rSource, std::size_t i_Source, const VBodyReading& i_rTarget,
    std::size_t i_Target, EBodyPart i_Part);

/// Phrases for what speaks for and against.
std::vector<std::string> PairReasons(const VBodyReading& i_rSource, std::size_t i_Source, const VBodyReading& i_rTarget,
    std::size_t i_Target, EBodyPart i_Part);

} // namespace SetupProposal
