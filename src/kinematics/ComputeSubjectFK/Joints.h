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

} // namespace ComputeSubject
