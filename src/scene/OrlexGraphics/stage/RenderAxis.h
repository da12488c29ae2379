#pragma once

#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Shapes.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <QRect>

#include <memory>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace OrlexGraphics
{

/// The world's axes in a corner of the view. Render thread; made with the context current.
class VRenderAxis : public IRenderType
{
public:
	explicit VRenderAxis(CoreGraphics::VShaderLibrary& io_rLibrary);

	/// The square that they are drawn in, in device pixels as the viewport is.
	/// @param i_PixelRatio device pixels by those that sizes on the screen count in.
	static QRect Corner(const QRect& i_rViewport, float i_PixelRatio);

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pProgram;
	CoreGraphics::VShape m_Axes;
	CoreGraphics::VRenderState m_State;
};

} // namespace OrlexGraphics
