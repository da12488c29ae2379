#pragma once

#include "CoreGraphics/Buffers.h"

#include <cstdint>

namespace CoreGraphics
{

/// Vertices and the order to draw them in.
struct VShape
{
	VVertexBuffer m_Vertices;
	VIndexBuffer m_Indices;
};

/// Three lines from the origin, X red, Y green, Z blue, in positions and colours.
VShape MakeAxes(float i_Length);

/// The unit cube about the origin, in positions and normals: triangles with a normal per face; or lines, where each
/// corner's normal points away from the centre.
VShape MakeBox(bool i_bWire);

/// The unit sphere as triangles: an octahedron whose faces are cut in four i_Level times. The positions are the
/// normals.
/// @param i_Level 0 to 6, beyond which the indices have no room
VShape MakeSphere(std::uint32_t i_Level);

/// The unit cylinder about Z from 0 to 1 as triangles, in positions and normals.
/// @param i_Sides 3 to 10000
VShape MakeCylinder(std::uint32_t i_Sides, bool i_bCaps);

/// The cone with its unit circle at Z 0 and its tip at Z 1 as triangles, in positions and normals.
/// @param i_Sides 3 to 10000
VShape MakeCone(std::uint32_t i_Sides, bool i_bCaps);

} // namespace CoreGraphics
