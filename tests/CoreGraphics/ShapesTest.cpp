#include "CoreGraphics/Shapes.h"

#include <QVector2D>
#include <QVector3D>

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <map>
#include <tuple>
#include <utility>
#include <vector>

using namespace CoreGraphics;

namespace
{

std::vector<std::uint16_t> Indices(const VShape& i_rShape)
{
	const std::vector<std::uint8_t>& rBytes = i_rShape.m_Indices.Bytes();
	std::vector<std::uint16_t> indices(rBytes.size() / sizeof(std::uint16_t));
	std::memcpy(indices.data(), rBytes.data(), rBytes.size());
	return indices;
}

/// Of an attribute of three floats.
std::vector<QVector3D> Vectors(const VShape& i_rShape, std::size_t i_Attribute)
{
	std::vector<QVector3D> vectors(i_rShape.m_Vertices.Count());
	const VVertexFormat& rFormat = i_rShape.m_Vertices.Format();
	for (std::size_t i = 0; i < vectors.size(); ++i)
		std::memcpy(&vectors[i],
		    i_rShape.m_Vertices.Bytes().data() + i * rFormat.m_Stride + rFormat.m_Entries[i_Attribute].m_Offset,
		    sizeof(QVector3D));
	return vectors;
}

using VKey = std::tuple<int, int, int>;

VKey KeyOf(const QVector3D& i_rPoint)
{
	return {qRound(i_rPoint.x() * 1e4f), qRound(i_rPoint.y() * 1e4f), qRound(i_rPoint.z() * 1e4f)};
}

/// Every edge is passed once in each direction, and the triangles look outwards, as their normals do.
void ExpectClosedAndOutward(const VShape& i_rShape, const QVector3D& i_rInside, bool i_bClosed)
{
	const std::vector<std::uint16_t> indices = Indices(i_rShape);
	const std::vector<QVector3D> positions = Vectors(i_rShape, 0);
	const bool bNormals = i_rShape.m_Vertices.Format() == VVertexFormat::PositionNormal();
	const std::vector<QVector3D> normals = Vectors(i_rShape, bNormals ? 1 : 0);
	std::map<std::pair<VKey, VKey>, int> edges;
	ASSERT_EQ(indices.size() % 3, 0u);
	for (std::size_t i = 0; i < indices.size(); i += 3)
	{
		const QVector3D corners[] = {
		    positions.at(indices[i]), positions.at(indices[i + 1]), positions.at(indices[i + 2])};
		const QVector3D face = QVector3D::crossProduct(corners[1] - corners[0], corners[2] - corners[0]);
		EXPECT_GT(QVector3D::dotProduct(face, corners[0] + corners[1] + corners[2] - 3.0f * i_rInside), 0.0f);
		for (int corner = 0; corner < 3; ++corner)
		{
			const QVector3D& rNormal = normals[indices[i + std::size_t(corner)]];
			EXPECT_NEAR(rNormal.length(), 1.0f, 1e-5f);
			EXPECT_GT(QVector3D::dotProduct(face.normalized(), rNormal), 0.49f);
			++edges[{KeyOf(corners[corner]), KeyOf(corners[(corner + 1) % 3])}];
		}
	}
	for (const auto& [rEdge, count] : edges)
	{
		EXPECT_EQ(count, 1);
		EXPECT_TRUE(!i_bClosed || edges.count({rEdge.second, rEdge.first}));
	}
}

} // namespace

TEST(Shapes, BoxIsTheUnitCube)
{
	const VShape box = MakeBox(false), wire = MakeBox(true);
	EXPECT_EQ(box.m_Indices.Count(), 36u);
	ExpectClosedAndOutward(box, {}, true);
	for (const VShape* const pBox : {&box, &wire})
		for (const QVector3D& rPoint : Vectors(*pBox, 0))
			for (int axis = 0; axis < 3; ++axis)
				EXPECT_EQ(std::abs(rPoint[axis]), 0.5f);
	const std::vector<std::uint16_t> edges = Indices(wire);
	ASSERT_EQ(edges.size(), 24u);
	for (std::size_t i = 0; i < edges.size(); i += 2)
		EXPECT_EQ((Vectors(wire, 0)[edges[i]] - Vectors(wire, 0)[edges[i + 1]]).length(), 1.0f);
}

TEST(Shapes, SphereSharesItsVertices)
{
	// 7 and beyond give 6: 16-bit indices have no room for more.
	for (const std::uint32_t level : {0u, 1u, 2u, 3u, 6u, 7u, 4000000000u})
	{
		const VShape sphere = MakeSphere(level);
		const std::size_t faces = std::size_t{8} << (2 * std::min(level, 6u));
		EXPECT_EQ(sphere.m_Indices.Count(), 3 * faces) << level;
		EXPECT_EQ(sphere.m_Vertices.Count(), faces / 2 + 2) << level;
		EXPECT_EQ(sphere.m_Vertices.Format(), VVertexFormat::Format3D());
		if (level <= 3)
			ExpectClosedAndOutward(sphere, {}, true);
	}
}

TEST(Shapes, CylinderAndConeStandOnZ)
{
	for (const std::uint32_t sides : {3u, 16u})
	{
		for (const bool bCaps : {false, true})
		{
			SCOPED_TRACE(testing::Message() << sides << (bCaps ? " with caps" : ""));
			const VShape cylinder = MakeCylinder(sides, bCaps), cone = MakeCone(sides, bCaps);
			ExpectClosedAndOutward(cylinder, {0.0f, 0.0f, 0.5f}, bCaps);
			ExpectClosedAndOutward(cone, {0.0f, 0.0f, 0.25f}, bCaps);
			EXPECT_EQ(cylinder.m_Indices.Count(), 3 * sides * (bCaps ? 4 : 2));
			EXPECT_EQ(cone.m_Indices.Count(), 3 * sides * (bCaps ? 2 : 1));
			for (const QVector3D& rPoint : Vectors(cylinder, 0))
				EXPECT_TRUE(rPoint.z() == 0.0f || rPoint.z() == 1.0f);
			for (const QVector3D& rPoint : Vectors(cone, 0))
				EXPECT_NEAR(
				    rPoint.toVector2D().length(), rPoint.z() == 0.0f && rPoint != QVector3D() ? 1.0f : 0.0f, 1e-6f);
		}
	}
	EXPECT_EQ(MakeCylinder(0, false).m_Indices.Count(), 18u);
}
