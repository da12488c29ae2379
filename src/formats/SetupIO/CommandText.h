#pragma once

#include "SetupIO/Setup.h"

#include <string>

namespace SetupIO
{

/// What a recipe without pairs and checks does as a command line for a shell: of "create" for one that begins with an
/// FBX file, else of "edit". One option a line.
std::string CommandText(const VSetup& i_rRecipe);

} // namespace SetupIO
