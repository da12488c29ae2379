#pragma once

#include <string>

/// A panel that answers the host's named commands ("Workspace3d:FrameSelected", ...). The host finds it by asking the
/// panel's widget for the meta class "ITesselExecuteCommand".
class ITesselExecuteCommand
{
public:
	virtual ~ITesselExecuteCommand() = default;

	/// False for a command that is not the panel's, by its exact name.
	virtual bool ExecuteCommand(const std::string& i_rCommand) = 0;
};
