#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <cstddef>
#include <cstdint>

namespace RetargetSetup
{

/// The segment on the other side: FindMirrorSegment's and, where that finds none, the one by words for sides anywhere
/// in the names or by the mirrored place in the bind pose, which is told. -1 for none.
/// @param i_rSubject converted from i_rParametrised.
std::int32_t FindPartner(const CoreOrlexTypes::VSubjectParametrised& i_rParametrised,
    const CoreOrlexTypes::VSubject& i_rSubject, std::size_t i_SegmentIndex);

} // namespace RetargetSetup
