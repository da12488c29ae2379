// The target subject of VRetargetSetup, taken over to a changed file of its character or to another performer.

#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/StepNames.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "SetupReview/rebind/Rebind.h"

#include <QStringList>

#include <optional>

namespace
{

using SetupReview::ERebindRule;
using SetupReview::VRebound;

/// Nothing if there are no two to hold against each other.
std::optional<VRebound> Rebound(const VRetargetSetupCore& i_rDocument, bool i_bPerformer)
{
	const auto source = i_rDocument.SourceValues();
	const auto target = i_rDocument.TargetValues();
	const auto pSkeleton = i_rDocument.GetFBXSkeleton();
	if (!target.m_pParametrised || !target.m_pApplicationData || !target.m_pSubject
	    || (i_bPerformer ? !source.m_pParametrised : !pSkeleton))
		return std::nullopt;
	const SetupReview::VSetup setup{
	    {*target.m_pParametrised, *target.m_pApplicationData}, i_rDocument.GetTargetExtras()};
	if (i_bPerformer)
		return SetupReview::RebindPerformer(setup, RetargetSetup::RestOf(*source.m_pParametrised, *source.m_pSubject),
		    RetargetSetup::RestOf(*target.m_pParametrised, *target.m_pSubject), i_rDocument.GetShownSourceName());
	return SetupReview::RebindCharacter(
	    setup, {*pSkeleton, i_rDocument.GetTargetAxisMatrix(), i_rDocument.GetTargetName(), {}});
}

QStringList ToStrings(const std::vector<std::string>& i_rTexts)
{
	QStringList list;
	for (const std::string& rText : i_rTexts)
		list << QString::fromStdString(rText);
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
	const std::optional<VRebound> rebound = Rebound(*this, i_bPerformer);
	if (!rebound)
		return {};
	if (!rebound->m_Refusal.empty())
		return {{"refusal", QString::fromStdString(rebound->m_Refusal)}};
	QStringList renamed;
	int kept = 0;
	for (const SetupReview::VRebindMatch& rMatch : rebound->m_Matches)
		if (rMatch.m_Rule == ERebindRule::Name)
			++kept;
		else if (rMatch.m_Rule != ERebindRule::None)
			renamed << QStringLiteral("%1 is %2, %3")
			               .arg(QString::fromStdString(rMatch.m_Old), QString::fromStdString(rMatch.m_New),
			                   RuleText(rMatch));
	QStringList changed;
	for (const SetupReview::VSetupChange& rChange : rebound->m_Changes)
		changed << QString::fromStdString(SetupReview::ChangeLine(rChange));
	const QStringList lost = ToStrings(rebound->m_Lost);
	const QStringList added = ToStrings(rebound->m_Added);
	if (renamed.isEmpty() && changed.isEmpty() && lost.isEmpty() && added.isEmpty())
		return {};
	return {{"kept", kept}, {"renamed", renamed}, {"changed", changed}, {"lost", lost}, {"added", added}};
}

void VRetargetSetup::Rebind(bool i_bPerformer, bool i_bMeasure)
{
	constexpr const char* c_Command = "Rebind";
	std::optional<VRebound> rebound = Rebound(*this, i_bPerformer);
	if (!rebound)
		return CommandIgnored(c_Command,
		    !TargetValues().m_pParametrised ? RetargetSetup::Ignored::c_NoTarget
		        : i_bPerformer              ? RetargetSetup::Ignored::c_NoSource
		                                    : RetargetSetup::Ignored::c_NoFBX);
	if (!rebound->m_Refusal.empty())
		return CommandIgnored(c_Command, rebound->m_Refusal);
	auto& rRecord = rebound->m_Setup.m_Record;
	RunStep({RetargetSetup::Steps::c_Rebind},
	    [&]
	    {
		    if (SetTargetSubject(std::move(rRecord.m_SubjectParametrised), std::move(rRecord.m_SubjectApplicationData),
		            std::move(rebound->m_Setup.m_Extras))
		        && i_bMeasure)
			    VRetargetSetupCore::UpdateTargets();
	    });
}
