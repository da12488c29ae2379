#include "ComputeSubjectFK/JointSolveBall.h"

#include "ComputeSubjectFK/BallJointPrior.h"
#include "ComputeSubjectFK/NearestRevolution.h"

namespace ComputeSubject
{

VJointSolveBall::VJointSolveBall(const CoreOrlexTypes::VSubject::VSegment& i_rSegment)
    : VJointFKBall(i_rSegment.m_Joint), m_pPrior(CreateJointPrior(i_rSegment)), m_pRange(CreateJointRange(i_rSegment))
{
}

VJointSolveBall::VJointSolveBall(const VJointSolveBall& i_rOther)
    : VJointFKBall(i_rOther), IComputeJointPrior(), IComputeJointRange(), m_pPrior(i_rOther.m_pPrior->Clone())
{
	i_rOther.m_pRange->Clone(m_pRange);
}

void VJointSolveBall::SetState(const double*& io_rpState)
{
	const Rotation::VVector3 previous = m_State;
	VJointFKBall::SetState(io_rpState);
	m_State = NearestRevolution(m_State, previous);
	const double* pState = m_State.data();
	m_pPrior->SetState(pState);
}

void VJointSolveBall::Clone(std::unique_ptr<IComputeJointRange>& o_rpTarget) const
{
	o_rpTarget = std::make_unique<VJointSolveBall>(*this);
}

} // namespace ComputeSubject
