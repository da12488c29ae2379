// The target subject of VRetargetSetup, taken over to a changed file of its character or to another performer.

#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/ShownText.h"
#include "SetupReview/rebind/RebindDocument.h"

#include <QStringList>

#include <optional>

namespace
{

using SetupReview::ERebindRule;
using SetupReview::VRebound;

QStringList ToStrings(const std::vector<std::string>& i_rTexts)
{
	QStringList list;
	for (const std::string& rText : i_rTexts)
		list << RetargetSetup::ShownText(rText);
	return list;
}

QString RuleText(const SetupReview::VRebindMatch& i_rMatch)
{
	return i_rMatch.m_Rule == ERebindRule::Place
	    ? QStringLiteral("by its place")
	    : QStringLiteral("as the same part of a body, score %1").arg(i_rMatch.m_Score, 0, 'f', 2);
}

} // namespace

QVariantMap VRetargetSetup::LookAtRebind(bool i_bPerformer) const
{
	const std::optional<VRebound> rebound = SetupReview::ReboundOf(*this, i_bPerformer);
	if (!rebound)
		return {};
	if (!rebound->m_Refusal.empty())
		return {{"refusal", RetargetSetup::ShownText(rebound->m_Refusal)}};
	QStringList renamed;
	int kept = 0;
	for (const SetupReview::VRebindMatch& rMatch : rebound->m_Matches)
		if (rMatch.m_Rule == ERebindRule::Name)
			++kept;
		else if (rMatch.m_Rule != ERebindRule::None)
			renamed << QStringLiteral("%1 is %2, %3")
			               .arg(RetargetSetup::ShownText(rMatch.m_Old), RetargetSetup::ShownText(rMatch.m_New),
			                   RuleText(rMatch));
	QStringList changed;
	for (const SetupReview::VSetupChange& rChange : rebound->m_Changes)
		changed << RetargetSetup::ShownText(SetupReview::ChangeLine(rChange));
	const QStringList lost = ToStrings(rebound->m_Lost);
	const QStringList added = ToStrings(rebound->m_Added);
	if (renamed.isEmpty() && changed.isEmpty() && lost.isEmpty() && added.isEmpty())
		return {};
	return {{"kept", kept}, {"renamed", renamed}, {"changed", changed}, {"lost", lost}, {"added", added}};
}

void VRetargetSetup::Rebind(bool i_bPerformer, bool i_bMeasure)
{
	constexpr const char* c_Command = "Rebind";
	const std::optional<VRebound> rebound = SetupReview::ReboundOf(*this, i_bPerformer);
	if (!rebound)
		return CommandIgnored(c_Command,
		    !TargetValues().m_pParametrised ? RetargetSetup::Ignored::c_NoTarget
		        : i_bPerformer              ? RetargetSetup::Ignored::c_NoSource
		                                    : RetargetSetup::Ignored::c_NoFBX);
	if (!rebound->m_Refusal.empty())
		return CommandIgnored(c_Command, rebound->m_Refusal);
	SetupReview::TakeOver(*this, *rebound, i_bPerformer, i_bMeasure);
}
