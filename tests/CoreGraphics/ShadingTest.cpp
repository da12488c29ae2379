#include "DrawingFixture.h"

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Texture.h"

#include <QColor>
#include <QImage>
#include <QOpenGLFramebufferObject>

#include <array>
#include <cmath>

using namespace CoreGraphics;

namespace
{

/// One pixel of a square before an eye that looks along -Z from the origin.
class Shading : public GraphicsTest::VDrawingTest
{
protected:
	Shading() : VDrawingTest(QSize(1, 1)) {}

	void SetUp() override
	{
		ASSERT_NO_FATAL_FAILURE(VDrawingTest::SetUp());
		m_Render.m_Projection.ortho(-1, 1, -1, 1, 1, 10);
		m_Render.SetYUp(true);
	}

	bool Use(const char* i_pVertex, const char* i_pFragment)
	{
		return m_Render.UseProgram(m_Library.GetProgram(i_pVertex, i_pFragment));
	}

	template <typename T>
	void Set(const char* i_pName, const T& i_rValue)
	{
		VUniform uniform(i_pName);
		m_Render.SetUniform(uniform, i_rValue);
	}

	/// Red, green, blue and alpha, as parts of 1.
	std::array<float, 4> Draw(const QVector3D& i_rNormal)
	{
		std::vector<float> floats;
		for (const auto& [x, y] : {std::pair(-1.0f, -1.0f), {1.0f, -1.0f}, {-1.0f, 1.0f}, {1.0f, 1.0f}})
			floats.insert(floats.end(), {x, y, -5.0f, i_rNormal.x(), i_rNormal.y(), i_rNormal.z(), 0.5f, 0.5f});
		VVertexBuffer quad(VVertexFormat::Mesh(), BytesOf(floats));
		m_Render.ClearBuffers(true, false);
		m_Render.BindVertices(quad);
		m_Render.DrawArrays(GL_TRIANGLE_STRIP, 4);
		std::vector<std::uint8_t> bytes;
		m_Render.ReadPixels(QRect(0, 0, 1, 1), bytes);
		return {bytes[0] / 255.0f, bytes[1] / 255.0f, bytes[2] / 255.0f, bytes[3] / 255.0f};
	}

	void ExpectColour(const QVector3D& i_rNormal, const QVector4D& i_rExpected)
	{
		const std::array<float, 4> colour = Draw(i_rNormal);
		for (int channel = 0; channel < 4; ++channel)
			EXPECT_NEAR(colour[static_cast<std::size_t>(channel)], i_rExpected[channel], 0.008f)
			    << "channel " << channel;
	}
};
INSTANTIATE_IN_BOTH_DIALECTS(Shading);

} // namespace

TEST_P(Shading, LightsComeFromTheTopTheEyeAndTheFloor)
{
	struct VRow
	{
		const char* m_pFragment;
		QVector3D m_Normal;
		/// Of the colour (0.4, 0.2, 0.1).
		float m_Light;
		float m_Alpha;
	};
	const QVector3D toEye(0, 0, 1), up(0, 1, 0), between(0, 0.6f, 0.8f);
	const VRow rows[] = {{"SimpleLighting", toEye, 0.7f, 1}, {"SimpleLighting", up, 1.0f, 1},
	    {"SimpleLighting", -up, 0.4f, 1}, {"SimpleLighting", -toEye, 0.2f, 1},
	    {"SimpleLighting", between, 0.4f + 0.48f + 0.2f, 1}, {"SimpleLighting", 7 * between, 1.08f, 1},
	    {"Covariance", toEye, 1.5f, 1}, {"Covariance", up, 0.7f, 1}, {"Covariance", -up, 0.7f, 1},
	    {"Covariance", -toEye, 0.5f, 1}, {"MissingMarker", toEye, 1.0f, 0.5f}, {"MissingMarker", between, 1.0f, 0.3f},
	    {"MissingMarker", up, 1.0f, 0.0f}, {"Colour", between, 1.0f, 1}};
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(testing::Message() << rRow.m_pFragment << rRow.m_Normal.y());
		ASSERT_TRUE(Use("Simple3DModelColour", rRow.m_pFragment));
		Set("u_ModelTransform", QMatrix4x4());
		Set("u_ModelColour", QVector4D(0.4f, 0.2f, 0.1f, 1.0f));
		ExpectColour(
		    rRow.m_Normal, QVector4D(0.4f * rRow.m_Light, 0.2f * rRow.m_Light, 0.1f * rRow.m_Light, rRow.m_Alpha));
	}
}

