#include "ComputeSubjectSolve/TargetTerms.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ConstructionException.h"
#include "ComputeSubjectFK/TargetFK.h"

#include <Eigen/Geometry>

#include <algorithm>
#include <cmath>
#include <limits>

namespace ComputeSubject
{
namespace
{

using CoreOrlexTypes::VSubject;
using Eigen::Vector3d;

constexpr double c_SquaredRotationLength = c_RotationLength * c_RotationLength;

template <std::size_t t_Size>
bool Observed(std::span<const double> i_Values, std::uint32_t i_Index, std::array<double, t_Size>& o_rValue)
{
	if (i_Index >= i_Values.size() / t_Size)
		return false;
	const auto values = i_Values.subspan(t_Size * i_Index, t_Size);
	std::copy(values.begin(), values.end(), o_rValue.begin());
	return std::all_of(values.begin(), values.end(), [](double i_Value) { return std::isfinite(i_Value); });
}

/// How a position is off: from where it was observed to the nearest point of the target, and the directions in which
/// the target goes on, so that nothing is off along them.
struct VOffset
{
	Vector3d m_Observed = Vector3d::Zero();
	Vector3d m_Offset = Vector3d::Zero();
	Vector3d m_Along[2] = {Vector3d::Zero(), Vector3d::Zero()};
	int m_Directions = 0;
};

/// Calls i_rVisit(const VOffset&) for each position of the target that was observed.
template <typename TVisitor>
void ForEachOffset(const ITargetFK& i_rTarget, const VObservations& i_rObservations, const TVisitor& i_rVisit)
{
	Rotation::VVector3 observed;
	VOffset offset;
	if (const auto& rpGroup = i_rTarget.FromPointGroup())
	{
		std::size_t marker = 0;
		for (const std::uint32_t index : i_rTarget.MarkerGroup()->MarkerIndices())
		{
			if (Observed(i_rObservations.m_Positions, index, observed))
			{
				offset.m_Observed = ToEigen(observed);
				offset.m_Offset = ToEigen(rpGroup->WorldPoint(marker)) - offset.m_Observed;
				i_rVisit(offset);
			}
			++marker;
		}
		return;
	}
	if (!i_rTarget.SingleMarker()
	    || !Observed(i_rObservations.m_Positions, i_rTarget.SingleMarker()->MarkerIdx(), observed))
		return;
	offset.m_Observed = ToEigen(observed);
	if (const auto& rpPoint = i_rTarget.FromLocalPoint())
		offset.m_Offset = ToEigen(rpPoint->WorldPoint()) - offset.m_Observed;
	else if (const auto& rpLine = i_rTarget.FromLocalLine())
	{
		const Vector3d first = ToEigen(rpLine->WorldPoint1());
		const Vector3d along = ToEigen(rpLine->WorldPoint2()) - first;
		offset.m_Offset = first - offset.m_Observed;
		if (along.norm() > 0.0)
		{
			offset.m_Along[0] = along.normalized();
			offset.m_Directions = 1;
			offset.m_Offset -= offset.m_Along[0].dot(offset.m_Offset) * offset.m_Along[0];
		}
	}
	else if (const auto& rpPlane = i_rTarget.FromLocalPlane())
	{
		const Vector3d normal = ToEigen(rpPlane->WorldNormal());
		offset.m_Offset = -(normal.dot(offset.m_Observed) + rpPlane->WorldOffset()) * normal;
		offset.m_Along[0] = normal.unitOrthogonal();
		offset.m_Along[1] = normal.cross(offset.m_Along[0]);
		offset.m_Directions = 2;
	}
	i_rVisit(offset);
}

void AddPosition(
    double i_Weight, const VOffset& i_rOffset, const Vector3d& i_rReference, bool i_bBend, VLinkTerms& io_rTerms)
{
	const Vector3d observed = i_rOffset.m_Observed - i_rReference;
	const Vector3d point = observed + i_rOffset.m_Offset;
	const Vector3d force = i_Weight * i_rOffset.m_Offset;
	// Without the bend a line or a plane counts as if it turned about the observed point, which keeps the Hessian a sum
	// of squares.
	const Vector3d about = i_bBend || i_rOffset.m_Directions == 0 ? point : observed;
	const Eigen::Matrix3d cross = i_Weight * Cross(about);
	io_rTerms.m_Hessian.topLeftCorner<3, 3>() -= cross * Cross(about);
	io_rTerms.m_Hessian.topRightCorner<3, 3>() += cross;
	io_rTerms.m_Hessian.bottomLeftCorner<3, 3>() -= cross;
	io_rTerms.m_Hessian.bottomRightCorner<3, 3>().diagonal().array() += i_Weight;
	for (int i = 0; i < i_rOffset.m_Directions; ++i)
	{
		VVector6 free;
		free << observed.cross(i_rOffset.m_Along[i]), i_rOffset.m_Along[i];
		io_rTerms.m_Hessian -= i_Weight * free * free.transpose();
	}
	io_rTerms.m_Gradient.head<3>() += point.cross(force);
	io_rTerms.m_Gradient.tail<3>() += force;
	io_rTerms.m_Moment += point * force.transpose();
	io_rTerms.m_Force += force;
}

/// From the observed rotation to the target's, about the axes of the world.
bool TurnFromObservation(const ITargetFK& i_rTarget, const VObservations& i_rObservations, Vector3d& o_rTurn)
{
	Rotation::VMatrix3 observed;
	if (!i_rTarget.FromLocalRotation()
	    || !Observed(i_rObservations.m_Rotations, i_rTarget.SingleRotationObservation()->RotationIdx(), observed))
		return false;
	o_rTurn = ToEigen(Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(
	    Rotation::Product(i_rTarget.FromLocalRotation()->WorldRotation(), Rotation::Transposed(observed)))));
	return true;
}

void AddRotation(double i_Weight, const Vector3d& i_rTurn, bool i_bBend, VLinkTerms& io_rTerms)
{
	const double weight = i_Weight * c_SquaredRotationLength;
	const double half = 0.5 * i_rTurn.norm();
	// The second derivative of half the squared angle across the axis, or the square of the first.
	double across = 1.0;
	if (half > 1e-4)
		across = i_bBend ? half / std::tan(half) : std::pow(half / std::sin(half), 2);
	Eigen::Matrix3d hessian = across * Eigen::Matrix3d::Identity();
	if (half > 1e-4)
		hessian += (1.0 - across) / (4.0 * half * half) * i_rTurn * i_rTurn.transpose();
	io_rTerms.m_Hessian.topLeftCorner<3, 3>() += weight * hessian;
	io_rTerms.m_Gradient.head<3>() += weight * i_rTurn;
	io_rTerms.m_Torque += weight * i_rTurn;
}

std::string LeftOut(const VSubject::VTarget& i_rTarget, const VSegmentTree& i_rTree)
{
	const auto* const pFactory = TargetFKFactory(i_rTarget.m_Type);
	if (!pFactory)
		return "Targets of this type are not solved.";
	if (!(i_rTarget.m_Weight > 0.0) || !std::isfinite(i_rTarget.m_Weight))
		return "Its weight is not above 0.";
	try
	{
		const auto pTarget = pFactory->Create(i_rTarget, i_rTree);
		const auto& rpPlane = pTarget->FromLocalPlane();
		pTarget->ComputeTargetFK()->Update();
		if (rpPlane && rpPlane->WorldNormal() == Rotation::VVector3{})
			return "Its plane has no normal.";
		return {};
	}
	catch (const VConstructionException&)
	{
		return "Its values do not fit its type.";
	}
}

} // namespace

