#include "InMemoryHost/ParameterRegistry.h"

#include "TesselPluginInterface/IParameterGroup.h"

using TesselPluginInterface::IParameterGroup;

namespace InMemoryHost
{

void VParameterRegistry::Register(const std::string& i_rPath, const std::shared_ptr<IParameterGroup>& i_rpGroup)
{
	if (!i_rpGroup)
		return;
	m_Groups[{i_rPath, i_rpGroup->GetName()}] = i_rpGroup;
	m_RegisteredSignal.Fire(i_rPath, i_rpGroup->GetName());
}

std::shared_ptr<IParameterGroup> VParameterRegistry::Find(const std::string& i_rPath, const std::string& i_rName) const
{
	const auto found = m_Groups.find({i_rPath, i_rName});
	return found == m_Groups.end() ? nullptr : found->second.lock();
}

} // namespace InMemoryHost
