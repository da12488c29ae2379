#pragma once

#include <string>

namespace CoreGraphics
{

/// The folder that holds "Geometry", in UTF-8: beside the binary that this code was linked into, or beside the module
/// in the installation or build folder that the binary lies in. Empty if there is none.
std::string FindResourceRoot();

} // namespace CoreGraphics
