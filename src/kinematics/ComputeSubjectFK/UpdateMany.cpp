#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ComputeSubjectFK.h"

#include <algorithm>
#include <future>
#include <unordered_map>

namespace ComputeSubject
{
namespace
{

using Rotation::VLanes;
using VLanePose = Rotation::VPose<VLanes>;

/// First b, then a; one of them may be the same in all frames. Sums stand in the order of Rotation::VPoseRows.
template <typename TA, typename TB>
void ComposeLanes(const Rotation::VPose<TA>& a, const Rotation::VPose<TB>& b, VLanePose& o_rPose)
{
	for (int row = 0; row < 3; ++row)
	{
		const VLanes x = a.R[3 * row];
		const VLanes y = a.R[3 * row + 1];
		const VLanes z = a.R[3 * row + 2];
		for (int column = 0; column < 3; ++column)
			o_rPose.R[3 * row + column] = x * b.R[column] + y * b.R[3 + column] + z * b.R[6 + column];
		o_rPose.t[row] = x * b.t[0] + y * b.t[1] + z * b.t[2] + a.t[row];
	}
}

void Store(const VLanePose& i_rPose, int i_Lane, Rotation::VPose<double>& o_rPose)
{
	for (int i = 0; i < 9; ++i)
		o_rPose.R[i] = i_rPose.R[i][i_Lane];
	for (int i = 0; i < 3; ++i)
		o_rPose.t[i] = i_rPose.t[i][i_Lane];
}

/// What does not depend on the frame.
struct VRest
{
	const IJointFK* m_pJoint;
	/// Null at the root.
	const VLanePose* m_pParent;
	Rotation::VPose<double> m_Base;
	Rotation::VPose<double> m_InversePost;
};

/// The poses of the frames from i_First to before i_End.
void Compute(const VSegmentTree& i_rTree, std::size_t i_States, const double* i_pStates, std::size_t i_First,
    std::size_t i_End, Rotation::VPose<double>* o_pPoses)
{
	std::vector<VLanePose> worlds(i_rTree.size());
	std::unordered_map<const IComputeSegmentFK*, const VLanePose*> worldOf;
	std::vector<VRest> rests;
	rests.reserve(i_rTree.size());
	for (const auto& rpSegment : i_rTree)
	{
		const auto parent = std::find_if(i_rTree.begin(), i_rTree.end(),
		    [&](const auto& i_rpOther) { return i_rpOther.get() == rpSegment->Parent(); });
		rests.push_back(
		    {&rpSegment->Joint(), parent == i_rTree.end() ? nullptr : &worlds[std::size_t(parent - i_rTree.begin())],
		        rpSegment->JointBasePoseInParent(), Rotation::Inverse(rpSegment->PostPose())});
	}
	std::vector<VLanes> states(i_States);
	for (std::size_t frame = i_First; frame < i_End; frame += 2)
	{
		// The last of an odd number stands in both lanes.
		const std::size_t second = std::min(frame + 1, i_End - 1);
		for (std::size_t i = 0; i < i_States; ++i)
			states[i] = {i_pStates[frame * i_States + i], i_pStates[second * i_States + i]};
		const VLanes* pState = states.data();
		for (std::size_t i = 0; i < rests.size(); ++i)
		{
			VLanePose motion;
			rests[i].m_pJoint->MoveLanes(pState, motion);
			VLanePose local;
			ComposeLanes(rests[i].m_Base, motion, local);
			if (rests[i].m_pParent)
				ComposeLanes(*rests[i].m_pParent, local, worlds[i]);
			else
				worlds[i] = local;
			VLanePose segment;
			ComposeLanes(worlds[i], rests[i].m_InversePost, segment);
			Store(segment, 0, o_pPoses[frame * rests.size() + i]);
			Store(segment, 1, o_pPoses[second * rests.size() + i]);
		}
	}
}

} // namespace

void VComputeSubjectFK::UpdateMany(
    std::span<const double> i_States, std::span<Rotation::VPose<double>> o_Poses, unsigned i_Threads) const
{
	if (m_SegmentTree.empty())
		return;
	std::size_t frames = o_Poses.size() / m_SegmentTree.size();
	if (m_NumberOfStates > 0)
		frames = std::min(frames, i_States.size() / m_NumberOfStates);
	// A thread is worth its start from some thousand poses on.
	const std::size_t worthwhile = 1 + frames * m_SegmentTree.size() / 4096;
	const std::size_t threads = std::clamp<std::size_t>(i_Threads, 1, worthwhile);
	const auto compute = [&](std::size_t i_Part)
	{
		Compute(m_SegmentTree, m_NumberOfStates, i_States.data(), frames * i_Part / threads,
		    frames * (i_Part + 1) / threads, o_Poses.data());
	};
	// What has no thread of its own, where none can be started, is computed when it is waited for.
	std::vector<std::future<void>> others;
	for (std::size_t part = 1; part < threads; ++part)
		others.push_back(std::async(std::launch::async | std::launch::deferred, compute, part));
	compute(0);
	for (std::future<void>& rOther : others)
		rOther.get();
}

} // namespace ComputeSubject
