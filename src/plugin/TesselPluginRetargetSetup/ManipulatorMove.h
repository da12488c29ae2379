#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <QMatrix4x4>

#include <cstddef>
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

/// Gives the segment on the other side the mirrored rotation, whatever pose it had before. The mirror plane stands
/// across the line between the two joints; where they coincide there is none, and the rotation is turned round.
/// @param i_rWorld the new world matrix of the segment that is dragged.
/// @param i_rOrigin where the manipulator stood when the segment was selected.
void PoseMirrorSegment(CoreOrlexTypes::VSubjectParametrised::VSegment& io_rMirrorSegment,
    const QMatrix4x4& i_rJointFrame, const QMatrix4x4& i_rWorld, const QMatrix4x4& i_rOrigin,
    const QMatrix4x4& i_rMirrorJointFrame);

/// The whole of a drag: poses the segment and, with symmetry, the one on the other side if there is one.
/// @param i_rJointFrame the joint frame of a segment by its index.
/// @return false, with no change, for a segment that is not there.
bool MoveSegment(CoreOrlexTypes::VSubjectParametrised& io_rSubject, std::size_t i_SegmentIndex,
    const QMatrix4x4& i_rWorld, const QMatrix4x4& i_rOrigin, bool i_bSymmetry,
    const std::function<QMatrix4x4(std::size_t)>& i_rJointFrame);

} // namespace RetargetSetup
