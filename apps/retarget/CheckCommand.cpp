#include "retarget/Commands.h"
#include "retarget/Output.h"
#include "retarget/SubjectFile.h"

#include "CoreOrlexTypesUtils/SubjectCheck.h"

namespace CommandLine
{
namespace
{

using CoreOrlexTypesUtils::VSubjectFinding;
using VFindings = std::vector<VSubjectFinding>;

struct VCheckSettings
{
	std::string m_File;
	bool m_bJson = false;
};

/// With the names of targets, which stand in the application data.
VFindings FindingsOf(const CoreOrlexTypes::VSubjectRecord& i_rRecord)
{
	VFindings findings = CoreOrlexTypesUtils::FindSubjectFaults(i_rRecord.m_SubjectParametrised);
	const auto& rTargets = i_rRecord.m_SubjectApplicationData.m_Targets;
	for (VSubjectFinding& rFinding : findings)
		if (rFinding.m_Element == VSubjectFinding::ETarget && rFinding.m_Index < rTargets.size())
			rFinding.m_Name = rTargets[rFinding.m_Index].m_Name;
	return findings;
}

const char* KindOf(VSubjectFinding::EElement i_Element)
{
	switch (i_Element)
	{
	case VSubjectFinding::EStaticParameter: return "static parameter";
	case VSubjectFinding::EMarker: return "marker";
	case VSubjectFinding::ESegment: return "segment";
	case VSubjectFinding::ETarget: return "target";
	}
	return "";
}

VJson ToJson(const VFindings& i_rFindings)
{
	VJson list = VJson::array();
	for (const VSubjectFinding& rFinding : i_rFindings)
		list.push_back({{"kind", KindOf(rFinding.m_Element)}, {"index", rFinding.m_Index}, {"name", rFinding.m_Name},
		    {"message", rFinding.m_Message}, {"remedy", rFinding.m_Remedy}, {"tolerated", rFinding.m_bTolerated}});
	return list;
}

std::string ToText(const VFindings& i_rFindings)
{
	std::string text;
	for (const VSubjectFinding& rFinding : i_rFindings)
	{
		text += std::string(KindOf(rFinding.m_Element)) + " #" + std::to_string(rFinding.m_Index);
		if (!rFinding.m_Name.empty())
			text += " \"" + Printable(rFinding.m_Name) + "\"";
		text += ": " + Printable(rFinding.m_Message) + (rFinding.m_bTolerated ? " (tolerated)" : "") + "\n    "
		    + Printable(rFinding.m_Remedy) + "\n";
	}
	const std::size_t count = i_rFindings.size();
	return text + (count == 0 ? "no findings" : std::to_string(count) + (count == 1 ? " finding" : " findings")) + "\n";
}

EExitStatus ShowFindings(const VCheckSettings& i_rSettings)
{
	VSubjectFile file;
	const bool bRead = TryReadSubjectFile(i_rSettings.m_File, file);
	VFindings findings = FindingsOf(file.m_Record);
	// Elements that the reader dropped leave gaps among the others that are no fault of the file's.
	if (!bRead)
		std::erase_if(findings,
		    [](const VSubjectFinding& i_rFinding)
		    { return i_rFinding.m_Element != VSubjectFinding::EStaticParameter; });
	if (bRead || !findings.empty())
	{
		if (i_rSettings.m_bJson)
			PrintJson(ToJson(findings));
		else
			Print(ToText(findings));
	}
	if (!bRead)
		throw VCommandError(EBadInput,
		    "\"" + i_rSettings.m_File + "\" could not be read as a skeleton file"
		        + (findings.empty() ? "" : "; only its static parameters were checked"));
	return findings.empty() ? EFine : EFindings;
}

} // namespace

VCommand AddCheckCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "check",
	    "Check whether a skeleton or retarget file is well formed: each finding with the element that it concerns and "
	    "how to mend it, in the names that \"retarget dump\" shows. Exit status 1 if there is any; what a finding "
	    "calls "
	    "tolerated works all the same",
	    {"check hero.qrr", "check hero.qrr --json | jq -r '.[] | .kind + \" \" + .name + \": \" + .message'"});
	const auto pSettings = std::make_shared<VCheckSettings>();
	pApp->add_option("FILE", pSettings->m_File, "Skeleton file (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx)")
	    ->required();
	pApp->add_flag("--json", pSettings->m_bJson, "As JSON");
	return {pApp, [pSettings] { return ShowFindings(*pSettings); }};
}

} // namespace CommandLine
