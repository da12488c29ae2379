#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <string>
#include <vector>

namespace CoreOrlexQRTIO
{

struct VVersionLosses
{
	/// With counts, as "12 targets".
	std::vector<std::string> m_Losses;
	/// Why no reader would take the file, in which case nothing is compared; empty if one would.
	std::string m_Refusal;
};

/// What would be lost or changed if the subject were written at a version and read again. Found by doing just that in
/// memory. Numbers that come back but for rounding (1e-9 of their size) are not lost. Empty if nothing is lost, or if
/// the subject cannot be written at all.
VVersionLosses ListVersionLosses(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras,
    std::uint32_t i_VersionValue);

} // namespace CoreOrlexQRTIO
