#include "ComputeSubjectSolve/SolveSeed.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"

#include <Eigen/LU>
#include <Eigen/SVD>

#include <cmath>

namespace ComputeSubject
{
namespace
{

using Eigen::Matrix3d;
using Eigen::Vector3d;

/// What staying counts, against a rotation that was observed on the segment itself. It decides where a single point
/// leaves a joint free to turn about it.
constexpr double c_ShareOfStaying = 1e-4;

/// What the targets below a link ask for.
VAlignment AlignmentOf(std::size_t i_Link, const VObservations& i_rObservations,
    const std::vector<VSolvedTarget>& i_rTargets, double i_ShareOfFurther, const VSolveLinks& i_rLinks)
{
	VAlignment alignment;
	for (const VSolvedTarget& rTarget : i_rTargets)
	{
		double share = 1.0;
		std::size_t link = i_rLinks.m_LinkOfSegment[rTarget.m_Segment];
		while (link != c_NoLink && link > i_Link)
		{
			const std::size_t parent = i_rLinks.m_Links[link].m_Parent;
			if (parent != c_NoLink && i_rLinks.m_Links[parent].m_Segment != i_rLinks.m_Links[link].m_Segment)
				share *= i_ShareOfFurther;
			link = parent;
		}
		if (link == i_Link)
			AddAlignment(rTarget, i_rObservations, i_rLinks.m_Reference, share, alignment);
	}
	return alignment;
}

/// The rotation R for which the trace of R' i_rMatrix is greatest (G. Wahba's problem, SIAM Review 7, 1965).
Vector3d BestTurn(const Matrix3d& i_rMatrix)
{
	const Eigen::JacobiSVD<Matrix3d> svd(i_rMatrix, Eigen::ComputeFullU | Eigen::ComputeFullV);
	Matrix3d left = svd.matrixU();
	if (left.determinant() * svd.matrixV().determinant() < 0.0)
		left.col(2) *= -1.0;
	const Matrix3d best = left * svd.matrixV().transpose();
	Rotation::VMatrix3 rows;
	Eigen::Map<Eigen::Matrix<double, 3, 3, Eigen::RowMajor>>(rows.data()) = best;
	return ToEigen(Rotation::AngleAxisFromRotationMatrix(rows));
}

/// The same among the rotations about an axis.
Vector3d BestTurnAbout(const Vector3d& i_rAxis, const Matrix3d& i_rMatrix)
{
	const Vector3d twist(
	    i_rMatrix(2, 1) - i_rMatrix(1, 2), i_rMatrix(0, 2) - i_rMatrix(2, 0), i_rMatrix(1, 0) - i_rMatrix(0, 1));
	return {std::atan2(i_rAxis.dot(twist), i_rMatrix.trace() - i_rAxis.dot(i_rMatrix * i_rAxis)), 0.0, 0.0};
}

Vector3d BestChange(const VSolveLink& i_rLink, const VAlignment& i_rAlignment, bool i_bMoved)
{
	const double weight = i_rAlignment.m_Weight;
	if (!i_rLink.m_bTurn)
	{
		if (!(weight > 0.0))
			return Vector3d::Zero();
		const Vector3d move = (i_rAlignment.m_Observed - i_rAlignment.m_Points) / weight;
		return i_rLink.m_Size == 3 ? move : Vector3d(i_rLink.m_Axis.dot(move), 0.0, 0.0);
	}
	Matrix3d matrix = i_rAlignment.m_Rotations + i_rAlignment.m_Products;
	if (i_bMoved && weight > 0.0)
		matrix -= i_rAlignment.m_Observed * i_rAlignment.m_Points.transpose() / weight;
	else
		matrix -= i_rLink.m_Centre * i_rAlignment.m_Points.transpose()
		    + (i_rAlignment.m_Observed - weight * i_rLink.m_Centre) * i_rLink.m_Centre.transpose();
	matrix.diagonal().array() += c_ShareOfStaying * c_RotationLength * c_RotationLength;
	return i_rLink.m_Size == 3 ? BestTurn(matrix) : BestTurnAbout(i_rLink.m_Axis, matrix);
}

} // namespace

void Seed(const VObservations& i_rObservations, const std::vector<VSolvedTarget>& i_rTargets, double i_ShareOfFurther,
    VComputeSubjectFK& io_rKinematics, VSolveLinks& io_rLinks, std::vector<double>& io_rStates)
{
	const auto change = [&](std::size_t i_Link, bool i_bMoved)
	{
		io_rKinematics.Update(io_rStates.data());
		PlaceLinks(io_rKinematics, io_rStates, io_rLinks);
		const VSolveLink& rLink = io_rLinks.m_Links[i_Link];
		MoveLink(rLink,
		    BestChange(rLink, AlignmentOf(i_Link, i_rObservations, i_rTargets, i_ShareOfFurther, io_rLinks), i_bMoved),
		    io_rStates.data());
	};
	for (std::size_t i = 0; i < io_rLinks.m_Links.size(); ++i)
	{
		const bool bFree = io_rLinks.m_Links[i].m_Size == 3 && !io_rLinks.m_Links[i].m_bTurn;
		// A free joint turns about the middle of its points first, and is moved where that leaves it.
		if (bFree)
			change(i + 1, true);
		change(i, false);
		if (bFree)
			++i;
	}
}

} // namespace ComputeSubject
