#include "TesselParametersGUI/ParameterFBX.h"

namespace TesselParametersGUI
{

VParameterFBX::VParameterFBX(std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore, const std::string& i_rPath,
    std::string i_Name, std::shared_ptr<const TesselParameters::VParameterChecker> i_pChecker,
    std::string i_NameExpression, VDelay i_Delay)
    : VParameterEnumFolderWatcher(std::move(i_pStore), i_rPath, std::move(i_Name), std::move(i_pChecker), ".fbx",
        std::move(i_NameExpression), std::move(i_Delay))
{
}

std::vector<TesselPluginInterface::VEnumEntry> VParameterFBX::PermittedValues(
    std::vector<TesselPluginInterface::VEnumEntry> i_Files) const
{
	i_Files.insert(i_Files.begin(), {"(None)", TesselDataStore::ToVariant("")});
	return i_Files;
}

} // namespace TesselParametersGUI

#include "moc_ParameterFBX.cpp"
