#include "retarget/subject/SubjectFile.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/subject/Session.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/OutputFile.h"

#include "CoreOrlexQRTIO/Limits.h"
#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/Identity.h"

#include <vector>

namespace CommandLine
{

bool TryReadSubjectFile(const std::string& i_rPath, VSubjectFile& o_rFile)
{
	if (RetargetSetup::FileExtension(i_rPath) == c_LegacyExtension)
	{
		VSession session;
		session.LoadTarget(i_rPath);
		const auto values = session.Document().TargetValues();
		o_rFile.m_Record = {*values.m_pParametrised, *values.m_pApplicationData};
		o_rFile.m_Extras = session.Document().GetTargetExtras();
		return true;
	}
	CoreOrlexQRTIO::VReader reader(/*i_bOwnFormsAreDetails*/ true);
	return reader.Read(InputPath(i_rPath, CoreOrlexQRTIO::c_MaximumFileSize), RetargetSetup::c_SubjectName,
	    RetargetSetup::c_SubjectId, o_rFile.m_Record.m_SubjectParametrised, o_rFile.m_Record.m_SubjectApplicationData,
	    o_rFile.m_Extras);
}

VSubjectFile ReadSubjectFile(const std::string& i_rPath)
{
	VSubjectFile file;
	if (!TryReadSubjectFile(i_rPath, file))
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as a skeleton file");
	return file;
}

void WriteSubjectFile(const std::string& i_rPath, const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData,
    const CoreOrlexQRTIO::VSubjectQRTExtras& i_rExtras, std::uint32_t i_VersionValue)
{
	std::string text;
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	const bool bWritten = CoreOrlexQRTIO::VWriter().WriteText(
	    i_rSubject, i_rApplicationData, i_rExtras, i_VersionValue, text, errors, warnings);
	for (const std::string& rWarning : warnings)
		NVX_LOG("QRTIO", NVX::ELogWarning, "%1%", rWarning);
	for (const std::string& rError : errors)
		NVX_LOG("QRTIO", NVX::ELogError, "%1%", rError);
	if (!bWritten)
		throw VCommandError(EBadOutput, "The subject could not be written");
	WriteText(text, i_rPath);
}

} // namespace CommandLine
