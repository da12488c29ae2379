#pragma once

#include "TesselPluginInterface/IPlugin.h"

/// The module, as the host sees it. It holds nothing itself: what it builds belongs to what the host is given.
class VTesselPluginRetargetSetup : public TesselPluginInterface::IPlugin
{
public:
	bool RegisterQmlTypes() override;

	/// Builds the objects of the "Retarget Setup" panel from the host's services. Always true; an allocation that fails
	/// is raised, and what was made so far goes.
	bool CreateContent(
	    TesselPluginInterface::IPluginContext& i_rContext, TesselPluginInterface::IPluginGui& i_rGui) override;

	/// Harmless without content, and when called twice.
	bool ReleaseContent() override;
};
