#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectRecord.h"
#include "SetupReview/compare/Comparison.h"

#include <string>

namespace CommandLine
{

/// Of the legacy text form, which is only read.
inline constexpr const char* c_LegacyExtension = ".qrx";

/// What help says of a file that any command reads.
inline constexpr const char* c_pSkeletonFileHelp =
    "Skeleton file (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx); - is standard input";

/// What a file of the skeleton family holds.
using VSubjectFile = SetupReview::VSetup;

/// False if a skeleton file (.qrt, .qrk, .qrs, .qrr) could not be read, which is told; what could be read stands in the
/// result all the same. Throws VCommandError with EBadInput for a legacy text file (.qrx) that fails.
bool TryReadSubjectFile(const std::string& i_rPath, VSubjectFile& o_rFile);

/// Reads a skeleton file as it stands, or a legacy text file (.qrx) as the document takes it in. Throws VCommandError
/// with EBadInput if that fails.
VSubjectFile ReadSubjectFile(const std::string& i_rPath);

/// Writes a skeleton file at a version of the format, to standard output if the path is "-". Throws VCommandError with
/// EBadOutput if that fails, and with EFindings where --strict forbids it; a file that stood there then stays.
void WriteSubjectFile(const std::string& i_rPath, const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData,
    const CoreOrlexQRTIO::VSubjectQRTExtras& i_rExtras, std::uint32_t i_VersionValue);

} // namespace CommandLine
