#include "TakeSolve/SolvedMotion.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace TakeSolve
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using TakeIO::EChannel;
using VPose = Rotation::VPose<double>;

void Place(const ComputeSubject::VSegmentTree& i_rTree, std::span<const double> i_States)
{
	const double* pState = i_States.data();
	for (const auto& rpSegment : i_rTree)
		rpSegment->Update(pState);
}

VPose ToParent(const ComputeSubject::VComputeSegmentFK& i_rSegment)
{
	const VPose pose = i_rSegment.SegmentPose();
	return i_rSegment.Parent() ? Rotation::Relative(
	           static_cast<const ComputeSubject::VComputeSegmentFK*>(i_rSegment.Parent())->SegmentPose(), pose)
	                           : pose;
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
	take.m_Frames = i_rSolved.m_Frames;
	take.m_FileUp = TakeIO::EUp::Z;
	const ComputeSubject::VSegmentTree tree = ComputeSubject::MakeSegmentTree(i_rTarget);
	std::vector<double> bindPose(i_rSolved.m_NumberOfStates, 0.0);
	std::copy_n(i_BindPose.begin(), std::min(i_BindPose.size(), bindPose.size()), bindPose.begin());
	Place(tree, bindPose);
	for (std::size_t i = 0; i < tree.size(); ++i)
	{
		const auto& rSegment = i_rTarget.m_Segments[i];
		TakeIO::VJoint joint;
		joint.m_Name = rSegment.m_Name;
		joint.m_Parent = i == 0 ? -1 : std::int32_t(rSegment.m_ParentSegmentIndex);
		joint.m_Rest = ToParent(*tree[i]);
		joint.m_FirstValue = take.m_Channels;
		if (i == 0 || MovesAlong(rSegment, *tree[i]))
			joint.m_Channels = {EChannel::XPosition, EChannel::YPosition, EChannel::ZPosition};
		if (i == 0 || CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType) > 0)
			joint.m_Channels.insert(
			    joint.m_Channels.end(), {EChannel::ZRotation, EChannel::YRotation, EChannel::XRotation});
		take.m_Channels += joint.m_Channels.size();
		take.m_Joints.push_back(std::move(joint));
	}
	take.m_Values.reserve(take.m_Frames * take.m_Channels);
	for (std::size_t frame = 0; frame < take.m_Frames; ++frame)
	{
		Place(tree, i_rSolved.States(frame));
		for (std::size_t i = 0; i < tree.size(); ++i)
		{
			const VPose pose = ToParent(*tree[i]);
			const std::vector<EChannel>& rChannels = take.m_Joints[i].m_Channels;
			if (!rChannels.empty() && !TakeIO::IsRotation(rChannels.front()))
				take.m_Values.insert(take.m_Values.end(), pose.t.begin(), pose.t.end());
			if (!rChannels.empty() && TakeIO::IsRotation(rChannels.back()))
			{
				Rotation::VVector3 angles;
				Rotation::EulerFromRotationMatrix(pose.R, Rotation::EZYX, angles);
				// Of the revolutions the one that goes on from the frame before.
				for (std::size_t k = 0; k < 3; ++k)
				{
					const std::size_t before = take.m_Values.size() - take.m_Channels;
					if (frame > 0)
						angles[k] = take.m_Values[before]
						    + std::remainder(angles[k] - take.m_Values[before], 2.0 * std::numbers::pi);
					take.m_Values.push_back(angles[k]);
				}
			}
		}
	}
	return take;
}

} // namespace TakeSolve
