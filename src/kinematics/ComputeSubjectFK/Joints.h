#pragma once

#include "ComputeSubjectFK/JointFKInterfaces.h"
#include "CoreOrlexTypes/Subject.h"
#include "numerics/FastRotation.h"

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
/// TJoint::Motion(states, pose out) is the motion, of one frame (T is double) or of two at once (VLanes).
template <typename TJoint, VJointFKBase::EJointType t_Type, std::size_t t_States>
class VJointFKOfType : public VJointFKBase
{
public:
	static constexpr std::size_t c_States = t_States;

	explicit VJointFKOfType(const CoreOrlexTypes::VSubject::VJoint& i_rJoint) : VJointFKBase(i_rJoint, t_Type) {}
	EJointType JointType() const override { return t_Type; }
	std::size_t NumberOfStates() const override { return t_States; }
	void SetState(const double*& io_rpState) override
	{
		for (double& rValue : m_State)
			rValue = *io_rpState++;
	}
	void GetPose(Rotation::VPose<double>& o_rPose) const override { TJoint::Motion(m_State.data(), o_rPose); }

protected:
	std::array<double, t_States> m_State{};
};

/// Angle-axis, then translation.
class VJointFKFree : public VJointFKOfType<VJointFKFree, VJointFKBase::EJointType::EFree, 6>
{
public:
	using VJointFKOfType::VJointFKOfType;
	template <typename T>
	static void Motion(const T* i_pState, Rotation::VPose<T>& o_rPose);
	void NormaliseState(double*& io_rpState) const override;
};

/// Angle-axis.
class VJointFKBall : public VJointFKOfType<VJointFKBall, VJointFKBase::EJointType::EBall, 3>
{
public:
	using VJointFKOfType::VJointFKOfType;
	template <typename T>
	static void Motion(const T* i_pState, Rotation::VPose<T>& o_rPose);
	void NormaliseState(double*& io_rpState) const override;
};

/// About Z by the first angle, after about Y by the second.
class VJointFKHardySpicer : public VJointFKOfType<VJointFKHardySpicer, VJointFKBase::EJointType::EHardySpicer, 2>
{
public:
	using VJointFKOfType::VJointFKOfType;
	template <typename T>
	static void Motion(const T* i_pState, Rotation::VPose<T>& o_rPose);
	void NormaliseState(double*& io_rpState) const override;
};

/// About Z.
class VJointFKHinge : public VJointFKOfType<VJointFKHinge, VJointFKBase::EJointType::EHinge, 1>
{
public:
	using VJointFKOfType::VJointFKOfType;
	template <typename T>
	static void Motion(const T* i_pState, Rotation::VPose<T>& o_rPose);
	void NormaliseState(double*& io_rpState) const override;
};

/// Along Z.
class VJointFKSlider : public VJointFKOfType<VJointFKSlider, VJointFKBase::EJointType::ESlider, 1>
{
public:
	using VJointFKOfType::VJointFKOfType;
	template <typename T>
	static void Motion(const T* i_pState, Rotation::VPose<T>& o_rPose);
	void NormaliseState(double*& io_rpState) const override;
};

class VJointFKDummy : public VJointFKOfType<VJointFKDummy, VJointFKBase::EJointType::EDummy, 0>
{
public:
	using VJointFKOfType::VJointFKOfType;
	template <typename T>
	static void Motion(const T* i_pState, Rotation::VPose<T>& o_rPose);
	void NormaliseState(double*& io_rpState) const override;
};

template <typename T>
void VJointFKFree::Motion(const T* i_pState, Rotation::VPose<T>& o_rPose)
{
	o_rPose.R = Rotation::FastRotationMatrix(std::array<T, 3>{i_pState[0], i_pState[1], i_pState[2]});
	o_rPose.t = {i_pState[3], i_pState[4], i_pState[5]};
}

template <typename T>
void VJointFKBall::Motion(const T* i_pState, Rotation::VPose<T>& o_rPose)
{
	o_rPose.R = Rotation::FastRotationMatrix(std::array<T, 3>{i_pState[0], i_pState[1], i_pState[2]});
	o_rPose.t = {};
}

template <typename T>
void VJointFKHardySpicer::Motion(const T* i_pState, Rotation::VPose<T>& o_rPose)
{
	using std::cos;
	using std::sin;
	const T ca = cos(i_pState[0]);
	const T sa = sin(i_pState[0]);
	const T cb = cos(i_pState[1]);
	const T sb = sin(i_pState[1]);
	o_rPose.R = {cb * ca, -sa, sb * ca, cb * sa, ca, sb * sa, -sb, 0.0, cb};
	o_rPose.t = {};
}

template <typename T>
void VJointFKHinge::Motion(const T* i_pState, Rotation::VPose<T>& o_rPose)
{
	using std::cos;
	using std::sin;
	const T c = cos(i_pState[0]);
	const T s = sin(i_pState[0]);
	o_rPose.R = {c, -s, 0.0, s, c, 0.0, 0.0, 0.0, 1.0};
	o_rPose.t = {};
}

template <typename T>
void VJointFKSlider::Motion(const T* i_pState, Rotation::VPose<T>& o_rPose)
{
	o_rPose = {};
	o_rPose.t[2] = i_pState[0];
}

template <typename T>
void VJointFKDummy::Motion(const T*, Rotation::VPose<T>& o_rPose)
{
	o_rPose = {};
}

} // namespace ComputeSubject
