#include "OrlexGraphics/stage/RenderReconstructions.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/frame/SceneOptions.h"

#include <qopengl.h>

namespace OrlexGraphics
{

namespace
{

const QVector4D c_Colour(0.9f, 0.9f, 0.9f, 1.0f);
/// From the middle of a cross to its ends, in millimetres at a scale of 1.
constexpr float c_Arm = 7.0f;
constexpr std::size_t c_VerticesOfPoint = 6;

} // namespace

VRenderReconstructions::VRenderReconstructions(CoreGraphics::VShaderLibrary& io_rLibrary)
    : m_pProgram(io_rLibrary.GetProgram("Simple3D", "UniformColour"))
{
	m_State.m_bDepthTest = true;
}

void VRenderReconstructions::SetPoints(const std::vector<QVector3D>& i_rPoints)
{
	m_Points = i_rPoints;
	m_Vertices.reserve(c_VerticesOfPoint * m_Points.size());
	m_Scale = -1.0f;
}

void VRenderReconstructions::MakeVertices(float i_Scale)
{
	m_Scale = i_Scale;
	m_Vertices.clear();
	const float arm = c_Arm * i_Scale;
	for (const QVector3D& rPoint : m_Points)
	{
		for (const QVector3D& rArm : {QVector3D(arm, 0.0f, 0.0f), {0.0f, arm, 0.0f}, {0.0f, 0.0f, arm}})
			m_Vertices.insert(m_Vertices.end(), {rPoint - rArm, rPoint + rArm});
	}
}

void VRenderReconstructions::Render(
    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	const float scale = i_rOptions.m_ReconstructionScale;
	if (i_Pass != EPassOpaque || io_rContext.m_Mode != CoreGraphics::ERenderNormal || !i_rOptions.m_bReconstructions
	    || m_Points.empty() || !(scale > 0.0f) || !io_rContext.UseProgram(m_pProgram))
		return;
	if (scale != m_Scale)
		MakeVertices(scale);
	io_rContext.ApplyState(m_State);
	io_rContext.SetUniform(m_Colour, c_Colour);
	m_Buffer.Upload(m_Vertices.data(), m_Vertices.size() * sizeof(QVector3D));
	io_rContext.SetVertexFormat(CoreGraphics::VVertexFormat::Format3D());
	io_rContext.DrawArrays(GL_LINES, m_Vertices.size());
}

} // namespace OrlexGraphics
