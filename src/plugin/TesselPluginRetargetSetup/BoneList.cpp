#include "TesselPluginRetargetSetup/BoneList.h"

#include <algorithm>
#include <tuple>

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

std::string BoneChanges(const FBXIO::VSkinSkeleton& i_rBefore, const FBXIO::VSkinSkeleton& i_rNow)
{
	const auto find = [](const FBXIO::VSkinSkeleton& i_rBones, const std::string& i_rName)
	{ return std::ranges::find(i_rBones, i_rName, &FBXIO::VSkinBone::m_Name); };
	const auto parent = [](const FBXIO::VSkinSkeleton& i_rBones, const FBXIO::VSkinBone& i_rBone)
	{ return i_rBone.m_ParentIndex < 0 ? std::string() : i_rBones[std::size_t(i_rBone.m_ParentIndex)].m_Name; };
	std::vector<std::string> come, gone, other;
	for (const FBXIO::VSkinBone& rBone : i_rNow)
	{
		const auto before = find(i_rBefore, rBone.m_Name);
		if (before == i_rBefore.end())
			come.push_back(rBone.m_Name);
		else if (before->m_PreRotation != rBone.m_PreRotation || before->m_Local != rBone.m_Local
		    || before->m_Global != rBone.m_Global || parent(i_rBefore, *before) != parent(i_rNow, rBone))
			other.push_back(rBone.m_Name);
	}
	for (const FBXIO::VSkinBone& rBone : i_rBefore)
		if (find(i_rNow, rBone.m_Name) == i_rNow.end())
			gone.push_back(rBone.m_Name);

	constexpr std::size_t c_Named = 5;
	std::string text;
	for (const auto& [rNames, pOne, pMany] : {std::tuple(come, "is new", "are new"), {gone, "is gone", "are gone"},
	         {other, "stands otherwise", "stand otherwise"}})
	{
		if (rNames.empty())
			continue;
		text += (text.empty() ? "" : ", ") + std::to_string(rNames.size()) + (rNames.size() == 1 ? " bone " : " bones ")
		    + (rNames.size() == 1 ? pOne : pMany) + " (";
		for (std::size_t i = 0; i < rNames.size() && i < c_Named; ++i)
			text += (i > 0 ? ", '" : "'") + rNames[i] + "'";
		text += rNames.size() > c_Named ? " and more)" : ")";
	}
	return text;
}

} // namespace RetargetSetup
