#pragma once

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Uniform.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <memory>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace OrlexGraphics
{

class VSelectionRegistry;

/// Fill and edge of what is selected and of what the mouse points at, drawn over the finished frame from the id frame
/// alone. Made with the context current; a member of the post list.
class VRenderOutlines : public IRenderType
{
public:
	VRenderOutlines(CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<const VSelectionRegistry> i_pRegistry);

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	const std::shared_ptr<const VSelectionRegistry> m_pRegistry;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pOutlines;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pAntiAlias;
	CoreGraphics::VUniform m_Selection{"t_Selection"};
	CoreGraphics::VUniform m_PrimaryColour{"u_PrimaryColour"};
	CoreGraphics::VUniform m_PreselectColour{"u_PreSelectColour"};
	CoreGraphics::VUniform m_Buffer{"t_Buffer"};
	CoreGraphics::VRenderState m_OutlineState;
	CoreGraphics::VRenderState m_AntiAliasState;
	CoreGraphics::VVertexBuffer m_Quad;
};

} // namespace OrlexGraphics
