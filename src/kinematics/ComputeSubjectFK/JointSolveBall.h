#pragma once

#include "ComputeSubjectFK/JointPriorInterfaces.h"
#include "ComputeSubjectFK/Joints.h"

namespace ComputeSubject
{

/// A ball joint that knows its prior and its range, and does not jump by a turn from one state to the next.
class VJointSolveBall : public VJointFKBall, public IComputeJointPrior, public IComputeJointRange
{
public:
	/// Throws VConstructionException for a joint that is no ball joint or whose statistics have not the sizes of one.
	explicit VJointSolveBall(const CoreOrlexTypes::VSubject::VSegment& i_rSegment);

	/// Shares nothing with the other one.
	VJointSolveBall(const VJointSolveBall& i_rOther);
	VJointSolveBall& operator=(const VJointSolveBall&) = delete;

	std::size_t NumberOfStates() const override { return 3; }

	/// Keeps of all revolutions of the state the nearest to the state before.
	void SetState(const double*& io_rpState) override;

	void Deviation(std::span<double> o_Deviation) const override { m_pPrior->Deviation(o_Deviation); }
	double Energy() const override { return m_pPrior->Energy(); }
	void RangeState(std::span<const double> i_State, std::span<double> o_RangeState) const override
	{
		m_pRange->RangeState(i_State, o_RangeState);
	}
	void Clone(std::unique_ptr<IComputeJointRange>& o_rpTarget) const override;

	/// Continuous from call to call.
	const std::array<double, 3>& State() const { return m_State; }

private:
	std::unique_ptr<VComputeJointPriorInterfaceForSegment> m_pPrior;
	std::unique_ptr<IComputeJointRange> m_pRange;
};

} // namespace ComputeSubject
