#include "CoreGraphics/ShapeBatch.h"

#include "CoreGraphics/RenderContext.h"
#include "DebugServices/Assert.h"

#include <qopengl.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>

namespace CoreGraphics
{

namespace
{

using VFloats3 = std::array<float, 3>;

constexpr std::size_t c_MostVertices = std::numeric_limits<std::uint16_t>::max() + std::size_t{1};

VFloats3 Cross(const float* i_pA, const float* i_pB)
{
	return {i_pA[1] * i_pB[2] - i_pA[2] * i_pB[1], i_pA[2] * i_pB[0] - i_pA[0] * i_pB[2],
	    i_pA[0] * i_pB[1] - i_pA[1] * i_pB[0]};
}

VFloats3 Combine(const float* i_pX, const float* i_pY, const float* i_pZ, const VFloats3& i_rBy)
{
	VFloats3 sum;
	for (std::size_t i = 0; i < 3; ++i)
		sum[i] = i_pX[i] * i_rBy[0] + i_pY[i] * i_rBy[1] + i_pZ[i] * i_rBy[2];
	return sum;
}

/// Bytes from a vertex's first; -1 if the format has no such attribute.
std::ptrdiff_t OffsetOf(const VVertexFormat& i_rFormat, EAttribute i_Attribute)
{
	for (const VVertexFormat::VEntry& rEntry : i_rFormat.m_Entries)
		if (rEntry.m_Attribute == i_Attribute)
			return std::ptrdiff_t{rEntry.m_Offset};
	return -1;
}

template <typename T>
T Read(const std::uint8_t* i_pBytes)
{
	T value;
	std::memcpy(&value, i_pBytes, sizeof value);
	return value;
}

} // namespace

VColourBytes ColourBytes(const QVector4D& i_rColour)
{
	VColourBytes bytes;
	for (int i = 0; i < 4; ++i)
		bytes[static_cast<std::size_t>(i)] =
		    static_cast<std::uint8_t>(std::lround(std::clamp(i_rColour[i], 0.0f, 1.0f) * 255.0f));
	return bytes;
}

VColourBytes ColourBytes(const VSelectionId& i_rId)
{
	const auto byte = [&](int i_Shift) { return static_cast<std::uint8_t>(i_rId.m_Id >> i_Shift & 0xff); };
	return {byte(0), byte(8), byte(16), 1};
}

const VVertexFormat& VShapeBatch::Format()
{
	static const VVertexFormat s_Format{
	    {{EAttributePosition, 3, 0, GL_FLOAT, 0}, {EAttributeNormal, 3, 0, GL_FLOAT, 12},
	        {EAttributeColour, 4, 1, GL_UNSIGNED_BYTE, 24}, {EAttributeUV, 2, 0, GL_FLOAT, 28}},
	    sizeof(VVertex)};
	return s_Format;
}

void VShapeBatch::Add(const VShape& i_rShape, const QMatrix4x4& i_rMatrix, const VColourBytes& i_rColour)
{
	NVX_ASSERT(i_rShape.m_Vertices.Count() <= c_MostVertices);
	const float* const m = i_rMatrix.constData();
	m_Gathered.push_back(
	    {&i_rShape, {m[0], m[1], m[2], m[4], m[5], m[6], m[8], m[9], m[10], m[12], m[13], m[14]}, i_rColour});
}

void VShapeBatch::Add(const VShape& i_rShape, const QVector4D& i_rPlace, const VColourBytes& i_rColour)
{
	NVX_ASSERT(i_rShape.m_Vertices.Count() <= c_MostVertices);
	const float s = i_rPlace.w();
	m_Gathered.push_back({&i_rShape, {s, 0, 0, 0, s, 0, 0, 0, s, i_rPlace.x(), i_rPlace.y(), i_rPlace.z()}, i_rColour});
}

void VShapeBatch::Place(const VPlacedShape& i_rPlaced)
{
	const VVertexBuffer& rVertices = i_rPlaced.m_pShape->m_Vertices;
	const VIndexBuffer& rIndices = i_rPlaced.m_pShape->m_Indices;
	m_Begins.push_back({m_Vertices.size(), m_Indices.size(), m_Parts.size()});
	if (m_Parts.empty() || m_Vertices.size() - m_Parts.back().m_FirstVertex + rVertices.Count() > c_MostVertices)
		m_Parts.push_back({m_Vertices.size(), m_Indices.size()});

	const std::size_t first = m_Vertices.size() - m_Parts.back().m_FirstVertex;
	const std::uint8_t* const pIndices = rIndices.Bytes().data();
	const bool bShort = rIndices.Type() == GL_UNSIGNED_SHORT;
	for (std::size_t i = 0; i < rIndices.Count(); ++i)
		m_Indices.push_back(static_cast<std::uint16_t>(
		    first + (bShort ? Read<std::uint16_t>(pIndices + 2 * i) : Read<std::uint32_t>(pIndices + 4 * i))));

	const float* const x = i_rPlaced.m_Matrix.data();
	const float *const y = x + 3, *const z = x + 6, *const t = x + 9;
	// Normals keep at right angles to their faces under any scale.
	const VFloats3 nx = Cross(y, z), ny = Cross(z, x), nz = Cross(x, y);
	const VVertexFormat& rFormat = rVertices.Format();
	const std::ptrdiff_t colour = OffsetOf(rFormat, EAttributeColour);
	const std::ptrdiff_t normal = std::max(OffsetOf(rFormat, EAttributeNormal), std::ptrdiff_t{0});
	const std::uint8_t* pVertex = rVertices.Bytes().data();
	for (std::size_t i = 0; i < rVertices.Count(); ++i, pVertex += rFormat.m_Stride)
	{
		VVertex& rVertex = m_Vertices.emplace_back();
		rVertex.m_Position = Combine(x, y, z, Read<VFloats3>(pVertex));
		for (std::size_t k = 0; k < 3; ++k)
			rVertex.m_Position[k] += t[k];
		const auto local = Read<VFloats3>(pVertex + normal);
		rVertex.m_Normal = Combine(nx.data(), ny.data(), nz.data(), local);
		const auto& [a, b, c] = rVertex.m_Normal;
		const float length = std::sqrt(a * a + b * b + c * c);
		for (float& rPart : rVertex.m_Normal)
			rPart = length > 0.0f ? rPart / length : 0.0f;
		rVertex.m_LocalNormal = {local[0], local[1]};
		rVertex.m_Colour = colour < 0 ? i_rPlaced.m_Colour : Read<VColourBytes>(pVertex + colour);
	}
}

bool VShapeBatch::PlaceChanged()
{
	const auto [gathered, placed] =
	    std::mismatch(m_Gathered.begin(), m_Gathered.end(), m_Placed.begin(), m_Placed.end());
	if (gathered == m_Gathered.end() && placed == m_Placed.end())
		return false;
	const auto kept = static_cast<std::size_t>(gathered - m_Gathered.begin());
	if (kept < m_Placed.size())
	{
		const VBegin& rBegin = m_Begins[kept];
		m_Vertices.resize(rBegin.m_Vertex);
		m_Indices.resize(rBegin.m_Index);
		m_Parts.resize(rBegin.m_Parts);
		m_Begins.resize(kept);
	}
	m_Placed.resize(kept);
	m_Placed.insert(m_Placed.end(), gathered, m_Gathered.end());
	for (std::size_t i = kept; i < m_Placed.size(); ++i)
		Place(m_Placed[i]);
	return true;
}

void VShapeBatch::Draw(VRenderContext& io_rContext, unsigned int i_Mode)
{
	const bool bChanged = PlaceChanged();
	if (m_VertexBuffer.Bind() || bChanged)
		m_VertexBuffer.Upload(m_Vertices.data(), m_Vertices.size() * sizeof(VVertex));
	if (m_IndexBuffer.Bind() || bChanged)
		m_IndexBuffer.Upload(m_Indices.data(), m_Indices.size() * sizeof(std::uint16_t));
	for (std::size_t i = 0; i < m_Parts.size(); ++i)
	{
		const std::size_t end = i + 1 < m_Parts.size() ? m_Parts[i + 1].m_FirstIndex : m_Indices.size();
		io_rContext.SetVertexFormat(Format(), m_Parts[i].m_FirstVertex);
		io_rContext.DrawElements(i_Mode, m_Parts[i].m_FirstIndex, end - m_Parts[i].m_FirstIndex);
	}
}

} // namespace CoreGraphics
