#pragma once

#include "TakeIO/Take.h"

#include <string>

namespace TakeIO
{

/// A take as BVH, in the axes and the unit that its file had (VTake::m_FileUp, m_FileUnit): with these given it reads
/// back as it is, within 12 digits. The format knows no rest rotations: a joint that has one and does not turn gets
/// channels for it. Line ends in names become blanks.
std::string PrintBvh(const VTake& i_rTake);

} // namespace TakeIO
