#pragma once

#include "numerics/Rotation.h"

#include <array>
#include <memory>
#include <vector>

namespace FBXIO
{

/// What a bone moves of all skins of its file.
struct VBoneSkin
{
	/// Its share of all weights, from 0 to 1.
	double m_Share = 0.0;
	/// Mean place of what it moves, by weight, along the bone's own axes from where it stands, in mm.
	Rotation::VVector3 m_Centre{};
	/// How far from there that is, as the root of the mean square, in mm.
	double m_Spread = 0.0;
	/// The points that it moves at least by half, along the same axes, in mm. Null if there are none.
	std::shared_ptr<const std::vector<std::array<float, 3>>> m_pCarried = nullptr;
	/// What was up when the skin was bound, along the same axes.
	Rotation::VVector3 m_BoundUp{};
};

} // namespace FBXIO
