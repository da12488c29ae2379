#pragma once

#include "ComputeSubjectFK/Joints.h"

namespace ComputeSubject
{

/// Owns a joint of class T and shows it through the two interfaces.
template <typename T>
class VJointFK final : public IJointFK
{
public:
	explicit VJointFK(const CoreOrlexTypes::VSubject::VJoint& i_rJoint) : m_Joint(i_rJoint) {}
	explicit VJointFK(const T& i_rJoint) : m_Joint(i_rJoint) {}
	VJointFK(const VJointFK&) = delete;
	VJointFK& operator=(const VJointFK&) = delete;

	IComputeJointFK& ComputeJointFK() override { return m_ComputeJointFK; }
	const IComputeJointFK& ComputeJointFK() const override { return m_ComputeJointFK; }
	const IComputeJointConstraints& ComputeJointConstraints() const override { return m_ComputeJointConstraints; }

	void Move(const double*& io_rpState, Rotation::VPose<double>& o_rPose) override
	{
		// Of what was given, not of what was just stored: a pair read from two stores that are under way waits for
		// both.
		const double* const pState = io_rpState;
		m_Joint.SetState(io_rpState);
		T::Motion(pState, o_rPose);
	}

	void MoveLanes(const Rotation::VLanes*& io_rpState, Rotation::VPose<Rotation::VLanes>& o_rPose) const override
	{
		T::Motion(io_rpState, o_rPose);
		io_rpState += T::c_States;
	}

	std::shared_ptr<IJointFK> Clone() const override { return std::make_shared<VJointFK>(m_Joint); }

private:
	class VComputeJointFK final : public IComputeJointFK
	{
	public:
		explicit VComputeJointFK(T& i_rJoint) : m_rJoint(i_rJoint) {}
		std::size_t NumberOfStates() const override { return m_rJoint.NumberOfStates(); }
		const Rotation::VPose<double>& PrePose() const override { return m_rJoint.PrePose(); }
		const Rotation::VPose<double>& PostPose() const override { return m_rJoint.PostPose(); }
		void SetState(const double*& io_rpState) override { m_rJoint.SetState(io_rpState); }
		void GetPose(Rotation::VPose<double>& o_rPose) const override { m_rJoint.GetPose(o_rPose); }

	private:
		T& m_rJoint;
	};

	class VComputeJointConstraints final : public IComputeJointConstraints
	{
	public:
		explicit VComputeJointConstraints(const T& i_rJoint) : m_rJoint(i_rJoint) {}
		void NormaliseState(double*& io_rpState) const override { m_rJoint.NormaliseState(io_rpState); }

	private:
		const T& m_rJoint;
	};

	T m_Joint;
	VComputeJointFK m_ComputeJointFK{m_Joint};
	VComputeJointConstraints m_ComputeJointConstraints{m_Joint};
};

class IJointFKFactory
{
public:
	virtual ~IJointFKFactory() = default;

	/// Throws VConstructionException if the joint is of another type than the factory's.
	virtual std::shared_ptr<IJointFK> Create(const CoreOrlexTypes::VSubject::VJoint& i_rJoint) const = 0;
};

template <typename T>
class VJointFKFactory final : public IJointFKFactory
{
public:
	std::shared_ptr<IJointFK> Create(const CoreOrlexTypes::VSubject::VJoint& i_rJoint) const override
	{
		return std::make_shared<VJointFK<T>>(i_rJoint);
	}
};

/// Null for a type that has no class.
const IJointFKFactory* JointFKFactory(VJointFKBase::EJointType i_Type);

} // namespace ComputeSubject
