#pragma once

#include "Flow2Graphics/IFlowRenderType.h"
#include "OrlexGraphics/stage/RenderCameras.h"

#include <memory>

namespace Flow2Graphics
{

/// The place of capture cameras in the flow of a scene. Frames that retarget bring none, and their partner draws none.
class VFlowRenderCameras : public IFlowRenderType
{
public:
	explicit VFlowRenderCameras(std::shared_ptr<OrlexGraphics::VRenderCameras> i_pPartner)
	    : m_pPartner(std::move(i_pPartner))
	{
	}

private:
	const std::shared_ptr<OrlexGraphics::VRenderCameras> m_pPartner;
};

} // namespace Flow2Graphics
