#include "RetargetSetupCore/Presets.h"

#include "NVX/Status.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "SetupIO/Limits.h"
#include "SetupIO/ReadSetup.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

#include <algorithm>
#include <cstdint>
#include <map>
#include <set>

using CoreOrlexTypes::VSubjectParametrised;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

namespace RetargetSetup
{
namespace
{

/// Names to indices; of segments that share one the first.
std::map<std::string, std::size_t> IndicesOf(const VSubjectParametrised& i_rSubject)
{
	std::map<std::string, std::size_t> indices;
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
		indices.emplace(i_rSubject.m_Segments[i].m_Name, i);
	return indices;
}

std::int64_t Find(const std::map<std::string, std::size_t>& i_rIndices, const std::string& i_rName)
{
	const auto found = i_rIndices.find(i_rName);
	return found == i_rIndices.end() ? -1 : std::int64_t(found->second);
}

std::string NoSegment(const char* i_pWhich, const std::string& i_rName)
{
	return std::string("the ") + i_pWhich + " has no segment \"" + i_rName + "\"";
}

} // namespace

std::vector<SetupIO::VPair> PairsOf(const VSubjectParametrised& i_rSubject, std::vector<std::string>& o_rLeftOut)
{
	std::vector<SetupIO::VPair> pairs;
	for (std::size_t i = 0; i < i_rSubject.m_Targets.size(); ++i)
	{
		const VTarget& rTarget = i_rSubject.m_Targets[i];
		const auto leaveOut = [&](const std::string& i_rReason)
		{ o_rLeftOut.push_back("Target #" + std::to_string(i) + " is left out: " + i_rReason); };
		const bool bPosition = rTarget.m_Type == VTarget::ELocalPointToWorldPoint;
		const std::string* const pSource = SourceName(i_rSubject, rTarget);
		const std::string* const pTarget = TargetSegmentName(i_rSubject, rTarget);
		if (!bPosition && rTarget.m_Type != VTarget::ELocalRotationToWorldRotation)
			leaveOut("a pair holds positions and rotations only");
		else if (!pSource || !pTarget || pSource->empty() || pTarget->empty())
			leaveOut("one of its segments has no name");
		else
		{
			auto pair = std::ranges::find_if(pairs,
			    [&](const SetupIO::VPair& i_rPair)
			    { return i_rPair.m_Source == *pSource && i_rPair.m_Target == *pTarget; });
			if (pair == pairs.end())
				pair = pairs.insert(pair, {*pSource, *pTarget, {}, {}, {}});
			std::optional<double>& rWeight = bPosition ? pair->m_Position : pair->m_Rotation;
			if (rWeight)
				leaveOut("there is one of its kind for the pair \"" + *pSource + "\" and \"" + *pTarget + "\" already");
			else
				rWeight = rTarget.m_Weight;
		}
	}
	return pairs;
}

SetupIO::VSetup PresetOf(const VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, std::vector<std::string>& o_rLeftOut)
{
	const auto orElse = [](const std::string& i_rName, const char* i_pElse)
	{ return i_rName.empty() ? i_pElse : i_rName; };
	SetupIO::VSetup preset;
	preset.m_Pairs = PairsOf(i_rSubject, o_rLeftOut);
	preset.m_Comment = "Pairs of " + orElse(i_rApplicationData.m_RetargetSourceTemplate, "a performer") + " and "
	    + orElse(i_rApplicationData.m_Skin, "a character");
	return preset;
}

VPresetFit FitPreset(const std::vector<SetupIO::VPair>& i_rPairs, const VSubjectParametrised& i_rSource,
    const VSubjectParametrised& i_rTarget, const SetupProposal::VProposal* i_pProposal)
{
	const auto sources = IndicesOf(i_rSource);
	const auto targets = IndicesOf(i_rTarget);
	// What pairs by name have, no proposal takes.
	std::set<std::size_t> usedSources;
	std::set<std::size_t> usedTargets;
	for (const SetupIO::VPair& rPair : i_rPairs)
		if (const auto source = Find(sources, rPair.m_Source), target = Find(targets, rPair.m_Target);
		    source >= 0 && target >= 0)
		{
			usedSources.insert(std::size_t(source));
			usedTargets.insert(std::size_t(target));
		}
	VPresetFit fit;
	for (const SetupIO::VPair& rPair : i_rPairs)
	{
		const std::int64_t source = Find(sources, rPair.m_Source);
		const std::int64_t target = Find(targets, rPair.m_Target);
		if (source >= 0 && target >= 0)
		{
			fit.m_Fitted.push_back({rPair, std::size_t(source), std::size_t(target), false});
			continue;
		}
		std::string reason = source < 0 ? NoSegment("source", rPair.m_Source) : NoSegment("target", rPair.m_Target);
		if (source < 0 && target < 0)
			reason += ", and " + NoSegment("target", rPair.m_Target);
		else if (i_pProposal)
		{
			const auto proposed = std::ranges::find_if(i_pProposal->m_Pairs,
			    [&](const SetupProposal::VProposedPair& i_rProposed) {
				    return std::int64_t(source < 0 ? i_rProposed.m_Target : i_rProposed.m_Source)
				        == std::max(source, target);
			    });
			if (proposed == i_pProposal->m_Pairs.end())
				reason += ", and nothing is proposed in its place";
			else if (source < 0 ? usedSources.contains(proposed->m_Source) : usedTargets.contains(proposed->m_Target))
				reason += ", and what is proposed in its place stands in another pair";
			else
			{
				usedSources.insert(proposed->m_Source);
				usedTargets.insert(proposed->m_Target);
				fit.m_Fitted.push_back({rPair, proposed->m_Source, proposed->m_Target, true});
				continue;
			}
		}
		fit.m_Misfits.push_back({rPair, reason});
	}
	return fit;
}

std::optional<std::vector<SetupIO::VPair>> ReadPreset(const boost::filesystem::path& i_rPath, std::string& o_rReason)
{
	const std::string path = UtilsFileSystem::ToUtf8(i_rPath);
	std::string text;
	if (UtilsFileSystem::ReadWholeFile(i_rPath, SetupIO::Limits::c_FileBytes, text, o_rReason)
	    != NVX::Status::c_Success)
	{
		o_rReason = "'" + path + "' could not be read as a preset: " + o_rReason;
		return std::nullopt;
	}
	SetupIO::VSetup preset;
	SetupIO::VFault fault;
	if (!SetupIO::ReadSetup(text, preset, fault) || !SetupIO::HasOnly(preset, {"pairs"}, "a preset", fault))
	{
		o_rReason = "'" + path + "', line " + std::to_string(fault.m_Line) + ": " + fault.m_Reason;
		return std::nullopt;
	}
	return std::move(preset.m_Pairs);
}

} // namespace RetargetSetup
