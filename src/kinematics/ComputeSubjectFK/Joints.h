#pragma once

#include "ComputeSubjectFK/JointFKInterfaces.h"
#include "CoreOrlexTypes/Subject.h"

#include <array>

namespace ComputeSubject
{

/// What all joint classes share: the turn of the axes in which the joint moves.
class VJointFKBase
{
public:
	using EJointType = CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType;

	virtual ~VJointFKBase() = default;
	virtual EJointType JointType() const = 0;
	virtual std::size_t NumberOfStates() const = 0;
	virtual const Rotation::VPose<double>& PrePose() const { return m_Axes; }
	virtual const Rotation::VPose<double>& PostPose() const { return m_Axes; }
	virtual void SetState(const double*& io_rpState) = 0;
	virtual void GetPose(Rotation::VPose<double>& o_rPose) const = 0;
	virtual void NormaliseState(double*& io_rpState) const = 0;

protected:
	/// Throws VConstructionException if the joint is of another type.
	VJointFKBase(const CoreOrlexTypes::VSubject::VJoint& i_rJoint, EJointType i_Type);

private:
	/// The rotation of JointOrientation. Pre and post pose are the same: the motion acts in axes that it turns.
	Rotation::VPose<double> m_Axes;
};

/// The part of a joint class that follows from its type and its degrees of freedom.
template <VJointFKBase::EJointType t_Type, std::size_t t_States>
class VJointFKOfType : public VJointFKBase
{
public:
	explicit VJointFKOfType(const CoreOrlexTypes::VSubject::VJoint& i_rJoint) : VJointFKBase(i_rJoint, t_Type) {}
	EJointType JointType() const override { return t_Type; }
	std::size_t NumberOfStates() const override { return t_States; }
	void SetState(const double*& io_rpState) override
	{
		for (double& rValue : m_State)
			rValue = *io_rpState++;
	}

protected:
	std::array<double, t_States> m_State{};
};

/// Angle-axis, then translation.
class VJointFKFree : public VJointFKOfType<VJointFKBase::EJointType::EFree, 6>
{
public:
	using VJointFKOfType::VJointFKOfType;
	void GetPose(Rotation::VPose<double>& o_rPose) const override;
	void NormaliseState(double*& io_rpState) const override;
};

/// Angle-axis.
class VJointFKBall : public VJointFKOfType<VJointFKBase::EJointType::EBall, 3>
{
public:
	using VJointFKOfType::VJointFKOfType;
	void GetPose(Rotation::VPose<double>& o_rPose) const override;
	void NormaliseState(double*& io_rpState) const override;
};

/// About Z by the first angle, after about Y by the second.
class VJointFKHardySpicer : public VJointFKOfType<VJointFKBase::EJointType::EHardySpicer, 2>
{
public:
	using VJointFKOfType::VJointFKOfType;
	void GetPose(Rotation::VPose<double>& o_rPose) const override;
	void NormaliseState(double*& io_rpState) const override;
};

/// About Z.
class VJointFKHinge : public VJointFKOfType<VJointFKBase::EJointType::EHinge, 1>
{
public:
	using VJointFKOfType::VJointFKOfType;
	void GetPose(Rotation::VPose<double>& o_rPose) const override;
	void NormaliseState(double*& io_rpState) const override;
};

/// Along Z.
class VJointFKSlider : public VJointFKOfType<VJointFKBase::EJointType::ESlider, 1>
{
public:
	using VJointFKOfType::VJointFKOfType;
	void GetPose(Rotation::VPose<double>& o_rPose) const override;
	void NormaliseState(double*& io_rpState) const override;
};

class VJointFKDummy : public VJointFKOfType<VJointFKBase::EJointType::EDummy, 0>
{
public:
	using VJointFKOfType::VJointFKOfType;
	void GetPose(Rotation::VPose<double>& o_rPose) const override;
	void NormaliseState(double*& io_rpState) const override;
};

inline void VJointFKFree::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose.R = Rotation::RotationMatrixFromAngleAxis({m_State[0], m_State[1], m_State[2]});
	o_rPose.t = {m_State[3], m_State[4], m_State[5]};
}

inline void VJointFKBall::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose.R = Rotation::RotationMatrixFromAngleAxis(m_State);
	o_rPose.t = {};
}

inline void VJointFKHardySpicer::GetPose(Rotation::VPose<double>& o_rPose) const
{
	const double ca = std::cos(m_State[0]);
	const double sa = std::sin(m_State[0]);
	const double cb = std::cos(m_State[1]);
	const double sb = std::sin(m_State[1]);
	o_rPose.R = {cb * ca, -sa, sb * ca, cb * sa, ca, sb * sa, -sb, 0.0, cb};
	o_rPose.t = {};
}

inline void VJointFKHinge::GetPose(Rotation::VPose<double>& o_rPose) const
{
	const double c = std::cos(m_State[0]);
	const double s = std::sin(m_State[0]);
	o_rPose.R = {c, -s, 0.0, s, c, 0.0, 0.0, 0.0, 1.0};
	o_rPose.t = {};
}

inline void VJointFKSlider::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose.R = Rotation::c_Identity3;
	o_rPose.t = {0.0, 0.0, m_State[0]};
}

inline void VJointFKDummy::GetPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose = {};
}

} // namespace ComputeSubject
