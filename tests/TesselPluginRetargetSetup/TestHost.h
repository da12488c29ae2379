#pragma once

#include "InMemoryHost/ParameterRegistry.h"
#include "InMemoryHost/PluginContext.h"
#include "TesselDataStore/DataStore.h"
#include "TesselPluginInterface/IQuickEngine.h"

#include <QQmlEngine>
#include <QStringList>

#include <memory>

/// A host of one panel, whose dispatcher runs only when it is told to.
class VTestContext : public InMemoryHost::VPluginContext
{
public:
	std::shared_ptr<TesselPluginInterface::IDataStore> GetDataStore() override { return m_pStore; }
	std::shared_ptr<TesselPluginInterface::IParameterRegistry> GetParameterRegistry() override { return m_pRegistry; }

	const std::shared_ptr<TesselDataStore::VDataStore> m_pStore = std::make_shared<TesselDataStore::VDataStore>();
	const std::shared_ptr<InMemoryHost::VParameterRegistry> m_pRegistry =
	    std::make_shared<InMemoryHost::VParameterRegistry>();
};

class VTestEngine : public TesselPluginInterface::IQuickEngine
{
public:
	/// @param i_bModules false leaves the host's QML modules out, so that no panel loads.
	VTestEngine(VTestContext& i_rContext, bool i_bModules);

	QQmlEngine& Engine() override { return m_Engine; }
	bool IsDeveloper() const override { return false; }
	NVX::VSignal<>& ReloadSignal() override { return m_ReloadSignal; }

	/// What the QML complained of.
	QStringList m_Warnings;

private:
	QQmlEngine m_Engine;
	NVX::VSignal<> m_ReloadSignal;
};

class VTestGui : public InMemoryHost::VPluginGui
{
public:
	explicit VTestGui(VTestContext& i_rContext, bool i_bModules = true);

	std::shared_ptr<TesselPluginInterface::IQuickEngine> GetQuickEngine() override { return m_pEngine; }
	std::shared_ptr<CoreGraphics::VShaderLibrary> GetGraphicsContext() override { return m_pShaderLibrary; }
	std::shared_ptr<OrlexGraphics::VSkinCache> GetSkinCache() override { return m_pSkinCache; }

	const std::shared_ptr<VTestEngine> m_pEngine;
	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaderLibrary;
	const std::shared_ptr<OrlexGraphics::VSkinCache> m_pSkinCache;
};

/// What was posted, what that posts, and Qt's events, until nothing is left.
void RunAll(VTestContext& io_rContext);
