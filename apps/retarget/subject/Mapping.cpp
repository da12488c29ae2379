#include "retarget/subject/Mapping.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/subject/Elements.h"
#include "retarget/subject/SetupFile.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/Presets.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/TargetConstruction.h"

#include <utility>
#include <vector>

namespace CommandLine
{
namespace
{

SetupProposal::VRestSkeleton RestOfSource(VSession& io_rSession)
{
	io_rSession.Source("A proposal");
	const auto values = io_rSession.Document().SourceValues();
	return RetargetSetup::RestOf(*values.m_pParametrised, *values.m_pSubject);
}

VMapped Mapped(VSession& io_rSession, SetupProposal::VRestSkeleton i_Target)
{
	VMapped mapped{RestOfSource(io_rSession), std::move(i_Target), {}, -1};
	if (mapped.m_Source.empty() || mapped.m_Target.empty())
		throw VCommandError(EBadInput, "The segments of the source or the target make no tree, so nothing is proposed");
	mapped.m_Proposal = SetupProposal::Propose(mapped.m_Source, mapped.m_Target, io_rSession.m_MinimumScore);
	mapped.m_Root = SetupProposal::BodyRoot(mapped.m_Proposal, mapped.m_Target);
	return mapped;
}

VJson ToJson(const SetupProposal::VProposedPair& i_rPair, const VMapped& i_rMapped)
{
	VJson item{{"source", i_rMapped.m_Source[i_rPair.m_Source].m_Name},
	    {"target", i_rMapped.m_Target[i_rPair.m_Target].m_Name}, {"score", std::round(1e4 * i_rPair.m_Score) / 1e4},
	    {"reasons", i_rPair.m_Reasons}};
	if (i_rPair.m_PositionWeight > 0.0)
		item["position"] = i_rPair.m_PositionWeight;
	if (i_rPair.m_RotationWeight > 0.0)
		item["rotation"] = i_rPair.m_RotationWeight;
	return item;
}

VJson ToJson(const std::vector<SetupProposal::VProposedPair>& i_rPairs, const VMapped& i_rMapped)
{
	VJson list = VJson::array();
	for (const SetupProposal::VProposedPair& rPair : i_rPairs)
		list.push_back(ToJson(rPair, i_rMapped));
	return list;
}

VJson ToJson(const std::vector<SetupProposal::VUnmapped>& i_rUnmapped, const SetupProposal::VRestSkeleton& i_rSkeleton)
{
	VJson list = VJson::array();
	for (const auto& rUnmapped : i_rUnmapped)
		list.push_back({{"name", i_rSkeleton[rUnmapped.m_Joint].m_Name}, {"reason", rUnmapped.m_Reason}});
	return list;
}

} // namespace

double ParseScore(const std::string& i_rWord)
{
	const double score = ParseFinite(i_rWord, "--min-score");
	if (score < 0.0 || score > 1.0)
		throw VCommandError(EWrongUsage, "--min-score: a score is from 0 to 1, not " + i_rWord);
	return score;
}

VMapped ProposeForFile(VSession& io_rSession, const std::optional<std::size_t>& i_rRoot)
{
	VRetargetSetupCore& rDocument = io_rSession.Document();
	const auto pSkeleton = rDocument.GetFBXSkeleton();
	return Mapped(io_rSession,
	    RetargetSetup::RestOf(i_rRoot ? RetargetSetup::ExtractSubtree(*pSkeleton, *i_rRoot) : *pSkeleton,
	        rDocument.GetTargetAxisMatrix()));
}

VMapped ProposeForSubject(VSession& io_rSession)
{
	if (io_rSession.m_Root)
		return ProposeForFile(io_rSession, io_rSession.m_Root);
	return Mapped(io_rSession, io_rSession.Document().TargetSkeleton());
}

void AddProposedTargets(VSession& io_rSession)
{
	const VMapped mapped = ProposeForSubject(io_rSession);
	const auto& rProposal = mapped.m_Proposal;
	if (!rProposal.m_NoBody.empty())
		throw VCommandError(EFindings, "--auto: nothing is proposed. " + rProposal.m_NoBody);
	if (rProposal.m_Pairs.empty())
		throw VCommandError(EFindings,
		    "--auto: no pair of segments scores enough; \"retarget map\" shows what there is, --min-score before "
		    "--auto "
		    "asks for less");
	std::vector<RetargetSetup::VNewTarget> targets;
	for (const SetupProposal::VProposedPair& rPair : rProposal.m_Pairs)
	{
		if (rPair.m_PositionWeight > 0.0)
			targets.push_back({rPair.m_Source, rPair.m_Target, true, rPair.m_PositionWeight});
		if (rPair.m_RotationWeight > 0.0)
			targets.push_back({rPair.m_Source, rPair.m_Target, false, rPair.m_RotationWeight});
	}
	io_rSession.Document().AddTargets(targets);
	NVX_LOG(c_pCategory, NVX::ELogInformation, "--auto: %1% pairs of segments, %2% segments of the source without one",
	    rProposal.m_Pairs.size(), rProposal.m_UnmappedSources.size());
}

void AddPairTargets(VSession& io_rSession, const SetupIO::VPair& i_rPair, std::size_t i_Source, std::size_t i_Target)
{
	std::vector<RetargetSetup::VNewTarget> targets;
	if (i_rPair.m_Position)
		targets.push_back({i_Source, i_Target, true, *i_rPair.m_Position});
	if (i_rPair.m_Rotation || !i_rPair.m_Position)
		targets.push_back({i_Source, i_Target, false, i_rPair.m_Rotation.value_or(1.0)});
	io_rSession.Document().AddTargets(targets);
}

void ApplyPreset(VSession& io_rSession, const std::string& i_rPath)
{
	const CoreOrlexTypes::VSubjectParametrised& rSource = io_rSession.Source("--preset");
	const SetupIO::VSetup preset = ParseSetup(ReadSetupText(i_rPath, "a preset"), i_rPath, {"pairs"}, "a preset");
	const VMapped mapped = ProposeForSubject(io_rSession);
	const RetargetSetup::VPresetFit fit =
	    RetargetSetup::FitPreset(preset.m_Pairs, rSource, io_rSession.Target(), &mapped.m_Proposal);
	if (fit.m_Fitted.empty())
		throw VCommandError(
		    EFindings, "--preset: no pair of \"" + i_rPath + "\" fits these two: " + fit.m_Misfits.front().m_Reason);
	VJson proposed = VJson::array();
	for (const RetargetSetup::VFittedPair& rPair : fit.m_Fitted)
	{
		AddPairTargets(io_rSession, rPair.m_Pair, rPair.m_Source, rPair.m_Target);
		if (!rPair.m_bProposed)
			continue;
		const std::string& rSourceName = rSource.m_Segments[rPair.m_Source].m_Name;
		const std::string& rTargetName = io_rSession.Target().m_Segments[rPair.m_Target].m_Name;
		proposed.push_back({{"source", rPair.m_Pair.m_Source}, {"target", rPair.m_Pair.m_Target},
		    {"foundSource", rSourceName}, {"foundTarget", rTargetName}});
		io_rSession.m_ReportText += "Preset: \"" + Printable(rPair.m_Pair.m_Source) + "\" and \""
		    + Printable(rPair.m_Pair.m_Target) + "\" became \"" + Printable(rSourceName) + "\" and \""
		    + Printable(rTargetName) + "\", by proposal\n";
	}
	VJson missing = VJson::array();
	for (const RetargetSetup::VMisfit& rMisfit : fit.m_Misfits)
	{
		missing.push_back(
		    {{"source", rMisfit.m_Pair.m_Source}, {"target", rMisfit.m_Pair.m_Target}, {"reason", rMisfit.m_Reason}});
		NVX_LOG(c_pCategory, NVX::ELogWarning, "--preset: \"%1%\" and \"%2%\" were not tied: %3%",
		    rMisfit.m_Pair.m_Source, rMisfit.m_Pair.m_Target, rMisfit.m_Reason);
	}
	io_rSession.m_ReportJson["preset"] = {{"pairs", fit.m_Fitted.size()}, {"proposed", proposed}, {"missing", missing}};
}

VJson MappedToJson(const VMapped& i_rMapped)
{
	const SetupProposal::VProposal& rProposal = i_rMapped.m_Proposal;
	VJson json{{"pairs", ToJson(rProposal.m_Pairs, i_rMapped)},
	    {"alternatives", ToJson(rProposal.m_Alternatives, i_rMapped)},
	    {"unmapped",
	        {{"source", ToJson(rProposal.m_UnmappedSources, i_rMapped.m_Source)},
	            {"target", ToJson(rProposal.m_UnmappedTargets, i_rMapped.m_Target)}}}};
	if (!rProposal.m_NoBody.empty())
		json["noBody"] = rProposal.m_NoBody;
	if (i_rMapped.m_Root >= 0)
		json["root"] = i_rMapped.m_Target[std::size_t(i_rMapped.m_Root)].m_Name;
	return json;
}

} // namespace CommandLine
