#pragma once

#include "TesselPluginInterface/IQuickEngine.h"
#include "studio/qmltypes/QmlModules.h"

#include <QQmlEngine>

namespace StudioHost
{

/// The QML engine that the panels share. What its QML complains of goes to the log.
class VQuickEngine : public TesselPluginInterface::IQuickEngine
{
public:
	VQuickEngine(bool i_bDeveloper, VQmlServices i_Services);

	QQmlEngine& Engine() override { return m_Engine; }
	bool IsDeveloper() const override { return m_bDeveloper; }
	NVX::VSignal<>& ReloadSignal() override { return m_ReloadSignal; }

private:
	const bool m_bDeveloper;
	QQmlEngine m_Engine;
	NVX::VSignal<> m_ReloadSignal;
};

} // namespace StudioHost
