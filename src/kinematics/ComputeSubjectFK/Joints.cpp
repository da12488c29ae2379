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

void VJointFKFree::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose.R = Rotation::RotationMatrixFromAngleAxis({m_State[0], m_State[1], m_State[2]});
	o_rPose.t = {m_State[3], m_State[4], m_State[5]};
}

void VJointFKFree::NormaliseState(double*& io_rpState) const
{
	WrapAngleAxis(io_rpState);
	io_rpState += 6;
}

void VJointFKBall::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose.R = Rotation::RotationMatrixFromAngleAxis(m_State);
	o_rPose.t = {};
}

void VJointFKBall::NormaliseState(double*& io_rpState) const
{
	WrapAngleAxis(io_rpState);
	io_rpState += 3;
}

void VJointFKHardySpicer::GetPose(Rotation::VPose<double>& o_rPose) const
{
	const double ca = std::cos(m_State[0]);
	const double sa = std::sin(m_State[0]);
	const double cb = std::cos(m_State[1]);
	const double sb = std::sin(m_State[1]);
	o_rPose.R = {cb * ca, -sa, sb * ca, cb * sa, ca, sb * sa, -sb, 0.0, cb};
	o_rPose.t = {};
}

void VJointFKHardySpicer::NormaliseState(double*& io_rpState) const
{
	for (int i = 0; i < 2; ++i, ++io_rpState)
		*io_rpState = Wrapped(*io_rpState);
}

void VJointFKHinge::GetPose(Rotation::VPose<double>& o_rPose) const
{
	const double c = std::cos(m_State[0]);
	const double s = std::sin(m_State[0]);
	o_rPose.R = {c, -s, 0.0, s, c, 0.0, 0.0, 0.0, 1.0};
	o_rPose.t = {};
}

void VJointFKHinge::NormaliseState(double*& io_rpState) const
{
	*io_rpState = Wrapped(*io_rpState);
	++io_rpState;
}

void VJointFKSlider::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose.R = Rotation::c_Identity3;
	o_rPose.t = {0.0, 0.0, m_State[0]};
}

void VJointFKSlider::NormaliseState(double*& io_rpState) const
{
	++io_rpState;
}

void VJointFKDummy::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose = {};
}

void VJointFKDummy::NormaliseState(double*&) const {}

} // namespace ComputeSubject
