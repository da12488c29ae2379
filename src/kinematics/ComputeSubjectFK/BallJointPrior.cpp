#include "ComputeSubjectFK/BallJointPrior.h"

#include "ComputeSubjectFK/ConstructionException.h"
#include "CoreOrlexTypes/JointType.h"
#include "numerics/UnscentedTransform.h"
#include "numerics/fnl_svd_fixed.h"

namespace ComputeSubject
{
namespace
{

using CoreOrlexTypes::VSubject;
using Rotation::VMatrix3;
using Rotation::VVector3;

constexpr auto c_Ball = CoreOrlexTypes::VSubjectParametrised::VJoint::EBall;

/// Singular values of a covariance or a range matrix up to this count as 0 when it is inverted.
constexpr double c_SmallestSingularValue = 1e-20;

template <std::size_t t_Size>
std::array<double, t_Size> Fixed(const VSubject::VSegment& i_rSegment, const std::vector<double>& i_rValues)
{
	if (i_rSegment.m_Joint.m_JointType != c_Ball || i_rValues.size() != t_Size)
		throw VConstructionException();
	std::array<double, t_Size> values;
	std::copy(i_rValues.begin(), i_rValues.end(), values.begin());
	return values;
}

/// Calls i_rMake with the number of states as a compile-time constant.
template <typename TMake>
auto ForStates(CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType i_Type, const TMake& i_rMake)
{
	switch (CoreOrlexTypes::StateSize(i_Type))
	{
	case 6: return i_rMake(std::integral_constant<std::size_t, 6>());
	case 3: return i_rMake(std::integral_constant<std::size_t, 3>());
	case 2: return i_rMake(std::integral_constant<std::size_t, 2>());
	case 1: return i_rMake(std::integral_constant<std::size_t, 1>());
	default: return i_rMake(std::integral_constant<std::size_t, 0>());
	}
}

bool HasRange(const VSubject::VSegment& i_rSegment)
{
	return i_rSegment.m_Joint.m_JointType == c_Ball && !i_rSegment.m_Joint.m_RangeMatrix.empty();
}

VMatrix3 MeanRotation(const VSubject::VSegment& i_rSegment)
{
	return Rotation::RotationMatrixFromAngleAxis(Fixed<3>(i_rSegment, i_rSegment.m_Joint.m_Mean));
}

/// The shortest rotation from one to the other, about the axes of the first.
VVector3 TurnFrom(const VMatrix3& i_rFrom, const VVector3& i_rState)
{
	return Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(
	    Rotation::Product(Rotation::Transposed(i_rFrom), Rotation::RotationMatrixFromAngleAxis(i_rState))));
}

} // namespace

VBallJointRange::VBallJointRange(const VSubject::VSegment& i_rSegment)
    : VComputeJointRangeForSegment(i_rSegment.m_SegmentIndex),
      m_Centre(Rotation::RotationMatrixFromAngleAxis(Fixed<3>(i_rSegment, i_rSegment.m_Joint.m_RangeCentringState))),
      m_RangeMatrix(Fixed<9>(i_rSegment, i_rSegment.m_Joint.m_RangeMatrix)),
      m_NormalisedSpace{fnl_svd_fixed<3, 3>(m_RangeMatrix).Inverse(c_SmallestSingularValue)}
{
}

void VBallJointRange::RangeState(std::span<const double> i_State, std::span<double> o_RangeState) const
{
	const VVector3 state = RangeState(VVector3{i_State[0], i_State[1], i_State[2]});
	std::copy(state.begin(), state.end(), o_RangeState.begin());
}

void VBallJointRange::Clone(std::unique_ptr<IComputeJointRange>& o_rpTarget) const
{
	o_rpTarget = std::make_unique<VBallJointRange>(*this);
}

VVector3 VBallJointRange::RangeState(const VVector3& i_rState) const
{
	return Rotation::Product(m_RangeMatrix, TurnFrom(m_Centre, i_rState));
}

VVector3 VBallJointRange::StateInRange(const VVector3& i_rRangeState) const
{
	const VVector3 fromCentre = Rotation::Product(m_NormalisedSpace.front(), i_rRangeState);
	return Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(
	    Rotation::Product(m_Centre, Rotation::RotationMatrixFromAngleAxis(fromCentre))));
}

VBallJointPrior::VBallJointPrior(const VSubject::VSegment& i_rSegment)
    : VBallJointPrior(i_rSegment, Fixed<9>(i_rSegment, i_rSegment.m_Joint.m_Covariance))
{
}

