#include "CoreGraphics/RenderContext.h"

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/ShaderProgram.h"
#include "CoreGraphics/Texture.h"
#include "CoreGraphics/VertexFormat.h"

#include <QColor>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>
#include <QOpenGLFunctions>
#include <QOpenGLShaderProgram>

#include <array>
#include <cstring>

// What only desktop OpenGL before the core profile has.
#ifndef GL_VERTEX_PROGRAM_POINT_SIZE
#define GL_VERTEX_PROGRAM_POINT_SIZE 0x8642
#endif
#ifndef GL_POINT_SPRITE
#define GL_POINT_SPRITE 0x8861
#endif
#ifndef GL_POINT_SMOOTH
#define GL_POINT_SMOOTH 0x0B10
#endif
#ifndef GL_MAX_TEXTURE_MAX_ANISOTROPY_EXT
#define GL_MAX_TEXTURE_MAX_ANISOTROPY_EXT 0x84FF
#endif

namespace CoreGraphics
{

namespace
{

struct VBlend
{
	GLenum m_Source;
	GLenum m_Destination;
};

constexpr std::array<VBlend, 5> c_ColourBlends = {{{GL_ONE, GL_ZERO}, {GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA},
    {GL_SRC_ALPHA, GL_ONE}, {GL_CONSTANT_ALPHA, GL_ONE}, {GL_ONE, GL_ONE_MINUS_SRC_ALPHA}}};
constexpr std::array<VBlend, 3> c_AlphaBlends = {{{GL_ZERO, GL_ONE}, {GL_ONE, GL_ONE}, {GL_ONE, GL_ZERO}}};
constexpr std::array<GLenum, 6> c_DepthFunctions = {GL_LESS, GL_LEQUAL, GL_GREATER, GL_GEQUAL, GL_NOTEQUAL, GL_EQUAL};

QVector2D AsVector(const QSize& i_rSize)
{
	return {static_cast<float>(i_rSize.width()), static_cast<float>(i_rSize.height())};
}

} // namespace

bool IsSoftware(QOpenGLFunctions& i_rFunctions)
{
	const auto* const pName = reinterpret_cast<const char*>(i_rFunctions.glGetString(GL_RENDERER));
	if (!pName)
		return false;
	for (const char* const pSoftware : {"llvmpipe", "softpipe", "swrast", "Software", "SWR", "GDI Generic", "WARP"})
		if (std::strstr(pName, pSoftware))
			return true;
	return false;
}

void VRenderContext::Initialise()
{
	m_pContext = QOpenGLContext::currentContext();
	// Resolved by the context, once for all who ask.
	m_pFunctions = m_pContext->functions();
	m_bSoftware = IsSoftware(*m_pFunctions);
	m_MostAnisotropy = 1.0f;
	if (!m_bSoftware && m_pContext->hasExtension("GL_EXT_texture_filter_anisotropic"))
		m_pFunctions->glGetFloatv(GL_MAX_TEXTURE_MAX_ANISOTROPY_EXT, &m_MostAnisotropy);
	SetClearColour(QColor(25, 25, 25, 255));
	VTexture::DeleteReleased();
}

void VRenderContext::ResetState()
{
	QOpenGLFunctions& rGL = *m_pFunctions;
	for (std::size_t array = 0; array < c_AttributeArrays; ++array)
		rGL.glDisableVertexAttribArray(static_cast<GLuint>(array));
	m_EnabledAttributes.reset();
	rGL.glBindBuffer(GL_ARRAY_BUFFER, 0);
	rGL.glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, 0);
	rGL.glUseProgram(0);
	for (const GLenum capability : {GL_CULL_FACE, GL_BLEND, GL_DEPTH_TEST})
		rGL.glDisable(capability);
	rGL.glColorMask(GL_TRUE, GL_TRUE, GL_TRUE, GL_TRUE);
	rGL.glDepthMask(GL_TRUE);
	rGL.glCullFace(GL_BACK);
	if (!m_pContext->isOpenGLES())
	{
		rGL.glEnable(GL_VERTEX_PROGRAM_POINT_SIZE);
		rGL.glEnable(GL_POINT_SPRITE);
		rGL.glDisable(GL_POINT_SMOOTH);
	}
	rGL.glActiveTexture(GL_TEXTURE0);
	rGL.glBindTexture(GL_TEXTURE_2D, 0);
	m_pProgram.reset();
}

