#include "SetupProposal/Proposal.h"

#include "SetupProposal/Assignment.h"
#include "SetupProposal/BodyCheck.h"
#include "SetupProposal/PairScore.h"

#include <algorithm>
#include <iterator>
#include <map>

namespace SetupProposal
{
namespace
{

/// Joints less likely than this are no candidates for a part.
constexpr double c_LeastLikely = 0.15;
/// The likeliest of a part and side that are looked at: a body has no more, and the assignment grows with the cube.
constexpr std::size_t c_MostCandidates = 100;
/// What scores less is no alternative, and what is within so much of a pair is as good.
constexpr double c_LeastAlternative = 0.3;
constexpr double c_AsGood = 0.05;

struct VWeights
{
	double m_Position;
	double m_Rotation;
};

VWeights WeightsFor(EBodyPart i_Part)
{
	switch (i_Part)
	{
	case EPelvis:
	case EHand: return {1.0, 1.0};
	// Arms of other lengths pull at the pelvis; feet stay where they stand all the same.
	case EFoot: return {4.0, 1.0};
	case EHead: return {0.5, 1.0};
	case ESpine:
	case ENeck:
	case EClavicle: return {0.0, 0.5};
	default: return {0.0, IsFinger(i_Part) || i_Part == EToe ? 0.5 : 1.0};
	}
}

std::vector<std::size_t> Candidates(const VBodyReading& i_rBody, const VRestSkeleton* i_pMoving, EBodyPart i_Part)
{
	std::vector<std::size_t> candidates;
	for (std::size_t i = 0; i < i_rBody.m_Joints.size(); ++i)
		if (i_rBody.m_Joints[i].m_Likely[i_Part] >= c_LeastLikely && (!i_pMoving || (*i_pMoving)[i].m_bMoves))
			candidates.push_back(i);
	if (candidates.size() > c_MostCandidates)
	{
		std::ranges::stable_sort(candidates, std::greater(),
		    [&](std::size_t i_Joint) { return i_rBody.m_Joints[i_Joint].m_Likely[i_Part]; });
		candidates.resize(c_MostCandidates);
		std::ranges::sort(candidates);
	}
	return candidates;
}

/// A joint that may be of two parts stands in one pair: the better.
void KeepBest(std::vector<VProposedPair>& io_rPairs, std::vector<VProposedPair>& io_rAlternatives)
{
	std::ranges::stable_sort(io_rPairs, std::greater(), &VProposedPair::m_Score);
	std::vector<VProposedPair> kept;
	for (VProposedPair& rPair : io_rPairs)
		(std::ranges::any_of(kept,
		     [&](const VProposedPair& i_rKept)
		     { return i_rKept.m_Source == rPair.m_Source || i_rKept.m_Target == rPair.m_Target; })
		        ? io_rAlternatives
		        : kept)
		    .push_back(std::move(rPair));
	io_rPairs = std::move(kept);
}

void Order(std::vector<VProposedPair>& io_rPairs)
{
	std::ranges::stable_sort(
	    io_rPairs, {}, [](const VProposedPair& i_rPair) { return std::pair(i_rPair.m_Source, -i_rPair.m_Score); });
}

std::string WhyUnmapped(const VJointReading& i_rJoint, const std::vector<VProposedPair>& i_rAlternatives,
    std::size_t i_Joint, std::size_t VProposedPair::*i_pSide)
{
	const bool bCouldBe =
	    std::ranges::any_of(i_rAlternatives, [&](const VProposedPair& i_rPair) { return i_rPair.*i_pSide == i_Joint; });
	if (i_rJoint.m_Part == EOther || i_rJoint.m_Part == ERoot)
		return i_rJoint.m_Part == ERoot                               ? "a root without a part of the body"
		    : i_rJoint.m_ByName && (*i_rJoint.m_ByName)[EOther] > 0.9 ? "a helper, control or prop by its name"
		                                                              : "no part of a body that was recognised";
	const std::string part = NameOf(i_rJoint.m_Part);
	if (i_rJoint.m_Likely[i_rJoint.m_Part] < c_DefaultLeastScore)
		return "ambiguous: " + part + ", if anything";
	return part
	    + (bCouldBe ? ": another pair fits better, see the alternatives"
	                : ": the other skeleton has none that is free");
}

std::string NoBody(const VRestSkeleton& i_rSource, const VBodyReading& i_rSourceBody, const VRestSkeleton& i_rTarget,
    const VBodyReading& i_rTargetBody)
{
	if (const std::string why = WhyNoBody(i_rSource, i_rSourceBody); !why.empty())
		return "The performer's skeleton is not taken for a body: " + why;
	if (const std::string why = WhyNoBody(i_rTarget, i_rTargetBody); !why.empty())
		return "The character's skeleton is not taken for a body: " + why;
	return "";
}

} // namespace

VProposal Propose(const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget, double i_LeastScore)
{
	const VRestSkeleton source = Sound(i_rSource);
	const VRestSkeleton target = Sound(i_rTarget);
	VProposal proposal;
	proposal.m_Source = ReadBody(source);
	proposal.m_Target = ReadBody(target);
	std::vector<VProposedPair> pairs;
	for (std::size_t i = EPelvis; i < EOther; ++i)
	{
		const auto part = EBodyPart(i);
		const std::vector<std::size_t> sources = Candidates(proposal.m_Source, &source, part);
		const std::vector<std::size_t> targets = Candidates(proposal.m_Target, nullptr, part);
		std::vector<std::vector<double>> gains(sources.size(), std::vector<double>(targets.size()));
		for (std::size_t s = 0; s < sources.size(); ++s)
			for (std::size_t t = 0; t < targets.size(); ++t)
				gains[s][t] = PairScore(proposal.m_Source, sources[s], proposal.m_Target, targets[t], part);
		// What would not be proposed takes no place from what would.
		std::vector<std::vector<double>> usable = gains;
		for (auto& rRow : usable)
			for (double& rGain : rRow)
				rGain = rGain < i_LeastScore ? 0.0 : rGain;
		const std::vector<std::int64_t> assignment = BestAssignment(usable);
		for (std::size_t s = 0; s < sources.size(); ++s)
			for (std::size_t t = 0; t < targets.size(); ++t)
			{
				const bool bAssigned = assignment[s] == std::int64_t(t);
				if (!bAssigned && gains[s][t] < c_LeastAlternative)
					continue;
				const auto [position, rotation] = WeightsFor(part);
				(bAssigned ? pairs : proposal.m_Alternatives)
				    .push_back({sources[s], targets[t], gains[s][t],
				        PairReasons(proposal.m_Source, sources[s], proposal.m_Target, targets[t], part), position,
				        rotation});
			}
	}
	KeepBest(pairs, proposal.m_Alternatives);
	proposal.m_NoBody = NoBody(source, proposal.m_Source, target, proposal.m_Target);
	if (proposal.m_NoBody.empty())
		proposal.m_Pairs = std::move(pairs);
	else
		std::ranges::move(pairs, std::back_inserter(proposal.m_Alternatives));
	for (VProposedPair& rPair : proposal.m_Pairs)
		for (const VProposedPair& rOther : proposal.m_Alternatives)
			if ((rOther.m_Source == rPair.m_Source || rOther.m_Target == rPair.m_Target)
			    && rOther.m_Score > rPair.m_Score - c_AsGood)
			{
				rPair.m_Reasons.push_back("ambiguous: "
				    + (rOther.m_Source == rPair.m_Source ? target[rOther.m_Target].m_Name
				                                         : source[rOther.m_Source].m_Name)
				    + " fits about as well");
				break;
			}
	Order(proposal.m_Pairs);
	Order(proposal.m_Alternatives);

	std::vector<bool> bSource(source.size());
	std::vector<bool> bTarget(target.size());
	for (const VProposedPair& rPair : proposal.m_Pairs)
		bSource[rPair.m_Source] = bTarget[rPair.m_Target] = true;
	for (std::size_t i = 0; i < bSource.size(); ++i)
		if (!bSource[i])
			proposal.m_UnmappedSources.push_back({i,
			    !source[i].m_bMoves ? "fixed to its parent: it has no joint"
			                        : WhyUnmapped(proposal.m_Source.m_Joints[i], proposal.m_Alternatives, i,
			                            &VProposedPair::m_Source)});
	for (std::size_t i = 0; i < bTarget.size(); ++i)
		if (!bTarget[i])
			proposal.m_UnmappedTargets.push_back(
			    {i, WhyUnmapped(proposal.m_Target.m_Joints[i], proposal.m_Alternatives, i, &VProposedPair::m_Target)});
	return proposal;
}

std::int64_t BodyRoot(const VProposal& i_rProposal, const VRestSkeleton& i_rTarget)
{
	std::map<std::int64_t, double> votes;
	for (const VProposedPair& rPair : i_rProposal.m_Pairs)
	{
		auto root = std::int64_t(rPair.m_Target);
		while (i_rTarget[std::size_t(root)].m_Parent >= 0)
			root = i_rTarget[std::size_t(root)].m_Parent;
		votes[root] += rPair.m_Score;
	}
	const auto most = std::ranges::max_element(votes, {}, [](const auto& i_rVote) { return i_rVote.second; });
	return most == votes.end() ? -1 : most->first;
}

} // namespace SetupProposal
