#include "RetargetSetupCore/RestSkeletons.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/TargetConstruction.h"

using CoreOrlexTypes::VSubjectParametrised;
using SetupProposal::VRestSkeleton;

namespace RetargetSetup
{

namespace
{

std::optional<SetupProposal::VRestSkin> SkinAtRest(
    const FBXIO::VSkinBone& i_rBone, const Rotation::VPose<double>& i_rPose, double i_Scale)
{
	if (!i_rBone.m_Skin)
		return std::nullopt;
	SetupProposal::VRestSkin skin{i_rBone.m_Skin->m_Share, i_rPose.t, i_Scale * i_rBone.m_Skin->m_Spread,
	    i_rBone.m_Skin->m_pCarried, i_rPose.R, Rotation::Product(i_rPose.R, i_rBone.m_Skin->m_BoundUp)};
	for (double& rValue : skin.m_Axes)
		rValue *= i_Scale;
	const Rotation::VVector3 centre = Rotation::Product(skin.m_Axes, i_rBone.m_Skin->m_Centre);
	for (std::size_t axis = 0; axis < 3; ++axis)
		skin.m_Centre[axis] += centre[axis];
	return skin;
}

} // namespace

VRestSkeleton RestOf(const VSubjectParametrised& i_rParametrised, const CoreOrlexTypes::VSubject& i_rSubject,
    const FBXIO::VSkinSkeleton& i_rBones)
{
	VRestSkeleton skeleton;
	const auto pFK = KinematicsInBindPose(i_rParametrised, i_rSubject, "compared");
	if (!pFK)
		return skeleton;
	const std::vector<Rotation::VPose<double>> poses = SegmentPoses(*pFK);
	for (std::size_t i = 0; i < poses.size(); ++i)
	{
		const VSubjectParametrised::VSegment& rSegment = i_rParametrised.m_Segments[i];
		const std::uint32_t parent = i_rSubject.m_Segments[i].m_ParentSegmentIndex;
		skeleton.push_back({rSegment.m_Name, parent == CoreOrlexTypes::c_NoParent ? -1 : std::int64_t(parent),
		    poses[i].t, rSegment.m_Joint.m_JointType != VSubjectParametrised::VJoint::EDummy,
		    i < i_rBones.size() ? SkinAtRest(i_rBones[i], poses[i], GetGlobalScale(i_rParametrised)) : std::nullopt});
	}
	return skeleton;
}

VRestSkeleton RestOf(const FBXIO::VSkinSkeleton& i_rSkeleton, const Rotation::VMatrix4& i_rAxis)
{
	VRestSkeleton skeleton;
	const std::vector<Rotation::VPose<double>> poses = PosesInFile(i_rSkeleton, i_rAxis, 1.0);
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
		skeleton.push_back({std::string(StripNamespace(i_rSkeleton[i].m_Name)), i_rSkeleton[i].m_ParentIndex,
		    poses[i].t, true, SkinAtRest(i_rSkeleton[i], poses[i], 1.0)});
	return skeleton;
}

} // namespace RetargetSetup
