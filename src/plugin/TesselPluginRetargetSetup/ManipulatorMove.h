#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <QMatrix4x4>

#include <cstddef>
#include <cstdint>
#include <functional>

/// What a drag of the manipulator does to the bind pose of a target subject. Matrices are for column vectors, in mm.
namespace RetargetSetup
{

/// The frame in the world in which a segment's joint turns.
/// @param i_rParentWorld the world matrix of the parent segment, identity for a root.
QMatrix4x4 JointFrame(const QMatrix4x4& i_rParentWorld, const CoreOrlexTypes::VSubject::VSegment& i_rSegment);

/// Gives a segment's joint the pose in which it stands at a place in the world: its rotation, and for the root its
/// place. Mean and bind pose are the same afterwards. Values that the joint does not have are left out.
/// @param i_rWorld the new world matrix of the segment.
/// @param i_bRoot the root moves too, every other segment only turns.
void PoseSegment(CoreOrlexTypes::VSubjectParametrised::VSegment& io_rSegment, const QMatrix4x4& i_rJointFrame,
    const QMatrix4x4& i_rWorld, bool i_bRoot);

/// Gives the segment on the other side the mirror image of a turn. The mirror plane stands across the line between the
/// two joints; where they coincide there is none, and the rotation is turned round.
/// @param i_rFrom what the dragged segment turned from to i_rWorld: its joint frame, so that the whole pose is
/// mirrored, or its world matrix before the drag, so that the change is.
/// @param i_rOrigin where the manipulator stood when the segment was selected.
/// @param i_rMirrorFrom what the segment on the other side turns from: its joint frame, so that its pose is replaced,
/// or its world matrix before the drag.
void PoseMirrorSegment(CoreOrlexTypes::VSubjectParametrised::VSegment& io_rMirrorSegment, const QMatrix4x4& i_rFrom,
    const QMatrix4x4& i_rWorld, const QMatrix4x4& i_rOrigin, const QMatrix4x4& i_rMirrorJointFrame,
    const QMatrix4x4& i_rMirrorFrom);

/// What a drag does to the other side.
struct VMirror
{
	/// The segment that moves too, -1 for none.
	std::int32_t m_SegmentIndex = -1;
	/// It takes over the change of the pose, not the pose.
	bool m_bMirrorsChange = false;
};

/// The whole of a drag: poses the segment and the one on the other side.
/// @param i_rJointFrame the joint frame of a segment by its index.
/// @return false, with no change, for a segment that is not there.
bool MoveSegment(CoreOrlexTypes::VSubjectParametrised& io_rSubject, std::size_t i_SegmentIndex,
    const QMatrix4x4& i_rWorld, const QMatrix4x4& i_rOrigin, const VMirror& i_rMirror,
    const std::function<QMatrix4x4(std::size_t)>& i_rJointFrame);

} // namespace RetargetSetup
