#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <string>
#include <vector>

namespace CoreOrlexQRTIO
{

/// What would be lost or changed if the subject were written at a version and read again, with counts, as "12 targets".
/// Found by doing just that in memory. Numbers that come back but for rounding (1e-9 of their size) are not lost.
/// Empty if nothing is lost, or if the subject cannot be written at all.
std::vector<std::string> ListVersionLosses(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras,
    std::uint32_t i_VersionValue);

} // namespace CoreOrlexQRTIO
