#include "SetupProposal/FingerOrder.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <optional>

namespace SetupProposal
{
namespace
{

/// A joint that is some finger by this much is one, and the one finger by this share of that.
constexpr double c_SomeFinger = 0.5;
constexpr double c_OneFinger = 0.6;
/// A finger that begins nearer to the hand than this part of what the others do is the thumb.
constexpr double c_ThumbIsNearer = 0.75;
/// How sure the order is with so many fingers beside the thumb: which are missing is not known.
constexpr double c_Sure[] = {0.0, 0.75, 0.8, 0.8, 0.95};
constexpr std::size_t c_MostFingers = 5;

double SumOfFingers(const VPartScores& i_rLikely)
{
	return std::accumulate(i_rLikely.begin() + EThumb, i_rLikely.begin() + ELittleFinger + 1, 0.0);
}

struct VFinger
{
	std::size_t m_First;
	std::optional<EBodyPart> m_Part;
};

/// The fingers of each hand: joints that may be some and hang on it, past helpers.
std::vector<std::vector<VFinger>> FingersOfHands(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody)
{
	std::vector<std::vector<VFinger>> fingers(i_rSkeleton.size());
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		const VPartScores& rLikely = i_rBody.m_Joints[i].m_Likely;
		const double sum = SumOfFingers(rLikely);
		if (sum < c_SomeFinger)
			continue;
		std::int64_t parent = i_rSkeleton[i].m_Parent;
		while (parent >= 0 && i_rBody.m_Joints[std::size_t(parent)].m_Part == EOther
		    && SumOfFingers(i_rBody.m_Joints[std::size_t(parent)].m_Likely) < c_SomeFinger)
			parent = i_rSkeleton[std::size_t(parent)].m_Parent;
		if (parent < 0 || i_rBody.m_Joints[std::size_t(parent)].m_Part != EHand)
			continue;
		const auto best = std::max_element(rLikely.begin() + EThumb, rLikely.begin() + ELittleFinger + 1);
		VFinger finger{i, std::nullopt};
		if (*best > c_OneFinger * sum)
			finger.m_Part = EBodyPart(best - rLikely.begin());
		fingers[std::size_t(parent)].push_back(finger);
	}
	return fingers;
}

double Apart(const VBodyReading& i_rBody, std::size_t i_A, std::size_t i_B)
{
	const VBodyPlace& rA = i_rBody.m_Joints[i_A].m_Place;
	const VBodyPlace& rB = i_rBody.m_Joints[i_B].m_Place;
	return std::hypot(rA.m_Left - rB.m_Left, rA.m_Forward - rB.m_Forward, rA.m_Up - rB.m_Up);
}

/// Which of the fingers is the thumb.
std::size_t ThumbOf(const VBodyReading& i_rBody, std::size_t i_Hand, const std::vector<VFinger>& i_rFingers)
{
	for (std::size_t i = 0; i < i_rFingers.size(); ++i)
		if (i_rFingers[i].m_Part == EThumb)
			return i;
	std::vector<double> distances;
	for (const VFinger& rFinger : i_rFingers)
		distances.push_back(Apart(i_rBody, i_Hand, rFinger.m_First));
	const auto nearest = std::ranges::min_element(distances);
	const double sum = std::accumulate(distances.begin(), distances.end(), 0.0);
	if (*nearest < c_ThumbIsNearer * (sum - *nearest) / double(distances.size() - 1))
		return std::size_t(nearest - distances.begin());
	return std::size_t(
	    std::ranges::max_element(i_rFingers, {},
	        [&](const VFinger& i_rFinger) { return i_rBody.m_Joints[i_rFinger.m_First].m_Place.m_Forward; })
	    - i_rFingers.begin());
}

void Tell(
    const VRestSkeleton& i_rSkeleton, VBodyReading& io_rBody, std::size_t i_First, EBodyPart i_Part, double i_Sure)
{
	std::vector<bool> bOfFinger(i_rSkeleton.size());
	for (std::size_t i = i_First; i < i_rSkeleton.size(); ++i)
	{
		const std::int64_t parent = i_rSkeleton[i].m_Parent;
		bOfFinger[i] = i == i_First || (parent >= 0 && bOfFinger[std::size_t(parent)]);
		if (!bOfFinger[i])
			continue;
		VPartScores& rLikely = io_rBody.m_Joints[i].m_Likely;
		const double sum = SumOfFingers(rLikely);
		std::fill(rLikely.begin() + EThumb, rLikely.begin() + ELittleFinger + 1, (1.0 - i_Sure) * sum / 4.0);
		rLikely[i_Part] = i_Sure * sum;
		io_rBody.m_Joints[i].m_Part = EBodyPart(std::ranges::max_element(rLikely) - rLikely.begin());
	}
}

} // namespace

void TellFingersApart(const VRestSkeleton& i_rSkeleton, VBodyReading& io_rBody)
{
	const std::vector<std::vector<VFinger>> hands = FingersOfHands(i_rSkeleton, io_rBody);
	for (std::size_t hand = 0; hand < hands.size(); ++hand)
	{
		const std::vector<VFinger>& rFingers = hands[hand];
		const bool bAllTold =
		    std::ranges::all_of(rFingers, [](const VFinger& i_rFinger) { return i_rFinger.m_Part.has_value(); });
		if (bAllTold || rFingers.size() < 2 || rFingers.size() > c_MostFingers)
			continue;
		const std::size_t thumb = ThumbOf(io_rBody, hand, rFingers);
		const double sure = c_Sure[rFingers.size() - 1];
		std::vector<std::size_t> others;
		for (std::size_t i = 0; i < rFingers.size(); ++i)
			if (i != thumb)
				others.push_back(i);
		std::ranges::sort(others, {},
		    [&](std::size_t i_Finger) { return Apart(io_rBody, rFingers[thumb].m_First, rFingers[i_Finger].m_First); });
		if (!rFingers[thumb].m_Part)
			Tell(i_rSkeleton, io_rBody, rFingers[thumb].m_First, EThumb, sure);
		for (std::size_t i = 0; i < others.size(); ++i)
			if (!rFingers[others[i]].m_Part)
				Tell(i_rSkeleton, io_rBody, rFingers[others[i]].m_First, EBodyPart(EIndexFinger + i), sure);
	}
}

} // namespace SetupProposal
