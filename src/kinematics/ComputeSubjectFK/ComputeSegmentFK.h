#pragma once

#include "ComputeSubjectFK/JointFKInterfaces.h"
#include "ComputeSubjectFK/SegmentFKInterfaces.h"
#include "CoreOrlexTypes/Subject.h"
#include "numerics/PoseRows.h"

#include <cstddef>

namespace ComputeSubject
{

class VComputeSegmentFK final : public IComputeSegmentFK
{
public:
	/// The parent, null for a root, must outlive the segment.
	/// Throws VConstructionException for a joint of a type that has no class.
	VComputeSegmentFK(const CoreOrlexTypes::VSubject::VSegment& i_rSegment, const IComputeSegmentFK* i_pParent);

	void Update(const double*& io_rpState) override
	{
		Move(io_rpState);
		Place();
	}

	/// The two halves of Update. Moving all segments of a subject first and placing them afterwards is a third faster
	/// than one after the other: the joints' sines and roots do not wait for each other.
	void Move(const double*& io_rpState) { m_pJoint->Move(io_rpState, m_Joint); }
	void Place()
	{
		const Rotation::VPoseRows local(m_B, Rotation::VPoseRows(m_Joint));
		local.Store(m_Local);
		if (m_pParentWorld)
			Rotation::VPoseRows(*m_pParentWorld, local).Store(m_World);
		else
			m_World = m_Local;
	}

	void SegmentPose(Rotation::VPose<double>& o_rPose) const override;
	Rotation::VPose<double> SegmentPose() const override;
	Rotation::VPose<double> JointBasePose() const override;
	Rotation::VPose<double> JointBasePoseInParent() const override { return m_B; }
	const Rotation::VPose<double>& WorldPose() const override { return m_World; }
	const Rotation::VPose<double>& LocalPose() const override { return m_Local; }
	const Rotation::VPose<double>& PostPose() const override { return m_Post; }
	std::uint32_t TreeDepth() const override { return m_Depth; }
	const IComputeSegmentFKBase* ParentBase() const override { return m_pParent; }
	const IComputeSegmentFK* Parent() const override { return m_pParent; }
	std::shared_ptr<IComputeSegmentFK> Clone(const IComputeSegmentFK* i_pParent) const override;
	const IComputeJointFK& JointBase() const override;
	const IJointFK& Joint() const override { return *m_pJoint; }

	std::size_t NumberOfStates() const { return m_NumberOfStates; }

private:
	VComputeSegmentFK(const VComputeSegmentFK& i_rOther, const IComputeSegmentFK* i_pParent);
	void SetParent(const IComputeSegmentFK* i_pParent);

	std::shared_ptr<IJointFK> m_pJoint;
	/// The segment's pre pose in the parent's joint frame, and the same with the joint's pre pose.
	Rotation::VPose<double> m_A;
	Rotation::VPose<double> m_B;
	Rotation::VPose<double> m_Post;
	Rotation::VPose<double> m_Local;
	Rotation::VPose<double> m_World;
	/// The joint's motion alone.
	Rotation::VPose<double> m_Joint;
	std::size_t m_NumberOfStates = 0;
	const IComputeSegmentFK* m_pParent = nullptr;
	std::uint32_t m_Depth = 1;
	const Rotation::VPose<double>* m_pParentWorld = nullptr;
};

/// The segments of a subject, in order. Empty if a parent does not stand before its children, or if there is a second
/// root.
/// Throws VConstructionException for a joint of a type that has no class.
VSegmentTree MakeSegmentTree(const CoreOrlexTypes::VSubject& i_rSubject);

} // namespace ComputeSubject
