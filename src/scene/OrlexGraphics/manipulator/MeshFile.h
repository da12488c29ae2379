#pragma once

#include "CoreGraphics/Shapes.h"

#include <optional>
#include <string>

namespace CoreGraphics
{
class VShaderLibrary;
}

namespace OrlexGraphics
{

/// A mesh of one part from the folder "Geometry" of the library's resource root. Nothing, and told in the log, if there
/// is none.
std::optional<CoreGraphics::VShape> ReadMeshFile(
    const CoreGraphics::VShaderLibrary& i_rLibrary, const std::string& i_rName);

} // namespace OrlexGraphics
