#pragma once

#include "TesselPluginInterface/IPlugin.h"

#include <cstdint>

#ifdef _WIN32
#define RETARGET_SETUP_EXPORT __declspec(dllexport)
#else
#define RETARGET_SETUP_EXPORT __attribute__((visibility("default")))
#endif

extern "C"
{
	/// The caller owns the plug-in and gives it back through DestroyPlugin. Null if there is no memory for it.
	RETARGET_SETUP_EXPORT TesselPluginInterface::IPlugin* CreatePlugin();

	/// Null is ignored.
	RETARGET_SETUP_EXPORT void DestroyPlugin(TesselPluginInterface::IPlugin* i_pPlugin);

	RETARGET_SETUP_EXPORT std::uint64_t PluginBuildRevision();
}
