// What VRetargetSetup hands out of proposals, as values that a host knows without our types.

#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/StepNames.h"
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

bool VRetargetSetup::IsAligning() const
{
	return m_pAligned && TargetValues().m_pParametrised == m_pAligned;
}

QVariantMap VRetargetSetup::AlignToSource(const QVariantList& i_rChains)
{
	if (IsAligning())
		SetTargetSubjectParametrised(*m_pBeforeAlignment, {RetargetSetup::Steps::c_Align, m_Alignment});
	else
	{
		VRetargetSetupCore::EndStep();
		++m_Alignment;
		m_pBeforeAlignment = TargetValues().m_pParametrised;
	}
	RetargetSetup::VAlignmentChoice choice;
	choice.m_bSpine = i_rChains.value(0).toBool();
	choice.m_bArms = i_rChains.value(1).toBool();
	choice.m_bLegs = i_rChains.value(2).toBool();
	choice.m_bOthers = i_rChains.value(3).toBool();
	const auto alignment = VRetargetSetupCore::AlignToSource(choice, m_Alignment);
	m_pAligned = TargetValues().m_pParametrised;
	if (!alignment)
		return {};
	const VSubjectValues source = SourceValues();
	QVariantList joints;
	for (const SetupProposal::VAlignedJoint& rJoint : alignment->m_Joints)
		joints << QVariantMap{{"target", QString::fromStdString(m_pAligned->m_Segments[rJoint.m_Target].m_Name)},
		    {"source", QString::fromStdString(source.m_pParametrised->m_Segments[rJoint.m_Source].m_Name)},
		    {"before", rJoint.m_Before}, {"after", rJoint.m_After}, {"note", QString::fromStdString(rJoint.m_Note)}};
	QVariantList refused;
	for (const SetupProposal::VRefusedChain& rChain : alignment->m_Refused)
		refused << QString("The %1 stays as it is: %2")
		               .arg(QString::fromStdString(rChain.m_Chain), QString::fromStdString(rChain.m_Reason));
	const Rotation::VVector3& rMove = alignment->m_MoveMm;
	return {{"joints", joints}, {"refused", refused}, {"turn", alignment->m_TurnDegrees},
	    {"move", std::hypot(rMove[0], rMove[1])}, {"lift", rMove[2]}};
}

void VRetargetSetup::EndAlignment(bool i_bKeep)
{
	if (!i_bKeep && IsAligning())
		SetTargetSubjectParametrised(*m_pBeforeAlignment, {RetargetSetup::Steps::c_Align, m_Alignment});
	VRetargetSetupCore::EndStep();
	m_pBeforeAlignment = m_pAligned = nullptr;
}
