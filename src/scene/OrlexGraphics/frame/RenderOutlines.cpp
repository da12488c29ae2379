#include "OrlexGraphics/frame/RenderOutlines.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"

#include <QOpenGLFramebufferObject>
#include <QVector3D>
#include <qopengl.h>

namespace OrlexGraphics
{

namespace
{

/// Of the id frame.
constexpr int c_OutlineUnit = 7;

constexpr QVector4D c_PrimaryColour(231.0f / 255.0f, 101.0f / 255.0f, 0.0f, 1.0f);

/// By CoreGraphics::EModifierState: what a click would do.
constexpr QVector3D c_PreselectColours[] = {
    {0.25f, 0.125f, 0.0f}, {0.0f, 1.0f, 0.0f}, {1.0f, 0.0f, 0.0f}, {0.0f, 1.0f, 1.0f}};

/// Less by some pixels on all sides but those of the frame.
QRect Inner(const QRect& i_rRectangle, const QRect& i_rFrame, int i_Pixels)
{
	const QRect inner = i_rRectangle.adjusted(i_Pixels, i_Pixels, -i_Pixels, -i_Pixels);
	return QRect(QPoint(i_rRectangle.left() == i_rFrame.left() ? i_rRectangle.left() : inner.left(),
	                 i_rRectangle.top() == i_rFrame.top() ? i_rRectangle.top() : inner.top()),
	    QPoint(i_rRectangle.right() == i_rFrame.right() ? i_rRectangle.right() : inner.right(),
	        i_rRectangle.bottom() == i_rFrame.bottom() ? i_rRectangle.bottom() : inner.bottom()));
}

CoreGraphics::VVertexBuffer MakeQuad()
{
	const std::vector<QVector3D> corners = {
	    {-1.0f, -1.0f, 0.0f}, {1.0f, -1.0f, 0.0f}, {-1.0f, 1.0f, 0.0f}, {1.0f, 1.0f, 0.0f}};
	return {CoreGraphics::VVertexFormat::Format3D(), CoreGraphics::BytesOf(corners)};
}

} // namespace

VRenderOutlines::VRenderOutlines(
    CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<const VSelectionRegistry> i_pRegistry)
    : m_pRegistry(std::move(i_pRegistry)), m_pOutlines(io_rLibrary.GetProgram("Simple", "Outlines")),
      m_pAntiAlias(io_rLibrary.GetProgram("Simple", "AntiAlias")), m_Quad(MakeQuad())
{
	m_OutlineState.m_bAlphaWrite = true;
	m_OutlineState.m_bDepthWrite = false;
	m_AntiAliasState.m_ColourBlend = CoreGraphics::EColourBlendPremultiplied;
	m_AntiAliasState.m_bDepthWrite = false;
}

void VRenderOutlines::Render(
    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& /*i_rOptions*/, std::uint32_t i_Pass)
{
	QOpenGLFramebufferObject* const pOutlines = io_rContext.m_pOutlineFramebuffer;
	if (i_Pass != EPassOverlay || io_rContext.m_Mode != CoreGraphics::ERenderNormal
	    || io_rContext.m_OutlineRectangle.isEmpty() || !pOutlines || !pOutlines->isValid()
	    || !io_rContext.UseProgram(m_pOutlines))
		return;
	QOpenGLFramebufferObject* const pTarget = io_rContext.m_pFramebuffer;
	// Each step reads around its pixels, what lies outside is left from other frames.
	const QRect& rIds = io_rContext.m_OutlineRectangle;
	const QRect frame = io_rContext.m_Viewport;
	io_rContext.SetScissor(Inner(rIds, frame, 2));
	io_rContext.BindFramebuffer(pOutlines);
	io_rContext.SetUniform(m_Selection, c_OutlineUnit);
	io_rContext.SetUniform(m_PrimaryColour, c_PrimaryColour);
	io_rContext.SetUniform(m_PreselectColour, c_PreselectColours[io_rContext.m_ModifierState % 4]);
	io_rContext.ApplyState(m_OutlineState);
	io_rContext.BindVertices(m_Quad);
	io_rContext.DrawArrays(GL_TRIANGLE_STRIP, m_Quad.Count());

	io_rContext.BindFramebuffer(pTarget);
	if (io_rContext.UseProgram(m_pAntiAlias))
	{
		io_rContext.SetScissor(Inner(rIds, frame, 4));
		io_rContext.BindFramebufferTexture(0, *pOutlines);
		io_rContext.SetUniform(m_Buffer, 0);
		io_rContext.ApplyState(m_AntiAliasState);
		io_rContext.BindVertices(m_Quad);
		io_rContext.DrawArrays(GL_TRIANGLE_STRIP, m_Quad.Count());
	}
	io_rContext.SetScissor();
}

} // namespace OrlexGraphics
