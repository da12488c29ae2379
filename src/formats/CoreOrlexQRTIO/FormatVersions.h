#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "UtilsRapidXml/Version.h"

#include <optional>
#include <string_view>

namespace CoreOrlexQRTIO
{

inline constexpr UtilsRapidXml::VVersion c_MinimumVersion{1, 0};
inline constexpr UtilsRapidXml::VVersion c_MaximumVersion{3, 5};

/// The version that a version value stands for; unset for a value that stands for none.
UtilsRapidXml::VVersion VersionFromValue(std::uint32_t i_Value);

/// The version value of "major.minor", or nothing if the format has no such version.
std::optional<std::uint32_t> VersionValueFromText(std::string_view i_Text);

/// The texts of all versions, oldest first, as "1.0 1.5 ... 3.5".
std::string AllVersionTexts();

/// The lowest version from 3.2 on that holds the subject.
std::uint32_t LowestVersionValue(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras);

} // namespace CoreOrlexQRTIO
