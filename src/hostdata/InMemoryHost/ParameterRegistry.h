#pragma once

#include "TesselPluginInterface/IParameterRegistry.h"

#include <map>
#include <utility>

namespace InMemoryHost
{

class VParameterRegistry : public TesselPluginInterface::IParameterRegistry
{
public:
	void Register(
	    const std::string& i_rPath, const std::shared_ptr<TesselPluginInterface::IParameterGroup>& i_rpGroup) override;
	std::shared_ptr<TesselPluginInterface::IParameterGroup> Find(
	    const std::string& i_rPath, const std::string& i_rName) const override;
	NVX::VSignal<std::string, std::string>& RegisteredSignal() override { return m_RegisteredSignal; }

private:
	std::map<std::pair<std::string, std::string>, std::weak_ptr<TesselPluginInterface::IParameterGroup>> m_Groups;
	NVX::VSignal<std::string, std::string> m_RegisteredSignal;
};

} // namespace InMemoryHost
