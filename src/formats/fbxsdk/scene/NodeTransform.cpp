#include "fbxsdk/scene/NodeTransform.h"

using namespace Rotation;

namespace
{

VMatrix3 LocalRotation(const FbxFormat::VNodeTransform& i_rNode)
{
	using FbxFormat::ERotationOrder;
	if (!i_rNode.HasRotationSpace())
		return FbxFormat::EulerRotation(i_rNode.m_Rotation, ERotationOrder::XYZ);
	const VMatrix3 pre = FbxFormat::EulerRotation(i_rNode.m_PreRotation, ERotationOrder::XYZ);
	const VMatrix3 post = FbxFormat::EulerRotation(i_rNode.m_PostRotation, ERotationOrder::XYZ);
	const VMatrix3 rotation = FbxFormat::EulerRotation(i_rNode.m_Rotation, i_rNode.m_Order);
	return Rotation::Product(pre, Rotation::Product(rotation, Transposed(post)));
}

} // namespace

FbxFormat::VLocalTransform FbxFormat::LocalTransform(const VNodeTransform& i_rNode)
{
	VLocalTransform local;
	local.m_Rotation = LocalRotation(i_rNode);
	local.m_Scaling = i_rNode.m_Scaling;
	local.m_Map.L = ScaledColumns(local.m_Rotation, i_rNode.m_Scaling);
	VVector3 turned;
	for (int i = 0; i < 3; ++i)
		turned[i] = i_rNode.m_ScalingOffset[i] + i_rNode.m_ScalingPivot[i]
		    - i_rNode.m_Scaling[i] * i_rNode.m_ScalingPivot[i] - i_rNode.m_RotationPivot[i];
	local.m_Map.t = Rotation::Product(local.m_Rotation, turned);
	for (int i = 0; i < 3; ++i)
		local.m_Map.t[i] += i_rNode.m_Translation[i] + i_rNode.m_RotationOffset[i] + i_rNode.m_RotationPivot[i];
	return local;
}

FbxFormat::VGlobalTransform FbxFormat::GlobalTransform(
    const VGlobalTransform& i_rParent, const VLocalTransform& i_rLocal, EInheritType i_InheritType)
{
	VGlobalTransform global;
	global.m_Scaling = i_rLocal.m_Scaling;
	global.m_Rotation = Rotation::Product(i_rParent.m_Rotation, i_rLocal.m_Rotation);
	switch (i_InheritType)
	{
	case EInheritType::RrSs: global.m_Inherited = ScaledColumns(i_rParent.m_Inherited, i_rParent.m_Scaling); break;
	case EInheritType::RSrs:
		// The parent's scaling stands before the rotation: it is seen through the rotation's inverse.
		global.m_Inherited = Rotation::Product(Transposed(i_rLocal.m_Rotation),
		    Rotation::Product(ScaledColumns(i_rParent.m_Inherited, i_rParent.m_Scaling), i_rLocal.m_Rotation));
		break;
	case EInheritType::Rrs: global.m_Inherited = i_rParent.m_Inherited; break;
	}
	global.m_Map.L = Rotation::Product(global.m_Rotation, ScaledColumns(global.m_Inherited, i_rLocal.m_Scaling));
	global.m_Map.t = Rotation::Product(i_rParent.m_Map.L, i_rLocal.m_Map.t);
	for (int i = 0; i < 3; ++i)
		global.m_Map.t[i] += i_rParent.m_Map.t[i];
	return global;
}
