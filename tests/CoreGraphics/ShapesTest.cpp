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

template <typename T>
std::vector<T> As(const std::vector<std::uint8_t>& i_rBytes)
{
	std::vector<T> values(i_rBytes.size() / sizeof(T));
	std::memcpy(values.data(), i_rBytes.data(), i_rBytes.size());
	return values;
}

std::vector<std::uint16_t> Indices(const VShape& i_rShape)
{
	return As<std::uint16_t>(i_rShape.m_Indices.Bytes());
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

TEST(Shapes, AxesAreThreeColouredLines)
{
	const VShape axes = MakeAxes(100.0f);
	EXPECT_EQ(axes.m_Vertices.Format(), VVertexFormat::PositionColour());
	ASSERT_EQ(axes.m_Vertices.Count(), 6u);
	EXPECT_EQ(Indices(axes), (std::vector<std::uint16_t>{0, 1, 2, 3, 4, 5}));
	const std::vector<QVector3D> positions = Vectors(axes, 0);
	const std::uint8_t colours[3][4] = {{255, 0, 0, 255}, {0, 255, 0, 255}, {0, 0, 255, 255}};
	for (std::size_t axis = 0; axis < 3; ++axis)
	{
		QVector3D end;
		end[int(axis)] = 100.0f;
		EXPECT_EQ(positions[2 * axis], QVector3D());
		EXPECT_EQ(positions[2 * axis + 1], end);
		for (std::size_t vertex = 2 * axis; vertex < 2 * axis + 2; ++vertex)
			EXPECT_EQ(std::memcmp(axes.m_Vertices.Bytes().data() + 16 * vertex + 12, colours[axis], 4), 0);
	}
}

TEST(Shapes, BoxIsTheUnitCube)
{
	const VShape box = MakeBox(false);
	EXPECT_EQ(box.m_Vertices.Count(), 24u);
	const std::vector<std::uint16_t> indices = Indices(box);
	ASSERT_EQ(indices.size(), 36u);
	const std::uint16_t pattern[] = {0, 2, 1, 0, 3, 2};
	for (std::size_t i = 0; i < indices.size(); ++i)
		EXPECT_EQ(indices[i], 4 * (i / 6) + pattern[i % 6]);
	ExpectClosedAndOutward(box, {}, true);
	for (const QVector3D& rPoint : Vectors(box, 0))
	{
		for (int axis = 0; axis < 3; ++axis)
			EXPECT_EQ(std::abs(rPoint[axis]), 0.5f);
	}
}

TEST(Shapes, WireBoxHasTwelveEdgesOfLengthOne)
{
	const VShape box = MakeBox(true);
	EXPECT_EQ(Indices(box),
	    (std::vector<std::uint16_t>{0, 1, 1, 2, 2, 3, 3, 0, 4, 5, 5, 6, 6, 7, 7, 4, 0, 4, 1, 5, 2, 6, 3, 7}));
	const std::vector<QVector3D> positions = Vectors(box, 0), normals = Vectors(box, 1);
	ASSERT_EQ(positions.size(), 8u);
	for (std::size_t i = 0; i < 24; i += 2)
		EXPECT_EQ((positions[Indices(box)[i]] - positions[Indices(box)[i + 1]]).length(), 1.0f);
	for (std::size_t i = 0; i < 8; ++i)
		EXPECT_LT((normals[i] - positions[i] / std::sqrt(0.75f)).length(), 1e-6f);
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
	EXPECT_EQ(Vectors(MakeSphere(0), 0),
	    (std::vector<QVector3D>{{0, 1, 0}, {0, 0, -1}, {-1, 0, 0}, {0, 0, 1}, {1, 0, 0}, {0, -1, 0}}));
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
