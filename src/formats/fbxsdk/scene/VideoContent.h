#pragma once

#include "fbxsdk/scene/ArraySource.h"

#include <string>

namespace FbxFormat
{

/// The file that a video's record "Content" holds: raw bytes, in the text form pieces of base64. Empty if there is
/// none, if it is damaged, or if it is beyond the budget.
std::string ReadContent(const VArraySource& i_rContent);

/// Whether there is anything in it.
bool HasContent(const VArraySource& i_rContent);

} // namespace FbxFormat
