#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Mapping.h"
#include "retarget/subject/Session.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"
#include "retarget/text/Table.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "SetupReview/rebind/Rebind.h"

#include <cmath>
#include <unistd.h>

namespace CommandLine
{
namespace
{

using SetupReview::ERebindRule;
using SetupReview::VRebound;
using SetupReview::VSetup;

struct VRebindSettings
{
	std::string m_In;
	std::string m_Fbx;
	std::optional<std::string> m_Root;
	std::string m_Source;
	bool m_bMeasure = false;
	bool m_bAllowPartial = false;
	std::string m_MinimumScore;
	VOutput m_Out;
};

const char* RuleText(ERebindRule i_Rule)
{
	switch (i_Rule)
	{
	case ERebindRule::Name: return "name";
	case ERebindRule::Place: return "place";
	case ERebindRule::Proposal: return "proposal";
	case ERebindRule::None: break;
	}
	return "none";
}

VJson MatchesToJson(const VRebound& i_rRebound)
{
	VJson list = VJson::array();
	for (const SetupReview::VRebindMatch& rMatch : i_rRebound.m_Matches)
		list.push_back({{"old", rMatch.m_Old}, {"new", rMatch.m_New.empty() ? VJson() : VJson(rMatch.m_New)},
		    {"rule", RuleText(rMatch.m_Rule)}, {"score", std::round(1e4 * rMatch.m_Score) / 1e4}});
	return list;
}

/// What has another name, or none; the others are only counted.
std::string MatchesToText(const VRebound& i_rRebound, const std::string& i_rWhat)
{
	VTable table;
	table.AddColumn("OLD", VTable::ELeft);
	table.AddColumn("NEW", VTable::ELeft);
	table.AddColumn("BY", VTable::ELeft);
	table.AddColumn("SCORE", VTable::ERight);
	std::size_t same = 0;
	for (const SetupReview::VRebindMatch& rMatch : i_rRebound.m_Matches)
		if (rMatch.m_Rule == ERebindRule::Name)
			++same;
		else
			table.AddRow({rMatch.m_Old, rMatch.m_New.empty() ? "-" : rMatch.m_New, RuleText(rMatch.m_Rule),
			    Fixed(rMatch.m_Score, 2)});
	return i_rWhat + ": " + std::to_string(same) + " of " + std::to_string(i_rRebound.m_Matches.size())
	    + " have their names\n" + (same < i_rRebound.m_Matches.size() ? table.Text(HasColours(STDOUT_FILENO)) : "");
}

std::string ListText(const std::string& i_rTitle, const std::vector<std::string>& i_rLines)
{
	std::string text;
	for (const std::string& rLine : i_rLines)
		text += "  " + Printable(rLine) + "\n";
	return text.empty() ? text : i_rTitle + "\n" + text;
}

/// What is told, in both forms, of all that was done.
struct VTold
{
	VJson m_Json = VJson::object();
	std::string m_Text;
	std::vector<std::string> m_Lost;
};

void Take(VSession& io_rSession, const VRebound& i_rRebound, VTold& io_rTold)
{
	if (!i_rRebound.m_Refusal.empty())
		throw VCommandError(EBadInput, i_rRebound.m_Refusal);
	const auto& rRecord = i_rRebound.m_Setup.m_Record;
	if (!io_rSession.Document().SetTargetSubject(
	        rRecord.m_SubjectParametrised, rRecord.m_SubjectApplicationData, i_rRebound.m_Setup.m_Extras))
		throw VCommandError(EBadInput, "The subject could not be taken over");
	io_rSession.Settle();
	io_rTold.m_Lost.insert(io_rTold.m_Lost.end(), i_rRebound.m_Lost.begin(), i_rRebound.m_Lost.end());
}

VSetup SetupOf(VSession& io_rSession)
{
	const auto values = io_rSession.Document().TargetValues();
	return {{*values.m_pParametrised, *values.m_pApplicationData}, io_rSession.Document().GetTargetExtras()};
}

void RebindToCharacter(VSession& io_rSession, const VRebindSettings& i_rSettings, VTold& io_rTold)
{
	io_rSession.LoadFbx(i_rSettings.m_Fbx);
	const auto pSkeleton = io_rSession.Document().GetFBXSkeleton();
	SetupReview::VNewCharacter character{
	    *pSkeleton, io_rSession.Document().GetTargetAxisMatrix(), io_rSession.Document().GetTargetName(), {}};
	if (i_rSettings.m_Fbx == c_pStandardStream)
		character.m_Name.clear();
	if (i_rSettings.m_Root)
		character.m_Root = FindRootBone(*i_rSettings.m_Root, *pSkeleton);
	const VRebound rebound = SetupReview::RebindCharacter(SetupOf(io_rSession), character, io_rSession.m_MinimumScore);
	Take(io_rSession, rebound, io_rTold);
	std::vector<std::string> changes;
	VJson json = VJson::array();
	for (const SetupReview::VSetupChange& rChange : rebound.m_Changes)
	{
		changes.push_back(SetupReview::ChangeLine(rChange));
		json.push_back(Printable(changes.back()));
	}
	io_rTold.m_Json["segments"] = MatchesToJson(rebound);
	io_rTold.m_Json["added"] = rebound.m_Added;
	io_rTold.m_Json["changes"] = json;
	io_rTold.m_Text += MatchesToText(rebound, "Segments of the character") + ListText("New", rebound.m_Added)
	    + ListText("What changed beside names", changes);
}

void RebindToPerformer(VSession& io_rSession, const VRebindSettings& i_rSettings, VTold& io_rTold)
{
	const auto source = io_rSession.Document().SourceValues();
	const auto target = io_rSession.Document().TargetValues();
	const std::string name =
	    i_rSettings.m_Source == c_pStandardStream ? "" : io_rSession.Document().GetShownSourceName();
	const VRebound rebound = SetupReview::RebindPerformer(SetupOf(io_rSession),
	    RetargetSetup::RestOf(*source.m_pParametrised, *source.m_pSubject),
	    RetargetSetup::RestOf(*target.m_pParametrised, *target.m_pSubject), name, io_rSession.m_MinimumScore);
	Take(io_rSession, rebound, io_rTold);
	io_rTold.m_Json["sources"] = MatchesToJson(rebound);
	io_rTold.m_Text += MatchesToText(rebound, "What targets follow");
}

EExitStatus Rebind(const VRebindSettings& i_rSettings)
{
	if (i_rSettings.m_Fbx.empty() && i_rSettings.m_Source.empty())
		throw VCommandError(
		    EWrongUsage, "Give what is new: the character's file with --fbx, the performer's with --source, or both");
	if (i_rSettings.m_bMeasure && i_rSettings.m_Source.empty())
		throw VCommandError(EWrongUsage, "--measure needs the performer's skeleton: give it with --source FILE.qrs");
	if (i_rSettings.m_Root && i_rSettings.m_Fbx.empty())
		throw VCommandError(EWrongUsage, "--root is a bone of the new character: give its file with --fbx");
	const bool bWrite = !i_rSettings.m_Out.m_Path.empty();
	if (bWrite)
		CheckOutput(i_rSettings.m_Out, c_RetargetSubjectFile, {i_rSettings.m_Fbx, i_rSettings.m_Source});
	VSession session;
	if (!i_rSettings.m_MinimumScore.empty())
		session.m_MinimumScore = ParseScore(i_rSettings.m_MinimumScore);
	// Before the subject, which was made for another one.
	if (!i_rSettings.m_Source.empty())
		session.LoadSource(i_rSettings.m_Source);
	session.LoadTarget(i_rSettings.m_In);
	VTold told;
	if (!i_rSettings.m_Fbx.empty())
		RebindToCharacter(session, i_rSettings, told);
	if (!i_rSettings.m_Source.empty())
		RebindToPerformer(session, i_rSettings, told);
	if (i_rSettings.m_bMeasure)
		session.Document().UpdateTargets();
	session.Settle();
	told.m_Json["lost"] = told.m_Lost;
	told.m_Text += ListText("What could not be kept", told.m_Lost);
	const bool bRefused = !told.m_Lost.empty() && !i_rSettings.m_bAllowPartial;
	RequireNoErrors();
	if (bWrite && !bRefused)
	{
		for (const std::string& rLost : told.m_Lost)
			NVX_LOG(c_pCategory, NVX::ELogWarning, "Not kept: %1%", rLost);
		session.Save(i_rSettings.m_Out.m_Path);
		told.m_Json["output"] = i_rSettings.m_Out.m_Path;
	}
	if (i_rSettings.m_Out.m_Path != c_pStandardStream)
		PrintResult(told.m_Json, told.m_Text);
	if (bRefused && bWrite)
		throw VCommandError(EFindings,
		    "\"" + i_rSettings.m_Out.m_Path + "\" is not written, since not all could be kept (" + told.m_Lost.front()
		        + "): --allow-partial writes it without");
	return told.m_Lost.empty() || i_rSettings.m_bAllowPartial ? EFine : EFindings;
}

} // namespace

VCommand AddRebindCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "rebind",
	    "Take a retarget subject over to a changed file of its character, or to another performer. Segments are "
	    "matched "
	    "by name, by place and by what they are of a body; targets, joints and poses are kept, offsets follow the new "
	    "lengths. What could not be kept is listed: then the exit status is 1, and nothing is written. Without -o it "
	    "is "
	    "only told what would come of it",
	    {"rebind hero.qrr --fbx hero-v2.fbx", "rebind hero.qrr --fbx hero-v2.fbx -o hero-v2.qrr",
	        "rebind hero.qrr --source other.qrs --measure -o other.qrr"});
	const auto pSettings = std::make_shared<VRebindSettings>();
	pApp->add_option("IN.qrr", pSettings->m_In, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--fbx", pSettings->m_Fbx, "The character's new FBX file")->option_text("FILE")->check(NotEmpty());
	pApp->add_option("--root", pSettings->m_Root,
	        "The bone of the new file that becomes the root; if left out the one of the old root's name, or the one "
	        "that "
	        "is the same of a body")
	    ->option_text("NAME|INDEX");
	pApp->add_option("--source", pSettings->m_Source, "The other performer's skeleton")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_flag(
	    "--measure", pSettings->m_bMeasure, "Measure all offsets anew, in the bind poses as they stand then");
	pApp->add_option("--min-score", pSettings->m_MinimumScore,
	        "Match nothing as the same of a body that scores less: from 0 to 1, 0.5 if left out")
	    ->option_text("SCORE");
	pApp->add_flag("--allow-partial", pSettings->m_bAllowPartial, "Write it without what could not be kept");
	pApp->add_option("-o,--output", pSettings->m_Out.m_Path,
	        "Where the retarget subject is saved; may be IN.qrr itself, - is standard output")
	    ->option_text("OUT.qrr");
	AddForceOption(*pApp, pSettings->m_Out);
	return {pApp, [pSettings] { return Rebind(*pSettings); }};
}

} // namespace CommandLine
