#pragma once

#include "OrlexGraphics/frame/IRenderType.h"

namespace OrlexGraphics
{

/// Capture cameras. A scene without camera data has none to draw.
class VRenderCameras : public IRenderType
{
public:
	void Render(CoreGraphics::VRenderContext& /*io_rContext*/, const VSceneOptions& /*i_rOptions*/,
	    std::uint32_t /*i_Pass*/) override
	{
	}

	/// The picture of the overlay camera, before all passes.
	/// @return whether 3D is to be drawn over it.
	virtual bool RenderOverlayCamera(CoreGraphics::VRenderContext& /*io_rContext*/, const VSceneOptions& /*i_rOptions*/)
	{
		return true;
	}
};

} // namespace OrlexGraphics
