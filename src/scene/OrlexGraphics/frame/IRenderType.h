#pragma once

#include <cstdint>

class QPainter;

namespace CoreGraphics
{
class VRenderContext;
}

namespace OrlexGraphics
{

struct VSceneOptions;

/// The walks over the render list that make a frame.
enum ERenderPass : std::uint32_t
{
	EPassOpaque = 0,
	EPassTransparent = 1,
	/// Depth was cleared before it: what is drawn now shows through all else.
	EPassOverlay = 2
};

/// Something that draws itself in a scene. Its calls come on the render thread with the context current; what they
/// draw was prepared before, so that a pass is a walk over arrays.
class IRenderType
{
public:
	virtual ~IRenderType() = default;

	virtual void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) = 0;

	/// Once a frame after the passes, for 2D text and marks.
	virtual void Paint(
	    QPainter& /*io_rPainter*/, CoreGraphics::VRenderContext& /*io_rContext*/, const VSceneOptions& /*i_rOptions*/)
	{
	}
};

} // namespace OrlexGraphics
