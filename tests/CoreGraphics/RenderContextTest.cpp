#include "DrawingFixture.h"

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/SelectionId.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/ShaderProgram.h"
#include "CoreGraphics/Shapes.h"
#include "CoreGraphics/Texture.h"

#include <QColor>
#include <QDir>
#include <QFile>
#include <QImage>
#include <QOpenGLExtraFunctions>
#include <QOpenGLFramebufferObject>
#include <QOpenGLShaderProgram>
#include <QTemporaryDir>

#include <cstddef>

using namespace CoreGraphics;
using GraphicsTest::EDialect;

namespace
{

constexpr int c_Side = 16;

class RenderContext : public GraphicsTest::VDrawingTest
{
protected:
	RenderContext() : VDrawingTest(QSize(c_Side, c_Side)) {}

	QOpenGLFunctions& GL() { return m_Context.GL(); }

	int Integer(GLenum i_Name)
	{
		GLint value = -1;
		GL().glGetIntegerv(i_Name, &value);
		return value;
	}

	std::vector<int> Pixel(int i_X, int i_Y)
	{
		std::vector<std::uint8_t> bytes;
		m_Render.ReadPixels(QRect(i_X, i_Y, 1, 1), bytes);
		return {bytes.begin(), bytes.end()};
	}
};
INSTANTIATE_IN_BOTH_DIALECTS(RenderContext);

} // namespace

TEST(VertexFormat, LiesAsTheVerticesDo)
{
	EXPECT_EQ(offsetof(VVertexFormat::VEntry, m_Attribute), 0u);
	EXPECT_EQ(offsetof(VVertexFormat::VEntry, m_Components), 1u);
	EXPECT_EQ(offsetof(VVertexFormat::VEntry, m_Normalised), 2u);
	EXPECT_EQ(offsetof(VVertexFormat::VEntry, m_Type), 4u);
	EXPECT_EQ(offsetof(VVertexFormat::VEntry, m_Offset), 8u);
	struct VRow
	{
		const VVertexFormat& m_rFormat;
		std::vector<VVertexFormat::VEntry> m_Entries;
		std::uint32_t m_Stride;
	};
	const VVertexFormat::VEntry position{EAttributePosition, 3, 0, GL_FLOAT, 0},
	    normal{EAttributeNormal, 3, 0, GL_FLOAT, 12}, uv{EAttributeUV, 2, 0, GL_FLOAT, 24};
	const VRow rows[] = {{VVertexFormat::Format2D(), {{EAttributePosition, 2, 0, GL_FLOAT, 0}}, 8},
	    {VVertexFormat::Format3D(), {position}, 12},
	    {VVertexFormat::PositionColour(), {position, {EAttributeColour, 4, 1, GL_UNSIGNED_BYTE, 12}}, 16},
	    {VVertexFormat::PositionNormal(), {position, normal}, 24}, {VVertexFormat::Mesh(), {position, normal, uv}, 32},
	    {VVertexFormat::Skin(),
	        {position, normal, uv, {EAttributeBoneIndices, 4, 0, GL_UNSIGNED_BYTE, 32},
	            {EAttributeBoneWeights, 4, 1, GL_UNSIGNED_BYTE, 36}},
	        40}};
	for (const VRow& rRow : rows)
	{
		EXPECT_EQ(rRow.m_rFormat.m_Entries, rRow.m_Entries);
		EXPECT_EQ(rRow.m_rFormat.m_Stride, rRow.m_Stride);
	}
}

TEST(SelectionId, IsAColour)
{
	const VSelectionId id = MakeSelectionId(0x5a0201);
	EXPECT_FLOAT_EQ(id.m_Red, 1 / 255.0f);
	EXPECT_FLOAT_EQ(id.m_Green, 2 / 255.0f);
	EXPECT_FLOAT_EQ(id.m_Blue, 0x5a / 255.0f);
	EXPECT_EQ(id.m_Id, 0x5a0201u);
	EXPECT_EQ(offsetof(VSelectionId, m_Id), 12u);
	EXPECT_EQ(MakeSelectionId(0xff000001).m_Blue, 0.0f);
}

