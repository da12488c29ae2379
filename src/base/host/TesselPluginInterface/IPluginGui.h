#pragma once

#include "TesselPluginInterface/IPanelManager.h"

#include <memory>

namespace CoreGraphics
{
class VShaderLibrary;
}

namespace OrlexGraphics
{
class VSkinCache;
}

namespace TesselPluginInterface
{

class IQuickEngine;

/// The host's services around its window, in slot order. Each call hands out a new owner.
class IPluginGui
{
public:
	virtual ~IPluginGui() = default;

	/// The QML engine, with the developer's reload flag and signals.
	virtual std::shared_ptr<IQuickEngine> GetQuickEngine() = 0;
	virtual NVX::CountedPointer<IPanelManager> GetPanelManager() = 0;
	/// The shaders that all panels share.
	virtual std::shared_ptr<CoreGraphics::VShaderLibrary> GetGraphicsContext() = 0;
	virtual std::shared_ptr<OrlexGraphics::VSkinCache> GetSkinCache() = 0;
};

} // namespace TesselPluginInterface
