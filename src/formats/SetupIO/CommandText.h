#pragma once

#include "SetupIO/Setup.h"

#include <string>

namespace SetupIO
{

/// In single quotes where a shell would see more than a word.
std::string ForShell(const std::string& i_rWord);

/// What a recipe without pairs and checks does as a command line for a shell: of "create" for one that begins with an
/// FBX file, else of "edit". One option a line.
std::string CommandText(const VSetup& i_rRecipe);

} // namespace SetupIO
