#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"
#include "FBXIO/SkinSkeleton.h"
#include "numerics/Rotation.h"

#include <QMatrix4x4>

#include <cstddef>
#include <vector>

namespace RetargetSetup
{

/// World poses, in millimetres, of the bones that the segments of a target subject were made of, in their order.
/// A bone's rotation is its matrix without scale and shear; a mirror, which no segment can hold, becomes the rotation
/// with the same X and Y axes. Distances from the root are multiplied by the scale, as the segments' lengths are.
/// @param i_rBones the root and all below it, as ExtractSubtree gives them.
/// @param i_rAxis turns the file's space into the system's Z-up space.
std::vector<Rotation::VPose<double>> PosesInFile(
    const FBXIO::VSkinSkeleton& i_rBones, const QMatrix4x4& i_rAxis, double i_Scale);

/// What MatchFilePose changed beside bind poses: indices of segments.
struct VFileMatch
{
	std::vector<std::size_t> m_Lengths;
	std::vector<std::size_t> m_PreRotations;
};

/// Gives every segment the world rotation of its bone, and the root the bone's world position, through its bind pose,
/// which becomes its mean too. Two things that no bind pose can reach are rewritten: an offset from the parent that
/// differs from the file's by more than a thousandth (accumulated scales make it so) becomes the file's, in numbers
/// times the scale parameter; and the pre-rotation of a segment without a joint takes up its rotation.
/// @param io_rSubject as CreateTargetSubject makes it of these bones, pruned or not: a free root, below it ball joints
/// or none, no joint orientations and no post poses.
VFileMatch MatchFilePose(
    CoreOrlexTypes::VSubjectParametrised& io_rSubject, const FBXIO::VSkinSkeleton& i_rBones, const QMatrix4x4& i_rAxis);

} // namespace RetargetSetup
