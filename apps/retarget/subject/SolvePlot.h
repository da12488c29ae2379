#pragma once

#include "retarget/subject/SolveText.h"

#include <string>

namespace CommandLine
{

/// An SVG drawing of what the targets are off by over the frames: mm above, degrees below. The worst of each are in
/// colour and named, the others grey.
std::string SolvePlot(const VSolveResult& i_rResult);

} // namespace CommandLine
