#include "SetupProposal/TreeVote.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace SetupProposal
{
namespace
{

struct VUsual
{
	EBodyPart m_Parent;
	EBodyPart m_Child;
	double m_Log;
};

/// EOther stands for none above.
constexpr VUsual c_Usual[] = {
    {EOther, ERoot, 0.0},
    {EOther, EPelvis, 0.0},
    {EOther, ESpine, -2.5},
    {ERoot, ERoot, -1.0},
    {ERoot, EPelvis, 0.0},
    {ERoot, ESpine, -1.5},
    {ERoot, EThigh, -2.5},
    {EPelvis, EPelvis, -1.5},
    {EPelvis, ESpine, 0.0},
    {EPelvis, EThigh, 0.0},
    {EPelvis, EClavicle, -2.5},
    {EPelvis, EUpperArm, -2.5},
    {ESpine, ESpine, 0.0},
    {ESpine, ENeck, 0.0},
    {ESpine, EHead, -2.5},
    {ESpine, EClavicle, 0.0},
    {ESpine, EUpperArm, -0.7},
    {ESpine, EPelvis, -2.0},
    {ESpine, EThigh, -1.0},
    {ENeck, ENeck, -2.0},
    {ENeck, EHead, 0.0},
    {ENeck, EClavicle, -0.7},
    {ENeck, EUpperArm, -2.0},
    {EHead, EHead, -3.0},
    {EClavicle, EClavicle, -2.5},
    {EClavicle, EUpperArm, 0.0},
    {EUpperArm, EForeArm, 0.0},
    {EForeArm, EHand, 0.0},
    {EHand, EHand, -2.5},
    {EHand, EThumb, 0.0},
    {EHand, EIndexFinger, 0.0},
    {EHand, EMiddleFinger, 0.0},
    {EHand, ERingFinger, 0.0},
    {EHand, ELittleFinger, 0.0},
    {EThumb, EThumb, 0.0},
    {EIndexFinger, EIndexFinger, 0.0},
    {EMiddleFinger, EMiddleFinger, 0.0},
    {ERingFinger, ERingFinger, 0.0},
    {ELittleFinger, ELittleFinger, 0.0},
    {EThigh, EShin, 0.0},
    {EThigh, EThigh, -2.5},
    {EShin, EFoot, 0.0},
    {EFoot, EToe, 0.0},
    {EToe, EToe, -1.2},
};
/// What is never seen: no more than this, so that names and rest pose together outvote it.
constexpr double c_Unusual = -4.0;
/// A helper beneath anything, a helper beneath another, and a part beneath a helper.
constexpr double c_Helper = -0.8;
constexpr double c_HelperBeneathHelper = -0.1;
constexpr double c_BeneathHelper = -0.7;

/// A joint is a part, or a helper beneath the last part above it, or beneath none: so the parts know of each other
/// across helpers.
constexpr std::size_t c_Parts = EOther;
constexpr std::size_t c_States = 2 * c_Parts + 1;

bool IsHelper(std::size_t i_State)
{
	return i_State >= c_Parts;
}

/// EOther for none.
std::size_t LastPart(std::size_t i_State)
{
	return IsHelper(i_State) ? i_State - c_Parts : i_State;
}

/// The more hang on one joint beyond what hangs on a body's, the less it tells of them.
constexpr double c_ChildrenOfBody = 8.0;

using VStates = std::array<double, c_States>;

constexpr double c_Never = -1e300;

/// What a step from one state to the next costs.
const std::array<VStates, c_States>& Steps()
{
	static const std::array<VStates, c_States> c_Steps = []
	{
		std::array<VStates, c_States> steps;
		for (std::size_t from = 0; from < c_States; ++from)
			for (std::size_t to = 0; to < c_States; ++to)
				if (IsHelper(to))
					steps[from][to] = LastPart(from) != LastPart(to) ? c_Never
					    : IsHelper(from)                             ? c_HelperBeneathHelper
					                                                 : c_Helper;
				else
					steps[from][to] = UsualBeneath(EBodyPart(LastPart(from)), EBodyPart(to))
					    + (IsHelper(from) && from != c_States - 1 ? c_BeneathHelper : 0.0);
		return steps;
	}();
	return c_Steps;
}

double VoteFor(const VPartLogs& i_rVotes, std::size_t i_State)
{
	return i_rVotes[IsHelper(i_State) ? EOther : i_State];
}

double LogSum(const VStates& i_rValues)
{
	const double most = *std::ranges::max_element(i_rValues);
	double sum = 0.0;
	for (const double value : i_rValues)
		sum += std::exp(value - most);
	return most + std::log(sum);
}

} // namespace

double UsualBeneath(EBodyPart i_Parent, EBodyPart i_Child)
{
	for (const VUsual& rUsual : c_Usual)
		if (rUsual.m_Parent == i_Parent && rUsual.m_Child == i_Child)
			return rUsual.m_Log;
	return c_Unusual;
}

std::vector<VPartScores> LikelyParts(const VRestSkeleton& i_rSkeleton, const std::vector<VPartLogs>& i_rVotes)
{
	const std::array<VStates, c_States>& rSteps = Steps();
	const std::size_t count = i_rSkeleton.size();
	std::vector<double> children(count);
	for (const VRestJoint& rJoint : i_rSkeleton)
		if (rJoint.m_Parent >= 0)
			++children[std::size_t(rJoint.m_Parent)];
	const auto trust = [&](std::size_t i_Joint)
	{
		const std::int64_t parent = i_rSkeleton[i_Joint].m_Parent;
		return parent < 0 ? 1.0 : std::min(1.0, c_ChildrenOfBody / children[std::size_t(parent)]);
	};
	// What a joint and all beneath it say for each of its states, and what of that its parent hears.
	std::vector<VStates> below(count);
	std::vector<VStates> told(count);
	for (std::size_t i = 0; i < count; ++i)
		for (std::size_t state = 0; state < c_States; ++state)
			below[i][state] = VoteFor(i_rVotes[i], state);
	for (std::size_t i = count; i-- > 0;)
	{
		for (std::size_t from = 0; from < c_States; ++from)
		{
			VStates sum;
			for (std::size_t to = 0; to < c_States; ++to)
				sum[to] = below[i][to] + trust(i) * rSteps[from][to];
			told[i][from] = LogSum(sum);
		}
		if (i_rSkeleton[i].m_Parent >= 0)
			for (std::size_t from = 0; from < c_States; ++from)
				below[std::size_t(i_rSkeleton[i].m_Parent)][from] += told[i][from];
	}
	// What all others say, from above.
	std::vector<VStates> above(count);
	std::vector<VPartScores> likely(count);
	for (std::size_t i = 0; i < count; ++i)
	{
		VStates parent;
		parent.fill(c_Never);
		if (i_rSkeleton[i].m_Parent < 0)
			parent.back() = 0.0;
		else
		{
			const auto index = std::size_t(i_rSkeleton[i].m_Parent);
			for (std::size_t from = 0; from < c_States; ++from)
				parent[from] = above[index][from] + below[index][from] - told[i][from];
		}
		const double level = *std::ranges::max_element(parent);
		VStates all;
		for (std::size_t to = 0; to < c_States; ++to)
		{
			VStates sum;
			for (std::size_t from = 0; from < c_States; ++from)
				sum[from] = parent[from] - level + trust(i) * rSteps[from][to];
			above[i][to] = LogSum(sum);
			all[to] = above[i][to] + below[i][to];
		}
		const double whole = LogSum(all);
		for (std::size_t state = 0; state < c_States; ++state)
			likely[i][IsHelper(state) ? EOther : state] += std::exp(all[state] - whole);
	}
	return likely;
}

} // namespace SetupProposal
