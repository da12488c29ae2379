#include "ComputeSubjectFK/Joints.h"

#include "ComputeSubjectFK/ConstructionException.h"

#include <cmath>
#include <numbers>

namespace ComputeSubject
{
namespace
{

double Wrapped(double i_Angle)
{
	return std::atan2(std::sin(i_Angle), std::cos(i_Angle));
}

void WrapAngleAxis(double* io_pVector)
{
	const double length = std::hypot(io_pVector[0], io_pVector[1], io_pVector[2]);
	if (!(length > std::numbers::pi))
		return;
	const double scale = Wrapped(length) / length;
	for (int i = 0; i < 3; ++i)
		io_pVector[i] *= scale;
}

} // namespace

VJointFKBase::VJointFKBase(const CoreOrlexTypes::VSubject::VJoint& i_rJoint, EJointType i_Type)
    : m_Axes{Rotation::RotationMatrixFromAngleAxis(i_rJoint.m_JointOrientation), {}}
{
	if (i_rJoint.m_JointType != i_Type)
		throw VConstructionException();
}

void VJointFKFree::NormaliseState(double*& io_rpState) const
{
	WrapAngleAxis(io_rpState);
	io_rpState += 6;
}

void VJointFKBall::NormaliseState(double*& io_rpState) const
{
	WrapAngleAxis(io_rpState);
	io_rpState += 3;
}

void VJointFKHardySpicer::NormaliseState(double*& io_rpState) const
{
	for (int i = 0; i < 2; ++i, ++io_rpState)
		*io_rpState = Wrapped(*io_rpState);
}

void VJointFKHinge::NormaliseState(double*& io_rpState) const
{
	*io_rpState = Wrapped(*io_rpState);
	++io_rpState;
}

void VJointFKSlider::NormaliseState(double*& io_rpState) const
{
	++io_rpState;
}

void VJointFKDummy::NormaliseState(double*&) const {}

} // namespace ComputeSubject
