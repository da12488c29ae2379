// What VRetargetSetup hands out of proposals, as values that a host knows without our types.

#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "SetupProposal/PoseCheck.h"

#include <QStringList>

using CoreOrlexTypes::VSubjectParametrised;

namespace
{

QVariantMap ToMap(const SetupProposal::VProposedPair& i_rPair, const VSubjectParametrised& i_rSource,
    const VSubjectParametrised& i_rTarget)
{
	QStringList reasons;
	for (const std::string& rReason : i_rPair.m_Reasons)
		reasons << QString::fromStdString(rReason);
	const auto isThere = [&](bool i_bPosition)
	{
		return RetargetSetup::FindTargetPair(
		           i_rTarget, i_rSource.m_Segments[i_rPair.m_Source].m_Name, i_rPair.m_Target, i_bPosition)
		    != -1;
	};
	const bool bPresent =
	    (i_rPair.m_PositionWeight <= 0.0 || isThere(true)) && (i_rPair.m_RotationWeight <= 0.0 || isThere(false));
	return {{"source", int(i_rPair.m_Source)}, {"target", int(i_rPair.m_Target)}, {"score", i_rPair.m_Score},
	    {"reasons", reasons.join(QStringLiteral("; "))}, {"position", i_rPair.m_PositionWeight},
	    {"rotation", i_rPair.m_RotationWeight}, {"present", bPresent}};
}

} // namespace

QVariantMap VRetargetSetup::ProposeTargets(double i_LeastScore)
{
	const std::optional<SetupProposal::VProposal> proposal = VRetargetSetupCore::ProposeTargets(i_LeastScore);
	if (!proposal)
		return {};
	const VSubjectValues source = SourceValues();
	const VSubjectValues target = TargetValues();
	const auto toList = [&](const std::vector<SetupProposal::VProposedPair>& i_rPairs)
	{
		QVariantList list;
		for (const SetupProposal::VProposedPair& rPair : i_rPairs)
			list << ToMap(rPair, *source.m_pParametrised, *target.m_pParametrised);
		return list;
	};
	QVariantList unmapped;
	for (const SetupProposal::VUnmapped& rUnmapped : proposal->m_UnmappedSources)
		unmapped << QVariantMap{
		    {"source", int(rUnmapped.m_Joint)}, {"reason", QString::fromStdString(rUnmapped.m_Reason)}};
	QStringList findings;
	for (const SetupProposal::VPoseFinding& rFinding :
	    SetupProposal::CheckPose(RetargetSetup::RestOf(*source.m_pParametrised, *source.m_pSubject),
	        RetargetSetup::RestOf(*target.m_pParametrised, *target.m_pSubject), *proposal))
		if (!rFinding.m_bFine)
			findings << QString::fromStdString(rFinding.m_Message);
	return {{"pairs", toList(proposal->m_Pairs)}, {"alternatives", toList(proposal->m_Alternatives)},
	    {"unmapped", unmapped}, {"findings", findings}};
}

void VRetargetSetup::AddTargets(const QVariantList& i_rTargets)
{
	std::vector<RetargetSetup::VNewTarget> targets;
	for (const QVariant& rTarget : i_rTargets)
	{
		const QVariantMap map = rTarget.toMap();
		// A negative index is beyond all segments.
		targets.push_back({std::size_t(map["source"].toInt()), std::size_t(map["target"].toInt()),
		    map["position"].toBool(), map["weight"].toDouble()});
	}
	VRetargetSetupCore::AddTargets(targets);
}