TEST(RenderState, SelectionOverwritesAndTestsDepth)
{
	EXPECT_EQ(VRenderState().m_BlendConstant, 1.0f);
	EXPECT_FALSE(VRenderState().m_bDepthTest);
	EXPECT_TRUE(VRenderState().m_bDepthWrite);
	EXPECT_TRUE(VRenderState().m_bColourWrite);
	EXPECT_FALSE(VRenderState().m_bAlphaWrite);

	const VRenderState from{
	    EColourBlendAdd, EAlphaBlendReplace, ECullBack, EDepthGreater, 0.25f, false, false, false, true};
	const VRenderState expected{
	    EColourBlendOff, EAlphaBlendAdd, ECullBack, EDepthLessEqual, 1.0f, true, true, true, false};
	EXPECT_EQ(MakeSelectionState(from), expected);
}

TEST_P(RenderContext, InitialiseSetsTheClearColour)
{
	m_Render.ClearBuffers(true, true);
	EXPECT_EQ(Pixel(3, 3), (std::vector<int>{25, 25, 25, 255}));
}

TEST_P(RenderContext, ResetStateUndoesWhatOthersLeft)
{
	VShape box = MakeBox(false);
	m_Render.UseProgram(m_Library.GetProgram("Simple3DModelColour", "SimpleLighting"));
	m_Render.BindVertices(box.m_Vertices);
	box.m_Indices.Bind();
	EXPECT_NE(Integer(GL_ARRAY_BUFFER_BINDING), 0);
	GLuint texture = 0;
	GL().glGenTextures(1, &texture);
	GL().glBindTexture(GL_TEXTURE_2D, texture);
	GL().glActiveTexture(GL_TEXTURE3);
	GL().glEnableVertexAttribArray(7);
	for (const GLenum capability : {GL_CULL_FACE, GL_BLEND, GL_DEPTH_TEST})
		GL().glEnable(capability);
	GL().glColorMask(GL_FALSE, GL_TRUE, GL_FALSE, GL_FALSE);
	GL().glDepthMask(GL_FALSE);
	GL().glCullFace(GL_FRONT);

	m_Render.ResetState();
	for (GLuint array = 0; array < 8; ++array)
	{
		GLint enabled = -1;
		GL().glGetVertexAttribiv(array, GL_VERTEX_ATTRIB_ARRAY_ENABLED, &enabled);
		EXPECT_EQ(enabled, 0) << array;
	}
	EXPECT_TRUE(m_Render.m_EnabledAttributes.none());
	EXPECT_EQ(Integer(GL_ARRAY_BUFFER_BINDING), 0);
	EXPECT_EQ(Integer(GL_ELEMENT_ARRAY_BUFFER_BINDING), 0);
	EXPECT_EQ(Integer(GL_CURRENT_PROGRAM), 0);
	EXPECT_FALSE(m_Render.m_pProgram);
	for (const GLenum capability : {GL_CULL_FACE, GL_BLEND, GL_DEPTH_TEST})
		EXPECT_FALSE(GL().glIsEnabled(capability));
	GLboolean mask[4] = {};
	GL().glGetBooleanv(GL_COLOR_WRITEMASK, mask);
	EXPECT_TRUE(mask[0] && mask[1] && mask[2] && mask[3]);
	EXPECT_EQ(Integer(GL_DEPTH_WRITEMASK), GL_TRUE);
	EXPECT_EQ(Integer(GL_CULL_FACE_MODE), GL_BACK);
	EXPECT_EQ(Integer(GL_ACTIVE_TEXTURE), GL_TEXTURE0);
	EXPECT_EQ(Integer(GL_TEXTURE_BINDING_2D), 0);
	if (GetParam() == EDialect::Desktop)
	{
		// Points of a shader's size, as sprites, without smoothing.
		EXPECT_TRUE(GL().glIsEnabled(0x8642));
		EXPECT_TRUE(GL().glIsEnabled(0x8861));
		EXPECT_FALSE(GL().glIsEnabled(0x0B10));
	}
	GL().glDeleteTextures(1, &texture);
}

