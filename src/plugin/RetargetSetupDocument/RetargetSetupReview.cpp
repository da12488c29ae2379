// What VRetargetSetup tells of its target subject, as tables that a host shows.

#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/ShownText.h"
#include "SetupProposal/PoseCheck.h"
#include "SetupReview/advice/Advice.h"
#include "SetupReview/compare/CompareDocument.h"

#include <QStringList>

#include <utility>

namespace
{

QVariantMap Row(const QStringList& i_rCells, const QString& i_rAbout)
{
	return {{"cells", i_rCells}, {"about", i_rAbout}};
}

QVariantMap AdviceOn(const VRetargetSetupCore::VSubjectValues& i_rSource,
    const VRetargetSetupCore::VSubjectValues& i_rTarget, const boost::filesystem::path& i_rFbx)
{
	auto advice = SetupReview::AdviceOn(i_rSource, i_rTarget, i_rFbx);
	if (!advice)
		advice = SetupReview::AdviceOn(i_rSource, i_rTarget, {});
	QVariantList rows;
	for (const SetupReview::VPruneAdvice& rAdvice : advice->m_Prune)
	{
		const QString joint = RetargetSetup::ShownText(i_rTarget.m_pParametrised->m_Segments[rAdvice.m_Segment].m_Name);
		QVariantMap row =
		    Row({joint, SetupReview::NameOf(rAdvice.m_Verdict),
		            RetargetSetup::ShownText(SetupReview::PoseChangeText(rAdvice, *i_rTarget.m_pParametrised)),
		            RetargetSetup::ShownText(rAdvice.m_Words)},
		        '"' + joint + '"');
		row["joint"] = int(rAdvice.m_Segment);
		rows << row;
	}
	QString summary = rows.isEmpty() ? QStringLiteral("Every joint carries a target.")
	                                 : QString("Joints without a target of their own: %1.").arg(rows.size());
	if (!advice->m_bSkin && !rows.isEmpty())
		summary += QStringLiteral(" Which must stay for the skin is not known: the character's FBX file is not open.");
	if (!advice->m_Range)
		return {{"summary", summary + QStringLiteral(" Without a source skeleton there is no range of motion.")},
		    {"rows", rows}};
	for (const SetupReview::VRangeConflict& rConflict : advice->m_Range->m_Conflicts)
	{
		const QString missed = "target " + RetargetSetup::ShownText(rConflict.m_TargetName);
		rows << Row({missed, QStringLiteral("is pulled"), {},
		                QString("target %1 pulls against it: it %2")
		                    .arg(RetargetSetup::ShownText(rConflict.m_AgainstName),
		                        RetargetSetup::ShownText(rConflict.m_Words))},
		    missed);
	}
	return {{"summary", summary + ' ' + RetargetSetup::ShownText(SetupReview::RangeSummary(*advice->m_Range)) + '.'},
	    {"rows", rows}};
}

} // namespace

QVariantMap VRetargetSetup::CompareWith(const QUrl& i_rFileURL)
{
	constexpr const char* c_Command = "CompareWith";
	const boost::filesystem::path path = LocalPath(c_Command, i_rFileURL);
	if (path.empty())
		return {};
	std::string reason;
	const auto changes = SetupReview::ChangesSince(*this, path, reason);
	if (!changes)
	{
		CommandIgnored(c_Command, reason);
		return {};
	}
	QVariantList rows;
	for (const SetupReview::VSetupChange& rChange : *changes)
	{
		const QString line = RetargetSetup::ShownText(SetupReview::ChangeLine(rChange));
		rows << Row({line}, line);
	}
	return {{"summary",
	            rows.isEmpty() ? QStringLiteral("Nothing differs.")
	                           : QString("Differences, from the file to what is here now: %1").arg(rows.size())},
	    {"rows", rows}};
}

bool VRetargetSetup::Advise()
{
	const VSubjectValues target = TargetValues();
	if (!target.m_pParametrised || !target.m_pApplicationData || !target.m_pSubject)
	{
		CommandIgnored("Advise", RetargetSetup::Ignored::c_NoTarget);
		return false;
	}
	if (std::exchange(m_bAdvising, true))
	{
		m_bAdviseAgain = true;
		return true;
	}
	const bool bItsFile = target.m_pApplicationData->m_Skin == GetTargetName() && !GetTargetFBXPath().empty();
	m_Advising = std::jthread(
	    [this, source = SourceValues(), target, fbx = bItsFile ? GetTargetFBXPath() : boost::filesystem::path()]
	    {
		    QMetaObject::invokeMethod(
		        this,
		        [this, advice = AdviceOn(source, target, fbx)]
		        {
			        m_bAdvising = false;
			        if (!std::exchange(m_bAdviseAgain, false) || !Advise())
				        emit advised(advice);
		        },
		        Qt::QueuedConnection);
	    });
	return true;
}

std::vector<SetupProposal::VPoseFinding> VRetargetSetup::PoseFindings(const SetupProposal::VProposal& i_rProposal) const
{
	const VSubjectValues source = SourceValues();
	return SetupProposal::CheckPose(
	    RetargetSetup::RestOf(*source.m_pParametrised, *source.m_pSubject), TargetSkeleton(), i_rProposal);
}

QVariantMap VRetargetSetup::CheckPose()
{
	constexpr const char* c_Command = "CheckPose";
	const char* const pMissing = !SourceValues().m_pParametrised ? RetargetSetup::Ignored::c_NoSource
	    : !TargetValues().m_pParametrised                        ? RetargetSetup::Ignored::c_NoTarget
	                                                             : nullptr;
	if (pMissing)
	{
		CommandIgnored(c_Command, pMissing);
		return {};
	}
	const auto proposal = VRetargetSetupCore::ProposeTargets(SetupProposal::c_DefaultLeastScore);
	if (!proposal)
		return {};
	QVariantList rows;
	int toMend = 0;
	for (const SetupProposal::VPoseFinding& rFinding : PoseFindings(*proposal))
	{
		const QString message = RetargetSetup::ShownText(rFinding.m_Message);
		const QString options = RetargetSetup::ShownText(rFinding.m_Options);
		rows << Row({rFinding.m_pId, rFinding.m_bFine ? QStringLiteral("fine") : QStringLiteral("look"), message,
		                options.isEmpty() ? QString()
		                                  : QString("\"Align to Source...\", or retarget edit with %1").arg(options)},
		    message);
		toMend += !rFinding.m_bFine;
	}
	const QString summary = rows.isEmpty() ? RetargetSetup::ShownText(proposal->m_NoBody)
	    : toMend == 0                      ? QStringLiteral("Both stand alike.")
	                                       : QString("To be looked at: %1 of %2.").arg(toMend).arg(rows.size());
	return {{"summary", summary.isEmpty() ? QStringLiteral("There is no pair to compare the two by.") : summary},
	    {"rows", rows}};
}
