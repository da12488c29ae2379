#pragma once

#include "TesselPluginInterface/IPanelManager.h"

#include <memory>

namespace OrlexGraphics
{
class VSkinCache;
}

namespace TesselPluginInterface
{

class IQuickEngine;
class IGraphicsContext;

/// The host's services around its window, in slot order. Each call hands out a new owner.
class IPluginGui
{
public:
	virtual ~IPluginGui() = default;

	/// The QML engine, with the developer's reload flag and signals.
	virtual std::shared_ptr<IQuickEngine> GetQuickEngine() = 0;
	virtual NVX::CountedPointer<IPanelManager> GetPanelManager() = 0;
	virtual std::shared_ptr<IGraphicsContext> GetGraphicsContext() = 0;
	virtual std::shared_ptr<OrlexGraphics::VSkinCache> GetSkinCache() = 0;
};

} // namespace TesselPluginInterface
