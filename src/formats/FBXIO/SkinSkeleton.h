#pragma once

#include "FBXIO/BoneSkin.h"
#include "numerics/Matrix4.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace FBXIO
{

/// A bone of an FBX file. Matrices are for column vectors with the translation in column 3, in millimetres.
struct VSkinBone
{
	/// As the file has it, namespace included, in UTF-8.
	std::string m_Name;
	/// The node's pre-rotation, rotation only.
	Rotation::VMatrix4 m_PreRotation;
	/// Identity until a skin cluster fills it.
	Rotation::VMatrix4 m_InverseBind;
	/// The node's local transform with its pre-rotation taken out on the right.
	Rotation::VMatrix4 m_Local;
	Rotation::VMatrix4 m_Global;
	/// Index into the same array, -1 for a root.
	std::int64_t m_ParentIndex = -1;
	/// Product of the local X scalings from the scene root down to this node; the unit scale is not in it.
	float m_AccumulatedScale = 1.0f;
	/// Nothing unless FBXReader::ReadBoneSkins found a skin.
	std::optional<VBoneSkin> m_Skin = std::nullopt;
};

/// Bones in pre-order of the node tree: a parent stands before its children.
using VSkinSkeleton = std::vector<VSkinBone>;

} // namespace FBXIO
