#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "numerics/Rotation.h"

#include <vector>

namespace RetargetSetup
{

/// The covariance of a joint that nothing is known about, of the size that its type prescribes.
void DefaultCovariance(CoreOrlexTypes::VSubjectParametrised::VJoint& io_rJoint);

/// Gives a segment without a joint (type Dummy) one: Free for segment 0, Ball for the others. Mean and bind pose are
/// the rotation (angle-axis) with zeros behind it. Does nothing to other joints.
void EnableJoint(CoreOrlexTypes::VSubjectParametrised& io_rSubject, std::size_t i_SegmentIndex,
    const Rotation::VVector3& i_rRotation);

/// EnableJoint without a rotation for every segment but the root.
/// @param io_rExtras of the file that the subject comes from: T-pose constraints stay in step with the joints.
void EnableAllJoints(CoreOrlexTypes::VSubjectParametrised& io_rSubject, CoreOrlexQRTIO::VSubjectQRTExtras& io_rExtras);

/// Takes the joint from a segment. The bind pose of a Ball joint goes into the segment's pre-rotation, as bind pose
/// times pre-rotation: this keeps the world pose only where one of the two is zero. Joints of other types lose theirs.
void RemoveJoint(CoreOrlexTypes::VSubjectParametrised::VSegment& io_rSegment);

/// For each segment whether it carries a target of its own.
std::vector<bool> SegmentsWithTargets(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// Every segment, the root aside, with a joint and no target of its own; targets of its children do not count.
std::vector<std::size_t> JointsWithoutTargets(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// RemoveJoint for each of these segments.
/// @param io_rExtras as above.
void RemoveJoints(CoreOrlexTypes::VSubjectParametrised& io_rSubject, CoreOrlexQRTIO::VSubjectQRTExtras& io_rExtras,
    const std::vector<std::size_t>& i_rSegments);

} // namespace RetargetSetup
