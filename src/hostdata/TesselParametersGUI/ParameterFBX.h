#pragma once

#include "TesselParametersGUI/ParameterEnumFolderWatcher.h"

namespace TesselParametersGUI
{

/// The FBX files of folders, behind "(None)", whose value is empty.
class VParameterFBX : public VParameterEnumFolderWatcher
{
	Q_OBJECT

public:
	/// As those of VParameterEnumFolderWatcher.
	VParameterFBX(std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore, const std::string& i_rPath,
	    std::string i_Name, std::shared_ptr<const TesselParameters::VParameterChecker> i_pChecker,
	    std::string i_NameExpression = {}, VDelay i_Delay = {});

protected:
	std::vector<TesselPluginInterface::VEnumEntry> PermittedValues(
	    std::vector<TesselPluginInterface::VEnumEntry> i_Files) const override;
};

} // namespace TesselParametersGUI