TEST_P(RenderContext, ApplyStateSetsWhatTheNumbersSay)
{
	const int keep[] = {GL_ZERO, GL_ONE};
	const int colour[][2] = {{GL_ONE, GL_ZERO}, {GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA}, {GL_SRC_ALPHA, GL_ONE},
	    {GL_CONSTANT_ALPHA, GL_ONE}, {GL_ONE, GL_ONE_MINUS_SRC_ALPHA}};
	const int alpha[][2] = {{keep[0], keep[1]}, {GL_ONE, GL_ONE}, {GL_ONE, GL_ZERO}, {GL_ONE, GL_ZERO}};
	for (std::uint32_t colourMode = 0; colourMode < 5; ++colourMode)
	{
		for (std::uint32_t alphaMode = 0; alphaMode < 4; ++alphaMode)
		{
			SCOPED_TRACE(testing::Message() << colourMode << ", " << alphaMode);
			VRenderState state;
			state.m_ColourBlend = colourMode;
			state.m_AlphaBlend = alphaMode;
			state.m_BlendConstant = 0.25f;
			m_Render.ApplyState(state);
			EXPECT_EQ(GL().glIsEnabled(GL_BLEND) == GL_TRUE, colourMode != 0 || alphaMode != 0);
			if (colourMode == 0 && alphaMode == 0)
				continue;
			EXPECT_EQ(Integer(GL_BLEND_SRC_RGB), colour[colourMode][0]);
			EXPECT_EQ(Integer(GL_BLEND_DST_RGB), colour[colourMode][1]);
			EXPECT_EQ(Integer(GL_BLEND_SRC_ALPHA), alpha[alphaMode][0]);
			EXPECT_EQ(Integer(GL_BLEND_DST_ALPHA), alpha[alphaMode][1]);
			if (colourMode != 3)
				continue;
			float constant[4] = {};
			GL().glGetFloatv(GL_BLEND_COLOR, constant);
			for (const float channel : constant)
				EXPECT_NEAR(channel, 0.25f, 1e-6f);
		}
	}
	const int functions[] = {GL_LESS, GL_LEQUAL, GL_GREATER, GL_GEQUAL, GL_NOTEQUAL, GL_EQUAL};
	for (std::uint32_t mode = 0; mode < 6; ++mode)
	{
		VRenderState state;
		state.m_DepthFunction = mode;
		state.m_Cull = mode;
		state.m_bDepthTest = mode % 2;
		state.m_bDepthWrite = mode % 3;
		state.m_bColourWrite = mode != 2;
		state.m_bAlphaWrite = mode == 4;
		m_Render.ApplyState(state);
		EXPECT_EQ(Integer(GL_DEPTH_FUNC), functions[mode]);
		EXPECT_EQ(GL().glIsEnabled(GL_CULL_FACE) == GL_TRUE, mode != 0);
		EXPECT_TRUE(mode == 0 || Integer(GL_CULL_FACE_MODE) == (mode == 1 ? GL_FRONT : GL_BACK));
		EXPECT_EQ(GL().glIsEnabled(GL_DEPTH_TEST) == GL_TRUE, mode % 2 == 1);
		EXPECT_EQ(Integer(GL_DEPTH_WRITEMASK) == GL_TRUE, mode % 3 != 0);
		GLboolean mask[4] = {};
		GL().glGetBooleanv(GL_COLOR_WRITEMASK, mask);
		for (int channel = 0; channel < 4; ++channel)
			EXPECT_EQ(mask[channel] == GL_TRUE, channel < 3 ? mode != 2 : mode == 4);
	}
	// Numbers beyond the table change nothing that they should not.
	VRenderState wild{99, 99, 99, 99, 1.0f, true, true, true, true};
	m_Render.ApplyState(wild);
	EXPECT_EQ(Integer(GL_DEPTH_FUNC), GL_LESS);
}

