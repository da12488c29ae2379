#include "OrlexGraphics/stage/RenderAxis.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/frame/SceneOptions.h"

#include <QOpenGLContext>

#include <algorithm>

namespace OrlexGraphics
{

namespace
{

constexpr float c_Share = 0.25f;
constexpr float c_LargestSide = 100.0f;

} // namespace

VRenderAxis::VRenderAxis(CoreGraphics::VShaderLibrary& io_rLibrary)
    : m_pProgram(io_rLibrary.GetProgram("ScreenSpaceAxis", "Colour")), m_Axes(CoreGraphics::MakeAxes(1.0f))
{
	m_State.m_bDepthTest = true;
	m_State.m_DepthFunction = CoreGraphics::EDepthLessEqual;
}

QRect VRenderAxis::Corner(const QRect& i_rViewport, float i_PixelRatio)
{
	const float share = static_cast<float>(std::min(i_rViewport.width(), i_rViewport.height())) * c_Share;
	const int side = static_cast<int>(std::min(share, c_LargestSide * i_PixelRatio));
	return {i_rViewport.topLeft(), QSize(side, side)};
}

void VRenderAxis::Render(
    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (i_Pass != EPassOverlay || io_rContext.m_Mode != CoreGraphics::ERenderNormal || !i_rOptions.m_bGlobalAxis
	    || !i_rOptions.m_OverlayCamera.empty())
		return;
	const QRect viewport = io_rContext.m_Viewport;
	io_rContext.SetViewport(Corner(viewport, io_rContext.m_PixelRatio));
	if (io_rContext.UseProgram(m_pProgram))
	{
		io_rContext.ApplyState(m_State);
		io_rContext.BindVertices(m_Axes.m_Vertices);
		io_rContext.DrawElements(GL_LINES, m_Axes.m_Indices);
	}
	io_rContext.SetViewport(viewport);
}

} // namespace OrlexGraphics
