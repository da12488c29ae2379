#include "retarget/subject/Rebinding.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Table.h"

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

void Take(VSession& io_rSession, const VRebound& i_rRebound, VRebinding& io_rTold)
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

} // namespace

void RebindToCharacter(
    VSession& io_rSession, const std::string& i_rFbx, const std::optional<std::string>& i_rRoot, VRebinding& io_rTold)
{
	io_rSession.LoadFbx(i_rFbx);
	// Those of the file before.
	io_rSession.m_Root.reset();
	io_rSession.Document().SetTargetRootIndex(0, false);
	const auto pSkeleton = io_rSession.Document().GetFBXSkeleton();
	SetupReview::VNewCharacter character{
	    *pSkeleton, io_rSession.Document().GetTargetAxisMatrix(), io_rSession.Document().GetTargetName(), {}};
	if (i_rFbx == c_pStandardStream)
		character.m_Name.clear();
	if (i_rRoot)
		character.m_Root = FindRootBone(*i_rRoot, *pSkeleton);
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

void RebindToPerformer(VSession& io_rSession, VRebinding& io_rTold)
{
	io_rSession.Source("Another performer");
	const auto source = io_rSession.Document().SourceValues();
	const auto target = io_rSession.Document().TargetValues();
	const std::string name = io_rSession.IsSourceNamed() ? io_rSession.Document().GetShownSourceName() : "";
	const VRebound rebound = SetupReview::RebindPerformer(SetupOf(io_rSession),
	    RetargetSetup::RestOf(*source.m_pParametrised, *source.m_pSubject),
	    RetargetSetup::RestOf(*target.m_pParametrised, *target.m_pSubject), name, io_rSession.m_MinimumScore);
	Take(io_rSession, rebound, io_rTold);
	io_rTold.m_Json["sources"] = MatchesToJson(rebound);
	io_rTold.m_Text += MatchesToText(rebound, "What targets follow");
}

void TellLost(VRebinding& io_rTold)
{
	io_rTold.m_Json["lost"] = io_rTold.m_Lost;
	io_rTold.m_Text += ListText("What could not be kept", io_rTold.m_Lost);
}

namespace
{

void Report(VSession& io_rSession, VRebinding& io_rTold)
{
	TellLost(io_rTold);
	io_rSession.m_Lost.insert(io_rSession.m_Lost.end(), io_rTold.m_Lost.begin(), io_rTold.m_Lost.end());
	io_rSession.m_ReportJson["rebound"].push_back(io_rTold.m_Json);
	io_rSession.m_ReportText += io_rTold.m_Text;
}

} // namespace

void RebindFbx(VSession& io_rSession, const std::string& i_rFbx)
{
	VRebinding told;
	RebindToCharacter(io_rSession, i_rFbx, std::nullopt, told);
	Report(io_rSession, told);
}

void RebindSource(VSession& io_rSession, const std::string&)
{
	VRebinding told;
	RebindToPerformer(io_rSession, told);
	Report(io_rSession, told);
}

} // namespace CommandLine