bool VRenderContext::UseProgram(const std::shared_ptr<VShaderProgram>& i_rpProgram)
{
	if (!i_rpProgram || i_rpProgram->IsEmpty())
		return false;
	m_pProgram = i_rpProgram;
	QOpenGLShaderProgram& rProgram = *m_pProgram->Get();
	m_pFunctions->glUseProgram(rProgram.programId());
	const auto write = [&](EStandardUniform i_Uniform, const auto& i_rMakeValue)
	{
		if (const int location = m_pProgram->UniformLocation(i_Uniform); location != -1)
			rProgram.setUniformValue(location, i_rMakeValue());
	};
	write(EUniformViewProjection, [&] { return m_Projection * m_View; });
	write(EUniformView, [&] { return m_View; });
	write(EUniformProjection, [&] { return m_Projection; });
	write(EUniformView2D, [&] { return m_View2D; });
	write(EUniformViewportSize, [&] { return AsVector(m_Viewport.size()); });
	write(EUniformViewportOffset, [&] { return QVector2D(m_Viewport.topLeft()); });
	write(EUniformFrameSize, [&] { return AsVector(m_FrameSize); });
	write(EUniformLightVector, [&] { return m_LightVector; });
	write(EUniformUp, [&] { return m_Up; });
	write(EUniformGlobalTime, [&] { return m_GlobalTime; });
	write(EUniformCameraPosition, [&] { return m_View.inverted().map(QVector3D()); });
	write(EUniformRadialDistortionCentre, [&] { return m_Distortion.m_Centre; });
	write(EUniformRadialDistortionParameters, [&] { return m_Distortion.m_Parameters; });
	write(EUniformSensorSize, [&] { return m_Distortion.m_SensorSize; });
	return true;
}

void VRenderContext::SetUniform(VUniform& io_rUniform, int i_Value)
{
	if (const int location = io_rUniform.LocationIn(*m_pProgram); location != -1)
		m_pFunctions->glUniform1i(location, i_Value);
}

void VRenderContext::SetUniform(VUniform& io_rUniform, float i_Value)
{
	if (const int location = io_rUniform.LocationIn(*m_pProgram); location != -1)
		m_pFunctions->glUniform1f(location, i_Value);
}

void VRenderContext::SetUniform(VUniform& io_rUniform, const QVector2D& i_rValue)
{
	if (const int location = io_rUniform.LocationIn(*m_pProgram); location != -1)
		m_pFunctions->glUniform2f(location, i_rValue.x(), i_rValue.y());
}

void VRenderContext::SetUniform(VUniform& io_rUniform, const QVector3D& i_rValue)
{
	if (const int location = io_rUniform.LocationIn(*m_pProgram); location != -1)
		m_pFunctions->glUniform3f(location, i_rValue.x(), i_rValue.y(), i_rValue.z());
}

void VRenderContext::SetUniform(VUniform& io_rUniform, const QVector4D& i_rValue)
{
	if (const int location = io_rUniform.LocationIn(*m_pProgram); location != -1)
		m_pFunctions->glUniform4f(location, i_rValue.x(), i_rValue.y(), i_rValue.z(), i_rValue.w());
}

void VRenderContext::SetUniform(VUniform& io_rUniform, const QMatrix4x4& i_rValue)
{
	if (const int location = io_rUniform.LocationIn(*m_pProgram); location != -1)
		m_pFunctions->glUniformMatrix4fv(location, 1, GL_FALSE, i_rValue.constData());
}

void VRenderContext::SetUniform(VUniform& io_rUniform, const float* i_pMatrices, std::size_t i_Count)
{
	if (const int location = io_rUniform.LocationIn(*m_pProgram); location != -1)
		m_pFunctions->glUniformMatrix4fv(location, static_cast<GLsizei>(i_Count), GL_FALSE, i_pMatrices);
}

