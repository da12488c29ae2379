#include "OrlexGraphics/stage/RenderReconstructionVolume.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/frame/SceneOptions.h"

#include <qopengl.h>

namespace OrlexGraphics
{

namespace
{

const QVector4D c_WallColour(0.7f, 0.7f, 0.7f, 0.08f);
const QVector4D c_VolumeEdgeColour(0.7f, 0.7f, 0.7f, 1.0f);

} // namespace

VRenderReconstructionVolume::VRenderReconstructionVolume(CoreGraphics::VShaderLibrary& io_rLibrary)
    : m_pWalls(io_rLibrary.GetProgram("Simple3DModelColour", "SimpleLighting")),
      m_pEdges(io_rLibrary.GetProgram("Simple3DModelWireframe", "UniformColour")), m_Box(CoreGraphics::MakeBox(false)),
      m_WireBox(CoreGraphics::MakeBox(true))
{
	// What stands in the volume is not seen through its near walls.
	m_WallState.m_Cull = CoreGraphics::ECullBack;
	m_WallState.m_ColourBlend = CoreGraphics::EColourBlendAlpha;
	m_WallState.m_bDepthTest = true;
	m_WallState.m_bDepthWrite = false;
	m_EdgeState.m_bDepthTest = true;
	m_EdgeState.m_DepthFunction = CoreGraphics::EDepthLessEqual;
}

void VRenderReconstructionVolume::Render(
    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (!m_Volume || !i_rOptions.m_bReconstructionVolume || io_rContext.m_Mode != CoreGraphics::ERenderNormal
	    || i_Pass == EPassOverlay)
		return;
	const bool bWalls = i_Pass == EPassTransparent;
	if (!io_rContext.UseProgram(bWalls ? m_pWalls : m_pEdges))
		return;
	CoreGraphics::VShape& rBox = bWalls ? m_Box : m_WireBox;
	io_rContext.ApplyState(bWalls ? m_WallState : m_EdgeState);
	QMatrix4x4 model = BoxTransform(*m_Volume);
	// Inside out.
	if (bWalls)
		model.scale(-1.0f);
	io_rContext.SetUniform(m_Model, model);
	if (bWalls)
		io_rContext.SetUniform(m_WallColour, c_WallColour);
	else
		io_rContext.SetUniform(m_EdgeColour, c_VolumeEdgeColour);
	io_rContext.BindVertices(rBox.m_Vertices);
	io_rContext.DrawElements(bWalls ? GL_TRIANGLES : GL_LINES, rBox.m_Indices);
}

} // namespace OrlexGraphics
