#include "ComputeSubjectSolve/JointTerms.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"

#include <Eigen/Eigenvalues>

#include <algorithm>
#include <cmath>
#include <numbers>

namespace ComputeSubject
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using Eigen::Matrix3d;
using Eigen::Vector3d;

/// Eigenvalues of a covariance up to this say nothing, as in the priors of forward kinematics.
constexpr double c_SmallestEigenvalue = 1e-20;
/// Ranges are at least this wide, in radians: a joint that is locked by its range is held, but not by a singular
/// matrix.
constexpr double c_NarrowestRange = 1e-3;

/// The inverse of a covariance-like matrix; eigenvalues that are too small are raised, or say nothing.
VMatrix6 InverseOf(const std::vector<double>& i_rMatrix, std::size_t i_Size, double i_Smallest, bool i_bRaise)
{
	const Eigen::MatrixXd matrix = Eigen::Map<const Eigen::MatrixXd>(i_rMatrix.data(), i_Size, i_Size);
	const Eigen::SelfAdjointEigenSolver<Eigen::MatrixXd> eigen(matrix);
	Eigen::VectorXd values = eigen.eigenvalues();
	for (double& rValue : values)
		rValue = rValue > i_Smallest ? 1.0 / rValue : i_bRaise ? 1.0 / i_Smallest : 0.0;
	VMatrix6 inverse = VMatrix6::Zero();
	inverse.topLeftCorner(i_Size, i_Size) =
	    eigen.eigenvectors() * values.asDiagonal() * eigen.eigenvectors().transpose();
	return inverse;
}

bool HoldsNumbers(const std::vector<double>& i_rValues, std::size_t i_Size)
{
	return i_rValues.size() == i_Size
	    && std::all_of(i_rValues.begin(), i_rValues.end(), [](double i_Value) { return std::isfinite(i_Value); });
}

/// What exp(d) before a rotation of this angle-axis vector does to the vector, to first order in d.
Matrix3d InverseLeftJacobian(const Vector3d& i_rTurn)
{
	const double half = 0.5 * i_rTurn.norm();
	const double factor = half > 1e-4 ? (1.0 - half / std::tan(half)) / (4.0 * half * half) : 1.0 / 12.0;
	const Matrix3d cross = Cross(i_rTurn);
	return Matrix3d::Identity() - 0.5 * cross + factor * cross * cross;
}

/// What a length counts as among angles.
double AngleOf(bool i_bLength)
{
	return i_bLength ? 1.0 / c_RotationLength : 1.0;
}

} // namespace

