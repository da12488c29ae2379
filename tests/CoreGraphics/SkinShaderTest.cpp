#include "DrawingFixture.h"

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/ShaderProgram.h"
#include "FBXIO/Mesh.h"

#include <QColor>
#include <QOpenGLFramebufferObject>

#include <cmath>

using namespace CoreGraphics;

namespace
{

constexpr int c_Width = 64;
constexpr std::size_t c_Bones = 250;

/// A column of the picture that a square two pixels wide was drawn to, and its colour.
struct VDrawn
{
	int m_Column = -1;
	std::vector<int> m_Colour;
};

class SkinShader : public GraphicsTest::VDrawingTest
{
protected:
	SkinShader() : VDrawingTest(QSize(c_Width, 2)) {}

	void SetUp() override
	{
		ASSERT_NO_FATAL_FAILURE(VDrawingTest::SetUp());
		m_Render.SetClearColour(Qt::black);
		// One unit is a pixel, and the origin lies at the left edge.
		m_Render.m_Projection.ortho(0, c_Width, -1, 1, -10, 10);
	}

	/// A square about the origin, all of whose vertices have these bones.
	VDrawn Draw(
	    const std::array<std::uint8_t, 4>& i_rIndices, const std::array<std::uint8_t, 4>& i_rWeights, bool i_bHealth)
	{
		std::vector<FBXIO::VSkinVertex> vertices(4);
		for (std::size_t i = 0; i < 4; ++i)
		{
			vertices[i].m_Position = {i % 2 ? 1.0f : -1.0f, i / 2 ? 1.0f : -1.0f, 0.0f};
			vertices[i].m_Normal = {0.0f, 0.0f, 1.0f};
			vertices[i].m_BoneIndices = i_rIndices;
			vertices[i].m_BoneWeights = i_rWeights;
		}
		VVertexBuffer buffer(VVertexFormat::Skin(), BytesOf(vertices));
		VUniform bones("u_BoneTransforms"), highlight("u_HighlightMissing");
		m_Render.ClearBuffers(true, true);
		EXPECT_TRUE(m_Render.UseProgram(m_Library.GetProgram("FBXSkin", "Colour")));
		std::vector<float> columns;
		for (const QMatrix4x4& rBone : m_Bones)
			columns.insert(columns.end(), rBone.constData(), rBone.constData() + 16);
		m_Render.SetUniform(bones, columns.data(), m_Bones.size());
		m_Render.SetUniform(highlight, i_bHealth ? 1 : 0);
		m_Render.BindVertices(buffer);
		m_Render.DrawArrays(GL_TRIANGLE_STRIP, 4);
		std::vector<std::uint8_t> bytes;
		m_Render.ReadPixels(QRect(0, 1, c_Width, 1), bytes);
		VDrawn drawn;
		for (int column = 0; column < c_Width && drawn.m_Column < 0; ++column)
		{
			if (const auto first = bytes.begin() + 4 * column; *first != 0)
				drawn = {column, {first, first + 3}};
		}
		return drawn;
	}

	std::vector<QMatrix4x4> m_Bones = std::vector<QMatrix4x4>(c_Bones);
};
INSTANTIATE_IN_BOTH_DIALECTS(SkinShader);

} // namespace

TEST_P(SkinShader, BonesMoveVertices)
{
	m_Bones[0].translate(10, 0, 0);
	m_Bones[1].translate(20, 0, 0);
	m_Bones[2].translate(40, 0, 0);
	m_Bones[249].translate(60, 0, 0);
	struct VRow
	{
		const char* m_pName;
		std::array<std::uint8_t, 4> m_Indices;
		std::array<std::uint8_t, 4> m_Weights;
		/// Of the square's middle.
		int m_Place;
	};
	const VRow rows[] = {{"one bone", {1, 0, 0, 0}, {255, 0, 0, 0}, 20},
	    {"the last influence", {0, 0, 0, 2}, {0, 0, 0, 255}, 40}, {"two bones", {1, 2, 0, 0}, {128, 127, 0, 0}, 30},
	    {"no weight goes with the first bone", {2, 2, 2, 2}, {0, 0, 0, 0}, 10},
	    {"weights below 1", {2, 0, 0, 0}, {200, 0, 0, 0}, 40}, {"bone 249", {249, 0, 0, 0}, {255, 0, 0, 0}, 60},
	    {"beyond the last bone", {255, 250, 0, 0}, {128, 127, 0, 0}, 60}};
	for (const VRow& rRow : rows)
		EXPECT_EQ(Draw(rRow.m_Indices, rRow.m_Weights, false).m_Column, rRow.m_Place - 1) << rRow.m_pName;
}

TEST_P(SkinShader, HealthFadesToRedAndMovesNothing)
{
	for (QMatrix4x4& rBone : m_Bones)
		rBone.translate(10, 0, 0);
	m_Bones[1](3, 3) = 0.0f;
	m_Bones[2](3, 3) = 0.5f;
	struct VRow
	{
		std::array<std::uint8_t, 4> m_Indices;
		std::array<std::uint8_t, 4> m_Weights;
		int m_Green;
	};
	const VRow rows[] = {{{0, 0, 0, 0}, {255, 0, 0, 0}, 255}, {{1, 0, 0, 0}, {255, 0, 0, 0}, 0},
	    {{2, 0, 0, 0}, {255, 0, 0, 0}, 128}, {{0, 1, 0, 0}, {204, 51, 0, 0}, 204},
	    {{1, 2, 0, 0}, {51, 204, 0, 0}, 102}};
	for (const VRow& rRow : rows)
	{
		for (const bool bHealth : {true, false})
		{
			const VDrawn drawn = Draw(rRow.m_Indices, rRow.m_Weights, bHealth);
			EXPECT_EQ(drawn.m_Column, 9);
			ASSERT_EQ(drawn.m_Colour.size(), 3u);
			EXPECT_EQ(drawn.m_Colour[0], 255);
			EXPECT_NEAR(drawn.m_Colour[1], bHealth ? rRow.m_Green : 255, 1);
			EXPECT_EQ(drawn.m_Colour[2], drawn.m_Colour[1]);
		}
	}
}
