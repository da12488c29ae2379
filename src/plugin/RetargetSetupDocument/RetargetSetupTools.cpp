// What VRetargetSetup hands out of proposals, as values that a host knows without our types.

#include "RetargetSetupCore/Presets.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/StepNames.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/ShownText.h"
#include "SetupProposal/PoseCheck.h"

#include <QStringList>

#include <optional>
#include <set>

using CoreOrlexTypes::VSubjectParametrised;

namespace
{

/// Both subjects, and what is asked of them.
struct VBoth
{
	const VSubjectParametrised& m_rSource;
	const VSubjectParametrised& m_rTarget;
};

QVariantMap ToMap(const SetupProposal::VProposedPair& i_rPair, const VBoth& i_rBoth)
{
	QStringList reasons;
	for (const std::string& rReason : i_rPair.m_Reasons)
		reasons << RetargetSetup::ShownText(rReason);
	const auto isThere = [&](bool i_bPosition)
	{
		return RetargetSetup::FindTargetPair(i_rBoth.m_rTarget, i_rBoth.m_rSource.m_Segments[i_rPair.m_Source].m_Name,
		           i_rPair.m_Target, i_bPosition)
		    != -1;
	};
	const bool bPresent =
	    (i_rPair.m_PositionWeight <= 0.0 || isThere(true)) && (i_rPair.m_RotationWeight <= 0.0 || isThere(false));
	return {{"source", int(i_rPair.m_Source)}, {"target", int(i_rPair.m_Target)}, {"score", i_rPair.m_Score},
	    {"reasons", reasons.join(QStringLiteral("; "))}, {"position", i_rPair.m_PositionWeight},
	    {"rotation", i_rPair.m_RotationWeight}, {"present", bPresent}};
}

QVariantList ToList(const std::vector<SetupProposal::VProposedPair>& i_rPairs, const VBoth& i_rBoth)
{
	QVariantList list;
	for (const SetupProposal::VProposedPair& rPair : i_rPairs)
		list << ToMap(rPair, i_rBoth);
	return list;
}

QVariantMap ToMap(const RetargetSetup::VFittedPair& i_rFitted, const VBoth& i_rBoth)
{
	const SetupIO::VPair& rPair = i_rFitted.m_Pair;
	SetupProposal::VProposedPair pair;
	pair.m_Source = i_rFitted.m_Source;
	pair.m_Target = i_rFitted.m_Target;
	pair.m_PositionWeight = rPair.m_Position.value_or(0.0);
	pair.m_RotationWeight = rPair.m_Rotation.value_or(rPair.m_Position ? 0.0 : 1.0);
	pair.m_Reasons.push_back(i_rFitted.m_bProposed
	        ? "in the preset \"" + rPair.m_Source + "\" and \"" + rPair.m_Target + "\", here what is proposed for them"
	        : "by names in the preset");
	if (!rPair.m_Comment.empty())
		pair.m_Reasons.push_back(rPair.m_Comment);
	QVariantMap map = ToMap(pair, i_rBoth);
	map.remove("score");
	return map;
}

} // namespace

QVariantMap VRetargetSetup::ProposeTargets(double i_LeastScore)
{
	const std::optional<SetupProposal::VProposal> proposal = VRetargetSetupCore::ProposeTargets(i_LeastScore);
	if (!proposal)
		return {};
	const VSubjectValues source = SourceValues();
	const VSubjectValues target = TargetValues();
	const VBoth both{*source.m_pParametrised, *target.m_pParametrised};
	QVariantList unmapped;
	for (const SetupProposal::VUnmapped& rUnmapped : proposal->m_UnmappedSources)
		unmapped << QVariantMap{
		    {"source", int(rUnmapped.m_Joint)}, {"reason", RetargetSetup::ShownText(rUnmapped.m_Reason)}};
	QStringList findings;
	for (const SetupProposal::VPoseFinding& rFinding : PoseFindings(*proposal))
		if (!rFinding.m_bFine)
			findings << RetargetSetup::ShownText(rFinding.m_Message);
	return {{"pairs", ToList(proposal->m_Pairs, both)}, {"alternatives", ToList(proposal->m_Alternatives, both)},
	    {"unmapped", unmapped}, {"findings", findings}, {"noBody", RetargetSetup::ShownText(proposal->m_NoBody)}};
}

