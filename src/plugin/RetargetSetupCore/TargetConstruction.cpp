#include "RetargetSetupCore/TargetConstruction.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/AngleAxis.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/Joints.h"
#include "math/NumberText.h"

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using FBXIO::VSkinBone;
using FBXIO::VSkinSkeleton;

namespace RetargetSetup
{

namespace
{

/// A mirrored or sheared transform has no rotation to take over: the operator is told, since the pose will differ.
Rotation::VVector3 RotationOrTold(
    const Rotation::VMatrix4& i_rMatrix, const std::string& i_rBoneName, const char* i_pWhat)
{
	const std::optional<Rotation::VVector3> rotation = RotationOf(i_rMatrix);
	if (!rotation)
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The %1% of bone '%2%' is no rotation (negative or sheared scale): it is lost and counts as none", i_pWhat,
		    i_rBoneName);
	return rotation.value_or(Rotation::VVector3{});
}

void FillSegment(VSubjectParametrised& io_rSubject, const VSkinSkeleton& i_rBones, std::size_t i_Index)
{
	const VSkinBone& rBone = i_rBones[i_Index];
	VSubjectParametrised::VSegment& rSegment = io_rSubject.m_Segments[i_Index];
	rSegment.m_Name = StripNamespace(rBone.m_Name);
	rSegment.m_SegmentIndex = std::uint32_t(i_Index);
	float factor = 1.0f;
	if (rBone.m_ParentIndex >= 0)
	{
		rSegment.m_ParentSegmentIndex = std::uint32_t(rBone.m_ParentIndex);
		rSegment.m_TreeDepth = io_rSubject.m_Segments[std::size_t(rBone.m_ParentIndex)].m_TreeDepth + 1;
		factor = i_rBones[std::size_t(rBone.m_ParentIndex)].m_AccumulatedScale;
	}
	const std::array<float, 3> translation = rBone.m_Local.Translation();
	const Rotation::VVector3 preRotation = RotationOrTold(rBone.m_PreRotation, rBone.m_Name, "pre-rotation");
	for (int i = 0; i < 3; ++i)
	{
		rSegment.m_PreRotation[i] = NumberText::PrintF(preRotation[i]);
		rSegment.m_PreTranslation[i] = NumberText::PrintF(translation[i] * factor) + "*" + c_GlobalScaleName;
	}
	EnableJoint(io_rSubject, i_Index, RotationOrTold(rBone.m_Local, rBone.m_Name, "local transform"));
}

} // namespace

VSkinSkeleton ExtractSubtree(const VSkinSkeleton& i_rSkeleton, std::size_t i_RootIndex)
{
	VSkinSkeleton subtree;
	std::vector<std::int64_t> newIndices(i_rSkeleton.size(), -1);
	for (std::size_t i = i_RootIndex; i < i_rSkeleton.size(); ++i)
	{
		const std::int64_t oldParent = i_rSkeleton[i].m_ParentIndex;
		const bool bInRange = oldParent >= 0 && std::size_t(oldParent) < newIndices.size();
		const std::int64_t parent = bInRange ? newIndices[std::size_t(oldParent)] : -1;
		if (i != i_RootIndex && parent == -1)
			continue;
		newIndices[i] = std::int64_t(subtree.size());
		subtree.push_back(i_rSkeleton[i]);
		subtree.back().m_ParentIndex = parent;
		if (parent == -1)
			subtree.back().m_Local = {};
	}
	return subtree;
}

std::string_view StripNamespace(std::string_view i_Name)
{
	return i_Name.substr(i_Name.rfind(':') + 1);
}

std::vector<std::size_t> RootBones(const VSkinSkeleton& i_rSkeleton)
{
	std::vector<std::size_t> roots;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
		if (i_rSkeleton[i].m_ParentIndex < 0)
			roots.push_back(i);
	return roots;
}

void BuildTargetSubject(const VSkinSkeleton& i_rSkeleton, VSubjectParametrised& io_rSubject,
    VSubjectApplicationData& io_rApplicationData, std::size_t i_RootIndex)
{
	const VSkinSkeleton bones = ExtractSubtree(i_rSkeleton, i_RootIndex);
	io_rSubject.m_Segments.assign(bones.size(), {});
	io_rApplicationData.m_Segments.assign(bones.size(), {});
	for (std::size_t i = 0; i < bones.size(); ++i)
	{
		FillSegment(io_rSubject, bones, i);
		io_rApplicationData.m_Segments[i].m_Colour = c_MadeHereColour;
	}
}

} // namespace RetargetSetup