TEST_P(RenderContext, UseProgramWritesTheStandardUniformsOnce)
{
	QTemporaryDir folder;
	QDir(folder.path()).mkdir("FragmentShaders");
	QFile file(folder.filePath("FragmentShaders/All.glsl"));
	ASSERT_TRUE(file.open(QIODevice::WriteOnly));
	file.write("uniform mat4 u_ViewProjection, u_View, u_Projection;\nuniform vec4 u_View2D;\n"
	           "uniform vec2 u_ViewportSize, u_ViewportOffset, u_FrameSize, u_RadialDistortionCentre, u_SensorSize;\n"
	           "uniform vec3 u_LightVector, u_Up, u_CameraPosition, u_RadialDistortionParameters;\n"
	           "uniform float u_GlobalTime;\nvoid main() { gl_FragColor = (u_ViewProjection + u_View + u_Projection)\n"
	           "* u_View2D + vec4(u_ViewportSize + u_ViewportOffset + u_FrameSize + u_RadialDistortionCentre +\n"
	           "u_SensorSize, 0.0, u_GlobalTime) + vec4(u_LightVector + u_Up + u_CameraPosition +\n"
	           "u_RadialDistortionParameters, 0.0); }\n");
	file.close();
	VShaderLibrary library({true, {folder.path().toStdString()}, {}});
	library.InitialiseGL();
	const auto pProgram = library.GetProgram("Simple", "All");
	ASSERT_TRUE(pProgram && !pProgram->IsEmpty());

	// A quarter turn about Z, seen from (0, 0, 10): products that are known without multiplying.
	m_Render.m_View = QMatrix4x4(0, 1, 0, 0, -1, 0, 0, 0, 0, 0, 1, -10, 0, 0, 0, 1);
	m_Render.m_Projection = QMatrix4x4(2, 0, 0, 0, 0, 3, 0, 0, 0, 0, -1, -1, 0, 0, -1, 0);
	m_Render.m_View2D = QVector4D(1, 2, 3, 4);
	m_Render.SetViewport(QRect(3, 5, 7, 11));
	m_Render.m_FrameSize = QSize(13, 17);
	m_Render.m_LightVector = QVector3D(1, 2, 3);
	m_Render.SetYUp(true);
	m_Render.m_GlobalTime = 42.5f;
	m_Render.m_Distortion = {QVector2D(21, 22), QVector3D(23, 24, 25), QVector2D(26, 27)};
	ASSERT_TRUE(m_Render.UseProgram(pProgram));
	EXPECT_EQ(m_Render.m_pProgram, pProgram);
	// Nothing is written before the next use.
	m_Render.m_GlobalTime = 1.0f;

	const std::vector<std::vector<float>> expected = {{0, -3, 0, 0, 2, 0, 0, 0, 0, 0, -1, -1, 0, 0, 9, 10},
	    {0, -1, 0, 0, 1, 0, 0, 0, 0, 0, 1, 0, 0, 0, -10, 1}, {2, 0, 0, 0, 0, 3, 0, 0, 0, 0, -1, -1, 0, 0, -1, 0},
	    {1, 2, 3, 4}, {7, 11}, {3, 5}, {13, 17}, {1, 2, 3}, {0, 1, 0}, {42.5f}, {0, 0, 10}, {21, 22}, {23, 24, 25},
	    {26, 27}};
	ASSERT_EQ(expected.size(), std::size_t{EStandardUniformCount});
	for (std::size_t uniform = 0; uniform < EStandardUniformCount; ++uniform)
	{
		const int location = pProgram->UniformLocation(static_cast<EStandardUniform>(uniform));
		ASSERT_NE(location, -1) << c_StandardUniformNames[uniform];
		std::vector<float> value(16);
		GL().glGetUniformfv(pProgram->Get()->programId(), location, value.data());
		value.resize(expected[uniform].size());
		EXPECT_EQ(value, expected[uniform]) << c_StandardUniformNames[uniform];
	}
	m_Render.SetYUp(false);
	EXPECT_EQ(m_Render.m_Up, QVector3D(0, 0, 1));
}

