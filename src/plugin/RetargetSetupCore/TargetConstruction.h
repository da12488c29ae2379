#pragma once

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "FBXIO/SkinSkeleton.h"

#include <string>
#include <string_view>

namespace RetargetSetup
{

/// The colour of segments and targets that this system makes: magenta.
inline constexpr CoreOrlexTypes::VColour c_MadeHereColour = CoreOrlexTypes::ColourFromPattern(0xFFFF00FFu);

/// The bone at i_RootIndex and all its descendants, in the order of the skeleton, with parents renumbered. The root's
/// local matrix becomes the identity. Empty if the index is out of range.
FBXIO::VSkinSkeleton ExtractSubtree(const FBXIO::VSkinSkeleton& i_rSkeleton, std::size_t i_RootIndex);

/// Everything behind the last ":".
std::string_view StripNamespace(std::string_view i_Name);

/// Indices of the bones without a parent.
std::vector<std::size_t> RootBones(const FBXIO::VSkinSkeleton& i_rSkeleton);

/// Fills the segments of both values from a bone tree. Lengths become a number of millimetres times the global scale,
/// which the caller adds; pre-rotations are numbers; the joints hold the bones' local rotations as mean and bind pose.
/// The root's own place is left to the caller.
void BuildTargetSubject(const FBXIO::VSkinSkeleton& i_rSkeleton, CoreOrlexTypes::VSubjectParametrised& io_rSubject,
    CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData, std::size_t i_RootIndex);

} // namespace RetargetSetup
