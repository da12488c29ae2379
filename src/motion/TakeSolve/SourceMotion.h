#pragma once

#include "TakeIO/Take.h"
#include "TakeSolve/Finding.h"
#include "TakeSolve/JointPairs.h"
#include "numerics/Rotation.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace TakeSolve
{

struct VSourceSettings
{
	/// Pairs of a joint and a segment beside those that are found.
	std::vector<VNamedPair> m_Joints;
	/// The frame in which the performer of the take stands as the subject does in its bind pose. Without it the rest
	/// pose of the take counts, and each bone's direction there is brought onto the subject's by the shortest arc.
	std::optional<std::size_t> m_RestFrame;
};

/// A performer posed by the frames of a take.
///
/// A segment's world rotation is that of its joint since rest, applied to the segment in the bind pose; it turns about
/// its joint's centre, and the way from there to the next is the subject's own. Segments without a joint go along
/// with the one above, those above the first driven one with that. The way of the first driven segment is the take's,
/// times the ratio of the distances from there to the lowest joint, the median over the frames.
///
/// A performer whose joints at zero are the take's rest pose, bone by bone, is of the same skeleton: there the two are
/// one, whatever the bind pose is. Else the bind pose is related to the rest pose.
///
/// Where these differ, a bone that leads to one other keeps the direction that the take gives it. Of one that
/// leads to several, or to none, no arc is known: it takes that of the one above where its bones fit better with it,
/// and what is left is told. A performer who faces another way at rest is turned first.
///
/// Never changes after it is made, so that any number of threads may pose by it.
class VSourceMotion
{
public:
	/// @param i_BindPose the states of all joints in the order of the segments; missing ones count as 0.
	/// @return null if the subject's segments make no tree, or a setting names what is not there; o_rError tells it.
	static std::shared_ptr<const VSourceMotion> Make(const CoreOrlexTypes::VSubject& i_rSource,
	    std::span<const double> i_BindPose, std::shared_ptr<const TakeIO::VTake> i_pTake,
	    const VSourceSettings& i_rSettings, std::string& o_rError);

	const TakeIO::VTake& Take() const { return *m_pTake; }
	const std::vector<std::string>& SegmentNames() const { return m_Names; }
	/// By segments, -1 for none.
	const std::vector<std::int32_t>& Joints() const { return m_Joints; }
	/// What the operator ought to know of the pairs and of the rest poses.
	const std::vector<VFinding>& Findings() const { return m_Findings; }
	/// What the take's way is multiplied by.
	double Scale() const { return m_Scale; }
	/// By segments, in radians, how far the rest direction of the take was brought.
	const std::vector<double>& Arcs() const { return m_Arcs; }

	const SetupProposal::VRestSkeleton& RestSkeleton() const { return m_Rest; }
	const std::vector<Rotation::VPose<double>>& BindPoses() const { return m_BindPoses; }

	/// World poses of all segments in a frame.
	/// @param io_rJoints room that is kept from call to call.
	void Poses(std::size_t i_Frame, std::vector<Rotation::VPose<double>>& io_rJoints,
	    std::vector<Rotation::VPose<double>>& o_rSegments) const;

private:
	VSourceMotion() = default;
	/// The driven segment that one hangs on, -1 for none.
	std::int64_t DrivenAbove(std::size_t i_Segment) const;
	/// Whether all bones between driven segments point as the take's at rest.
	bool StandsAs(
	    const std::vector<Rotation::VPose<double>>& i_rRest, const std::vector<Rotation::VVector3>& i_rCentres) const;
	/// @param i_rReference, i_rCentres the pose of the segments, and of their joints, that is the take's at rest.
	void FindArcs(const std::vector<Rotation::VPose<double>>& i_rRest,
	    const std::vector<Rotation::VPose<double>>& i_rReference, const std::vector<Rotation::VVector3>& i_rCentres,
	    bool i_bArcs);
	void FindScale();

	/// How a segment hangs on the one above.
	struct VLink
	{
		std::int64_t m_Parent = -1;
		/// The joint's centre in the parent's frame, and the segment's origin from there in its own.
		Rotation::VVector3 m_Centre{};
		Rotation::VVector3 m_Offset{};
		/// From the take's joint to the segment; of one without a joint, from the parent to it.
		Rotation::VMatrix3 m_Turn = Rotation::c_Identity3;
	};

	std::shared_ptr<const TakeIO::VTake> m_pTake;
	std::vector<std::string> m_Names;
	std::vector<std::int32_t> m_Joints;
	std::vector<VLink> m_Links;
	/// The first driven segment, and of each segment whether it is above that.
	std::size_t m_First = 0;
	std::vector<bool> m_Above;
	std::vector<Rotation::VPose<double>> m_BindPoses;
	/// Of the joints in the bind pose.
	std::vector<Rotation::VVector3> m_Centres;
	SetupProposal::VRestSkeleton m_Rest;
	std::vector<double> m_Arcs;
	std::vector<VFinding> m_Findings;
	double m_Scale = 1.0;
};

} // namespace TakeSolve
