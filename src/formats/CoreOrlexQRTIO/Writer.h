#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <boost/filesystem/path.hpp>

#include <string>
#include <vector>

namespace CoreOrlexQRTIO
{

/// Version value that lets the writer choose the lowest version that holds the subject.
inline constexpr std::uint32_t c_AutomaticVersion = 19;

class VWriter
{
public:
	/// Replaces the file only when the whole text stands on disk.
	/// @return 0, or 0x80000020 on failure. Errors go to o_pErrors, without it to the log category "QRTIO".
	std::uint32_t Write(const boost::filesystem::path& i_rPath, const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
	    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras,
	    std::uint32_t i_VersionValue, std::vector<std::string>* o_pErrors = nullptr);
};

} // namespace CoreOrlexQRTIO
