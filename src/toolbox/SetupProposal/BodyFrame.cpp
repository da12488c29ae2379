#include "SetupProposal/BodyFrame.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <numbers>

namespace SetupProposal
{
namespace
{

/// More joints than this are sampled: their mirror images are looked for each among all.
constexpr std::size_t c_MostSampled = 160;
constexpr int c_Angles = 60;
/// A mirror image that is farther away than this part of the height counts as missing.
constexpr double c_Missing = 0.08;
/// Directions from the right to the left that add up to less than this part of their lengths contradict each other.
constexpr double c_Agree = 0.6;
/// Lower than this part of the height are feet.
constexpr double c_FeetBelow = 0.14;
/// Shorter directions than this part of the height tell nothing.
constexpr double c_Tells = 0.004;
/// Both feet, which point farther to the front than this in all, outvote the names.
constexpr double c_ClearlyTells = 0.04;
/// Limbs that begin outside of these parts of the height, or nearer to each other, tell no proportions.
constexpr double c_LowestLegs = 0.15;
constexpr double c_HighestArms = 0.97;
constexpr double c_ShortestTrunk = 0.1;

struct VFlat
{
	double x = 0.0;
	double y = 0.0;
};

double Dot(const VFlat& i_rA, const VFlat& i_rB)
{
	return i_rA.x * i_rB.x + i_rA.y * i_rB.y;
}

double Along(const Rotation::VVector3& i_rPlace, const VFlat& i_rDirection)
{
	return Dot({i_rPlace[0], i_rPlace[1]}, i_rDirection);
}

double Median(std::vector<double> i_Values)
{
	std::ranges::nth_element(i_Values, i_Values.begin() + std::ptrdiff_t(i_Values.size() / 2));
	return i_Values[i_Values.size() / 2];
}

/// Mean distance of the joints from mirror images of others, as a part of the height, by the plane across a direction
/// through the median of the joints.
double CostOfMirror(const std::vector<Rotation::VVector3>& i_rPlaces, double i_Height, const VFlat& i_rAcross)
{
	std::vector<double> along;
	for (const auto& rPlace : i_rPlaces)
		along.push_back(Along(rPlace, i_rAcross));
	const double middle = Median(along);
	double cost = 0.0;
	for (std::size_t i = 0; i < i_rPlaces.size(); ++i)
	{
		const double back = 2.0 * (along[i] - middle);
		double nearest = c_Missing;
		for (const auto& rOther : i_rPlaces)
			nearest = std::min(nearest,
			    std::hypot(i_rPlaces[i][0] - back * i_rAcross.x - rOther[0],
			        i_rPlaces[i][1] - back * i_rAcross.y - rOther[1], i_rPlaces[i][2] - rOther[2])
			        / i_Height);
		cost += nearest / double(i_rPlaces.size());
	}
	return cost;
}

VFlat From(const VRestSkeleton& i_rSkeleton, std::size_t i_A, std::size_t i_B)
{
	return {i_rSkeleton[i_B].m_Place[0] - i_rSkeleton[i_A].m_Place[0],
	    i_rSkeleton[i_B].m_Place[1] - i_rSkeleton[i_A].m_Place[1]};
}

/// Joints whose names differ in nothing but the side: right and left.
std::vector<std::pair<std::size_t, std::size_t>> PairsByName(const std::vector<VNameWords>& i_rNames)
{
	using VKey = std::pair<std::vector<std::string>, std::string>;
	std::map<VKey, std::size_t> right;
	for (std::size_t i = 0; i < i_rNames.size(); ++i)
		if (i_rNames[i].m_Side == ESide::Right)
			right.emplace(VKey{i_rNames[i].m_Words, i_rNames[i].m_Digits}, i);
	std::vector<std::pair<std::size_t, std::size_t>> pairs;
	for (std::size_t i = 0; i < i_rNames.size(); ++i)
		if (i_rNames[i].m_Side == ESide::Left)
			if (const auto found = right.find({i_rNames[i].m_Words, i_rNames[i].m_Digits}); found != right.end())
				pairs.emplace_back(found->second, i);
	return pairs;
}

/// From the right to the left by the names; zero if they tell none, or contradict each other.
VFlat LeftByNames(const VRestSkeleton& i_rSkeleton, const std::vector<VNameWords>& i_rNames)
{
	VFlat sum;
	double lengths = 0.0;
	for (const auto& [right, left] : PairsByName(i_rNames))
	{
		const VFlat apart = From(i_rSkeleton, right, left);
		sum = {sum.x + apart.x, sum.y + apart.y};
		lengths += std::hypot(apart.x, apart.y);
	}
	return std::hypot(sum.x, sum.y) < c_Agree * lengths ? VFlat{} : sum;
}

/// The line that most of the distances between twins lie on, as the principal axis of their outer products; zero
/// without twins. Weighted by their squares: thighs and arms count, fingers do not.
VFlat AcrossByTwins(const VRestSkeleton& i_rSkeleton, const std::vector<std::int64_t>& i_rTwins)
{
	double xx = 0.0;
	double xy = 0.0;
	double yy = 0.0;
	for (std::size_t i = 0; i < i_rTwins.size(); ++i)
		if (i_rTwins[i] > std::int64_t(i))
		{
			const VFlat apart = From(i_rSkeleton, i, std::size_t(i_rTwins[i]));
			xx += apart.x * apart.x;
			xy += apart.x * apart.y;
			yy += apart.y * apart.y;
		}
	if (xx + yy <= 0.0)
		return {};
	const double angle = 0.5 * std::atan2(2.0 * xy, xx - yy);
	return {std::cos(angle), std::sin(angle)};
}

/// Where the lowest bones point, with what they move of the skin, and how long all of them are.
struct VFeet
{
	VFlat m_Sum;
	double m_Length = 0.0;