void VRenderContext::SetVertexFormat(const VVertexFormat& i_rFormat, std::size_t i_First)
{
	std::bitset<c_AttributeArrays> enabled;
	for (const VVertexFormat::VEntry& rEntry : i_rFormat.m_Entries)
	{
		const int location = m_pProgram->AttributeLocation(rEntry.m_Attribute);
		if (location < 0 || static_cast<std::size_t>(location) >= c_AttributeArrays)
			continue;
		enabled.set(static_cast<std::size_t>(location));
		m_pFunctions->glVertexAttribPointer(static_cast<GLuint>(location), rEntry.m_Components, rEntry.m_Type,
		    rEntry.m_Normalised ? GL_TRUE : GL_FALSE, static_cast<GLsizei>(i_rFormat.m_Stride),
		    reinterpret_cast<const void*>(i_First * i_rFormat.m_Stride + rEntry.m_Offset));
	}
	const std::bitset<c_AttributeArrays> changed = enabled ^ m_EnabledAttributes;
	for (std::size_t array = 0; changed.any() && array < c_AttributeArrays; ++array)
	{
		if (!changed[array])
			continue;
		if (enabled[array])
			m_pFunctions->glEnableVertexAttribArray(static_cast<GLuint>(array));
		else
			m_pFunctions->glDisableVertexAttribArray(static_cast<GLuint>(array));
	}
	m_EnabledAttributes = enabled;
}

void VRenderContext::BindVertices(VVertexBuffer& io_rBuffer)
{
	io_rBuffer.Bind();
	SetVertexFormat(io_rBuffer.Format());
}

void VRenderContext::ApplyState(const VRenderState& i_rState)
{
	QOpenGLFunctions& rGL = *m_pFunctions;
	if (i_rState.m_ColourBlend == EColourBlendOff && i_rState.m_AlphaBlend == EAlphaBlendKeep)
		rGL.glDisable(GL_BLEND);
	else
	{
		const VBlend colour =
		    c_ColourBlends[i_rState.m_ColourBlend < c_ColourBlends.size() ? i_rState.m_ColourBlend : 0];
		const VBlend alpha =
		    c_AlphaBlends[i_rState.m_AlphaBlend < c_AlphaBlends.size() ? i_rState.m_AlphaBlend : EAlphaBlendReplace];
		rGL.glEnable(GL_BLEND);
		rGL.glBlendFuncSeparate(colour.m_Source, colour.m_Destination, alpha.m_Source, alpha.m_Destination);
		if (i_rState.m_ColourBlend == EColourBlendAddConstant)
		{
			const float constant = i_rState.m_BlendConstant;
			rGL.glBlendColor(constant, constant, constant, constant);
		}
	}

	if (i_rState.m_Cull == ECullOff)
		rGL.glDisable(GL_CULL_FACE);
	else
	{
		rGL.glEnable(GL_CULL_FACE);
		rGL.glCullFace(i_rState.m_Cull == ECullFront ? GL_FRONT : GL_BACK);
	}

	// Without the test OpenGL writes no depth either.
	if (i_rState.m_bDepthTest)
		rGL.glEnable(GL_DEPTH_TEST);
	else
		rGL.glDisable(GL_DEPTH_TEST);
	rGL.glDepthFunc(
	    c_DepthFunctions[i_rState.m_DepthFunction < c_DepthFunctions.size() ? i_rState.m_DepthFunction : 0]);
	const GLboolean colour = i_rState.m_bColourWrite ? GL_TRUE : GL_FALSE;
	rGL.glColorMask(colour, colour, colour, i_rState.m_bAlphaWrite ? GL_TRUE : GL_FALSE);
	rGL.glDepthMask(i_rState.m_bDepthWrite ? GL_TRUE : GL_FALSE);
}

void VRenderContext::DrawArrays(unsigned int i_Mode, std::size_t i_Count)
{
	m_pFunctions->glDrawArrays(i_Mode, 0, static_cast<GLsizei>(i_Count));
}

