#pragma once

#include "numerics/Lanes.h"
#include "numerics/Rotation.h"

#include <cstddef>
#include <memory>

namespace ComputeSubject
{

/// A joint as forward kinematics sees it: PrePose, then the motion of its state, then the inverse of PostPose.
class IComputeJointFK
{
public:
	virtual ~IComputeJointFK() = default;

	/// The joint's degrees of freedom.
	virtual std::size_t NumberOfStates() const = 0;

	virtual const Rotation::VPose<double>& PrePose() const = 0;
	virtual const Rotation::VPose<double>& PostPose() const = 0;

	/// Reads NumberOfStates() values (radians, mm) and moves the pointer behind them.
	virtual void SetState(const double*& io_rpState) = 0;

	/// The motion of the state that was set last.
	virtual void GetPose(Rotation::VPose<double>& o_rPose) const = 0;
};

class IComputeJointConstraints
{
public:
	virtual ~IComputeJointConstraints() = default;

	/// Wraps the joint's NumberOfStates() values into their principal range and moves the pointer behind them.
	virtual void NormaliseState(double*& io_rpState) const = 0;
};

/// Owns the joint of one segment, whatever its class.
class IJointFK
{
public:
	virtual ~IJointFK() = default;

	virtual IComputeJointFK& ComputeJointFK() = 0;
	virtual const IComputeJointFK& ComputeJointFK() const = 0;
	virtual const IComputeJointConstraints& ComputeJointConstraints() const = 0;

	/// SetState and GetPose in one call.
	virtual void Move(const double*& io_rpState, Rotation::VPose<double>& o_rPose) = 0;

	/// The motion alone, of two frames at once; moves the pointer behind what it reads. The joint stays as it is.
	virtual void MoveLanes(const Rotation::VLanes*& io_rpState, Rotation::VPose<Rotation::VLanes>& o_rPose) const = 0;

	/// Shares nothing with this one.
	virtual std::shared_ptr<IJointFK> Clone() const = 0;
};

} // namespace ComputeSubject
