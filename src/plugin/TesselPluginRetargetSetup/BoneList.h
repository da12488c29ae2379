#pragma once

#include "FBXIO/SkinSkeleton.h"

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace RetargetSetup
{

/// The bones of a skeleton as an enumeration: names indented by one blank for each level of the tree, with the bones'
/// indices.
std::vector<std::pair<std::string, std::uint32_t>> BoneListForEnum(const FBXIO::VSkinSkeleton& i_rSkeleton);

/// What has become of the bones of a file, by name: "2 bones are new ('a', 'b'), 1 is gone ('c'), 1 stands otherwise
/// ('d')". Empty if they are all as they were.
std::string BoneChanges(const FBXIO::VSkinSkeleton& i_rBefore, const FBXIO::VSkinSkeleton& i_rNow);

} // namespace RetargetSetup