TEST_P(Shading, NormalsStandOnStretchedAndTurnedFaces)
{
	ASSERT_TRUE(Use("Simple3DModelColour", "SimpleLighting"));
	Set("u_ModelColour", QVector4D(0.5f, 0.5f, 0.5f, 1.0f));
	// Twice as high: the normal leans to the eye. (0, 0.3, 0.8), of length 0.8544.
	QMatrix4x4 model;
	model.scale(1.0f, 2.0f, 1.0f);
	Set("u_ModelTransform", model);
	const float light = 0.5f * (0.8f / 0.8544f * 0.5f + 0.3f / 0.8544f * 0.8f + 0.2f);
	ExpectColour(QVector3D(0, 0.6f, 0.8f), QVector4D(light, light, light, 1.0f));
	// A quarter turn about X: what looked up looks at the eye.
	model.setToIdentity();
	model.translate(0, 0, -5);
	model.rotate(90, 1, 0, 0);
	model.scale(1.0f, 1.0f, 3.0f);
	Set("u_ModelTransform", model);
	std::vector<float> floats;
	for (const auto& [x, z] : {std::pair(-1.0f, -1.0f), {-1.0f, 1.0f}, {1.0f, -1.0f}, {1.0f, 1.0f}})
		floats.insert(floats.end(), {x, 0.0f, z, 0.0f, 1.0f, 0.0f});
	VVertexBuffer floor(VVertexFormat::PositionNormal(), BytesOf(floats));
	m_Render.BindVertices(floor);
	m_Render.DrawArrays(GL_TRIANGLE_STRIP, 4);
	std::vector<std::uint8_t> bytes;
	m_Render.ReadPixels(QRect(0, 0, 1, 1), bytes);
	EXPECT_NEAR(bytes[0], 255 * 0.5 * 0.7, 2);
}

TEST_P(Shading, BonesHaveAStripe)
{
	ASSERT_TRUE(Use("Segment", "Segment"));
	// The stripe is told in the bone's own space: this one lies on its back.
	QMatrix4x4 model;
	model.translate(0, 0, -10);
	model.rotate(180, 0, 1, 0);
	Set("u_ModelTransform", model);
	Set("u_SegmentColour", QVector4D(0.8f, 0.8f, 0.8f, 1.0f));
	const float lit = 0.8f * (0.48f + 0.2f);
	ExpectColour(QVector3D(0.0f, 0.6f, 0.8f), QVector4D(0.67f * lit, 0.67f * lit, 0.67f * lit, 1.0f));
	ExpectColour(QVector3D(0.8f, 0.6f, 0.0f), QVector4D(lit, lit, lit, 1.0f));
	const float below = 0.8f * (0.6f * 0.2f + 0.2f);
	ExpectColour(QVector3D(0.0f, -0.6f, 0.8f), QVector4D(below, below, below, 1.0f));
}

