#include "TesselPluginRetargetSetup/BoneList.h"

namespace RetargetSetup
{

std::vector<std::pair<std::string, std::uint32_t>> BoneListForEnum(const FBXIO::VSkinSkeleton& i_rSkeleton)
{
	std::vector<std::pair<std::string, std::uint32_t>> list;
	list.reserve(i_rSkeleton.size());
	std::vector<std::size_t> depths;
	depths.reserve(i_rSkeleton.size());
	for (const FBXIO::VSkinBone& rBone : i_rSkeleton)
	{
		// A parent stands before its children.
		depths.push_back(rBone.m_ParentIndex < 0 ? 0 : depths[std::size_t(rBone.m_ParentIndex)] + 1);
		list.emplace_back(std::string(depths.back(), ' ') + rBone.m_Name, std::uint32_t(list.size()));
	}
	return list;
}

} // namespace RetargetSetup
