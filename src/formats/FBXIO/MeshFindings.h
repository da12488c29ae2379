#pragma once

#include <cstddef>
#include <cstdint>
#include <set>
#include <string>

namespace FBXIO
{

/// What is told once for all meshes of a file: each of it is by rule, and changes what is to be seen.
struct VMeshFindings
{
	/// Polygon vertices that were moved to other control points, and were told mesh by mesh.
	std::size_t m_Moved = 0;
	/// Polygons whose material is none of their node's.
	std::size_t m_WithoutPart = 0;
	/// Meshes that their geometric transform does not move, and how far it would, in millimetres.
	std::size_t m_Geometric = 0;
	float m_GeometricDistance = 0.0f;
	/// Materials that are neither Phong nor Lambert, and those of them that are shown by their base colour.
	std::size_t m_OtherMaterials = 0;
	std::size_t m_BaseColours = 0;
	/// Bones that meshes bind differently.
	std::set<std::int64_t> m_BoundDifferently;
};

/// To the log.
void Tell(const VMeshFindings& i_rFindings, const std::string& i_rPath);

} // namespace FBXIO
