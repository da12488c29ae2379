#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Mapping.h"
#include "retarget/subject/Session.h"
#include "retarget/text/Output.h"
#include "retarget/text/PoseFindings.h"
#include "retarget/text/Table.h"

#include <cmath>
#include <unistd.h>

namespace CommandLine
{
namespace
{

using SetupProposal::VProposedPair;
using SetupProposal::VRestSkeleton;

struct VMapSettings
{
	std::string m_Source;
	std::string m_Fbx;
	std::string m_Subject;
	std::string m_MinimumScore;
};

std::string PairKind(const VProposedPair& i_rPair)
{
	std::string text;
	if (i_rPair.m_PositionWeight > 0.0)
		text += "position " + Shortest(i_rPair.m_PositionWeight);
	if (i_rPair.m_RotationWeight > 0.0)
		text += (text.empty() ? "rotation " : ", rotation ") + Shortest(i_rPair.m_RotationWeight);
	return text;
}

std::string Joined(const std::vector<std::string>& i_rTexts)
{
	std::string joined;
	for (const std::string& rText : i_rTexts)
		joined += (joined.empty() ? "" : "; ") + rText;
	return joined;
}

std::string TableOf(const std::vector<VProposedPair>& i_rPairs, const VMapped& i_rMapped)
{
	VTable table;
	table.AddColumn("SCORE", VTable::ERight);
	table.AddColumn("SOURCE", VTable::ELeft);
	table.AddColumn("TARGET", VTable::ELeft);
	table.AddColumn("KIND AND WEIGHT", VTable::ELeft);
	table.AddColumn("REASONS", VTable::ELeft);
	for (const VProposedPair& rPair : i_rPairs)
		table.AddRow({Fixed(rPair.m_Score, 2), i_rMapped.m_Source[rPair.m_Source].m_Name,
		    i_rMapped.m_Target[rPair.m_Target].m_Name, PairKind(rPair), Joined(rPair.m_Reasons)});
	return table.Text(HasColours(STDOUT_FILENO));
}

std::string ListOf(const std::vector<SetupProposal::VUnmapped>& i_rUnmapped, const VRestSkeleton& i_rSkeleton)
{
	std::string text;
	for (const auto& rUnmapped : i_rUnmapped)
		text += "  " + Printable(i_rSkeleton[rUnmapped.m_Joint].m_Name) + ": " + rUnmapped.m_Reason + "\n";
	return text.empty() ? "  none\n" : text;
}

std::string ToText(const VMapped& i_rMapped)
{
	const SetupProposal::VProposal& rProposal = i_rMapped.m_Proposal;
	std::string text = rProposal.m_NoBody.empty() ? TableOf(rProposal.m_Pairs, i_rMapped)
	                                              : "Nothing is proposed. " + rProposal.m_NoBody + "\n";
	if (!rProposal.m_Alternatives.empty())
		text += "\nAlternatives\n" + TableOf(rProposal.m_Alternatives, i_rMapped);
	text += "\nWithout a pair, of the source\n" + ListOf(rProposal.m_UnmappedSources, i_rMapped.m_Source);
	text += "\nWithout a pair, of the target\n" + ListOf(rProposal.m_UnmappedTargets, i_rMapped.m_Target);
	if (i_rMapped.m_Root >= 0)
		text += "\nThe body's root is " + Printable(i_rMapped.m_Target[std::size_t(i_rMapped.m_Root)].m_Name) + "\n";
	return text;
}

EExitStatus Map(const VMapSettings& i_rSettings)
{
	if (i_rSettings.m_Fbx.empty() && i_rSettings.m_Subject.empty())
		throw VCommandError(EWrongUsage, "Give a character: --fbx FILE, a retarget subject, or both");
	VSession session;
	session.LoadSource(i_rSettings.m_Source);
	if (!i_rSettings.m_Subject.empty())
		session.LoadTarget(i_rSettings.m_Subject);
	if (!i_rSettings.m_Fbx.empty())
		session.LoadFbx(i_rSettings.m_Fbx);
	if (!i_rSettings.m_MinimumScore.empty())
		session.m_MinimumScore = ParseScore(i_rSettings.m_MinimumScore);
	const VMapped mapped = i_rSettings.m_Subject.empty() ? ProposeForFile(session) : ProposeForSubject(session);
	const auto findings = SetupProposal::CheckPose(mapped.m_Source, mapped.m_Target, mapped.m_Proposal);
	VJson json = MappedToJson(mapped);
	json["pose"] = PoseJson(findings);
	PrintResult(json, ToText(mapped) + PoseText(findings));
	return EFine;
}

} // namespace

VCommand AddMapCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "map",
	    "Propose which segment of a performer belongs to which of a character, with a score from 0 to 1 and the "
	    "reasons: "
	    "names, the tree and the rest pose. It also looks whether the two face the same way and stand alike. Kinds and "
	    "weights are what the targets of a pair should get. Nothing is "
	    "written: \"create --auto\" and \"edit --auto\" take the pairs over",
	    {"map --source performer.qrs --fbx hero.fbx", "map hero.qrr --source performer.qrs --min-score 0.7",
	        "map --source performer.qrs --fbx hero.fbx --json | jq -r '.pairs[] | .source + \":\" + .target'"});
	const auto pSettings = std::make_shared<VMapSettings>();
	pApp->add_option("IN.qrr", pSettings->m_Subject,
	    "A retarget subject, in place of an FBX file, or with its own for what it stands on");
	pApp->add_option("--source", pSettings->m_Source, "The performer's skeleton")->option_text("FILE.qrs")->required();
	pApp->add_option("--fbx", pSettings->m_Fbx, "The character's FBX file")->option_text("FILE");
	pApp->add_option("--min-score", pSettings->m_MinimumScore,
	        "Propose no pair that scores less: from 0 to 1, 0.5 if left out; what it keeps out stands with the "
	        "alternatives")
	    ->option_text("SCORE");
	return {pApp, [pSettings] { return Map(*pSettings); }};
}

} // namespace CommandLine
