#pragma once

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/SelectionId.h"
#include "CoreGraphics/Shapes.h"

#include <QMatrix4x4>
#include <QVector4D>

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace CoreGraphics
{

class VRenderContext;

/// Red, green, blue and alpha as bytes, as vertices have them.
using VColourBytes = std::array<std::uint8_t, 4>;

/// @param i_rColour from 0 to 1
VColourBytes ColourBytes(const QVector4D& i_rColour);
/// What a pick reads: the id with its flags in the colour, and 1 in alpha.
VColourBytes ColourBytes(const VSelectionId& i_rId);

/// Many shapes, drawn with one call instead of one for each: their vertices lie in one buffer as they stand in the
/// world, for the vertex shader "Placed". Each frame gathers all of them anew; what is as it was is neither placed nor
/// sent again. Once the largest frame was gathered nothing is allocated.
class VShapeBatch
{
public:
	/// Begins to gather.
	void Clear() { m_Gathered.clear(); }
	bool IsEmpty() const { return m_Gathered.empty(); }

	/// @param i_rShape up to 65536 vertices. It lives as long as the batch, where it is. Its own colours count if it
	/// has any; without normals its positions are its normals
	/// @param i_rMatrix from the shape to the world
	void Add(const VShape& i_rShape, const QMatrix4x4& i_rMatrix, const VColourBytes& i_rColour);
	/// The same moved and scaled alone.
	/// @param i_rPlace where it is, and its scale
	void Add(const VShape& i_rShape, const QVector4D& i_rPlace, const VColourBytes& i_rColour);

	/// Draws what was gathered, with the program in use.
	/// @param i_Mode GL_TRIANGLES or GL_LINES
	void Draw(VRenderContext& io_rContext, unsigned int i_Mode);

private:
	struct VPlacedShape
	{
		const VShape* m_pShape;
		/// Columns of the matrix.
		std::array<float, 12> m_Matrix;
		VColourBytes m_Colour;

		bool operator==(const VPlacedShape&) const = default;
	};
	struct VVertex
	{
		std::array<float, 3> m_Position;
		std::array<float, 3> m_Normal;
		VColourBytes m_Colour;
		std::array<float, 2> m_LocalNormal;
	};
	/// As many shapes as indices of two bytes have room for: OpenGL ES 2 promises no others.
	struct VPart
	{
		std::size_t m_FirstVertex = 0;
		std::size_t m_FirstIndex = 0;
	};
	/// Where a shape's vertices and indices begin.
	struct VBegin
	{
		std::size_t m_Vertex;
		std::size_t m_Index;
		std::size_t m_Parts;
	};

	static const VVertexFormat& Format();
	/// From the first gathered shape that is not as it was placed.
	bool PlaceChanged();
	void Place(const VPlacedShape& i_rPlaced);

	std::vector<VPlacedShape> m_Gathered;
	/// Of which the vertices are.
	std::vector<VPlacedShape> m_Placed;
	std::vector<VBegin> m_Begins;
	std::vector<VVertex> m_Vertices;
	std::vector<std::uint16_t> m_Indices;
	std::vector<VPart> m_Parts;
	VStreamBuffer m_VertexBuffer;
	VStreamBuffer m_IndexBuffer{EStreamIndices};
};

} // namespace CoreGraphics
