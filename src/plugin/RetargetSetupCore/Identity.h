#pragma once

#include <cstdint>

namespace RetargetSetup
{

/// The fixed identity of both subjects of the document: selection items address them by it.
inline constexpr const char* c_SubjectName = "Template";
inline constexpr std::uint32_t c_SubjectId = 0x0FFFFFFFu;

/// The log category of the document and its functions.
inline constexpr const char* c_LogCategory = "RetargetSetup";

} // namespace RetargetSetup
