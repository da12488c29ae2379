#pragma once

#include "ComputeSubjectFK/JointPriorInterfaces.h"
#include "CoreOrlexTypes/Subject.h"
#include "numerics/Rotation.h"

#include <vector>

namespace ComputeSubject
{

/// The range of a ball joint. Constructors here throw VConstructionException for a joint that is no ball joint or whose
/// vectors and matrices, row by row, have not the sizes of one.
class VBallJointRange : public VComputeJointRangeForSegment
{
public:
	explicit VBallJointRange(const CoreOrlexTypes::VSubject::VSegment& i_rSegment);

	std::size_t NumberOfStates() const override { return 3; }
	void RangeState(std::span<const double> i_State, std::span<double> o_RangeState) const override;
	void Clone(std::unique_ptr<IComputeJointRange>& o_rpTarget) const override;

	/// The rotation from the range's centre to the state, as an angle-axis vector times the range matrix.
	Rotation::VVector3 RangeState(const Rotation::VVector3& i_rState) const;

	/// The state, of at most half a turn from the centre, that RangeState maps to this; of a singular range matrix the
	/// one nearest to the centre.
	Rotation::VVector3 StateInRange(const Rotation::VVector3& i_rRangeState) const;

private:
	Rotation::VMatrix3 m_Centre;
	Rotation::VMatrix3 m_RangeMatrix;
	/// From the range space back.
	std::vector<Rotation::VMatrix3> m_NormalisedSpace;
};

/// The prior of a ball joint. What it measures is the rotation from the mean to the state as an angle-axis vector,
/// about the joint's axes at the mean; the joint's covariance is of that vector.
class VBallJointPrior : public VComputeJointPriorForSegment
{
public:
	explicit VBallJointPrior(const CoreOrlexTypes::VSubject::VSegment& i_rSegment);

	std::size_t NumberOfStates() const override { return 3; }
	void Deviation(std::span<double> o_Deviation) const override;
	double Energy() const override;
	void SetState(const double*& io_rpState) override;
	std::unique_ptr<VComputeJointPriorInterfaceForSegment> Clone() const override;

	virtual const Rotation::VMatrix3& Mean() const { return m_Mean; }
	virtual const Rotation::VMatrix3& InverseCovariance() const { return m_InverseCovariance; }

	/// How far an angle-axis state is from the mean, in the space of the covariance.
	virtual Rotation::VVector3 DeviationOf(const Rotation::VVector3& i_rState) const;

protected:
	/// @param i_rCovariance in the space of the deviation.
	VBallJointPrior(const CoreOrlexTypes::VSubject::VSegment& i_rSegment, const Rotation::VMatrix3& i_rCovariance);

private:
	Rotation::VMatrix3 m_Mean;
	Rotation::VMatrix3 m_InverseCovariance;
	Rotation::VVector3 m_Deviation{};
};

/// The same prior over the state in the range space.
class VBallJointPriorRangeNormalised : public VBallJointPrior
{
public:
	explicit VBallJointPriorRangeNormalised(const CoreOrlexTypes::VSubject::VSegment& i_rSegment);

	std::unique_ptr<VComputeJointPriorInterfaceForSegment> Clone() const override;
	Rotation::VVector3 DeviationOf(const Rotation::VVector3& i_rState) const override;

private:
	/// Maps an angle-axis state that is measured from the mean into the range space.
	struct VPriorToRangeSpace
	{
		Rotation::VVector3 operator()(const Rotation::VVector3& i_rFromMean) const;

		Rotation::VMatrix3 m_Mean;
		const VBallJointRange& m_rRange;
	};
	struct VStatistics
	{
		Rotation::VVector3 m_Mean;
		Rotation::VMatrix3 m_Covariance;
	};
	static VStatistics InRangeSpace(
	    const CoreOrlexTypes::VSubject::VSegment& i_rSegment, const VBallJointRange& i_rRange);
	VBallJointPriorRangeNormalised(const CoreOrlexTypes::VSubject::VSegment& i_rSegment,
	    const VBallJointRange& i_rRange, const VStatistics& i_rStatistics);

	VBallJointRange m_Range;
	Rotation::VVector3 m_RangeMean;
};

/// What is known about a segment's joint: a ball joint's own statistics where it has them, otherwise the default that
/// says nothing. A prior of a joint with a range is over the range space.
std::unique_ptr<VComputeJointPriorInterfaceForSegment> CreateJointPrior(
    const CoreOrlexTypes::VSubject::VSegment& i_rSegment);
std::unique_ptr<IComputeJointRange> CreateJointRange(const CoreOrlexTypes::VSubject::VSegment& i_rSegment);

} // namespace ComputeSubject
