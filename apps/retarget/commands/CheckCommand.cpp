#include "CommandLineText/HelpFormatter.h"
#include "CommandLineText/Messages.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Findings.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/Output.h"

#include "DebugServices/GlobalLog.h"

namespace CommandLine
{
namespace
{

using CoreOrlexTypesUtils::VSubjectFinding;

struct VChecked
{
	std::string m_File;
	bool m_bReadable = false;
	VFindings m_Findings;
};

/// One list for all files, as scripts know it of one.
VJson ToJson(const std::vector<VChecked>& i_rFiles)
{
	VJson list = VJson::array();
	for (const VChecked& rFile : i_rFiles)
		for (const VSubjectFinding& rFinding : rFile.m_Findings)
			list.push_back({{"file", rFile.m_File}, {"kind", KindOf(rFinding.m_Element)}, {"index", rFinding.m_Index},
			    {"name", rFinding.m_Name}, {"message", rFinding.m_Message}, {"remedy", rFinding.m_Remedy},
			    {"tolerated", rFinding.m_bTolerated}});
	return list;
}

std::string Count(std::size_t i_Count, const std::string& i_rWhat)
{
	return (i_Count == 0 ? "no" : std::to_string(i_Count)) + " " + i_rWhat + (i_Count == 1 ? "" : "s");
}

std::string ToText(const VFindings& i_rFindings)
{
	std::string text;
	for (const VSubjectFinding& rFinding : i_rFindings)
	{
		std::string line = std::string(KindOf(rFinding.m_Element)) + " #" + std::to_string(rFinding.m_Index);
		if (!rFinding.m_Name.empty())
			line += " \"" + Printable(rFinding.m_Name) + "\"";
		line += ": " + Printable(rFinding.m_Message) + (rFinding.m_bTolerated ? " (tolerated)" : "");
		text += FitTerminal(line, 2) + "\n    " + FitTerminal(Printable(rFinding.m_Remedy), 4) + "\n";
	}
	return text + Count(i_rFindings.size(), "finding") + "\n";
}

VChecked Check(const std::string& i_rPath)
{
	VChecked checked{i_rPath, false, {}};
	VSubjectFile file;
	try
	{
		checked.m_bReadable = TryReadSubjectFile(i_rPath, file);
	}
	catch (const VCommandError& rError)
	{
		NVX_LOG(c_pCategory, NVX::ELogError, "%1%", rError.what());
		return checked;
	}
	checked.m_Findings = FindingsOf(file.m_Record);
	if (checked.m_bReadable)
		return checked;
	// Elements that the reader dropped leave gaps among the others that are no fault of the file's.
	std::erase_if(checked.m_Findings,
	    [](const VSubjectFinding& i_rFinding) { return i_rFinding.m_Element != VSubjectFinding::EStaticParameter; });
	NVX_LOG(c_pCategory, NVX::ELogError, "\"%1%\" could not be read as a skeleton file%2%", i_rPath,
	    checked.m_Findings.empty() ? "" : "; only its static parameters were checked");
	return checked;
}

EExitStatus ShowFindings(const std::vector<std::string>& i_rPaths)
{
	std::vector<VChecked> files;
	std::string text;
	std::size_t unreadable = 0;
	std::size_t faulty = 0;
	for (const std::string& rPath : i_rPaths)
	{
		const VChecked& rFile = files.emplace_back(Check(rPath));
		unreadable += !rFile.m_bReadable;
		faulty += !rFile.m_Findings.empty();
		if (!rFile.m_bReadable && rFile.m_Findings.empty())
			continue;
		text += (i_rPaths.size() > 1 ? Printable(rPath) + ":\n" : "") + ToText(rFile.m_Findings);
	}
	if (i_rPaths.size() > 1)
		text += Count(files.size(), "file") + ": " + std::to_string(faulty) + " with findings, "
		    + std::to_string(unreadable) + " unreadable\n";
	if (!text.empty())
		PrintResult(ToJson(files), text);
	if (unreadable > 0)
		return EBadInput;
	return faulty > 0 ? EFindings : EFine;
}

} // namespace

VCommand AddCheckCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "check",
	    "Check whether a skeleton or retarget file is well formed: each finding with the element that it concerns and "
	    "how to mend it, in the names that \"retarget dump\" shows. Exit status 1 if there is any; what a finding "
	    "calls "
	    "tolerated works all the same",
	    {"check hero.qrr", "check *.qrr *.qrs",
	        "check hero.qrr --json | jq -r '.[] | .kind + \" \" + .name + \": \" + .message'"});
	const auto pFiles = std::make_shared<std::vector<std::string>>();
	pApp->add_option("FILE", *pFiles, "Skeleton files (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx), any number")
	    ->option_text("FILE...")
	    ->required();
	return {pApp, [pFiles] { return ShowFindings(*pFiles); }};
}

} // namespace CommandLine
