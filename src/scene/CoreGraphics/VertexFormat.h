#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace CoreGraphics
{

/// The attributes of vertices, in the order of VShaderProgram's table.
enum EAttribute : std::uint8_t
{
	EAttributePosition,
	EAttributeNormal,
	EAttributeColour,
	EAttributeUV,
	EAttributeBoneIndices,
	EAttributeBoneWeights,
	EAttributeCount
};

/// How the attributes of a vertex lie in a buffer.
struct VVertexFormat
{
	struct VEntry
	{
		/// EAttribute.
		std::uint8_t m_Attribute = 0;
		std::uint8_t m_Components = 0;
		/// Whole numbers are read as parts of their largest value.
		std::uint8_t m_Normalised = 0;
		/// GL_FLOAT or GL_UNSIGNED_BYTE.
		std::uint32_t m_Type = 0;
		/// Bytes from the vertex's first.
		std::uint32_t m_Offset = 0;

		bool operator==(const VEntry&) const = default;
	};
	static_assert(sizeof(VEntry) == 12);

	std::vector<VEntry> m_Entries;
	/// Bytes from one vertex to the next.
	std::uint32_t m_Stride = 0;

	bool operator==(const VVertexFormat&) const = default;

	/// 2 floats of position.
	static const VVertexFormat& Format2D();
	/// 3 floats of position.
	static const VVertexFormat& Format3D();
	/// 3 floats of position, 4 bytes of colour.
	static const VVertexFormat& PositionColour();
	/// 3 floats of position, 3 floats of normal.
	static const VVertexFormat& PositionNormal();
	/// 3 floats of position, 3 floats of normal, 2 floats of texture coordinate: FBXIO::VBasicVertex.
	static const VVertexFormat& Mesh();
	/// As Mesh, then 4 bytes of bone indices, and 4 bytes of weights as parts of 255: FBXIO::VSkinVertex.
	static const VVertexFormat& Skin();
};

} // namespace CoreGraphics
