#include "SetupProposal/Twins.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace SetupProposal
{
namespace
{

/// Bones of a chain that are compared, and how much longer one may be.
constexpr std::size_t c_Compared = 4;
constexpr double c_Longer = 0.06;
/// More children than this of one joint are no limbs.
constexpr std::size_t c_MostChildren = 64;

double Distance(const Rotation::VVector3& i_rA, const Rotation::VVector3& i_rB)
{
	return std::hypot(i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]);
}

/// Lengths of a bone and of those that go on from its end; negative behind the last.
using VLengths = std::array<double, c_Compared>;

/// How different two chains are, from 0 to 1 for twins; more for others.
double Difference(const VLengths& i_rA, const VLengths& i_rB)
{
	double worst = 0.0;
	for (std::size_t i = 0; i < c_Compared; ++i)
	{
		// A chain may end a joint earlier.
		if (i_rA[i] < 0.0 || i_rB[i] < 0.0)
			return (i_rA[i] < 0.0) == (i_rB[i] < 0.0) || i > 2 ? worst : 2.0;
		const double longer = std::max(i_rA[i], i_rB[i]);
		if (longer > 0.0)
			worst = std::max(worst, std::abs(i_rA[i] - i_rB[i]) / (c_Longer * longer));
	}
	return worst;
}

/// Pairs up joints of two lists, the most alike first.
void PairUp(const std::vector<std::size_t>& i_rA, const std::vector<std::size_t>& i_rB, bool i_bSame,
    const VRestSkeleton& i_rSkeleton, const std::vector<VLengths>& i_rLengths, std::vector<std::int64_t>& io_rTwins)
{
	if (i_rA.size() > c_MostChildren || i_rB.size() > c_MostChildren)
		return;
	struct VCandidate
	{
		double m_Difference;
		std::size_t m_A;
		std::size_t m_B;
	};
	std::vector<VCandidate> candidates;
	for (std::size_t a = 0; a < i_rA.size(); ++a)
		for (std::size_t b = i_bSame ? a + 1 : 0; b < i_rB.size(); ++b)
		{
			const double difference = Difference(i_rLengths[i_rA[a]], i_rLengths[i_rB[b]]);
			// Two that stand in one place are no twins unless what hangs on them is.
			if (difference <= 1.0
			    && (!i_bSame
			        || Distance(i_rSkeleton[i_rA[a]].m_Place, i_rSkeleton[i_rB[b]].m_Place)
			            > 1e-3 * i_rLengths[i_rA[a]][0]))
				candidates.push_back({difference, i_rA[a], i_rB[b]});
		}
	std::ranges::stable_sort(candidates, {}, &VCandidate::m_Difference);
	for (const VCandidate& rCandidate : candidates)
		if (io_rTwins[rCandidate.m_A] < 0 && io_rTwins[rCandidate.m_B] < 0)
		{
			io_rTwins[rCandidate.m_A] = std::int64_t(rCandidate.m_B);
			io_rTwins[rCandidate.m_B] = std::int64_t(rCandidate.m_A);
		}
}

} // namespace

std::vector<std::int64_t> MainChildren(const VRestSkeleton& i_rSkeleton)
{
	std::vector<std::size_t> sizes(i_rSkeleton.size(), 1);
	std::vector<std::int64_t> children(i_rSkeleton.size(), -1);
	for (std::size_t i = i_rSkeleton.size(); i-- > 0;)
	{
		if (i_rSkeleton[i].m_Parent < 0)
			continue;
		const auto parent = std::size_t(i_rSkeleton[i].m_Parent);
		sizes[parent] += sizes[i];
		if (children[parent] < 0 || sizes[i] >= sizes[std::size_t(children[parent])])
			children[parent] = std::int64_t(i);
	}
	return children;
}

std::vector<std::int64_t> FindTwins(const VRestSkeleton& i_rSkeleton)
{
	const std::size_t count = i_rSkeleton.size();
	const std::vector<std::int64_t> mainChildren = MainChildren(i_rSkeleton);
	std::vector<std::vector<std::size_t>> children(count);
	std::vector<VLengths> lengths(count);
	for (std::size_t i = count; i-- > 0;)
	{
		lengths[i].fill(-1.0);
		lengths[i][0] = 0.0;
		if (mainChildren[i] >= 0)
			std::copy_n(lengths[std::size_t(mainChildren[i])].begin(), c_Compared - 1, lengths[i].begin() + 1);
		if (i_rSkeleton[i].m_Parent < 0)
			continue;
		const auto parent = std::size_t(i_rSkeleton[i].m_Parent);
		lengths[i][0] = Distance(i_rSkeleton[i].m_Place, i_rSkeleton[parent].m_Place);
		children[parent].insert(children[parent].begin(), i);
	}
	std::vector<std::int64_t> twins(count, -1);
	for (std::size_t i = 0; i < count; ++i)
		if (twins[i] < 0)
			PairUp(children[i], children[i], true, i_rSkeleton, lengths, twins);
		else if (const auto twin = std::size_t(twins[i]); i < twin)
			PairUp(children[i], children[twin], false, i_rSkeleton, lengths, twins);
	return twins;
}

} // namespace SetupProposal
