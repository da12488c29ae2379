#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace SetupProposal
{

/// One column for each row, and each column for one row, so that the sum of the gains is the largest: the Hungarian
/// method with potentials (Kuhn 1955; Munkres 1957), rows times rows times columns.
/// @param i_rGains one list for each row, all of one length; a gain of 0 or less is no pair.
/// @return for each row the column, -1 for none.
std::vector<std::int64_t> BestAssignment(const std::vector<std::vector<double>>& i_rGains);

} // namespace SetupProposal
