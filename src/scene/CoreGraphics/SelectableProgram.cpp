#include "CoreGraphics/SelectableProgram.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"

namespace CoreGraphics
{

VSelectableProgram VSelectableProgram::Make(
    VShaderLibrary& io_rLibrary, const std::string& i_rVertex, const std::string& i_rFragment)
{
	VSelectableProgram program;
	program.m_pNormal = io_rLibrary.GetProgram(i_rVertex, i_rFragment);
	program.m_pSelection = io_rLibrary.GetProgram(i_rVertex, "Selection");
	return program;
}

void VSelectableProgram::SetId(VRenderContext& io_rContext, const VSelectionId& i_rId)
{
	io_rContext.SetUniform(m_SelectionId, QVector3D(i_rId.m_Red, i_rId.m_Green, i_rId.m_Blue));
}

} // namespace CoreGraphics
