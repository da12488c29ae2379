#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "numerics/Rotation.h"

#include <cstddef>

/// Rotations on one side of a body and on the other.
namespace RetargetSetup
{

/// The unit normal of the mirror plane between two joints, which stands across the line from one to the other; zero
/// where they coincide. Places in mm.
Rotation::VVector3 MirrorNormal(const Rotation::VVector3& i_rA, const Rotation::VVector3& i_rB);

/// The mirror image of a rotation (angle-axis): one the other way about the mirrored axis.
/// @param i_rNormal of the mirror plane; zero turns the rotation round.
Rotation::VVector3 Mirrored(const Rotation::VVector3& i_rRotation, const Rotation::VVector3& i_rNormal);

/// True if two segments stand in the bind pose with rotations of their joints, taken in the world, that are mirror
/// images of each other. Only then does a pose that is mirrored leave the other side where it is when a drag begins.
/// True, too, where the segments make no tree.
/// @param i_rSubject converted from i_rParametrised.
bool AreMirrorImages(const CoreOrlexTypes::VSubjectParametrised& i_rParametrised,
    const CoreOrlexTypes::VSubject& i_rSubject, std::size_t i_SegmentIndex, std::size_t i_MirrorIndex);

} // namespace RetargetSetup
