#include "CommandLineText/HelpFormatter.h"
#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "CommandLineText/System.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Advice.h"
#include "retarget/subject/TargetLines.h"
#include "retarget/text/Output.h"
#include "retarget/text/Table.h"

#include "SetupIO/CommandText.h"

#include <unistd.h>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using SetupReview::VPruneAdvice;
using SetupReview::VRangeConflict;

struct VAdviseSettings
{
	std::string m_In;
	std::string m_Source;
	std::string m_Fbx;
};

VJson ToJson(const std::vector<VPruneAdvice>& i_rAdvice, const VSubjectParametrised& i_rSubject)
{
	VJson list = VJson::array();
	for (const VPruneAdvice& rAdvice : i_rAdvice)
	{
		VJson change;
		if (rAdvice.m_PoseChange)
			change = {{"segment", i_rSubject.m_Segments[rAdvice.m_PoseChange->m_SegmentIndex].m_Name},
			    {"millimetres", rAdvice.m_PoseChange->m_Distance},
			    {"degrees", AsDegrees(rAdvice.m_PoseChange->m_Angle)}};
		list.push_back({{"index", rAdvice.m_Segment}, {"segment", i_rSubject.m_Segments[rAdvice.m_Segment].m_Name},
		    {"verdict", SetupReview::NameOf(rAdvice.m_Verdict)}, {"targetsBelow", rAdvice.m_TargetsBelow},
		    {"vertices", rAdvice.m_Vertices}, {"poseChange", change}, {"words", rAdvice.m_Words},
		    {"options", rAdvice.m_Options}});
	}
	return list;
}

VJson ToJson(const SetupReview::VRangeOfMotion& i_rRange, const VSubjectParametrised& i_rSource)
{
	VJson conflicts = VJson::array();
	for (const VRangeConflict& rConflict : i_rRange.m_Conflicts)
	{
		const auto value = [&](double i_Value) { return rConflict.m_bRotation ? AsDegrees(i_Value) : i_Value; };
		conflicts.push_back({{"target", rConflict.m_Target}, {"unit", rConflict.m_bRotation ? "degrees" : "mm"},
		    {"atRest", value(rConflict.m_AtRest)}, {"atWorst", value(rConflict.m_AtWorst)},
		    {"source", i_rSource.m_Segments[rConflict.m_SourceSegment].m_Name}, {"axis", rConflict.m_Axis},
		    {"degrees", AsDegrees(rConflict.m_Angle)}, {"against", rConflict.m_Against},
		    {"without", value(rConflict.m_Without)}, {"words", rConflict.m_Words}});
	}
	return {{"poses", i_rRange.m_Poses}, {"notConverged", i_rRange.m_NotConverged}, {"cutShort", i_rRange.m_bCutShort},
	    {"conflicts", conflicts}, {"unopposed", i_rRange.m_Unopposed}};
}

/// What removes the joints of this verdict; empty if there are none.
std::string OptionsFor(const SetupReview::VAdvice& i_rAdvice, SetupReview::EPruneVerdict i_Verdict)
{
	std::string options;
	for (const VPruneAdvice& rAdvice : i_rAdvice.m_Prune)
		if (rAdvice.m_Verdict == i_Verdict)
			options += " " + rAdvice.m_Options;
	return options;
}

std::string PruneText(
    const SetupReview::VAdvice& i_rAdvice, const VSubjectParametrised& i_rSubject, const std::string& i_rFile)
{
	if (i_rAdvice.m_Prune.empty())
		return "Every joint carries a target\n";
	VTable table;
	table.AddColumn("JOINT", VTable::ELeft);
	table.AddColumn("VERDICT", VTable::ELeft);
	table.AddColumn("POSE WITHOUT IT", VTable::ELeft);
	table.AddColumn("WHY", VTable::ELeft);
	for (const VPruneAdvice& rAdvice : i_rAdvice.m_Prune)
		table.AddRow({i_rSubject.m_Segments[rAdvice.m_Segment].m_Name, SetupReview::NameOf(rAdvice.m_Verdict),
		    SetupReview::PoseChangeText(rAdvice, i_rSubject), rAdvice.m_Words});
	std::string text =
	    "Joints without a target of their own\n" + table.Text(HasColours(STDOUT_FILENO), TerminalWidth());
	const std::string file = SetupIO::ForShell(i_rFile == "-" ? "FILE.qrr" : i_rFile);
	for (const auto& [pWhich, verdict] : {std::pair("could go", SetupReview::EPruneVerdict::Go),
	         {"may go, each for a look of its own", SetupReview::EPruneVerdict::May}})
		if (const std::string options = OptionsFor(i_rAdvice, verdict); !options.empty())
			text += std::string("\nThose that ") + pWhich + "\n  retarget edit " + Printable(file + options) + " -o "
			    + Printable(file) + "\n";
	return text;
}

std::string RangeText(const SetupReview::VRangeOfMotion& i_rRange)
{
	std::string text = "\n" + SetupReview::RangeSummary(i_rRange) + "\n";
	for (std::size_t i = 0; i < i_rRange.m_Conflicts.size(); ++i)
	{
		const VRangeConflict& rConflict = i_rRange.m_Conflicts[i];
		if (i == 0 || rConflict.m_Against != i_rRange.m_Conflicts[i - 1].m_Against)
			text += FitTerminal(Printable("Target " + rConflict.m_AgainstName + " pulls against"), 2) + "\n";
		text += "  " + FitTerminal(Printable("target " + rConflict.m_TargetName + ", which " + rConflict.m_Words), 4)
		    + "\n";
	}
	return text;
}

EExitStatus Advise(const VAdviseSettings& i_rSettings)
{
	VSession session;
	session.LoadTarget(i_rSettings.m_In);
	if (!i_rSettings.m_Source.empty())
		session.LoadSource(i_rSettings.m_Source);
	const SetupReview::VAdvice advice = AdviceOn(session, i_rSettings.m_Fbx);
	VJson json{{"skin", advice.m_bSkin}, {"prune", ToJson(advice.m_Prune, session.Target())}};
	std::string text = PruneText(advice, session.Target(), i_rSettings.m_In);
	if (advice.m_Range)
	{
		json["range"] = ToJson(*advice.m_Range, session.Source(""));
		text += RangeText(*advice.m_Range);
	}
	PrintResult(json, text);
	return EFine;
}

} // namespace

VCommand AddAdviseCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "advise",
	    "Advise on the joints of a retarget subject: which carry no target and could go, what the bind pose would be "
	    "without each, and with the character's file which must stay since its skin bends there. With the performer's "
	    "skeleton, each of its joints goes through its range, and targets are told that pull against others there. "
	    "Nothing is written",
	    {"advise hero.qrr --fbx hero.fbx", "advise hero.qrr --source performer.qrs",
	        "advise hero.qrr --json | jq -r '.prune[] | select(.verdict == \"go\") | .segment'"});
	const auto pSettings = std::make_shared<VAdviseSettings>();
	pApp->add_option("FILE.qrr", pSettings->m_In, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--source", pSettings->m_Source, "The performer's skeleton, for the range of motion")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_option("--fbx", pSettings->m_Fbx, "The character's FBX file, for the skin")
	    ->option_text("FILE")
	    ->check(NotEmpty());
	return {pApp, [pSettings] { return Advise(*pSettings); }};
}

} // namespace CommandLine
