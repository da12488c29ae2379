#pragma once

#include "numerics/Rotation.h"

#include <cstddef>
#include <vector>

namespace TakeSolve
{

/// Frames from the first up to the last, which is not among them.
struct VStand
{
	std::size_t m_First = 0;
	std::size_t m_Last = 0;
};

/// When a foot stands that was at these places, frame after frame: slower than 200 mm/s, within 30 mm of its lowest
/// height, for a tenth of a second at least.
std::vector<VStand> FindStands(const std::vector<Rotation::VVector3>& i_rPlaces, double i_Rate);

} // namespace TakeSolve
