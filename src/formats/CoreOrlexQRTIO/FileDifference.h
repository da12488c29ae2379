#pragma once

#include "CoreOrlexTypes/SubjectRecord.h"

#include <string>

namespace CoreOrlexQRTIO
{

/// Where a subject that was read from a file differs first from the one that was written to it, as
/// CoreOrlexTypes::FirstDifference tells it; empty if nowhere. Left out is what a file does not tell: the ids of
/// markers and rotation observations, the order of the latter, and the last bits of joint orientations, which it holds
/// as axes.
std::string FileDifference(CoreOrlexTypes::VSubjectRecord i_Written, CoreOrlexTypes::VSubjectRecord i_Read);

} // namespace CoreOrlexQRTIO
