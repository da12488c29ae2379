#pragma once

#include <string>

namespace RetargetSetup
{

/// Without a dynamic parameter no offset can be stored: the operator is told what follows from it.
void TellNoDynamicParameter(const std::string& i_rConsequence);

} // namespace RetargetSetup
