#include "SetupProposal/Sole.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>
#include <vector>

namespace SetupProposal
{
namespace
{

using Rotation::VMatrix3;
using Rotation::VVector3;

/// Fewer points stand on nothing.
constexpr std::size_t c_FewestPoints = 4;
/// Of more, so many tell how a sole lies as well.
constexpr std::size_t c_MostPoints = 4000;
/// A sole that leans by fewer degrees more than when it was bound is as level.
constexpr double c_AsLevel = 3.0;
/// A plane is looked for that rises by no more than this to each side, to within so little.
constexpr double c_Steepest = 4.0;
constexpr double c_Within = 1e-3;

/// Where a concave function of one variable is largest, by golden sections.
template <typename VFunction>
double WhereLargest(const VFunction& i_rFunction)
{
	constexpr double c_Golden = 1.0 / std::numbers::phi;
	double low = -c_Steepest;
	double high = c_Steepest;
	double left = high - c_Golden * (high - low);
	double right = low + c_Golden * (high - low);
	double atLeft = i_rFunction(left);
	double atRight = i_rFunction(right);
	while (high - low > c_Within)
		if (atLeft > atRight)
		{
			high = right;
			right = left;
			atRight = atLeft;
			left = high - c_Golden * (high - low);
			atLeft = i_rFunction(left);
		}
		else
		{
			low = left;
			left = right;
			atLeft = atRight;
			right = low + c_Golden * (high - low);
			atRight = i_rFunction(right);
		}
	return 0.5 * (low + high);
}

/// How far from the level the face of the points' hull is that their centre stands over, in degrees: the plane below
/// all of them that is highest there.
double TiltOfLowerFace(const std::vector<VVector3>& i_rPoints)
{
	VVector3 centre{};
	for (const VVector3& rPoint : i_rPoints)
		for (std::size_t axis = 0; axis < 3; ++axis)
			centre[axis] += rPoint[axis] / double(i_rPoints.size());
	const auto beneath = [&](double i_X, double i_Y)
	{
		double height = std::numeric_limits<double>::max();
		for (const VVector3& rPoint : i_rPoints)
			height = std::min(height, rPoint[2] - i_X * (rPoint[0] - centre[0]) - i_Y * (rPoint[1] - centre[1]));
		return height;
	};
	const auto bestY = [&](double i_X) { return WhereLargest([&](double i_Y) { return beneath(i_X, i_Y); }); };
	const double x = WhereLargest([&](double i_X) { return beneath(i_X, bestY(i_X)); });
	return Rotation::c_Degrees * std::atan(std::hypot(x, bestY(x)));
}

/// From where it stands, along the axes of the world: each, or one of so many.
std::vector<VVector3> PointsOf(const VRestSkin& i_rSkin, std::size_t i_Step = 1)
{
	std::vector<VVector3> points;
	for (std::size_t i = 0; i < i_rSkin.m_pCarried->size(); i += i_Step)
	{
		const auto& rCarried = (*i_rSkin.m_pCarried)[i];
		points.push_back(Rotation::Product(i_rSkin.m_Axes, VVector3{rCarried[0], rCarried[1], rCarried[2]}));
	}
	return points;
}

/// By the smallest angle; from a unit vector.
VMatrix3 TurnUp(const VVector3& i_rFrom)
{
	const double across = std::hypot(i_rFrom[0], i_rFrom[1]);
	if (!(across > 0.0))
		return Rotation::c_Identity3;
	const double angle = std::atan2(across, i_rFrom[2]);
	return Rotation::RotationMatrixFromAngleAxis({angle * i_rFrom[1] / across, -angle * i_rFrom[0] / across, 0.0});
}

} // namespace

std::optional<double> LowestPoint(const VRestJoint& i_rJoint)
{
	if (!i_rJoint.m_Skin || !i_rJoint.m_Skin->m_pCarried)
		return std::nullopt;
	double lowest = std::numeric_limits<double>::max();
	for (const VVector3& rPoint : PointsOf(*i_rJoint.m_Skin))
		lowest = std::min(lowest, rPoint[2]);
	return i_rJoint.m_Place[2] + lowest;
}

std::optional<VMatrix3> LevelAsBound(const VRestJoint& i_rJoint)
{
	if (!i_rJoint.m_Skin || !i_rJoint.m_Skin->m_pCarried || i_rJoint.m_Skin->m_pCarried->size() < c_FewestPoints)
		return std::nullopt;
	const VMatrix3 turn = TurnUp(i_rJoint.m_Skin->m_BoundUp);
	std::vector<VVector3> points = PointsOf(*i_rJoint.m_Skin, i_rJoint.m_Skin->m_pCarried->size() / c_MostPoints + 1);
	const double tilt = TiltOfLowerFace(points);
	for (VVector3& rPoint : points)
		rPoint = Rotation::Product(turn, rPoint);
	return tilt > TiltOfLowerFace(points) + c_AsLevel ? turn : Rotation::c_Identity3;
}

} // namespace SetupProposal