QVariantMap VRetargetSetup::FitPreset(const QUrl& i_rFileURL, double i_LeastScore)
{
	constexpr const char* c_Command = "FitPreset";
	const boost::filesystem::path path = LocalPath(c_Command, i_rFileURL);
	const auto proposal = path.empty() ? std::nullopt : VRetargetSetupCore::ProposeTargets(i_LeastScore);
	if (!proposal)
		return {};
	std::string reason;
	const auto pairs = RetargetSetup::ReadPreset(path, reason);
	if (!pairs)
	{
		CommandIgnored(c_Command, reason);
		return {};
	}
	const VSubjectValues source = SourceValues();
	const VSubjectValues target = TargetValues();
	const VBoth both{*source.m_pParametrised, *target.m_pParametrised};
	const RetargetSetup::VPresetFit fit = RetargetSetup::FitPreset(*pairs, both.m_rSource, both.m_rTarget, &*proposal);
	QVariantList fitted;
	std::set<std::size_t> used;
	for (const RetargetSetup::VFittedPair& rPair : fit.m_Fitted)
	{
		fitted << ToMap(rPair, both);
		used.insert(rPair.m_Source);
	}
	QVariantList unmapped;
	for (std::size_t i = 0; i < both.m_rSource.m_Segments.size(); ++i)
		if (!used.contains(i))
			unmapped << QVariantMap{{"source", int(i)}, {"reason", QStringLiteral("not in the preset")}};
	QStringList misfits;
	for (const RetargetSetup::VMisfit& rMisfit : fit.m_Misfits)
		misfits << QStringLiteral("\"%1\" and \"%2\": %3")
		               .arg(RetargetSetup::ShownText(rMisfit.m_Pair.m_Source),
		                   RetargetSetup::ShownText(rMisfit.m_Pair.m_Target),
		                   RetargetSetup::ShownText(rMisfit.m_Reason));
	return {{"pairs", fitted},
	    {"alternatives", ToList(proposal->m_Pairs, both) + ToList(proposal->m_Alternatives, both)},
	    {"unmapped", unmapped}, {"misfits", misfits}};
}

bool VRetargetSetup::SavePresetURL(const QUrl& i_rFileURL)
{
	constexpr const char* c_Command = "SavePreset";
	const boost::filesystem::path path = LocalPath(c_Command, i_rFileURL);
	std::string reason;
	if (path.empty())
		return false;
	if (VRetargetSetupCore::SavePreset(path, reason))
		return true;
	CommandIgnored(c_Command, reason);
	return false;
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

QVariantMap VRetargetSetup::AlignToSource(
    const QVariantList& i_rChains, const QVariantList& i_rLocked, bool i_bFitScale, bool i_bFeetWithShins)
{
	if (IsAligning())
		Restore(m_BeforeAlignment, {RetargetSetup::Steps::c_Align, m_Alignment});
	else
	{
		VRetargetSetupCore::EndStep();
		++m_Alignment;
		m_BeforeAlignment = PosedTarget();
	}
	RetargetSetup::VAlignmentChoice choice;
	choice.m_bFitScale = i_bFitScale;
	choice.m_bSpine = i_rChains.value(0).toBool();
	choice.m_bArms = i_rChains.value(1).toBool();
	choice.m_bLegs = i_rChains.value(2).toBool();
	choice.m_bOthers = i_rChains.value(3).toBool();
	choice.m_bFeetWithShins = i_bFeetWithShins;
	const auto pTarget = TargetValues().m_pParametrised;
	for (const QVariant& rSegment : i_rLocked)
		if (const int segment = rSegment.toInt(); pTarget && segment >= 0 && segment < int(pTarget->m_Segments.size()))
			choice.m_Locked.insert(std::size_t(segment));
	const auto aligned = VRetargetSetupCore::AlignToSource(choice, m_Alignment);
	m_pAligned = TargetValues().m_pParametrised;
	if (!aligned)
		return {};
	const SetupProposal::VAlignment& rAlignment = aligned->m_Alignment;
	const VSubjectValues source = SourceValues();
	QVariantList joints;
	for (const SetupProposal::VAlignedJoint& rJoint : rAlignment.m_Joints)
		joints << QVariantMap{{"target", int(rJoint.m_Target)}, {"source", int(rJoint.m_Source)},
		    {"before", rJoint.m_Before}, {"after", rJoint.m_After}, {"note", RetargetSetup::ShownText(rJoint.m_Note)}};
	QVariantList refused;
	for (const SetupProposal::VRefusedChain& rChain : rAlignment.m_Refused)
		refused << QString("The %1 stays as it is: %2")
		               .arg(RetargetSetup::ShownText(rChain.m_Chain), RetargetSetup::ShownText(rChain.m_Reason));
	const Rotation::VVector3& rMove = rAlignment.m_MoveMm;
	const bool bToFit = aligned->m_Scale && !aligned->m_Scale->m_bFine;
	return {{"joints", joints}, {"refused", refused}, {"turn", rAlignment.m_TurnDegrees},
	    {"move", std::hypot(rMove[0], rMove[1])}, {"lift", rMove[2]}, {"scaled", aligned->m_bScaled},
	    {"scale", bToFit ? SetupProposal::SuggestedScale(*aligned->m_Scale) : 1.0},
	    {"heights", aligned->m_Scale ? RetargetSetup::ShownText(aligned->m_Scale->m_Message) : QString()}};
}

void VRetargetSetup::EndAlignment(bool i_bKeep)
{
	if (!i_bKeep && IsAligning())
		Restore(m_BeforeAlignment, {RetargetSetup::Steps::c_Align, m_Alignment});
	VRetargetSetupCore::EndStep();
	m_BeforeAlignment = {};
	m_pAligned = nullptr;
}