VJointTerms::VJointTerms(
    const CoreOrlexTypes::VSubject& i_rSubject, const VSolveLinks& i_rLinks, const VSolveScales& i_rScales)
    : m_RangeScale(i_rScales.m_Range)
{
	std::vector<std::size_t> states;
	std::size_t next = 0;
	for (const auto& rSegment : i_rSubject.m_Segments)
	{
		states.push_back(next);
		next += CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
	}
	for (std::size_t i = 0; i < i_rLinks.m_Links.size(); ++i)
	{
		const VSolveLink& rLink = i_rLinks.m_Links[i];
		const bool bSecond = i > 0 && i_rLinks.m_Links[i - 1].m_Segment == rLink.m_Segment;
		if (!bSecond)
			m_Joints.emplace_back();
		VJoint& rJoint = m_Joints.back();
		rJoint.m_Links[rLink.m_State == states[rLink.m_Segment] ? 0 : 1] = i;
		if (bSecond)
			continue;
		const auto& rSource = i_rSubject.m_Segments[rLink.m_Segment].m_Joint;
		rJoint.m_Segment = rLink.m_Segment;
		rJoint.m_State = states[rLink.m_Segment];
		rJoint.m_Size = CoreOrlexTypes::StateSize(rSource.m_JointType);
		rJoint.m_bRotation = rSource.m_JointType == VSubjectParametrised::VJoint::EBall
		    || rSource.m_JointType == VSubjectParametrised::VJoint::EFree;
		rJoint.m_bAngles = rSource.m_JointType == VSubjectParametrised::VJoint::EHinge
		    || rSource.m_JointType == VSubjectParametrised::VJoint::EHardySpicer;

		const std::size_t size = rJoint.m_Size;
		rJoint.m_Prior.m_bUsed = i_rScales.m_Prior > 0.0 && HoldsNumbers(rSource.m_Mean, size)
		    && HoldsNumbers(rSource.m_Covariance, size * size);
		if (rJoint.m_Prior.m_bUsed)
		{
			SetOrigin(rJoint, rSource.m_Mean.data(), rJoint.m_Prior);
			rJoint.m_Prior.m_Weights =
			    i_rScales.m_Prior * InverseOf(rSource.m_Covariance, size, c_SmallestEigenvalue, false);
		}
		rJoint.m_Range.m_bUsed = i_rScales.m_Range > 0.0 && HoldsNumbers(rSource.m_RangeCentringState, size)
		    && HoldsNumbers(rSource.m_RangeMatrix, size * size);
		if (rJoint.m_Range.m_bUsed)
		{
			SetOrigin(rJoint, rSource.m_RangeCentringState.data(), rJoint.m_Range);
			rJoint.m_Range.m_Weights =
			    InverseOf(rSource.m_RangeMatrix, size, c_NarrowestRange * c_NarrowestRange, true);
		}
		rJoint.m_Pull.m_bUsed = i_rScales.m_Pull > 0.0;
		for (std::size_t k = 0; k < size; ++k)
		{
			const double angle = AngleOf(!rJoint.m_bAngles && !(rJoint.m_bRotation && k < 3));
			rJoint.m_Pull.m_Weights(k, k) = i_rScales.m_Pull * angle * angle;
		}
	}
}

void VJointTerms::PullTo(std::span<const double> i_States)
{
	for (VJoint& rJoint : m_Joints)
		if (rJoint.m_Pull.m_bUsed)
			SetOrigin(rJoint, i_States.data() + rJoint.m_State, rJoint.m_Pull);
}

void VJointTerms::SetOrigin(const VJoint& i_rJoint, const double* i_pState, VMeasure& o_rMeasure)
{
	for (std::size_t k = 0; k < i_rJoint.m_Size; ++k)
		o_rMeasure.m_Origin[k] = i_pState[k];
	if (i_rJoint.m_bRotation)
		o_rMeasure.m_InverseRotation =
		    Rotation::RotationMatrixFromAngleAxis({-i_pState[0], -i_pState[1], -i_pState[2]});
}

VVector6 VJointTerms::Deviation(const VJoint& i_rJoint, const VMeasure& i_rMeasure, const double* i_pState)
{
	VVector6 deviation = VVector6::Zero();
	for (std::size_t k = 0; k < i_rJoint.m_Size; ++k)
		deviation[k] = i_pState[k] - i_rMeasure.m_Origin[k];
	if (i_rJoint.m_bRotation)
		deviation.head<3>() = ToEigen(Rotation::CanonicalAngleAxis(
		    Rotation::AngleAxisFromRotationMatrix(Rotation::Product(i_rMeasure.m_InverseRotation,
		        Rotation::RotationMatrixFromAngleAxis({i_pState[0], i_pState[1], i_pState[2]})))));
	if (i_rJoint.m_bAngles)
		for (std::size_t k = 0; k < i_rJoint.m_Size; ++k)
			deviation[k] = std::remainder(deviation[k], 2.0 * std::numbers::pi);
	return deviation;
}

VJointTerms::VTerm VJointTerms::RangeTerm(const VJoint& i_rJoint, const VVector6& i_rDeviation) const
{
	VTerm term;
	const VVector6 weighted = i_rJoint.m_Range.m_Weights * i_rDeviation;
	const double share = std::sqrt(i_rDeviation.dot(weighted));
	if (!(share > 1.0))
		return term;
	VVector6 scaled = i_rDeviation;
	for (std::size_t k = 0; k < i_rJoint.m_Size; ++k)
		scaled[k] *= AngleOf(!i_rJoint.m_bAngles && !(i_rJoint.m_bRotation && k < 3));
	const double length = scaled.norm();
	const double beyond = length * (1.0 - 1.0 / share);
	VVector6 slope = scaled;
	for (std::size_t k = 0; k < i_rJoint.m_Size; ++k)
		slope[k] *= AngleOf(!i_rJoint.m_bAngles && !(i_rJoint.m_bRotation && k < 3));
	slope = (1.0 - 1.0 / share) / length * slope + length / (share * share * share) * weighted;
	term.m_HalfCost = 0.5 * m_RangeScale * beyond * beyond;
	term.m_Gradient = m_RangeScale * beyond * slope;
	term.m_Hessian = m_RangeScale * slope * slope.transpose();
	return term;
}

