#include "RetargetSetupCore/RetargetTargets.h"
#include "SetupProposal/Proposal.h"
#include "SetupReview/rebind/Rebind.h"
#include "SetupReview/rebind/Renaming.h"

#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypesUtils/observations/UnusedObservations.h"

#include <algorithm>
#include <set>

namespace SetupReview
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using SetupProposal::VRestSkeleton;

/// What targets follow, each once, in the order of the targets, with the segments that follow it.
std::vector<std::pair<std::string, std::vector<std::uint32_t>>> FollowedSources(const VSubjectParametrised& i_rSubject)
{
	std::vector<std::pair<std::string, std::vector<std::uint32_t>>> sources;
	const auto add = [&](const auto& i_rElements, std::uint32_t i_Index, const VSubjectParametrised::VTarget& i_rTarget)
	{
		if (i_Index >= i_rElements.size())
			return;
		const std::string& rName = i_rElements[i_Index].m_Name;
		auto found = std::ranges::find(sources, rName, [](const auto& i_rSource) { return i_rSource.first; });
		if (found == sources.end())
			found = sources.emplace(sources.end(), rName, std::vector<std::uint32_t>());
		found->second.insert(found->second.end(), i_rTarget.m_SegmentIndices.begin(), i_rTarget.m_SegmentIndices.end());
	};
	for (const VSubjectParametrised::VTarget& rTarget : i_rSubject.m_Targets)
	{
		for (const std::uint32_t index : rTarget.m_MarkerIndices)
			add(i_rSubject.m_Markers, index, rTarget);
		for (const std::uint32_t index : rTarget.m_RotationObservationIndices)
			add(i_rSubject.m_Rotations, index, rTarget);
	}
	return sources;
}

/// Has all that names the old ones name the new ones.
void Rename(VSetup& io_rSetup, const VRenames& i_rRenames)
{
	VSubjectParametrised& rSubject = io_rSetup.m_Record.m_SubjectParametrised;
	auto& rData = io_rSetup.m_Record.m_SubjectApplicationData;
	const std::vector<std::string> before = StandardTargetNames(io_rSetup);
	const auto renamed = [&](auto& io_rIndices, const auto& i_rElements, auto i_FindOrAdd)
	{
		for (std::uint32_t& rIndex : io_rIndices)
			if (rIndex < i_rElements.size())
				if (const auto found = i_rRenames.find(i_rElements[rIndex].m_Name); found != i_rRenames.end())
					rIndex = i_FindOrAdd(rSubject, rData, found->second);
	};
	// In place, so that what else a marker has stays; but two of one name are one.
	const auto renameInPlace = [&](auto& io_rElements, auto i_pId)
	{
		for (auto& rElement : io_rElements)
			if (const auto found = i_rRenames.find(rElement.m_Name); found != i_rRenames.end()
			    && std::ranges::none_of(
			        io_rElements, [&](const auto& i_rOther) { return i_rOther.m_Name == found->second; }))
			{
				rElement.m_Name = found->second;
				rElement.*i_pId = CoreOrlexTypes::HashName(rElement.m_Name);
			}
	};
	renameInPlace(rSubject.m_Markers, &VSubjectParametrised::VMarker::m_MarkerId);
	renameInPlace(rSubject.m_Rotations, &VSubjectParametrised::VRotation::m_RotationId);
	for (VSubjectParametrised::VTarget& rTarget : rSubject.m_Targets)
	{
		renamed(rTarget.m_MarkerIndices, rSubject.m_Markers, RetargetSetup::FindOrAddMarker);
		renamed(rTarget.m_RotationObservationIndices, rSubject.m_Rotations, RetargetSetup::FindOrAddRotation);
	}
	CoreOrlexTypesUtils::RemoveUnusedMarkers(rSubject, rData);
	CoreOrlexTypesUtils::RemoveUnusedRotations(rSubject);
	for (auto& rMarker : io_rSetup.m_Extras.m_Markers)
		if (const auto found = i_rRenames.find(rMarker.m_Name); found != i_rRenames.end())
			rMarker.m_Name = found->second;
	RenameTargets(io_rSetup, before);
}

} // namespace

VRebound RebindPerformer(const VSetup& i_rSetup, const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget,
    const std::string& i_rName, double i_LeastScore)
{
	VRebound rebound;
	rebound.m_Setup = i_rSetup;
	const VSubjectParametrised& rSubject = i_rSetup.m_Record.m_SubjectParametrised;
	std::set<std::string> free;
	for (const SetupProposal::VRestJoint& rJoint : i_rSource)
		free.insert(rJoint.m_Name);
	const auto sources = FollowedSources(rSubject);
	std::set<std::string> kept;
	for (const auto& [name, segments] : sources)
		if (free.erase(name) > 0)
			kept.insert(name);
	SetupProposal::VProposal proposal;
	if (kept.size() < sources.size())
		proposal = SetupProposal::Propose(i_rSource, i_rTarget, i_LeastScore);
	VRenames renames;
	for (const auto& [name, segments] : sources)
	{
		VRebindMatch& rMatch = rebound.m_Matches.emplace_back();
		rMatch.m_Old = name;
		if (kept.contains(name))
		{
			rMatch = {name, name, ERebindRule::Name, 1.0};
			continue;
		}
		for (const SetupProposal::VProposedPair& rPair : proposal.m_Pairs)
			if (std::ranges::find(segments, rPair.m_Target) != segments.end()
			    && free.contains(i_rSource[rPair.m_Source].m_Name))
			{
				rMatch = {name, i_rSource[rPair.m_Source].m_Name, ERebindRule::Proposal, rPair.m_Score};
				free.erase(rMatch.m_New);
				renames.emplace(name, rMatch.m_New);
				break;
			}
		if (rMatch.m_New.empty())
			rebound.m_Lost.push_back("The new performer has no segment \"" + name
			    + "\", and none was found in its place: the targets that follow it keep its name, and follow nothing");
	}
	Rename(rebound.m_Setup, renames);
	rebound.m_Setup.m_Record.m_SubjectApplicationData.m_RetargetSourceTemplate = i_rName;
	return rebound;
}

} // namespace SetupReview
