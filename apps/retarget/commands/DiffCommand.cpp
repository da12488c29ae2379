#include "CommandLineText/Messages.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/Output.h"

#include "SetupReview/compare/Comparison.h"

namespace CommandLine
{
namespace
{

using SetupReview::VSetupChange;

struct VDiffSettings
{
	std::vector<std::string> m_Files;
	bool m_bDescribe = false;
};

/// What git names in place of a file that one side does not have.
constexpr const char* c_pNoFile = "/dev/null";

VSubjectFile ReadSide(const std::string& i_rPath)
{
	return i_rPath == c_pNoFile ? VSubjectFile() : ReadSubjectFile(i_rPath);
}

VJson ToJson(const std::vector<VSetupChange>& i_rChanges)
{
	VJson list = VJson::array();
	for (const VSetupChange& rChange : i_rChanges)
	{
		VJson item{{"id", rChange.m_Id}, {"element", rChange.m_Element}, {"name", rChange.m_Name},
		    {"field", rChange.m_Field}, {"words", rChange.m_Words}};
		if (!rChange.m_Before.empty() || !rChange.m_After.empty())
		{
			item["before"] = rChange.m_Before;
			item["after"] = rChange.m_After;
		}
		if (rChange.m_Millimetres)
			item["millimetres"] = *rChange.m_Millimetres;
		if (rChange.m_Degrees)
			item["degrees"] = *rChange.m_Degrees;
		list.push_back(std::move(item));
	}
	return list;
}

EExitStatus Diff(const VDiffSettings& i_rSettings)
{
	const std::vector<std::string>& rFiles = i_rSettings.m_Files;
	if (i_rSettings.m_bDescribe)
	{
		if (rFiles.size() != 1)
			throw VCommandError(EWrongUsage, "--describe tells what one file holds: give one file");
		const std::string text = SetupReview::DescribeSetup(ReadSide(rFiles.front()));
		PrintResult({{"file", rFiles.front()}, {"description", text}}, text);
		return EFine;
	}
	if (rFiles.size() != 2)
		throw VCommandError(
		    EWrongUsage, "Give two files to compare, the earlier one first; --describe tells what a single one holds");
	const VSubjectFile before = ReadSide(rFiles[0]);
	const std::vector<VSetupChange> changes = SetupReview::CompareSetups(before, ReadSide(rFiles[1]));
	std::string text;
	for (const VSetupChange& rChange : changes)
		text += Printable(SetupReview::ChangeLine(rChange)) + "\n";
	PrintResult({{"before", rFiles[0]}, {"after", rFiles[1]}, {"same", changes.empty()}, {"changes", ToJson(changes)}},
	    text.empty() ? "no differences\n" : text);
	return changes.empty() ? EFine : EFindings;
}

} // namespace

VCommand AddDiffCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "diff",
	    "Tell in what two retarget subjects differ, in the words of the trade: targets that were added, removed or "
	    "weighted anew, offsets that moved by so many mm or degrees, joints that were pruned, poses that turned, "
	    "scale, "
	    "segments, files. Nothing that differs goes unmentioned. Exit status 0 if they are the same, 1 if they differ",
	    {"diff hero.qrr hero-new.qrr",
	        "diff hero.qrr hero-new.qrr --json | jq -r '.changes[] | select(.degrees > 5) | "
	        ".name'",
	        "diff --describe hero.qrr", "git difftool --extcmd 'retarget diff' -- hero.qrr"});
	const auto pSettings = std::make_shared<VDiffSettings>();
	pApp->add_option("FILES", pSettings->m_Files,
	        "Skeleton files (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx): the earlier one, then the later one; one "
	        "may "
	        "be - for standard input, or /dev/null for one that is not there")
	    ->option_text("BEFORE AFTER")
	    ->required();
	pApp->add_flag("--describe", pSettings->m_bDescribe,
	    "Tell what one file holds, a line for each thing, for tools that compare lines, as git does by its textconv");
	return {pApp, [pSettings] { return Diff(*pSettings); }};
}

} // namespace CommandLine
