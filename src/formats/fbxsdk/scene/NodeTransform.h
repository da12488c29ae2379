#pragma once

#include "fbxsdk/scene/Affine.h"

namespace FbxFormat
{

/// How the rotation R and scaling S of a node combine with its parent's: the letters of a type stand in the order in
/// which they are multiplied, large for the parent and small for the node.
enum class EInheritType
{
	RrSs,
	RSrs,
	/// The parent's own scaling is left out, that of its ancestors is not.
	Rrs
};

/// The properties that place a node, in file units and degrees.
struct VNodeTransform
{
	Rotation::VVector3 m_Translation{};
	Rotation::VVector3 m_Rotation{};
	Rotation::VVector3 m_Scaling{1, 1, 1};
	Rotation::VVector3 m_RotationOffset{};
	Rotation::VVector3 m_RotationPivot{};
	Rotation::VVector3 m_ScalingOffset{};
	Rotation::VVector3 m_ScalingPivot{};
	Rotation::VVector3 m_PreRotation{};
	Rotation::VVector3 m_PostRotation{};
	/// Of what the node is, and not of what is below it: in no transform of a node.
	Rotation::VVector3 m_GeometricTranslation{};
	Rotation::VVector3 m_GeometricRotation{};
	Rotation::VVector3 m_GeometricScaling{1, 1, 1};
	ERotationOrder m_Order = ERotationOrder::XYZ;
	EInheritType m_InheritType = EInheritType::RrSs;
	bool m_bRotationActive = false;
	/// Pre- and post-rotation and order are those of the limits of the rotation only.
	bool m_bRotationSpaceForLimitOnly = false;

	/// False: pre- and post-rotation count as zero and the order as XYZ.
	bool HasRotationSpace() const { return m_bRotationActive && !m_bRotationSpaceForLimitOnly; }
};

struct VLocalTransform
{
	/// T Roff Rp Rpre R Rpost^-1 Rp^-1 Soff Sp S Sp^-1, the chain that the format documents.
	VAffine m_Map;
	/// Rpre R Rpost^-1; pre- and post-rotation are always in order XYZ.
	Rotation::VMatrix3 m_Rotation = Rotation::c_Identity3;
	Rotation::VVector3 m_Scaling{1, 1, 1};
};

VLocalTransform LocalTransform(const VNodeTransform& i_rNode);

/// A node's place in the scene: the linear part is m_Rotation m_Inherited diag(m_Scaling).
struct VGlobalTransform
{
	VAffine m_Map;
	/// The rotations alone, from the root down.
	Rotation::VMatrix3 m_Rotation = Rotation::c_Identity3;
	/// What the ancestors' scaling does inside the node's rotation.
	Rotation::VMatrix3 m_Inherited = Rotation::c_Identity3;
	Rotation::VVector3 m_Scaling{1, 1, 1};
};

VGlobalTransform GlobalTransform(
    const VGlobalTransform& i_rParent, const VLocalTransform& i_rLocal, EInheritType i_InheritType);

} // namespace FbxFormat
