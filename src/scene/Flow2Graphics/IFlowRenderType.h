#pragma once

#include "NVX/CountedPointer.h"
#include "TesselPluginInterface/IFlowFrame.h"

namespace OrlexGraphics
{
class VSelectionRegistry;
class VSkinCache;
} // namespace OrlexGraphics

namespace Flow2Graphics
{

/// What a frame update works with.
struct VFlowContext
{
	OrlexGraphics::VSelectionRegistry& m_rRegistry;
	/// May be null.
	OrlexGraphics::VSkinCache* m_pSkinCache = nullptr;
	bool m_bYUp = false;
};

/// Reads the items that it knows from each frame, and prepares what its partner in the render list draws. Render
/// thread. Without its items it changes nothing.
class IFlowRenderType
{
public:
	virtual ~IFlowRenderType() = default;

	/// For each new frame, and again for the same one when ids, options or skins have become others.
	virtual void Update(const TesselPluginInterface::IFlowFrame& /*i_rFrame*/, VFlowContext& /*io_rContext*/) {}
	/// With what seldom changes: the floor, the volumes.
	virtual void UpdateStatic(const TesselPluginInterface::IFlowFrame& /*i_rFrame*/) {}
};

} // namespace Flow2Graphics
