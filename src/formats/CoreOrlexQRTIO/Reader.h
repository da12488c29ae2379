#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <boost/filesystem/path.hpp>

#include <string>
#include <vector>

namespace CoreOrlexQRTIO
{

/// Subject id that asks for ids hashed from names.
inline constexpr std::uint32_t c_HashedIds = 0xFFFFFFFFu;

/// Reads the skeleton file family (.qrt, .qrk, .qrs, .qrr), versions 1.0 to 3.5. One reader serves one thread.
class VReader
{
public:
	/// Warnings and errors go to the log category "QRTIO". On false the outputs are empty or partly filled.
	bool Read(const boost::filesystem::path& i_rPath, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
	    CoreOrlexTypes::VSubjectParametrised& o_rSubject, CoreOrlexTypes::VSubjectApplicationData& o_rApplicationData,
	    VSubjectQRTExtras& o_rExtras);

	/// Warnings and errors go to the caller.
	bool Read(const boost::filesystem::path& i_rPath, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
	    CoreOrlexTypes::VSubjectParametrised& o_rSubject, CoreOrlexTypes::VSubjectApplicationData& o_rApplicationData,
	    VSubjectQRTExtras& o_rExtras, std::vector<std::string>& o_rErrors, std::vector<std::string>& o_rWarnings);

	/// Writes the generated XML schema of the format. False if the file could not be written.
	bool WriteSchema(const boost::filesystem::path& i_rPath);
};

} // namespace CoreOrlexQRTIO
