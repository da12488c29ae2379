#include "Flow2Graphics/FlowRenderGeometry.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"

#include <QPainter>
#include <qopengl.h>

#include <algorithm>
#include <optional>

namespace Flow2Graphics
{

using CoreGraphics::VRenderContext;

namespace
{

QColor ColourOf(const QVector4D& i_rColour)
{
	const auto part = [](float i_Part) { return static_cast<double>(std::clamp(i_Part, 0.0f, 1.0f)); };
	return QColor::fromRgbF(part(i_rColour.x()), part(i_rColour.y()), part(i_rColour.z()), part(i_rColour.w()));
}

/// From -1 to 1 in both directions; nothing behind the eye.
std::optional<QVector2D> PlaceOf(const VGeometry::VText& i_rText, const VRenderContext& i_rContext)
{
	const QVector4D& rView2D = i_rContext.m_View2D;
	if (i_rText.m_b2D)
		return i_rText.m_Position.toVector2D() * rView2D.toVector2D() + QVector2D(rView2D.z(), rView2D.w());
	const QVector4D clip = i_rContext.m_Projection * (i_rContext.m_View * QVector4D(i_rText.m_Position, 1.0f));
	if (!(clip.w() > 0.0f))
		return {};
	return clip.toVector2D() / clip.w();
}

} // namespace

VFlowRenderGeometry::VFlowRenderGeometry(CoreGraphics::VShaderLibrary& io_rLibrary)
    : m_p2D(io_rLibrary.GetProgram("General2D", "UniformColour")),
      m_p3D(io_rLibrary.GetProgram("Simple3DPointSize", "UniformColour"))
{
	m_State2D.m_ColourBlend = CoreGraphics::EColourBlendAlpha;
	m_State2D.m_bDepthWrite = false;
	m_State3D = m_State2D;
	m_State3D.m_bDepthTest = true;
	m_State3D.m_DepthFunction = CoreGraphics::EDepthLessEqual;
}

void VFlowRenderGeometry::Update(const TesselPluginInterface::IFlowFrame& i_rFrame, VFlowContext& /*io_rContext*/)
{
	m_Geometry.Update(i_rFrame);
}

void VFlowRenderGeometry::Render(
    VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& /*i_rOptions*/, std::uint32_t i_Pass)
{
	const VGeometry* const pGeometry = m_Geometry.Value().get();
	if (!pGeometry || io_rContext.m_Mode != CoreGraphics::ERenderNormal)
		return;
	if (i_Pass == OrlexGraphics::EPassTransparent)
		Render3D(io_rContext, *pGeometry);
	else if (i_Pass == OrlexGraphics::EPassOverlay)
		Render2D(io_rContext, *pGeometry);
}

void VFlowRenderGeometry::Render3D(VRenderContext& io_rContext, const VGeometry& i_rGeometry)
{
	if ((i_rGeometry.m_Lines.empty() && i_rGeometry.m_Points.empty()) || !io_rContext.UseProgram(m_p3D))
		return;
	io_rContext.ApplyState(m_State3D);
	const auto draw = [&](unsigned int i_Mode, const std::vector<QVector3D>& i_rVertices, const QVector4D& i_rColour)
	{
		io_rContext.SetUniform(m_Colour, i_rColour);
		m_Buffer.Upload(i_rVertices.data(), i_rVertices.size() * sizeof(QVector3D));
		io_rContext.SetVertexFormat(CoreGraphics::VVertexFormat::Format3D());
		io_rContext.DrawArrays(i_Mode, i_rVertices.size());
	};
	for (const VGeometry::VLines& rLines : i_rGeometry.m_Lines)
		draw(GL_LINES, rLines.m_Ends, rLines.m_Colour);
	for (const VGeometry::VPoints& rPoints : i_rGeometry.m_Points)
	{
		io_rContext.SetUniform(m_PointSize, rPoints.m_Size);
		draw(GL_POINTS, rPoints.m_Points, rPoints.m_Colour);
	}
}

void VFlowRenderGeometry::Render2D(VRenderContext& io_rContext, const VGeometry& i_rGeometry)
{
	if (i_rGeometry.m_Lines2D.empty() || !io_rContext.UseProgram(m_p2D))
		return;
	io_rContext.ApplyState(m_State2D);
	for (const VGeometry::VLines2D& rLines : i_rGeometry.m_Lines2D)
	{
		io_rContext.SetUniform(m_Colour, rLines.m_Colour);
		io_rContext.SetUniform(m_Rotation, rLines.m_Rotation);
		io_rContext.SetUniform(m_RotationCentre, rLines.m_RotationCentre);
		m_Buffer.Upload(rLines.m_Ends.data(), rLines.m_Ends.size() * sizeof(QVector2D));
		io_rContext.SetVertexFormat(CoreGraphics::VVertexFormat::Format2D());
		io_rContext.DrawArrays(GL_LINES, rLines.m_Ends.size());
	}
}

void VFlowRenderGeometry::Paint(
    QPainter& io_rPainter, VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& /*i_rOptions*/)
{
	const VGeometry* const pGeometry = m_Geometry.Value().get();
	if (!pGeometry)
		return;
	// Pixels of the view, however many the device makes of them.
	const QSizeF size = QSizeF(io_rContext.m_Viewport.size()) / io_rPainter.device()->devicePixelRatioF();
	io_rPainter.setFont(m_Font);
	for (const VGeometry::VText& rText : pGeometry->m_Texts)
	{
		const std::optional<QVector2D> place = PlaceOf(rText, io_rContext);
		if (!place)
			continue;
		io_rPainter.setPen(ColourOf(rText.m_Colour));
		io_rPainter.drawText(QPointF(0.5 * (1.0 + static_cast<double>(place->x())) * size.width(),
		                         0.5 * (1.0 - static_cast<double>(place->y())) * size.height()),
		    rText.m_Text);
	}
}

} // namespace Flow2Graphics
