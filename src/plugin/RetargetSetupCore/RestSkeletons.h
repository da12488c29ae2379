#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "RetargetSetupCore/FilePose.h"
#include "SetupProposal/RestSkeleton.h"

/// Skeletons at rest, as proposals compare them.
namespace RetargetSetup
{

/// A subject in its bind pose. Empty, which is told, if its segments make no tree.
/// @param i_rSubject converted from i_rParametrised.
/// @param i_rBones that its segments were made of, for what they move of the skin; empty if not known.
SetupProposal::VRestSkeleton RestOf(const CoreOrlexTypes::VSubjectParametrised& i_rParametrised,
    const CoreOrlexTypes::VSubject& i_rSubject, const FBXIO::VSkinSkeleton& i_rBones = {});

/// All bones of an FBX file, of every root, as they stand there.
/// @param i_rAxis turns the file's space into the system's Z-up space.
SetupProposal::VRestSkeleton RestOf(const FBXIO::VSkinSkeleton& i_rSkeleton, const Rotation::VMatrix4& i_rAxis);

} // namespace RetargetSetup