VBallJointPrior::VBallJointPrior(const VSubject::VSegment& i_rSegment, const VMatrix3& i_rCovariance)
    : VComputeJointPriorForSegment(i_rSegment.m_SegmentIndex), m_Mean(MeanRotation(i_rSegment)),
      m_InverseCovariance(fnl_svd_fixed<3, 3>(i_rCovariance).Inverse(c_SmallestSingularValue))
{
}

void VBallJointPrior::Deviation(std::span<double> o_Deviation) const
{
	std::copy(m_Deviation.begin(), m_Deviation.end(), o_Deviation.begin());
}

double VBallJointPrior::Energy() const
{
	const VVector3 weighted = Rotation::Product(m_InverseCovariance, m_Deviation);
	return 0.5 * (weighted[0] * m_Deviation[0] + weighted[1] * m_Deviation[1] + weighted[2] * m_Deviation[2]);
}

void VBallJointPrior::SetState(const double*& io_rpState)
{
	m_Deviation = DeviationOf({io_rpState[0], io_rpState[1], io_rpState[2]});
	io_rpState += 3;
}

std::unique_ptr<VComputeJointPriorInterfaceForSegment> VBallJointPrior::Clone() const
{
	return std::make_unique<VBallJointPrior>(*this);
}

VVector3 VBallJointPrior::DeviationOf(const VVector3& i_rState) const
{
	return TurnFrom(m_Mean, i_rState);
}

VVector3 VBallJointPriorRangeNormalised::VPriorToRangeSpace::operator()(const VVector3& i_rFromMean) const
{
	return m_rRange.RangeState(Rotation::AngleAxisFromRotationMatrix(
	    Rotation::Product(m_Mean, Rotation::RotationMatrixFromAngleAxis(i_rFromMean))));
}

VBallJointPriorRangeNormalised::VStatistics VBallJointPriorRangeNormalised::InRangeSpace(
    const VSubject::VSegment& i_rSegment, const VBallJointRange& i_rRange)
{
	VStatistics statistics;
	UnscentedTransform(VPriorToRangeSpace{MeanRotation(i_rSegment), i_rRange}, VVector3{},
	    Fixed<9>(i_rSegment, i_rSegment.m_Joint.m_Covariance), statistics.m_Mean, statistics.m_Covariance);
	return statistics;
}

VBallJointPriorRangeNormalised::VBallJointPriorRangeNormalised(const VSubject::VSegment& i_rSegment)
    : VBallJointPriorRangeNormalised(
        i_rSegment, VBallJointRange(i_rSegment), InRangeSpace(i_rSegment, VBallJointRange(i_rSegment)))
{
}

VBallJointPriorRangeNormalised::VBallJointPriorRangeNormalised(
    const VSubject::VSegment& i_rSegment, const VBallJointRange& i_rRange, const VStatistics& i_rStatistics)
    : VBallJointPrior(i_rSegment, i_rStatistics.m_Covariance), m_Range(i_rRange), m_RangeMean(i_rStatistics.m_Mean)
{
}

std::unique_ptr<VComputeJointPriorInterfaceForSegment> VBallJointPriorRangeNormalised::Clone() const
{
	return std::make_unique<VBallJointPriorRangeNormalised>(*this);
}

VVector3 VBallJointPriorRangeNormalised::DeviationOf(const VVector3& i_rState) const
{
	const VVector3 state = m_Range.RangeState(i_rState);
	return {state[0] - m_RangeMean[0], state[1] - m_RangeMean[1], state[2] - m_RangeMean[2]};
}

std::unique_ptr<VComputeJointPriorInterfaceForSegment> CreateJointPrior(const VSubject::VSegment& i_rSegment)
{
	if (i_rSegment.m_Joint.m_JointType == c_Ball && !i_rSegment.m_Joint.m_Mean.empty())
	{
		if (HasRange(i_rSegment))
			return std::make_unique<VBallJointPriorRangeNormalised>(i_rSegment);
		return std::make_unique<VBallJointPrior>(i_rSegment);
	}
	return ForStates(i_rSegment.m_Joint.m_JointType,
	    [&](auto i_States) -> std::unique_ptr<VComputeJointPriorInterfaceForSegment>
	    { return std::make_unique<VDefaultJointPrior<i_States()>>(i_rSegment.m_SegmentIndex); });
}

std::unique_ptr<IComputeJointRange> CreateJointRange(const VSubject::VSegment& i_rSegment)
{
	if (HasRange(i_rSegment))
		return std::make_unique<VBallJointRange>(i_rSegment);
	return ForStates(i_rSegment.m_Joint.m_JointType,
	    [&](auto i_States) -> std::unique_ptr<IComputeJointRange>
	    { return std::make_unique<VDefaultJointRange<i_States()>>(i_rSegment.m_SegmentIndex); });
}

} // namespace ComputeSubject