TEST_P(RenderContext, SetVertexFormatEnablesWhatTheProgramHas)
{
	m_Render.UseProgram(m_Library.GetProgram("Simple3DModelColour", "SimpleLighting"));
	VVertexBuffer buffer(VVertexFormat::Skin(), std::vector<std::uint8_t>(40 * 3));
	m_Render.BindVertices(buffer);
	EXPECT_EQ(m_Render.m_EnabledAttributes.to_ulong(), 1ul << EAttributePosition | 1ul << EAttributeNormal);
	m_Render.UseProgram(m_Library.GetProgram("FBXSkin", "FBXMaterial"));
	m_Render.BindVertices(buffer);
	EXPECT_EQ(m_Render.m_EnabledAttributes.to_ulong(), 0x3bul);
	// There are eight places: no more can be enabled, whatever a format asks for.
	VVertexFormat wild = VVertexFormat::Format3D();
	for (const std::uint8_t attribute : std::initializer_list<std::uint8_t>{6, 8, 255})
		wild.m_Entries.push_back({attribute, 3, 0, GL_FLOAT, 0});
	m_Render.SetVertexFormat(wild);
	EXPECT_EQ(m_Render.m_EnabledAttributes.to_ulong(), 1ul);
	for (GLuint array = 0; array < 8; ++array)
	{
		GLint enabled = -1;
		GL().glGetVertexAttribiv(array, GL_VERTEX_ATTRIB_ARRAY_ENABLED, &enabled);
		EXPECT_EQ(enabled, array == 0) << array;
	}
}

TEST_P(RenderContext, DrawsWithinTheScissorAndReadsRowsFromTheBottom)
{
	m_Render.SetClearColour(Qt::black);
	// Masks that others left do not keep anything from being cleared.
	GL().glColorMask(GL_FALSE, GL_FALSE, GL_FALSE, GL_FALSE);
	m_Render.ClearBuffers(true, true);
	m_Render.SetViewport(QRect(4, 2, 8, 3));
	m_Render.SetScissor();
	m_Render.SetClearColour(Qt::red);
	m_Render.ClearBuffers(true, false);
	m_Render.ResetScissor();
	std::vector<std::uint8_t> bytes;
	m_Render.ReadPixels(QRect(0, 0, c_Side, c_Side), bytes);
	ASSERT_EQ(bytes.size(), 4u * c_Side * c_Side);
	for (int y = 0; y < c_Side; ++y)
	{
		for (int x = 0; x < c_Side; ++x)
			EXPECT_EQ(bytes[4 * std::size_t(y * c_Side + x)], QRect(4, 2, 8, 3).contains(x, y) ? 255 : 0)
			    << x << ", " << y;
	}
}

TEST_P(RenderContext, FramebufferTexturesAreExactForPicks)
{
	for (const std::uint32_t mode : {ERenderNormal, ERenderPick, ERenderId})
	{
		m_Render.m_Mode = mode;
		m_Render.BindFramebufferTexture(7, *m_pTarget);
		EXPECT_EQ(Integer(GL_ACTIVE_TEXTURE), GL_TEXTURE0);
		GL().glActiveTexture(GL_TEXTURE7);
		EXPECT_EQ(Integer(GL_TEXTURE_BINDING_2D), static_cast<int>(m_pTarget->texture()));
		GLint filter = 0;
		GL().glGetTexParameteriv(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, &filter);
		EXPECT_EQ(filter, mode == ERenderNormal ? GL_LINEAR : GL_NEAREST);
	}
}

TEST_P(RenderContext, BuffersAreUploadedAgainWhereNothingIsShared)
{
	VShape sphere = MakeSphere(1);
	VUniform place("u_ReconPosAndSize"), colour("u_ModelColour");
	const auto pProgram = m_Library.GetProgram("Sphere", "Colour");
	const auto draw = [&](VRenderContext& io_rRender)
	{
		io_rRender.SetViewport(QRect(0, 0, c_Side, c_Side));
		io_rRender.ClearBuffers(true, true);
		EXPECT_TRUE(io_rRender.UseProgram(pProgram));
		io_rRender.SetUniform(place, QVector4D(0, 0, 0, 1));
		io_rRender.SetUniform(colour, QVector4D(0, 1, 0, 1));
		io_rRender.BindVertices(sphere.m_Vertices);
		io_rRender.DrawElements(GL_TRIANGLES, sphere.m_Indices);
		std::vector<std::uint8_t> bytes;
		io_rRender.ReadPixels(QRect(c_Side / 2, c_Side / 2, 1, 1), bytes);
		EXPECT_EQ(bytes, (std::vector<std::uint8_t>{0, 255, 0, 255}));
	};
	draw(m_Render);
	{
		GraphicsTest::VOffscreenContext other(GetParam());
		m_Library.InitialiseGL();
		QOpenGLFramebufferObject target(c_Side, c_Side);
		VRenderContext render;
		render.Initialise();
		render.BindFramebuffer(&target);
		draw(render);
		EXPECT_EQ(other.GL().glGetError(), static_cast<GLenum>(GL_NO_ERROR));
	}
	m_Context.MakeCurrent();
}