template <typename TVisitor>
void VJointTerms::ForEachTerm(std::span<const double> i_States, const TVisitor& i_rVisit) const
{
	for (const VJoint& rJoint : m_Joints)
	{
		const double* const pState = i_States.data() + rJoint.m_State;
		for (const VMeasure* pMeasure : {&rJoint.m_Prior, &rJoint.m_Pull})
			if (pMeasure->m_bUsed)
			{
				const VVector6 deviation = Deviation(rJoint, *pMeasure, pState);
				VTerm term;
				term.m_Gradient = pMeasure->m_Weights * deviation;
				term.m_HalfCost = 0.5 * deviation.dot(term.m_Gradient);
				term.m_Hessian = pMeasure->m_Weights;
				i_rVisit(rJoint, *pMeasure, deviation, term);
			}
		if (rJoint.m_Range.m_bUsed)
		{
			const VVector6 deviation = Deviation(rJoint, rJoint.m_Range, pState);
			i_rVisit(rJoint, rJoint.m_Range, deviation, RangeTerm(rJoint, deviation));
		}
	}
}

double VJointTerms::HalfCost(std::span<const double> i_States) const
{
	double sum = 0.0;
	ForEachTerm(i_States,
	    [&](const VJoint&, const VMeasure&, const VVector6&, const VTerm& i_rTerm) { sum += i_rTerm.m_HalfCost; });
	return sum;
}

void VJointTerms::RangeShares(std::span<const double> i_States, std::vector<double>& io_rShares) const
{
	for (const VJoint& rJoint : m_Joints)
		if (rJoint.m_Range.m_bUsed)
		{
			const VVector6 deviation = Deviation(rJoint, rJoint.m_Range, i_States.data() + rJoint.m_State);
			io_rShares[rJoint.m_Segment] = std::sqrt(deviation.dot(rJoint.m_Range.m_Weights * deviation));
		}
}

void VJointTerms::AddTerms(
    std::span<const double> i_States, const VSolveLinks& i_rLinks, std::vector<VLinkTerms>& io_rTerms) const
{
	ForEachTerm(i_States,
	    [&](const VJoint& i_rJoint, const VMeasure& i_rMeasure, const VVector6& i_rDeviation, const VTerm& i_rTerm)
	    {
		    int first = 0;
		    for (const std::size_t index : i_rJoint.m_Links)
		    {
			    if (index == c_NoLink)
				    break;
			    const VSolveLink& rLink = i_rLinks.m_Links[index];
			    VLinkTerms& rTerms = io_rTerms[index];
			    if (rLink.m_Size == 1)
			    {
				    rTerms.m_OwnGradient[0] += i_rTerm.m_Gradient[first];
				    rTerms.m_OwnHessian(0, 0) += i_rTerm.m_Hessian(first, first);
			    }
			    else
			    {
				    // What a small change in the world does to the deviation.
				    Matrix3d change = rLink.m_Base.transpose();
				    if (rLink.m_bTurn)
					    change = InverseLeftJacobian(i_rDeviation.head<3>()) * ToEigen(i_rMeasure.m_InverseRotation)
					        * change;
				    rTerms.m_OwnGradient += change.transpose() * i_rTerm.m_Gradient.segment<3>(first);
				    rTerms.m_OwnHessian += change.transpose() * i_rTerm.m_Hessian.block<3, 3>(first, first) * change;
			    }
			    first += rLink.m_Size;
		    }
	    });
}

} // namespace ComputeSubject
