#pragma once

#include "SetupProposal/BodyPart.h"
#include "SetupProposal/NameWords.h"

#include <optional>
#include <string_view>

namespace SetupProposal
{

/// Whether a word in lower case is one that names parts of bodies or helpers, or goes with such a word.
bool IsKnownWord(std::string_view i_Word);

/// How likely a name makes each part, from 0 to 1; nothing if it tells none.
std::optional<VPartScores> PartsByName(const VNameWords& i_rName);

} // namespace SetupProposal