	void Add(const Rotation::VVector3& i_rFrom, const Rotation::VVector3& i_rTo)
	{
		const VFlat way{i_rTo[0] - i_rFrom[0], i_rTo[1] - i_rFrom[1]};
		m_Sum = {m_Sum.x + way.x, m_Sum.y + way.y};
		m_Length += std::hypot(way.x, way.y);
	}
};

VFeet FrontByFeet(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame)
{
	const auto isLow = [&](const Rotation::VVector3& i_rPlace)
	{ return i_rPlace[2] - i_rFrame.m_Floor <= c_FeetBelow * i_rFrame.m_Height; };
	VFeet feet;
	for (const VRestJoint& rJoint : i_rSkeleton)
	{
		// What moves no skin beside what does is a control.
		const bool bControl = rJoint.m_Skin && rJoint.m_Skin->m_Share <= 0.0;
		if (bControl || !isLow(rJoint.m_Place))
			continue;
		if (rJoint.m_Parent >= 0 && isLow(i_rSkeleton[std::size_t(rJoint.m_Parent)].m_Place))
			feet.Add(i_rSkeleton[std::size_t(rJoint.m_Parent)].m_Place, rJoint.m_Place);
		if (rJoint.m_Skin)
			feet.Add(rJoint.m_Place, rJoint.m_Skin->m_Centre);
	}
	return feet;
}

/// The horizontal direction whose plane mirrors the joints best.
VFlat AcrossByShape(const VRestSkeleton& i_rSkeleton, double i_Height)
{
	std::vector<Rotation::VVector3> places;
	const std::size_t step = i_rSkeleton.size() / c_MostSampled + 1;
	for (std::size_t i = 0; i < i_rSkeleton.size(); i += step)
		places.push_back(i_rSkeleton[i].m_Place);
	VFlat across{1.0, 0.0};
	double best = 2.0;
	for (int i = 0; i < c_Angles; ++i)
	{
		const double angle = std::numbers::pi * i / c_Angles;
		const VFlat direction{std::cos(angle), std::sin(angle)};
		const double cost = CostOfMirror(places, i_Height, direction);
		if (cost < best - 1e-9)
		{
			best = cost;
			across = direction;
		}
	}
	return across;
}

/// Where the mirror plane stands: in the middle of most twins, or of all joints without twins.
double MiddleAlong(const VRestSkeleton& i_rSkeleton, const std::vector<std::int64_t>& i_rTwins, const VFlat& i_rAcross)
{
	std::vector<double> middles;
	std::vector<double> all;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		all.push_back(Along(i_rSkeleton[i].m_Place, i_rAcross));
		if (i_rTwins[i] >= 0 && std::size_t(i_rTwins[i]) < i)
			middles.push_back(0.5 * (all.back() + all[std::size_t(i_rTwins[i])]));
	}
	return Median(middles.empty() ? all : middles);
}

} // namespace

