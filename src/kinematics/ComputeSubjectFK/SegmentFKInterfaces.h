#pragma once

#include "numerics/Rotation.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace ComputeSubject
{

class IComputeJointFK;
class IJointFK;
class VComputeSegmentFK;

/// The poses of one segment, all of the latest Update. Three frames matter: the joint frame, in which WorldPose and
/// LocalPose work; the segment frame, which PostPose carries into the joint frame; and the parent's of each.
class IComputeSegmentFKBase
{
public:
	virtual ~IComputeSegmentFKBase() = default;

	/// Reads the joint's values and moves the pointer behind them. The parent must have been updated before.
	virtual void Update(const double*& io_rpState) = 0;

	/// The segment frame in the world: WorldPose composed with the inverse of PostPose.
	virtual void SegmentPose(Rotation::VPose<double>& o_rPose) const = 0;
	virtual Rotation::VPose<double> SegmentPose() const = 0;

	/// Where the joint's motion starts, in the world: WorldPose composed with the inverse of the joint's motion.
	virtual Rotation::VPose<double> JointBasePose() const = 0;

	/// The same in the parent's joint frame; it does not depend on the state.
	virtual Rotation::VPose<double> JointBasePoseInParent() const = 0;

	/// The references stay valid as long as the segment lives.
	virtual const Rotation::VPose<double>& WorldPose() const = 0;
	virtual const Rotation::VPose<double>& LocalPose() const = 0;
	virtual const Rotation::VPose<double>& PostPose() const = 0;

	/// The root's is 1.
	virtual std::uint32_t TreeDepth() const = 0;

	/// Null at the root.
	virtual const IComputeSegmentFKBase* ParentBase() const = 0;
};

class IComputeSegmentFK : public IComputeSegmentFKBase
{
public:
	/// Null at the root.
	virtual const IComputeSegmentFK* Parent() const = 0;

	/// A segment with the same poses and a joint of its own, bound to another parent (null for a root), which must
	/// outlive it.
	virtual std::shared_ptr<IComputeSegmentFK> Clone(const IComputeSegmentFK* i_pParent) const = 0;

	virtual const IComputeJointFK& JointBase() const = 0;
	virtual const IJointFK& Joint() const = 0;
};

/// In the order of the subject's segments: parents before their children.
using VSegmentTree = std::vector<std::shared_ptr<VComputeSegmentFK>>;

} // namespace ComputeSubject
