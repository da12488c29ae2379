#include "ComputeSubjectFK/ComputeSegmentFK.h"

#include "ComputeSubjectFK/ConstructionException.h"
#include "ComputeSubjectFK/JointFK.h"
#include "DebugServices/Assert.h"

namespace ComputeSubject
{

VComputeSegmentFK::VComputeSegmentFK(
    const CoreOrlexTypes::VSubject::VSegment& i_rSegment, const IComputeSegmentFK* i_pParent)
{
	SetParent(i_pParent);
	m_Depth = i_pParent ? i_pParent->TreeDepth() + 1 : 1;
	if (const IJointFKFactory* pFactory = JointFKFactory(i_rSegment.m_Joint.m_JointType))
		m_pJoint = pFactory->Create(i_rSegment.m_Joint);
	NVX_ASSERT(m_pJoint);
	if (!m_pJoint)
		throw VConstructionException();

	const IComputeJointFK& rJoint = m_pJoint->ComputeJointFK();
	m_NumberOfStates = rJoint.NumberOfStates();
	const Rotation::VPose<double> pre =
	    Rotation::PoseFromAngleAxis(i_rSegment.m_PreRotation, i_rSegment.m_PreTranslation);
	const Rotation::VPose<double> inversePost =
	    Rotation::PoseFromAngleAxis(i_rSegment.m_InversePostRotation, i_rSegment.m_InversePostTranslation);
	m_A = i_pParent ? Rotation::Relative(i_pParent->PostPose(), pre) : pre;
	m_B = Rotation::Compose(m_A, rJoint.PrePose());
	m_Post = Rotation::Compose(inversePost, rJoint.PostPose());
}

VComputeSegmentFK::VComputeSegmentFK(const VComputeSegmentFK& i_rOther, const IComputeSegmentFK* i_pParent)
    : m_pJoint(i_rOther.m_pJoint->Clone()), m_A(i_rOther.m_A), m_B(i_rOther.m_B), m_Post(i_rOther.m_Post),
      m_Local(i_rOther.m_Local), m_World(i_rOther.m_World), m_Joint(i_rOther.m_Joint),
      m_NumberOfStates(i_rOther.m_NumberOfStates), m_Depth(i_rOther.m_Depth)
{
	SetParent(i_pParent);
}

void VComputeSegmentFK::SetParent(const IComputeSegmentFK* i_pParent)
{
	m_pParent = i_pParent;
	m_pParentWorld = i_pParent ? &i_pParent->WorldPose() : nullptr;
}

void VComputeSegmentFK::SegmentPose(Rotation::VPose<double>& o_rPose) const
{
	o_rPose = SegmentPose();
}

Rotation::VPose<double> VComputeSegmentFK::SegmentPose() const
{
	return Rotation::Compose(m_World, Rotation::Inverse(m_Post));
}

Rotation::VPose<double> VComputeSegmentFK::JointBasePose() const
{
	return Rotation::Compose(m_World, Rotation::Inverse(m_Joint));
}

std::shared_ptr<IComputeSegmentFK> VComputeSegmentFK::Clone(const IComputeSegmentFK* i_pParent) const
{
	const std::shared_ptr<VComputeSegmentFK> pCloneFK(new VComputeSegmentFK(*this, i_pParent));
	NVX_ASSERT(pCloneFK->m_pJoint);
	if (i_pParent)
		NVX_ASSERT(pCloneFK->m_Depth == i_pParent->TreeDepth() + 1);
	else
		NVX_ASSERT(pCloneFK->m_Depth == 1);
	return pCloneFK;
}

const IComputeJointFK& VComputeSegmentFK::JointBase() const
{
	return m_pJoint->ComputeJointFK();
}

VSegmentTree MakeSegmentTree(const CoreOrlexTypes::VSubject& i_rSubject)
{
	VSegmentTree tree;
	tree.reserve(i_rSubject.m_Segments.size());
	for (const CoreOrlexTypes::VSubject::VSegment& rSegment : i_rSubject.m_Segments)
	{
		if (!tree.empty() && rSegment.m_ParentSegmentIndex >= tree.size())
			return {};
		const IComputeSegmentFK* const pParent = tree.empty() ? nullptr : tree[rSegment.m_ParentSegmentIndex].get();
		tree.push_back(std::make_shared<VComputeSegmentFK>(rSegment, pParent));
	}
	return tree;
}

} // namespace ComputeSubject
