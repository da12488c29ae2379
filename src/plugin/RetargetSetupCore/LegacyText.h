#pragma once

#include "CoreOrlexTypes/SubjectRecord.h"

#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <string_view>

namespace RetargetSetup
{

/// The latest version of the legacy text file (.qrx), the one that is read along with all before it.
inline constexpr std::array<std::uint32_t, 3> c_LegacyVersion{1, 0, 1};

/// Reads a legacy text file and brings it into line, see ParseLegacyText and RepairLegacyRecord. Failures are told.
/// @return 0; 0x8000002A if the file cannot be opened; else as ParseLegacyText. io_rRecord counts only with 0.
std::uint32_t ReadLegacyFile(const boost::filesystem::path& i_rPath, CoreOrlexTypes::VSubjectRecord& io_rRecord);

/// A header with the version, then the record.
/// @return 0; 0x80000000 for a text that is not in this form; 0x80000018 for a later version.
std::uint32_t ParseLegacyText(std::string_view i_Text, CoreOrlexTypes::VSubjectRecord& io_rRecord);

/// Gives both values the document's name and id and the application data one element for each of the subject's, and
/// tells each thing that was not so. Rotation targets get the calibration behaviour Other: these files hold no usable
/// one.
void RepairLegacyRecord(CoreOrlexTypes::VSubjectRecord& io_rRecord);

} // namespace RetargetSetup
