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

} // namespace RetargetSetup
