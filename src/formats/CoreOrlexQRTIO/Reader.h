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
	/// @param i_bOwnFormsAreDetails what is told of the attributes xmlns:* and xsi:*, which every written file has
	/// and the format does not declare, is no warning but goes to the log as a detail; so is a name that a marker and a
	/// segment share, as they do where performer and character name a segment alike.
	explicit VReader(bool i_bOwnFormsAreDetails = false) : m_bOwnFormsAreDetails(i_bOwnFormsAreDetails) {}

	/// Warnings and errors go to the log category "QRTIO". On false the outputs are empty or partly filled.
	/// @param i_SubjectId c_HashedIds makes the ids of subject, markers and rotations hashes of their names; with any
	/// other id those of markers and rotations are counts.
	bool Read(const boost::filesystem::path& i_rPath, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
	    CoreOrlexTypes::VSubjectParametrised& o_rSubject, CoreOrlexTypes::VSubjectApplicationData& o_rApplicationData,
	    VSubjectQRTExtras& o_rExtras);

	/// Warnings and errors go to the caller.
	bool Read(const boost::filesystem::path& i_rPath, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
	    CoreOrlexTypes::VSubjectParametrised& o_rSubject, CoreOrlexTypes::VSubjectApplicationData& o_rApplicationData,
	    VSubjectQRTExtras& o_rExtras, std::vector<std::string>& o_rErrors, std::vector<std::string>& o_rWarnings);

	/// The same from the bytes of a file.
	bool ReadText(std::string i_Text, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
	    CoreOrlexTypes::VSubjectParametrised& o_rSubject, CoreOrlexTypes::VSubjectApplicationData& o_rApplicationData,
	    VSubjectQRTExtras& o_rExtras, std::vector<std::string>& o_rErrors, std::vector<std::string>& o_rWarnings);

	/// The XML schema of the format, generated from the same functions that read.
	std::string SchemaText();

	/// Writes the schema to a file. False, with the reason in the log category "QRTIO", if that failed.
	bool WriteSchema(const boost::filesystem::path& i_rPath);

private:
	bool m_bOwnFormsAreDetails;
};

} // namespace CoreOrlexQRTIO
