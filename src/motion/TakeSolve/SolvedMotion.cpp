#include "TakeSolve/SolvedMotion.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"

#include <algorithm>

namespace TakeSolve
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VPose = Rotation::VPose<double>;

/// World poses of all segments.
void Place(const ComputeSubject::VSegmentTree& i_rTree, std::span<const double> i_States, std::vector<VPose>& o_rPoses)
{
	o_rPoses.resize(i_rTree.size());
	const double* pState = i_States.data();
	for (std::size_t i = 0; i < i_rTree.size(); ++i)
	{
		i_rTree[i]->Update(pState);
		i_rTree[i]->SegmentPose(o_rPoses[i]);
	}
}

/// Whether the place of a segment in the one above changes: it moves along, or turns about a point that is not its own
/// origin.
bool MovesAlong(const CoreOrlexTypes::VSubject::VSegment& i_rSegment, const ComputeSubject::VComputeSegmentFK& i_rFK)
{
	const auto type = i_rSegment.m_Joint.m_JointType;
	return type == VSubjectParametrised::VJoint::EFree || type == VSubjectParametrised::VJoint::ESlider
	    || std::ranges::any_of(i_rFK.PostPose().t, [](double i_Value) { return i_Value != 0.0; });
}

} // namespace

TakeIO::VTake MotionOf(const CoreOrlexTypes::VSubject& i_rTarget, std::span<const double> i_BindPose,
    const VSolvedTake& i_rSolved, double i_Rate)
{
	TakeIO::VTake take;
	take.m_Rate = i_Rate;
	take.m_FileUp = TakeIO::EUp::Z;
	const ComputeSubject::VSegmentTree tree = ComputeSubject::MakeSegmentTree(i_rTarget);
	std::vector<double> bindPose(i_rSolved.m_NumberOfStates, 0.0);
	std::copy_n(i_BindPose.begin(), std::min(i_BindPose.size(), bindPose.size()), bindPose.begin());
	for (std::size_t i = 0; i < tree.size(); ++i)
	{
		const auto& rSegment = i_rTarget.m_Segments[i];
		TakeIO::VJoint& rJoint = take.m_Joints.emplace_back();
		rJoint.m_Name = rSegment.m_Name;
		rJoint.m_Parent = i == 0 ? -1 : std::int32_t(rSegment.m_ParentSegmentIndex);
		const bool bGoes = i == 0 || MovesAlong(rSegment, *tree[i]);
		if (bGoes || CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType) > 0)
			TakeIO::AddChannels(take, i, bGoes);
	}
	std::vector<VPose> poses;
	Place(tree, bindPose, poses);
	TakeIO::SetWorldRest(take, poses);
	take.m_Values.reserve(i_rSolved.m_Frames * take.m_Channels);
	for (std::size_t frame = 0; frame < i_rSolved.m_Frames; ++frame)
	{
		Place(tree, i_rSolved.States(frame), poses);
		TakeIO::AddFrame(take, poses);
	}
	return take;
}

} // namespace TakeSolve
