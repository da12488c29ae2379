#pragma once

#include "numerics/Rotation.h"

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace SetupProposal
{

/// What a joint moves of the skin, as it stands at rest.
struct VRestSkin
{
	/// Its share of all weights, from 0 to 1.
	double m_Share = 0.0;
	/// Mean place of that by weight, in the world, in mm, Z up, and how far from there it is, as the root of the mean
	/// square.
	Rotation::VVector3 m_Centre{};
	double m_Spread = 0.0;
	/// The points that it carries along, from where it stands, and the axes of the joint in the world, as columns, that
	/// they are along, as long as one unit of theirs is in mm. Null if none are known.
	std::shared_ptr<const std::vector<std::array<float, 3>>> m_pCarried = nullptr;
	Rotation::VMatrix3 m_Axes = Rotation::c_Identity3;
	/// Where what was up when the skin was bound points now, in the world: a unit vector, zero if it is not known.
	Rotation::VVector3 m_BoundUp{};
};

/// A joint where it stands at rest.
struct VRestJoint
{
	/// Without a namespace.
	std::string m_Name;
	/// Index of a joint before this one, -1 for a root.
	std::int64_t m_Parent = -1;
	/// In the world, in mm, Z up.
	Rotation::VVector3 m_Place{};
	/// False if it is fixed to its parent: nothing of it is there to follow.
	bool m_bMoves = true;
	/// Nothing if no skin is known.
	std::optional<VRestSkin> m_Skin = std::nullopt;
};

/// Parents stand before their children; there may be several roots.
using VRestSkeleton = std::vector<VRestJoint>;

/// The same with every parent before its children, and every place a number: what a damaged file breaks counts as a
/// root, and as the origin.
VRestSkeleton Sound(VRestSkeleton i_Skeleton);

/// The same in another pose, skin along.
/// @param i_rTurns of each joint, in the world.
/// @param i_rPlaces of each joint, in mm.
VRestSkeleton Posed(VRestSkeleton i_Skeleton, const std::vector<Rotation::VMatrix3>& i_rTurns,
    const std::vector<Rotation::VVector3>& i_rPlaces);

} // namespace SetupProposal
