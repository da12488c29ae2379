#include "SetupReview/rebind/SegmentMatch.h"

#include "SetupProposal/Proposal.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace SetupReview
{
namespace
{

/// Two places in a parent are the same within this, in mm and as a share of the distance from the parent.
constexpr double c_NearPlace = 1.0;
constexpr double c_NearPlaceShare = 0.01;

class VMatching
{
public:
	VMatching(const VMatchSide& i_rOld, const VMatchSide& i_rNew)
	    : m_rOld(i_rOld), m_rNew(i_rNew), m_Matches(i_rOld.m_rSubject.m_Segments.size()),
	      m_Taken(i_rNew.m_rSubject.m_Segments.size())
	{
	}

	void ByNames()
	{
		std::map<std::string_view, std::vector<std::size_t>> places;
		for (std::size_t i = 0; i < m_Taken.size(); ++i)
			places[m_rNew.m_rSubject.m_Segments[i].m_Name].push_back(i);
		// Of several of one name the one beneath the same parent, or else the next.
		for (const bool bAnywhere : {false, true})
			for (std::size_t i = 0; i < m_Matches.size(); ++i)
			{
				const auto found = places.find(m_rOld.m_rSubject.m_Segments[i].m_Name);
				if (m_Matches[i].m_New >= 0 || found == places.end())
					continue;
				const auto& rPlaces = found->second;
				const auto free = [&](std::size_t i_New) { return !m_Taken[i_New]; };
				auto best = std::ranges::find_if(
				    rPlaces, [&](std::size_t i_New) { return free(i_New) && AreChildrenOfMatch(i, i_New); });
				if (best == rPlaces.end() && bAnywhere)
					best = std::ranges::find_if(rPlaces, free);
				if (best != rPlaces.end())
					Take(i, *best, ERebindRule::Name, 1.0);
			}
	}

	void ByPlaces()
	{
		if (!m_Matches.empty() && !m_Taken.empty() && m_Matches[0].m_New < 0 && !m_Taken[0])
			Take(0, 0, ERebindRule::Place, 1.0);
		const std::vector<std::vector<std::size_t>> oldChildren = ChildrenOf(m_rOld);
		const std::vector<std::vector<std::size_t>> newChildren = ChildrenOf(m_rNew);
		for (std::size_t parent = 0; parent < m_Matches.size(); ++parent)
		{
			if (m_Matches[parent].m_New < 0)
				continue;
			const auto& rNew = newChildren[std::size_t(m_Matches[parent].m_New)];
			std::vector<std::pair<std::size_t, std::size_t>> found;
			for (const std::size_t child : oldChildren[parent])
			{
				const auto fits = [&](std::size_t i_New) { return !m_Taken[i_New] && AtSamePlace(child, i_New); };
				const auto alike = [&](std::size_t i_Old)
				{
					return m_Matches[i_Old].m_New < 0
					    && std::ranges::any_of(
					        rNew, [&](std::size_t i_New) { return fits(i_New) && AtSamePlace(i_Old, i_New); });
				};
				if (m_Matches[child].m_New < 0 && std::ranges::count_if(rNew, fits) == 1
				    && std::ranges::count_if(oldChildren[parent], alike) == 1)
					found.emplace_back(child, *std::ranges::find_if(rNew, fits));
			}
			for (const auto& [child, place] : found)
				if (!m_Taken[place])
					Take(child, place, ERebindRule::Place, 1.0);
		}
	}

	void ByProposal(double i_LeastScore)
	{
		if (m_rOld.m_Rest.size() != m_Matches.size() || m_rNew.m_Rest.size() != m_Taken.size())
			return;
		SetupProposal::VRestSkeleton old = m_rOld.m_Rest;
		// What has no joint may have targets all the same.
		for (SetupProposal::VRestJoint& rJoint : old)
			rJoint.m_bMoves = true;
		for (const SetupProposal::VProposedPair& rPair :
		    SetupProposal::Propose(old, m_rNew.m_Rest, i_LeastScore).m_Pairs)
			if (m_Matches[rPair.m_Source].m_New < 0 && !m_Taken[rPair.m_Target])
				Take(rPair.m_Source, rPair.m_Target, ERebindRule::Proposal, rPair.m_Score);
	}

	const std::vector<VSegmentMatch>& Matches() const { return m_Matches; }

private:
	void Take(std::size_t i_Old, std::size_t i_New, ERebindRule i_Rule, double i_Score)
	{
		m_Matches[i_Old] = {std::int64_t(i_New), i_Rule, i_Score};
		m_Taken[i_New] = true;
	}

	static std::size_t ParentOf(const VMatchSide& i_rSide, std::size_t i_Index)
	{
		return i_rSide.m_rSubject.m_Segments[i_Index].m_ParentSegmentIndex;
	}

	bool AreChildrenOfMatch(std::size_t i_Old, std::size_t i_New) const
	{
		const std::size_t oldParent = ParentOf(m_rOld, i_Old);
		const std::size_t newParent = ParentOf(m_rNew, i_New);
		return oldParent < m_Matches.size() ? m_Matches[oldParent].m_New == std::int64_t(newParent)
		                                    : newParent >= m_Taken.size();
	}

	static std::vector<std::vector<std::size_t>> ChildrenOf(const VMatchSide& i_rSide)
	{
		std::vector<std::vector<std::size_t>> children(i_rSide.m_rSubject.m_Segments.size());
		for (std::size_t i = 0; i < children.size(); ++i)
			if (const std::size_t parent = ParentOf(i_rSide, i); parent < children.size())
				children[parent].push_back(i);
		return children;
	}

	bool AtSamePlace(std::size_t i_Old, std::size_t i_New) const
	{
		const Rotation::VVector3& rA = m_rOld.m_Offsets[i_Old];
		const Rotation::VVector3& rB = m_rNew.m_Offsets[i_New];
		return std::hypot(rA[0] - rB[0], rA[1] - rB[1], rA[2] - rB[2])
		    <= c_NearPlace + c_NearPlaceShare * std::hypot(rA[0], rA[1], rA[2]);
	}

	const VMatchSide& m_rOld;
	const VMatchSide& m_rNew;
	std::vector<VSegmentMatch> m_Matches;
	std::vector<bool> m_Taken;
};

} // namespace

std::vector<VSegmentMatch> MatchSegments(const VMatchSide& i_rOld, const VMatchSide& i_rNew, double i_LeastScore)
{
	VMatching matching(i_rOld, i_rNew);
	matching.ByNames();
	matching.ByPlaces();
	matching.ByProposal(i_LeastScore);
	matching.ByPlaces();
	return matching.Matches();
}

} // namespace SetupReview
