#pragma once

#include "TesselPluginInterface/IHostRules.h"

namespace InMemoryHost
{

/// The application of a program that nobody sits at: its rules are set once, and no question is ever answered with no.
class VApplication : public TesselPluginInterface::IApplicationObject, public TesselPluginInterface::IHostRules
{
public:
	TesselPluginInterface::VHostRules Rules() const override { return m_Rules; }
	bool MayReplaceTargetSubject(const std::string&) override { return true; }

	TesselPluginInterface::VHostRules m_Rules;
};

} // namespace InMemoryHost
