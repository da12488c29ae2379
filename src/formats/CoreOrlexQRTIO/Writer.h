#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <boost/filesystem/path.hpp>

#include <functional>
#include <string>
#include <vector>

namespace CoreOrlexQRTIO
{

/// Version value that lets the writer choose the lowest version that holds the subject.
inline constexpr std::uint32_t c_AutomaticVersion = 19;

/// Writes the skeleton file family at a version that the caller names by its value (see FormatVersions.h), or at the
/// lowest that holds the subject. What a version does not have is left out; VersionLoss.h tells what that is.
class VWriter
{
public:
	/// Replaces the file only when the whole text stands on disk: after a failure the file is what it was.
	/// @param i_VersionValue a value that stands for no version writes everything, which no reader takes back.
	/// @param i_rMayStand is shown the whole text; where it returns false, nothing is written and no error added.
	/// @return 0, or 0x80000020 on failure. Errors go to o_pErrors, without it to the log category "QRTIO", where
	/// warnings always go.
	std::uint32_t Write(const boost::filesystem::path& i_rPath, const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
	    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras,
	    std::uint32_t i_VersionValue, std::vector<std::string>* o_pErrors = nullptr,
	    const std::function<bool(const std::string& i_rText)>& i_rMayStand = {});

	/// The text of the file. Empty, and false, if there was an error.
	bool WriteText(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
	    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras,
	    std::uint32_t i_VersionValue, std::string& o_rText, std::vector<std::string>& o_rErrors,
	    std::vector<std::string>& o_rWarnings);
};

} // namespace CoreOrlexQRTIO
