#include "CoreGraphics/ShaderLibrary.h"
#include "FBXIO/FBXReader.h"

#include <QVector3D>

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstring>

using namespace CoreGraphics;

namespace
{

FBXIO::VBasicMesh ReadMesh(const std::string& i_rName)
{
	FBXIO::FBXReader reader;
	EXPECT_TRUE(reader.LoadFile(VShaderLibrary().GetResourceRoot() + "/Geometry/" + i_rName));
	EXPECT_TRUE(reader.IsComplete());
	EXPECT_FLOAT_EQ(reader.GetUnitScale(), 1.0f);
	FBXIO::VBasicMesh mesh;
	reader.ReadTopMesh(mesh);
	return mesh;
}

QVector3D Vector(const std::array<float, 3>& i_rValues)
{
	return {i_rValues[0], i_rValues[1], i_rValues[2]};
}

/// The triangles of the mesh's one part, three vertices each.
std::vector<FBXIO::VBasicVertex> Corners(const FBXIO::VBasicMesh& i_rMesh)
{
	std::vector<FBXIO::VBasicVertex> corners;
	EXPECT_EQ(i_rMesh.m_Parts.size(), 1u);
	for (const FBXIO::VMeshPart& rPart : i_rMesh.m_Parts)
	{
		EXPECT_EQ(rPart.m_IndexSize, 2u);
		std::vector<std::uint16_t> indices(rPart.m_Indices.size() / 2);
		std::memcpy(indices.data(), rPart.m_Indices.data(), rPart.m_Indices.size());
		for (const std::uint16_t index : indices)
			corners.push_back(i_rMesh.m_Vertices.at(index));
	}
	EXPECT_EQ(corners.size() % 3, 0u);
	return corners;
}

QVector3D FaceNormal(const FBXIO::VBasicVertex* i_pCorners)
{
	const QVector3D a = Vector(i_pCorners[0].m_Position);
	return QVector3D::normal(Vector(i_pCorners[1].m_Position) - a, Vector(i_pCorners[2].m_Position) - a);
}

} // namespace

TEST(Geometry, RingIsAThinTubeOfRadiusOne)
{
	const std::vector<FBXIO::VBasicVertex> corners = Corners(ReadMesh("ManipulatorRing.fbx"));
	ASSERT_FALSE(corners.empty());
	for (std::size_t i = 0; i < corners.size(); i += 3)
	{
		const QVector3D face = FaceNormal(&corners[i]);
		for (std::size_t corner = i; corner < i + 3; ++corner)
		{
			const QVector3D place = Vector(corners[corner].m_Position);
			const QVector3D onCircle = QVector3D(place.x(), place.y(), 0.0f).normalized();
			EXPECT_NEAR((place - onCircle).length(), 0.02f, 1e-5f);
			EXPECT_LT((Vector(corners[corner].m_Normal) - (place - onCircle).normalized()).length(), 1e-4f);
			EXPECT_GT(QVector3D::dotProduct(face, Vector(corners[corner].m_Normal)), 0.8f);
		}
	}
}

TEST(Geometry, BoneIsFlatSidedWithOneStripe)
{
	const std::vector<FBXIO::VBasicVertex> corners = Corners(ReadMesh("tetra_stripe.fbx"));
	ASSERT_FALSE(corners.empty());
	QVector3D low(9, 9, 9), high = -low;
	std::size_t stripes = 0;
	for (std::size_t i = 0; i < corners.size(); i += 3)
	{
		const QVector3D face = FaceNormal(&corners[i]);
		QVector3D middle;
		for (std::size_t corner = i; corner < i + 3; ++corner)
		{
			const QVector3D place = Vector(corners[corner].m_Position);
			middle += place / 3.0f;
			EXPECT_LT((Vector(corners[corner].m_Normal) - face).length(), 1e-5f);
			for (int axis = 0; axis < 3; ++axis)
			{
				low[axis] = std::min(low[axis], place[axis]);
				high[axis] = std::max(high[axis], place[axis]);
			}
		}
		EXPECT_GT(QVector3D::dotProduct(face, middle - QVector3D(0.0f, 0.0f, 0.15f)), 0.0f);
		// As the shader of bones tells the stripe.
		const bool bStripe = face.y() > 0.0f && std::abs(face.x()) < 0.1f;
		EXPECT_EQ(bStripe, middle.y() > 0.0f && std::abs(middle.x()) < 1e-4f);
		stripes += bStripe;
	}
	EXPECT_EQ(stripes, 2u);
	EXPECT_FLOAT_EQ(low.z(), 0.0f);
	EXPECT_FLOAT_EQ(high.z(), 1.0f);
	EXPECT_LE(std::max({-low.x(), high.x(), -low.y(), high.y()}), 0.1f + 1e-6f);
}
