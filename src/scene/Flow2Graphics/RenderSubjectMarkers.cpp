#include "Flow2Graphics/RenderSubjectMarkers.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "Flow2Graphics/RenderSubjectDynamics.h"
#include "OrlexGraphics/stage/SphereHelper.h"

#include <qopengl.h>

namespace Flow2Graphics
{

VRenderSubjectMarkers::VRenderSubjectMarkers(CoreGraphics::VShaderLibrary& io_rLibrary,
    std::shared_ptr<OrlexGraphics::VSphereHelper> i_pSphereHelper, bool i_bSolving)
    : m_pSphereHelper(std::move(i_pSphereHelper)), m_bSolving(i_bSolving),
      m_pStick(io_rLibrary.GetProgram("Stick", "Colour")), m_Cylinder(CoreGraphics::MakeCylinder(16, true))
{
	m_State.m_Cull = CoreGraphics::ECullBack;
	m_State.m_bDepthTest = true;
}

void VRenderSubjectMarkers::Render(
    CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (i_Pass == OrlexGraphics::EPassOverlay)
		return;
	for (const ESubjectClass list :
	    {ESubjectClassProp, ESubjectClassRigidObject, m_bSolving ? ESubjectClassSolving : ESubjectClassLabelling})
		if (const auto& rOptions = SubjectOptions(i_rOptions, list); rOptions.m_bEnabled && !m_Lists[list].empty())
			RenderList(io_rContext, m_Lists[list], rOptions, i_Pass);
}

void VRenderSubjectMarkers::RenderList(CoreGraphics::VRenderContext& io_rContext, const VSubjects& i_rSubjects,
    const OrlexGraphics::VSubjectOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (i_rOptions.m_bMarkers)
	{
		m_pSphereHelper->Begin(io_rContext);
		for (const auto& rpSubject : i_rSubjects)
			for (const VRenderSubjectData::VShape& rMarker : rpSubject->m_Markers)
				m_pSphereHelper->Draw(io_rContext, rMarker.m_PositionAndSize, rMarker.m_Id, rMarker.m_Colour, 3);
		m_pSphereHelper->End(io_rContext);
	}
	if (i_rOptions.m_bSticks && i_Pass == OrlexGraphics::EPassOpaque
	    && io_rContext.m_Mode == CoreGraphics::ERenderNormal)
		RenderSticks(io_rContext, i_rSubjects, i_rOptions.m_bSticksDuringGaps);
}

void VRenderSubjectMarkers::RenderSticks(
    CoreGraphics::VRenderContext& io_rContext, const VSubjects& i_rSubjects, bool i_bGaps)
{
	if (!io_rContext.UseProgram(m_pStick))
		return;
	io_rContext.ApplyState(m_State);
	io_rContext.BindVertices(m_Cylinder.m_Vertices);
	for (const auto& rpSubject : i_rSubjects)
	{
		const std::size_t count = i_bGaps ? rpSubject->m_Sticks.size() : rpSubject->m_SticksWithoutGaps;
		for (std::size_t i = 0; i < count; ++i)
		{
			const VRenderSubjectMarkerData::VStick& rStick = rpSubject->m_Sticks[i];
			io_rContext.SetUniform(m_Model, rStick.m_Matrix);
			io_rContext.SetUniform(m_ColourA, rStick.m_ColourA);
			io_rContext.SetUniform(m_ColourB, rStick.m_ColourB);
			io_rContext.DrawElements(GL_TRIANGLES, m_Cylinder.m_Indices);
		}
	}
}

} // namespace Flow2Graphics
