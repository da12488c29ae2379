#include "retarget/Commands.h"
#include "retarget/OutputFile.h"
#include "retarget/SubjectFile.h"

#include "CoreOrlexQRTIO/FormatVersions.h"
#include "CoreOrlexQRTIO/VersionLoss.h"
#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"

#include <boost/algorithm/string/join.hpp>
#include <boost/filesystem/operations.hpp>

namespace CommandLine
{
namespace
{

struct VConvertSettings
{
	std::string m_In;
	VOutput m_Out;
	std::uint32_t m_Version = CoreOrlexQRTIO::c_AutomaticVersion;
	std::string m_VersionText = "(automatic)";
};

/// A performer's skeleton and a retarget subject have one format, but take each other's place by a slip of the hand
/// only.
void CheckKind(const VConvertSettings& i_rSettings)
{
	const VOutput& rOut = i_rSettings.m_Out;
	CheckOutput(rOut, c_SkeletonFamilyFile);
	const std::string extension = LowerExtension(i_rSettings.m_In);
	boost::system::error_code error;
	if (!rOut.m_bForce && rOut.m_Path != "-" && boost::filesystem::exists(rOut.m_Path, error)
	    && LowerExtension(rOut.m_Path) != (extension == c_LegacyExtension ? ".qrr" : extension))
		throw VCommandError(EBadOutput,
		    "\"" + rOut.m_Path + "\" is there, and is of another kind than \"" + i_rSettings.m_In
		        + "\": give another name, or --force to replace it");
}

EExitStatus Convert(const VConvertSettings& i_rSettings)
{
	CheckKind(i_rSettings);
	const VSubjectFile file = ReadSubjectFile(i_rSettings.m_In);
	const CoreOrlexTypes::VSubjectRecord& rRecord = file.m_Record;
	const auto [losses, refusal] = CoreOrlexQRTIO::ListVersionLosses(
	    rRecord.m_SubjectParametrised, rRecord.m_SubjectApplicationData, file.m_Extras, i_rSettings.m_Version);
	if (!refusal.empty() && !i_rSettings.m_Out.m_bForce)
		throw VCommandError(EBadOutput,
		    "\"" + i_rSettings.m_Out.m_Path + "\" is not written, since nobody could read it again (" + refusal
		        + "): mend \"" + i_rSettings.m_In + "\", or give --force");
	if (!refusal.empty())
		NVX_LOG(c_pCategory, NVX::ELogWarning, "Nobody can read \"%1%\" again: %2%", i_rSettings.m_Out.m_Path, refusal);
	if (!losses.empty())
		NVX_LOG(c_pCategory, NVX::ELogWarning, "Version %1% of the format cannot hold: %2%", i_rSettings.m_VersionText,
		    boost::algorithm::join(losses, ", "));
	WriteSubjectFile(i_rSettings.m_Out.m_Path, rRecord.m_SubjectParametrised, rRecord.m_SubjectApplicationData,
	    file.m_Extras, i_rSettings.m_Version);
	return EFine;
}

} // namespace

VCommand AddConvertCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "convert",
	    "Read a skeleton or retarget file of any version and write it again. An older version cannot hold everything: "
	    "what it loses is told",
	    {"convert legacy.qrx hero.qrr", "convert performer.qrs old.qrs --format-version 2.6"});
	const auto pSettings = std::make_shared<VConvertSettings>();
	pApp->add_option("IN", pSettings->m_In, "Skeleton file (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx)")->required();
	pApp->add_option("OUT", pSettings->m_Out.m_Path,
	        "Where the skeleton file is written; may be IN itself, - is standard output")
	    ->required();
	AddForceOption(*pApp, pSettings->m_Out);
	pApp->get_option("--force")->description(
	    "Replace a file of another kind that stands where is written, and write what nobody can read again");
	pApp->add_option_function<std::string>(
	        "--format-version",
	        [pSettings](const std::string& i_rText)
	        {
		        const auto version = CoreOrlexQRTIO::VersionValueFromText(i_rText);
		        if (!version)
			        throw CLI::ValidationError("--format-version",
			            "the format has no version \"" + i_rText + "\", only " + CoreOrlexQRTIO::AllVersionTexts());
		        pSettings->m_Version = *version;
		        pSettings->m_VersionText = i_rText;
	        },
	        "Version of the format: " + CoreOrlexQRTIO::AllVersionTexts()
	            + " (default: the lowest from 3.2 on that holds everything)")
	    ->option_text("X.Y");
	return {pApp, [pSettings] { return Convert(*pSettings); }};
}

} // namespace CommandLine
