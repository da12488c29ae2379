#include "TakeIO/Guess.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace
{

using namespace TakeIO;

/// Least and greatest of one coordinate over all joints and ends.
std::pair<double, double> Extent(const VTake& i_rTake, int i_Axis)
{
	std::vector<VJointPose> poses;
	WorldRestPoses(i_rTake, poses);
	double least = std::numeric_limits<double>::infinity();
	double greatest = -least;
	const auto add = [&](const Rotation::VVector3& i_rPoint)
	{
		least = std::min(least, i_rPoint[i_Axis]);
		greatest = std::max(greatest, i_rPoint[i_Axis]);
	};
	for (std::size_t i = 0; i < poses.size(); ++i)
	{
		add(poses[i].t);
		for (const Rotation::VVector3& rEnd : i_rTake.m_Joints[i].m_Ends)
			add(Rotation::Apply(poses[i], rEnd));
	}
	return {least, greatest};
}

/// Units that motion is recorded in. The last is that of a large public library of motion: an inch over 0.45.
constexpr VUnit c_Units[]{{"m", 1000.0}, {"cm", 10.0}, {"mm", 1.0}, {"inch", 25.4}, {"inch/0.45", 25.4 / 0.45}};

/// Of a person, from a small woman to a tall man, with the centre of the pelvis where each system has it.
constexpr double c_LowestHips = 700.0;
constexpr double c_HighestHips = 1200.0;

} // namespace

EUp TakeIO::GuessUp(const VTake& i_rTake)
{
	const auto [leastY, greatestY] = Extent(i_rTake, 1);
	const auto [leastZ, greatestZ] = Extent(i_rTake, 2);
	return greatestZ - leastZ > greatestY - leastY ? EUp::Z : EUp::Y;
}

double TakeIO::HipsHeight(const VTake& i_rTake, EUp i_Up)
{
	const int axis = i_Up == EUp::Y ? 1 : 2;
	return i_rTake.m_Joints.front().m_Rest.t[axis] - Extent(i_rTake, axis).first;
}

VUnit TakeIO::GuessUnit(double i_HipsHeight)
{
	// How far the height is from a person's as a factor, 1 for one that fits.
	const auto distance = [i_HipsHeight](const VUnit& i_rUnit)
	{
		const double height = i_HipsHeight * i_rUnit.m_Size;
		return height > 0.0 ? std::max({c_LowestHips / height, height / c_HighestHips, 1.0})
		                    : std::numeric_limits<double>::infinity();
	};
	VUnit unit = *std::ranges::min_element(c_Units, {}, distance);
	unit.m_bFits = distance(unit) == 1.0;
	// Most files that tell nothing at all are in centimetres.
	return i_HipsHeight > 0.0 ? unit : VUnit{"cm", 10.0, false};
}
