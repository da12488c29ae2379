#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"
#include "FBXIO/SkinSkeleton.h"
#include "RetargetSetupCore/BindPose.h"
#include "numerics/Matrix4.h"
#include "numerics/Rotation.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace RetargetSetup
{

/// The bones that the segments of a target subject were made of: a tree in the skeleton that has their names, without
/// namespaces, and their parents in the same order. Empty if there is none.
/// @param i_Root the bone whose tree it is, if several fit.
FBXIO::VSkinSkeleton BonesOfSegments(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const FBXIO::VSkinSkeleton& i_rSkeleton, std::size_t i_Root);

/// World poses, in millimetres, of the bones that the segments of a target subject were made of, in their order.
/// A bone's rotation is its matrix without scale and shear; a mirror, which no segment can hold, becomes the rotation
/// with the same X and Y axes. Distances from the root are multiplied by the scale, as the segments' lengths are.
/// @param i_rBones the root and all below it, as ExtractSubtree gives them.
/// @param i_rAxis turns the file's space into the system's Z-up space.
/// @param i_RootFactor multiplies the height of the root above the floor.
std::vector<Rotation::VPose<double>> PosesInFile(
    const FBXIO::VSkinSkeleton& i_rBones, const Rotation::VMatrix4& i_rAxis, double i_Scale, double i_RootFactor = 1.0);

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
/// @param io_rSubject HoldsFilePose must be true of it.
/// @param i_rBones as BonesOfSegments gives them.
/// @param i_RootFactor multiplies the height of the root above the floor.
VFileMatch MatchFilePose(CoreOrlexTypes::VSubjectParametrised& io_rSubject, const FBXIO::VSkinSkeleton& i_rBones,
    const Rotation::VMatrix4& i_rAxis, double i_RootFactor = 1.0);

/// True of a subject as CreateTargetSubject makes it, pruned or not: a free root, below it ball joints or none, no
/// joint orientations, no post poses, and no dynamic parameter beside the scale.
bool HoldsFilePose(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// The segment that stands farthest from its bone in the file, at the subject's scale; nothing if all stand where their
/// bones do.
std::optional<VPoseDifference> DifferenceFromFile(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const FBXIO::VSkinSkeleton& i_rBones, const Rotation::VMatrix4& i_rAxis, double i_RootFactor);

/// "at worst "Head" by 12.3 mm and 4.5 degrees".
std::string WorstText(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, const VPoseDifference& i_rWorst);

/// MatchFilePose, with what it changed and what it could not reach told in the log.
void MatchFilePoseAndTell(CoreOrlexTypes::VSubjectParametrised& io_rSubject, const FBXIO::VSkinSkeleton& i_rBones,
    const Rotation::VMatrix4& i_rAxis, double i_RootFactor);

/// A root that stands turned because the pre-rotation of its bone counts twice: in its segment, and in the bone's place
/// in the world that is its bind pose.
struct VTurnedRoot
{
	std::string m_BoneName;
	/// From the file's pose, in radians.
	double m_Angle = 0.0;
};

/// Nothing for a root that stands as its bone does, or in a pose that somebody gave it.
std::optional<VTurnedRoot> FindTurnedRoot(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const FBXIO::VSkinSkeleton& i_rSkeleton, const Rotation::VMatrix4& i_rAxis);

} // namespace RetargetSetup
