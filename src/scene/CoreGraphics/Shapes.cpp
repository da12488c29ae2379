#include "CoreGraphics/Shapes.h"

#include <QVector3D>

#include <algorithm>
#include <array>
#include <cmath>
#include <map>
#include <numbers>
#include <utility>
#include <vector>

namespace CoreGraphics
{

namespace
{

struct VColourVertex
{
	float m_Position[3];
	std::uint8_t m_Colour[4];
};
static_assert(sizeof(VColourVertex) == 16);

struct VNormalVertex
{
	QVector3D m_Position;
	QVector3D m_Normal;
};
static_assert(sizeof(VNormalVertex) == 24);

using VIndices = std::vector<std::uint16_t>;

constexpr std::uint32_t c_MaximumSphereLevel = 6;
constexpr std::uint32_t c_MaximumSides = 10000;

VShape MakeShape(const std::vector<VNormalVertex>& i_rVertices, const VIndices& i_rIndices)
{
	return {VVertexBuffer(VVertexFormat::PositionNormal(), BytesOf(i_rVertices)), VIndexBuffer(i_rIndices)};
}

VShape MakeSolidBox()
{
	std::vector<VNormalVertex> vertices;
	VIndices indices;
	for (int axis = 0; axis < 3; ++axis)
	{
		for (const float side : {-1.0f, 1.0f})
		{
			QVector3D normal, u, v;
			normal[axis] = side;
			u[(axis + 1) % 3] = side;
			v[(axis + 2) % 3] = 1.0f;
			const auto first = static_cast<std::uint16_t>(vertices.size());
			// Clockwise as seen from outside; the pattern of indices turns the triangles round.
			for (const QVector3D& rCorner : {-u - v, -u + v, u + v, u - v})
				vertices.push_back({0.5f * (normal + rCorner), normal});
			for (const int corner : {0, 2, 1, 0, 3, 2})
				indices.push_back(static_cast<std::uint16_t>(first + corner));
		}
	}
	return MakeShape(vertices, indices);
}

VShape MakeWireBox()
{
	std::vector<VNormalVertex> vertices;
	for (const float z : {-0.5f, 0.5f})
	{
		for (const QVector3D& rCorner :
		    {QVector3D(-0.5f, -0.5f, z), {0.5f, -0.5f, z}, {0.5f, 0.5f, z}, {-0.5f, 0.5f, z}})
			vertices.push_back({rCorner, rCorner.normalized()});
	}
	return MakeShape(vertices, {0, 1, 1, 2, 2, 3, 3, 0, 4, 5, 5, 6, 6, 7, 7, 4, 0, 4, 1, 5, 2, 6, 3, 7});
}

QVector3D OnCircle(std::uint32_t i_Step, std::uint32_t i_Steps, float i_Z = 0.0f)
{
	const double angle = 2.0 * std::numbers::pi * i_Step / i_Steps;
	return {static_cast<float>(std::cos(angle)), static_cast<float>(std::sin(angle)), i_Z};
}

/// A disc at a height, that looks along Z or against it.
void AddCap(std::uint32_t i_Sides, float i_Z, float i_Direction, std::vector<VNormalVertex>& io_rVertices,
    VIndices& io_rIndices)
{
	const QVector3D normal(0.0f, 0.0f, i_Direction);
	const auto centre = static_cast<std::uint16_t>(io_rVertices.size());
	io_rVertices.push_back({{0.0f, 0.0f, i_Z}, normal});
	for (std::uint32_t side = 0; side < i_Sides; ++side)
	{
		io_rVertices.push_back({OnCircle(side, i_Sides, i_Z), normal});
		auto a = static_cast<std::uint16_t>(centre + 1 + side);
		auto b = static_cast<std::uint16_t>(centre + 1 + (side + 1) % i_Sides);
		if (i_Direction < 0.0f)
			std::swap(a, b);
		io_rIndices.insert(io_rIndices.end(), {centre, a, b});
	}
}

} // namespace

VShape MakeAxes(float i_Length)
{
	std::vector<VColourVertex> vertices;
	for (int axis = 0; axis < 3; ++axis)
	{
		VColourVertex vertex{{0.0f, 0.0f, 0.0f}, {0, 0, 0, 255}};
		vertex.m_Colour[axis] = 255;
		vertices.push_back(vertex);
		vertex.m_Position[axis] = i_Length;
		vertices.push_back(vertex);
	}
	return {VVertexBuffer(VVertexFormat::PositionColour(), BytesOf(vertices)), VIndexBuffer({0, 1, 2, 3, 4, 5})};
}

VShape MakeBox(bool i_bWire)
{
	return i_bWire ? MakeWireBox() : MakeSolidBox();
}

VShape MakeSphere(std::uint32_t i_Level)
{
	std::vector<QVector3D> vertices = {{0.0f, 1.0f, 0.0f}, {0.0f, 0.0f, -1.0f}, {-1.0f, 0.0f, 0.0f}, {0.0f, 0.0f, 1.0f},
	    {1.0f, 0.0f, 0.0f}, {0.0f, -1.0f, 0.0f}};
	VIndices indices = {0, 1, 2, 0, 2, 3, 0, 3, 4, 0, 4, 1, 5, 2, 1, 5, 3, 2, 5, 4, 3, 5, 1, 4};
	for (std::uint32_t level = 0; level < std::min(i_Level, c_MaximumSphereLevel); ++level)
	{
		std::map<std::pair<std::uint16_t, std::uint16_t>, std::uint16_t> middles;
		const auto middle = [&](std::uint16_t i_A, std::uint16_t i_B)
		{
			const auto [entry, bNew] =
			    middles.try_emplace(std::minmax(i_A, i_B), static_cast<std::uint16_t>(vertices.size()));
			if (bNew)
				vertices.push_back((vertices[i_A] + vertices[i_B]).normalized());
			return entry->second;
		};
		VIndices finer;
		finer.reserve(4 * indices.size());
		for (std::size_t i = 0; i < indices.size(); i += 3)
		{
			const std::uint16_t a = indices[i], b = indices[i + 1], c = indices[i + 2];
			const std::uint16_t ab = middle(a, b), bc = middle(b, c), ca = middle(c, a);
			finer.insert(finer.end(), {a, ab, ca, ab, b, bc, ca, bc, c, ab, bc, ca});
		}
		indices = std::move(finer);
	}
	return {VVertexBuffer(VVertexFormat::Format3D(), BytesOf(vertices)), VIndexBuffer(indices)};
}

VShape MakeCylinder(std::uint32_t i_Sides, bool i_bCaps)
{
	const std::uint32_t sides = std::clamp(i_Sides, 3u, c_MaximumSides);
	std::vector<VNormalVertex> vertices;
	VIndices indices;
	for (std::uint32_t side = 0; side < sides; ++side)
	{
		const QVector3D normal = OnCircle(side, sides);
		vertices.push_back({normal, normal});
		vertices.push_back({OnCircle(side, sides, 1.0f), normal});
		const auto a = static_cast<std::uint16_t>(2 * side);
		const auto b = static_cast<std::uint16_t>(2 * ((side + 1) % sides));
		const auto aTop = static_cast<std::uint16_t>(a + 1), bTop = static_cast<std::uint16_t>(b + 1);
		indices.insert(indices.end(), {a, b, bTop, a, bTop, aTop});
	}
	if (i_bCaps)
	{
		AddCap(sides, 0.0f, -1.0f, vertices, indices);
		AddCap(sides, 1.0f, 1.0f, vertices, indices);
	}
	return MakeShape(vertices, indices);
}

VShape MakeCone(std::uint32_t i_Sides, bool i_bCaps)
{
	const std::uint32_t sides = std::clamp(i_Sides, 3u, c_MaximumSides);
	std::vector<VNormalVertex> vertices;
	VIndices indices;
	for (std::uint32_t side = 0; side < sides; ++side)
	{
		// The tip has a vertex for each side: its normal is that of the side's middle.
		vertices.push_back({OnCircle(side, sides), OnCircle(side, sides, 1.0f).normalized()});
		vertices.push_back({{0.0f, 0.0f, 1.0f}, OnCircle(2 * side + 1, 2 * sides, 1.0f).normalized()});
		const auto a = static_cast<std::uint16_t>(2 * side);
		const auto b = static_cast<std::uint16_t>(2 * ((side + 1) % sides));
		indices.insert(indices.end(), {a, b, static_cast<std::uint16_t>(a + 1)});
	}
	if (i_bCaps)
		AddCap(sides, 0.0f, -1.0f, vertices, indices);
	return MakeShape(vertices, indices);
}

} // namespace CoreGraphics
