#pragma once

#include "NVX/Signal.h"

class QQmlEngine;

namespace TesselPluginInterface
{

/// The host's QML engine, which all panels share and the host owns.
class IQuickEngine
{
public:
	virtual ~IQuickEngine() = default;

	virtual QQmlEngine& Engine() = 0;

	/// True where QML files come from the sources and may be loaded again while the host runs.
	virtual bool IsDeveloper() const = 0;

	/// Fires when panels should load their QML again. Only where IsDeveloper.
	virtual NVX::VSignal<>& ReloadSignal() = 0;
};

} // namespace TesselPluginInterface
