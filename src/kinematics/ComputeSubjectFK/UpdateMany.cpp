#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ComputeSubjectFK.h"

#include <algorithm>
#include <atomic>
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

/// What of a segment does not depend on the frame.
struct VRest
{
	const IJointFK* m_pJoint;
	/// -1 at a root.
	std::ptrdiff_t m_Parent;
	Rotation::VPose<double> m_Base;
	Rotation::VPose<double> m_InversePost;
};

std::vector<VRest> Rests(const VSegmentTree& i_rTree)
{
	std::unordered_map<const IComputeSegmentFK*, std::ptrdiff_t> indices;
	std::vector<VRest> rests;
	rests.reserve(i_rTree.size());
	for (const auto& rpSegment : i_rTree)
	{
		const auto parent = indices.find(rpSegment->Parent());
		indices.emplace(rpSegment.get(), std::ptrdiff_t(rests.size()));
		rests.push_back({&rpSegment->Joint(), parent == indices.end() ? -1 : parent->second,
		    rpSegment->JointBasePoseInParent(), Rotation::Inverse(rpSegment->PostPose())});
	}
	return rests;
}

/// The poses of two frames, which may be the same.
/// @param io_rWorlds one for each segment, what they hold does not matter.
void Compute(const std::vector<VRest>& i_rRests, const VLanes* i_pStates, std::vector<VLanePose>& io_rWorlds,
    Rotation::VPose<double>* o_pFirst, Rotation::VPose<double>* o_pSecond)
{
	const VLanes* pState = i_pStates;
	for (std::size_t i = 0; i < i_rRests.size(); ++i)
	{
		const VRest& rRest = i_rRests[i];
		VLanePose motion;
		rRest.m_pJoint->MoveLanes(pState, motion);
		VLanePose local;
		ComposeLanes(rRest.m_Base, motion, local);
		if (rRest.m_Parent >= 0)
			ComposeLanes(io_rWorlds[std::size_t(rRest.m_Parent)], local, io_rWorlds[i]);
		else
			io_rWorlds[i] = local;
		VLanePose segment;
		ComposeLanes(io_rWorlds[i], rRest.m_InversePost, segment);
		Store(segment, 0, o_pFirst[i]);
		Store(segment, 1, o_pSecond[i]);
	}
}

} // namespace

void VComputeSubjectFK::UpdateMany(
    std::span<const double> i_States, std::span<Rotation::VPose<double>> o_Poses, unsigned i_Threads) const
{
	if (m_SegmentTree.empty())
		return;
	const std::size_t segments = m_SegmentTree.size();
	std::size_t frames = o_Poses.size() / segments;
	if (m_NumberOfStates > 0)
		frames = std::min(frames, i_States.size() / m_NumberOfStates);
	const std::vector<VRest> rests = Rests(m_SegmentTree);
	// Threads take the next frames whenever they are done with some, so that one which starts late or has no processor
	// of its own keeps none from its end.
	const std::size_t step = 2 * (1 + 512 / segments);
	std::atomic<std::size_t> next = 0;
	const auto compute = [&]
	{
		std::vector<VLanes> states(m_NumberOfStates);
		std::vector<VLanePose> worlds(segments);
		for (std::size_t first; (first = next.fetch_add(step, std::memory_order_relaxed)) < frames;)
			for (std::size_t frame = first; frame < std::min(first + step, frames); frame += 2)
			{
				// The last of an odd number stands in both lanes.
				const std::size_t second = std::min(frame + 1, frames - 1);
				for (std::size_t i = 0; i < m_NumberOfStates; ++i)
					states[i] = {i_States[frame * m_NumberOfStates + i], i_States[second * m_NumberOfStates + i]};
				Compute(rests, states.data(), worlds, &o_Poses[frame * segments], &o_Poses[second * segments]);
			}
	};
	// A thread is worth its start from some thousand poses on.
	const std::size_t worthwhile = 1 + frames * segments / 4096;
	// What has no thread of its own, where none can be started, is waited for, and finds nothing left.
	std::vector<std::future<void>> others;
	for (std::size_t thread = std::clamp<std::size_t>(i_Threads, 1, worthwhile); thread > 1; --thread)
		others.push_back(std::async(std::launch::async | std::launch::deferred, compute));
	compute();
	for (std::future<void>& rOther : others)
		rOther.get();
}

} // namespace ComputeSubject
