#include "TesselPluginRetargetSetup/TesselPluginRetargetSetup.h"

#include "RetargetSetupDocument/RetargetSetup.h"
#include "TesselPluginInterface/IPluginContext.h"

bool VTesselPluginRetargetSetup::RegisterQmlTypes()
{
	// The list models register their own types when they are made.
	return true;
}

bool VTesselPluginRetargetSetup::CreateContent(
    TesselPluginInterface::IPluginContext& i_rContext, TesselPluginInterface::IPluginGui& /*i_rGui*/)
{
	const auto pRetargetSetup = std::make_shared<VRetargetSetup>(
	    i_rContext.GetDispatcher(), i_rContext.GetFrameFactory(), i_rContext.GetItemFactory());
	// A panel would own the document from here on; without one it ends with this call.
	return true;
}

bool VTesselPluginRetargetSetup::ReleaseContent()
{
	return true;
}