TEST_P(Shading, MaterialsMixTheirColourWithTheSubjects)
{
	struct VRow
	{
		const char* m_pName;
		QVector3D m_Normal;
		float m_Alpha;
		QVector4D m_UserA;
		QVector4D m_Emissive;
		bool m_bTexture;
		QVector4D m_Expected;
	};
	const QVector3D toEye(0, 0, 1), up(0, 1, 0);
	const QVector4D none, red(1, 0, 0, 0.5f), blue(0, 0, 1, 1);
	const VRow rows[] = {// (0.5, 0.25, 1) with the factor 0.8, in the light of 0.7.
	    {"plain", toEye, 1, none, none, false, {0.28f, 0.14f, 0.56f, 1}},
	    {"edge", up, 1, none, none, false, {0.65f, 0.45f, 1.0f, 1}},
	    {"glowing", toEye, 1, none, {0.5f, 0, 0, 0.4f}, false, {0.48f, 0.14f, 0.56f, 1}},
	    {"half red", toEye, 1, red, none, false, {0.49f, 0.07f, 0.28f, 1}},
	    {"not quite opaque", toEye, 0.5f, red, none, false, {0.28f, 0.14f, 0.56f, 0.5f}},
	    // A texel (1, 0.5, 0) of alpha 0.25 takes three quarters of red and one of blue: (0.75, 0, 0.25), covering
	    // 0.625.
	    {"texture", toEye, 1, none, none, true, {0.7f * (0.75f + 0.0f * 0.25f), 0.7f * 0.375f, 0.7f * 0.0625f, 1}},
	    {"texture and red", toEye, 1, red, none, true,
	        {0.7f * (0.375f + 0.625f * 0.75f), 0.7f * 0.1875f, 0.7f * 0.15625f, 1}}};
	QImage image(1, 1, QImage::Format_RGBA8888);
	image.setPixelColor(0, 0, QColor(255, 128, 0, 64));
	const auto pTexture = VTexture::FromImage(image);
	ASSERT_TRUE(Use("FBXMesh", "FBXMaterial"));
	pTexture->Bind(m_Render, 0, {});
	Set("u_ModelTransform", QMatrix4x4());
	Set("t_DiffuseTexture", 0);
	Set("u_DiffuseColour", QVector4D(0.5f, 0.25f, 1.0f, 0.8f));
	Set("u_Shininess", 10.0f);
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		Set("u_DiffuseTextureEnabled", rRow.m_bTexture ? 1 : 0);
		Set("u_SpecularColour", none);
		Set("u_EmissiveColour", rRow.m_Emissive);
		Set("u_UserColourA", rRow.m_UserA);
		Set("u_UserColourB", blue);
		Set("u_Alpha", rRow.m_Alpha);
		ExpectColour(rRow.m_Normal, rRow.m_Expected);
	}

	// A mirror that shows the light: the normal is halfway between it and the eye.
	m_Render.m_LightVector = up;
	ASSERT_TRUE(Use("FBXMesh", "FBXMaterial"));
	Set("u_DiffuseTextureEnabled", 0);
	Set("u_DiffuseColour", none);
	Set("u_EmissiveColour", none);
	Set("u_UserColourA", none);
	Set("u_Alpha", 1.0f);
	Set("u_SpecularColour", QVector4D(1.0f, 0.5f, 0.0f, 0.6f));
	const float rim = std::pow(1.0f - 0.70710678f, 4.0f) * 0.25f;
	ExpectColour(QVector3D(0, 0.70710678f, 0.70710678f), QVector4D(0.6f + rim, 0.3f + rim, rim, 1.0f));
	ExpectColour(toEye, QVector4D(0, 0, 0, 1));

	// Seen from above the eye's light would double the top's.
	m_Render.SetYUp(false);
	ASSERT_TRUE(Use("FBXMesh", "FBXMaterial"));
	Set("u_SpecularColour", none);
	Set("u_DiffuseColour", QVector4D(0.5f, 0.25f, 0.5f, 1.0f));
	ExpectColour(toEye, QVector4D(0.5f, 0.25f, 0.5f, 1.0f));
}

TEST_P(Shading, XRayShowsEdges)
{
	ASSERT_TRUE(Use("FBXSkin", "XRay"));
	VUniform transforms("u_BoneTransforms");
	// Without bones in the vertices the fourth influence is all of bone 1.
	std::vector<float> bones(32);
	for (const std::size_t one : {0u, 5u, 10u, 15u})
		bones[one] = bones[16 + one] = 1.0f;
	m_Render.SetUniform(transforms, bones.data(), 2);
	Set("u_HighlightMissing", 0);
	Set("u_DiffuseTextureEnabled", 0);
	Set("u_DiffuseColour", QVector4D(1.0f, 0.5f, 0.0f, 1.0f));
	ExpectColour(QVector3D(0, 0, 1), QVector4D(1, 1, 1, 1.25f * 0.03f));
	ExpectColour(QVector3D(0, 1, 0), QVector4D(1, 1, 1, 0.25f + 1.25f * 0.03f));
}

TEST_P(Shading, SelectionWritesTheId)
{
	ASSERT_TRUE(Use("Simple3DModelColour", "Selection"));
	Set("u_ModelTransform", QMatrix4x4());
	Set("u_SelectionId", QVector3D(1 / 255.0f, 128 / 255.0f, 255 / 255.0f));
	ExpectColour(QVector3D(0, 0, 1), QVector4D(1 / 255.0f, 128 / 255.0f, 1.0f, 1 / 255.0f));
}