TEST_P(RenderContext, TexturesAreReadAsTheSamplingSays)
{
	QImage image(2, 1, QImage::Format_RGB32);
	image.setPixelColor(0, 0, QColor(10, 20, 30));
	image.setPixelColor(1, 0, QColor(200, 210, 220));
	const auto pTexture = VTexture::FromImage(image);
	ASSERT_TRUE(pTexture);
	EXPECT_FALSE(VTexture::FromImage(QImage()));
	const float corners[] = {-1, -1, 0, 1, -1, 0, -1, 1, 0, 1, 1, 0};
	VVertexBuffer quad(VVertexFormat::Format3D(), BytesOf(std::vector<float>(std::begin(corners), std::end(corners))));
	VUniform texture("t_Texture");
	VTextureSampling sampling{EMinificationNearest, false, true, true};
	m_Render.UseProgram(m_Library.GetProgram("FullScreen", "Copy"));
	pTexture->Bind(m_Render, 2, sampling);
	m_Render.SetUniform(texture, 2);
	m_Render.BindVertices(quad);
	m_Render.DrawArrays(GL_TRIANGLE_STRIP, quad.Count());
	EXPECT_EQ(Pixel(7, 3), (std::vector<int>{10, 20, 30, 255}));
	EXPECT_EQ(Pixel(8, 3), (std::vector<int>{200, 210, 220, 255}));

	sampling.m_bMagnificationLinear = true;
	sampling.m_bClampS = false;
	sampling.m_Minification = 77;
	// More than there is.
	sampling.m_Anisotropy = 1e6f;
	EXPECT_TRUE(m_Render.m_bSoftware);
	EXPECT_EQ(m_Render.m_MostAnisotropy, 1.0f);
	m_Render.m_MostAnisotropy = 4.0f;
	pTexture->Bind(m_Render, 2, sampling);
	GLint value = 0;
	const auto parameter = [&](GLenum i_Name)
	{
		GL().glGetTexParameteriv(GL_TEXTURE_2D, i_Name, &value);
		return value;
	};
	EXPECT_EQ(parameter(GL_TEXTURE_MIN_FILTER), GL_NEAREST_MIPMAP_NEAREST);
	constexpr GLenum c_Anisotropy = 0x84FE;
	EXPECT_EQ(parameter(c_Anisotropy), 4);
	EXPECT_EQ(parameter(GL_TEXTURE_MAG_FILTER), GL_LINEAR);
	EXPECT_EQ(parameter(GL_TEXTURE_WRAP_S), GL_REPEAT);
	EXPECT_EQ(parameter(GL_TEXTURE_WRAP_T), GL_CLAMP_TO_EDGE);
}

TEST(Texture, FormsOfPictures)
{
	// GL_R8, GL_RGB565, GL_RGB8, GL_RGBA8.
	const std::uint32_t r8 = 0x8229, rgb565 = 0x8D62, rgb8 = 0x8051, rgba8 = 0x8058;
	const std::vector<VTextureForm> expected = {{}, {r8, 1}, {r8, 1}, {r8, 1}, {r8, 1}, {r8, 1}, {rgb565, 1}, {rgb8, 1},
	    {rgb8, 1}, {rgba8, 1}, {rgba8, 1}, {rgba8, 2}, {rgba8, 2}, {rgba8, 2}, {r8, 1}, {r8, 1}, {r8, 1}, {r8, 1}, {}};
	for (std::uint32_t format = 0; format < expected.size(); ++format)
		EXPECT_EQ(FormOf(static_cast<EPixelFormat>(format)), expected[format]) << format;
}
