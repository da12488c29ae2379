#include "TesselPluginRetargetSetup/Exports.h"

#include "TesselPluginRetargetSetup/TesselPluginRetargetSetup.h"

#include <new>

TesselPluginInterface::IPlugin* CreatePlugin()
{
	return new (std::nothrow) VTesselPluginRetargetSetup;
}

void DestroyPlugin(TesselPluginInterface::IPlugin* i_pPlugin)
{
	delete i_pPlugin;
}

std::uint64_t PluginBuildRevision()
{
	return TesselPluginInterface::c_PluginBuildRevision;
}
