#include "CommandLineText/Messages.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "CoreOrlexQRTIO/FormatVersions.h"
#include "CoreOrlexQRTIO/VersionLoss.h"
#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"

#include <boost/algorithm/string/join.hpp>
#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <set>

namespace CommandLine
{
namespace
{

struct VConvertSettings
{
	/// The files to read and, last, the file or folder to write.
	std::vector<std::string> m_Paths;
	bool m_bForce = false;
	std::uint32_t m_Version = CoreOrlexQRTIO::c_AutomaticVersion;
	std::string m_VersionText = "(automatic)";
};

/// One file to read and where it goes.
struct VConversion
{
	std::string m_In;
	VOutput m_Out;
	std::vector<std::string> m_Losses;
};

/// The extension of what a file is written as.
std::string WrittenExtension(const std::string& i_rPath)
{
	const std::string extension = LowerExtension(i_rPath);
	return extension == c_LegacyExtension ? ".qrr" : extension;
}

/// A performer's skeleton and a retarget subject have one format, but take each other's place by a slip of the hand
/// only.
void CheckKind(const VConversion& i_rConversion)
{
	const VOutput& rOut = i_rConversion.m_Out;
	CheckOutput(rOut, c_SkeletonFamilyFile);
	boost::system::error_code error;
	if (!rOut.m_bForce && rOut.m_Path != c_pStandardStream && boost::filesystem::exists(rOut.m_Path, error)
	    && LowerExtension(rOut.m_Path) != WrittenExtension(i_rConversion.m_In))
		throw VCommandError(EBadOutput,
		    "\"" + rOut.m_Path + "\" is there, and is of another kind than \"" + i_rConversion.m_In
		        + "\": give another name, or --force to replace it");
}

void Convert(const VConvertSettings& i_rSettings, VConversion& io_rConversion)
{
	CheckKind(io_rConversion);
	const std::string& rIn = io_rConversion.m_In;
	const VOutput& rOut = io_rConversion.m_Out;
	const VSubjectFile file = ReadSubjectFile(rIn);
	if (rOut.m_bForce)
		ForgiveErrors();
	const CoreOrlexTypes::VSubjectRecord& rRecord = file.m_Record;
	const auto [losses, refusal] = CoreOrlexQRTIO::ListVersionLosses(
	    rRecord.m_SubjectParametrised, rRecord.m_SubjectApplicationData, file.m_Extras, i_rSettings.m_Version);
	io_rConversion.m_Losses = losses;
	if (!refusal.empty() && !rOut.m_bForce)
		throw VCommandError(EBadOutput,
		    "\"" + rOut.m_Path + "\" is not written, since nobody could read it again (" + refusal + "): mend \"" + rIn
		        + "\", or give --force");
	if (!refusal.empty())
		NVX_LOG(c_pCategory, NVX::ELogWarning, "Nobody can read \"%1%\" again: %2%", rOut.m_Path, refusal);
	if (!losses.empty())
		NVX_LOG(c_pCategory, NVX::ELogWarning, "Version %1% of the format cannot hold: %2%", i_rSettings.m_VersionText,
		    boost::algorithm::join(losses, ", "));
	WriteSubjectFile(rOut.m_Path, rRecord.m_SubjectParametrised, rRecord.m_SubjectApplicationData, file.m_Extras,
	    i_rSettings.m_Version);
}

/// Where each file goes: into a folder under its own name, or, of one alone, to the file that is named.
std::vector<VConversion> Conversions(const VConvertSettings& i_rSettings)
{
	const std::vector<std::string>& rPaths = i_rSettings.m_Paths;
	if (rPaths.size() < 2)
		throw VCommandError(EWrongUsage, "OUT is missing: give where \"" + rPaths.front() + "\" is to be written");
	const std::string& rOut = rPaths.back();
	boost::system::error_code error;
	const bool bFolder = boost::filesystem::is_directory(rOut, error);
	if (rPaths.size() > 2 && !bFolder)
		throw VCommandError(EWrongUsage,
		    "\"" + rOut + "\" is no folder: several files can only be written into one, under their own names");
	std::vector<VConversion> conversions;
	std::set<std::string> names;
	for (auto it = rPaths.begin(); it != rPaths.end() - 1; ++it)
	{
		if (bFolder && *it == c_pStandardStream)
			throw VCommandError(EWrongUsage,
			    "standard input has no name under which it could go into \"" + rOut + "\": name the file to write");
		boost::filesystem::path out = rOut;
		if (bFolder)
			out /= boost::filesystem::path(*it).filename().replace_extension(WrittenExtension(*it));
		if (!names.insert(out.string()).second)
			throw VCommandError(EWrongUsage, "two files would be written to \"" + out.string() + "\"");
		conversions.push_back({*it, {out.string(), i_rSettings.m_bForce}, {}});
	}
	return conversions;
}

EExitStatus ConvertAll(const VConvertSettings& i_rSettings)
{
	std::vector<VConversion> conversions = Conversions(i_rSettings);
	VJson report = VJson::array();
	EExitStatus status = EFine;
	for (VConversion& rConversion : conversions)
	{
		try
		{
			Convert(i_rSettings, rConversion);
			report.push_back(
			    {{"input", rConversion.m_In}, {"output", rConversion.m_Out.m_Path}, {"losses", rConversion.m_Losses}});
		}
		catch (const VCommandError& rError)
		{
			// One bad file among many does not keep the others waiting.
			if (conversions.size() == 1)
				throw;
			status = std::max(status, rError.Status());
			NVX_LOG(c_pCategory, NVX::ELogError, "\"%1%\" is not converted: %2%", rConversion.m_In, rError.what());
			ForgetCounts();
		}
	}
	const std::size_t count = conversions.size();
	PrintResult(report,
	    count == 1 ? ""
	               : std::to_string(count) + " files: " + std::to_string(report.size()) + " converted, "
	            + std::to_string(count - report.size()) + " not\n");
	return status;
}

} // namespace

VCommand AddConvertCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "convert",
	    "Read a skeleton or retarget file of any version and write it again. An older version cannot hold everything: "
	    "what it loses is told",
	    {"convert legacy.qrx hero.qrr", "convert performer.qrs old.qrs --format-version 2.6",
	        "convert season1/*.qrr converted/"});
	const auto pSettings = std::make_shared<VConvertSettings>();
	pApp->add_option("FILES", pSettings->m_Paths,
	        "IN: a skeleton file (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx), or several. OUT: where it is written; "
	        "may "
	        "be IN itself, - is standard output, and a folder takes each file under its own name")
	    ->option_text("IN... OUT")
	    ->required();
	pApp->add_flag("--force", pSettings->m_bForce,
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
	return {pApp, [pSettings] { return ConvertAll(*pSettings); }};
}

} // namespace CommandLine