VBodyFrame BodyFrameOf(const VRestSkeleton& i_rSkeleton, const std::vector<VNameWords>& i_rNames,
    const std::vector<std::int64_t>& i_rTwins)
{
	VBodyFrame frame;
	if (i_rSkeleton.empty())
		return frame;
	const auto [lowest, highest] =
	    std::ranges::minmax(i_rSkeleton, {}, [](const VRestJoint& i_rJoint) { return i_rJoint.m_Place[2]; });
	frame.m_Floor = lowest.m_Place[2];
	frame.m_Height = std::max(highest.m_Place[2] - frame.m_Floor, 1e-6);

	const VFlat byNames = LeftByNames(i_rSkeleton, i_rNames);
	const double length = std::hypot(byNames.x, byNames.y);
	frame.m_bSidesByName = length > c_Tells * frame.m_Height;
	VFlat across =
	    frame.m_bSidesByName ? VFlat{byNames.x / length, byNames.y / length} : AcrossByTwins(i_rSkeleton, i_rTwins);
	if (across.x == 0.0 && across.y == 0.0)
		across = AcrossByShape(i_rSkeleton, frame.m_Height);
	// Up times the front is left.
	const VFeet feet = FrontByFeet(i_rSkeleton, frame);
	const double front = Dot(feet.m_Sum, {across.y, -across.x});
	frame.m_bFrontByFeet = std::abs(front) > c_Tells * frame.m_Height;
	frame.m_bContradiction = frame.m_bFrontByFeet && frame.m_bSidesByName && front < 0.0;
	const bool bClear = std::abs(front) > std::max(c_ClearlyTells * frame.m_Height, c_Agree * feet.m_Length);
	if (frame.m_bFrontByFeet && front < 0.0 && (!frame.m_bSidesByName || bClear))
		across = {-across.x, -across.y};

	frame.m_Left = {across.x, across.y, 0.0};
	frame.m_Forward = {across.y, -across.x, 0.0};
	const double offset = MiddleAlong(i_rSkeleton, i_rTwins, across);
	frame.m_Centre = {across.x * offset, across.y * offset, 0.0};
	return frame;
}

VBodyPlace PlaceIn(const VBodyFrame& i_rFrame, const Rotation::VVector3& i_rPlace)
{
	const Rotation::VVector3 from{i_rPlace[0] - i_rFrame.m_Centre[0], i_rPlace[1] - i_rFrame.m_Centre[1], 0.0};
	return {(from[0] * i_rFrame.m_Left[0] + from[1] * i_rFrame.m_Left[1]) / i_rFrame.m_Height,
	    (from[0] * i_rFrame.m_Forward[0] + from[1] * i_rFrame.m_Forward[1]) / i_rFrame.m_Height,
	    (i_rPlace[2] - i_rFrame.m_Floor) / i_rFrame.m_Height};
}

double UsualUp(const VBodyFrame& i_rFrame, double i_Up)
{
	const double legs = i_rFrame.m_LegsUp;
	const double arms = i_rFrame.m_ArmsUp;
	if (legs < c_LowestLegs || arms > c_HighestArms || arms - legs < c_ShortestTrunk)
		return i_Up;
	if (i_Up < legs)
		return i_Up * c_UsualLegsUp / legs;
	if (i_Up < arms)
		return c_UsualLegsUp + (i_Up - legs) * (c_UsualArmsUp - c_UsualLegsUp) / (arms - legs);
	return c_UsualArmsUp + (i_Up - arms) * (1.0 - c_UsualArmsUp) / (1.0 - arms);
}

} // namespace SetupProposal