void VRenderContext::DrawElements(unsigned int i_Mode, VIndexBuffer& io_rIndices)
{
	io_rIndices.Bind();
	m_pFunctions->glDrawElements(i_Mode, static_cast<GLsizei>(io_rIndices.Count()), io_rIndices.Type(), nullptr);
}

void VRenderContext::DrawElements(unsigned int i_Mode, std::size_t i_First, std::size_t i_Count)
{
	m_pFunctions->glDrawElements(i_Mode, static_cast<GLsizei>(i_Count), GL_UNSIGNED_SHORT,
	    reinterpret_cast<const void*>(i_First * sizeof(std::uint16_t)));
}

void VRenderContext::SetClearColour(const QColor& i_rColour)
{
	m_pFunctions->glClearColor(static_cast<float>(i_rColour.redF()), static_cast<float>(i_rColour.greenF()),
	    static_cast<float>(i_rColour.blueF()), static_cast<float>(i_rColour.alphaF()));
}

void VRenderContext::ClearBuffers(bool i_bColour, bool i_bDepth)
{
	GLbitfield buffers = 0;
	if (i_bColour)
	{
		m_pFunctions->glColorMask(GL_TRUE, GL_TRUE, GL_TRUE, GL_TRUE);
		buffers |= GL_COLOR_BUFFER_BIT;
	}
	if (i_bDepth)
	{
		m_pFunctions->glDepthMask(GL_TRUE);
		buffers |= GL_DEPTH_BUFFER_BIT;
	}
	m_pFunctions->glClear(buffers);
}

void VRenderContext::ReadPixels(const QRect& i_rRectangle, std::vector<std::uint8_t>& o_rPixels)
{
	o_rPixels.resize(std::size_t{4} * static_cast<std::size_t>(i_rRectangle.width())
	    * static_cast<std::size_t>(i_rRectangle.height()));
	m_pFunctions->glReadPixels(i_rRectangle.x(), i_rRectangle.y(), i_rRectangle.width(), i_rRectangle.height(), GL_RGBA,
	    GL_UNSIGNED_BYTE, o_rPixels.data());
}

void VRenderContext::SetViewport(const QRect& i_rViewport)
{
	m_Viewport = i_rViewport;
	m_pFunctions->glViewport(i_rViewport.x(), i_rViewport.y(), i_rViewport.width(), i_rViewport.height());
}

void VRenderContext::SetScissor(const QRect& i_rRectangle)
{
	m_pFunctions->glEnable(GL_SCISSOR_TEST);
	m_pFunctions->glScissor(i_rRectangle.x(), i_rRectangle.y(), i_rRectangle.width(), i_rRectangle.height());
}

void VRenderContext::ResetScissor()
{
	m_pFunctions->glDisable(GL_SCISSOR_TEST);
}

void VRenderContext::SetYUp(bool i_bYUp)
{
	m_bYUp = i_bYUp;
	m_Up = i_bYUp ? QVector3D(0.0f, 1.0f, 0.0f) : QVector3D(0.0f, 0.0f, 1.0f);
}

void VRenderContext::BindFramebuffer(QOpenGLFramebufferObject* i_pFramebuffer)
{
	m_pFramebuffer = i_pFramebuffer;
	m_pFunctions->glBindFramebuffer(GL_FRAMEBUFFER, i_pFramebuffer ? i_pFramebuffer->handle() : m_DefaultFramebuffer);
}

void VRenderContext::BindDefaultFramebuffer()
{
	BindFramebuffer(nullptr);
}

void VRenderContext::BindFramebufferTexture(unsigned int i_Unit, const QOpenGLFramebufferObject& i_rFramebuffer)
{
	const GLint filter = m_Mode == ERenderNormal ? GL_LINEAR : GL_NEAREST;
	m_pFunctions->glActiveTexture(GL_TEXTURE0 + i_Unit);
	m_pFunctions->glBindTexture(GL_TEXTURE_2D, i_rFramebuffer.texture());
	m_pFunctions->glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, filter);
	m_pFunctions->glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, filter);
	m_pFunctions->glActiveTexture(GL_TEXTURE0);
}

} // namespace CoreGraphics