std::vector<std::string> TargetsLeftOut(const VSubject& i_rSubject)
{
	const VSegmentTree tree = MakeSegmentTree(i_rSubject);
	std::vector<std::string> reasons;
	for (const VSubject::VTarget& rTarget : i_rSubject.m_Targets)
		reasons.push_back(tree.empty() ? "The segments make no tree." : LeftOut(rTarget, tree));
	return reasons;
}

double HalfCost(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations)
{
	double sum = 0.0;
	Vector3d turn;
	if (i_rTarget.m_pTarget->FromLocalRotation())
	{
		if (TurnFromObservation(*i_rTarget.m_pTarget, i_rObservations, turn))
			sum = c_SquaredRotationLength * turn.squaredNorm();
	}
	else
		ForEachOffset(*i_rTarget.m_pTarget, i_rObservations,
		    [&](const VOffset& i_rOffset) { sum += i_rOffset.m_Offset.squaredNorm(); });
	return 0.5 * i_rTarget.m_Weight * sum;
}

double Residual(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations)
{
	double largest = std::numeric_limits<double>::quiet_NaN();
	Vector3d turn;
	if (i_rTarget.m_pTarget->FromLocalRotation())
	{
		if (TurnFromObservation(*i_rTarget.m_pTarget, i_rObservations, turn))
			largest = turn.norm();
	}
	else
		ForEachOffset(*i_rTarget.m_pTarget, i_rObservations,
		    [&](const VOffset& i_rOffset) { largest = std::fmax(largest, i_rOffset.m_Offset.norm()); });
	return largest;
}

void AddTerms(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations, const Eigen::Vector3d& i_rReference,
    bool i_bBend, VLinkTerms& io_rTerms)
{
	Vector3d turn;
	if (i_rTarget.m_pTarget->FromLocalRotation())
	{
		if (TurnFromObservation(*i_rTarget.m_pTarget, i_rObservations, turn))
			AddRotation(i_rTarget.m_Weight, turn, i_bBend, io_rTerms);
	}
	else
		ForEachOffset(*i_rTarget.m_pTarget, i_rObservations,
		    [&](const VOffset& i_rOffset)
		    { AddPosition(i_rTarget.m_Weight, i_rOffset, i_rReference, i_bBend, io_rTerms); });
}

void AddAlignment(const VSolvedTarget& i_rTarget, const VObservations& i_rObservations,
    const Eigen::Vector3d& i_rReference, double i_Share, VAlignment& io_rAlignment)
{
	const double weight = i_Share * i_rTarget.m_Weight;
	Vector3d turn;
	if (TurnFromObservation(*i_rTarget.m_pTarget, i_rObservations, turn))
		io_rAlignment.m_Rotations +=
		    weight * c_SquaredRotationLength * ToEigen(Rotation::RotationMatrixFromAngleAxis(FromEigen(-turn)));
	ForEachOffset(*i_rTarget.m_pTarget, i_rObservations,
	    [&](const VOffset& i_rOffset)
	    {
		    const Vector3d observed = i_rOffset.m_Observed - i_rReference;
		    const Vector3d point = observed + i_rOffset.m_Offset;
		    io_rAlignment.m_Products += weight * observed * point.transpose();
		    io_rAlignment.m_Points += weight * point;
		    io_rAlignment.m_Observed += weight * observed;
		    io_rAlignment.m_Weight += weight;
	    });
}

} // namespace ComputeSubject
