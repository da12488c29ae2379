#pragma once

#include "TesselPluginRetargetSetup/ProductFolders.h"
#include "TesselPluginRetargetSetup/ShownTarget.h"

#include <boost/filesystem/path.hpp>

#include <array>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace TesselParameters
{
class VParameter;
class VParameterGroup;
} // namespace TesselParameters

namespace TesselParametersGUI
{
class VParameterEnumFolderWatcher;
class VParameterFBX;
} // namespace TesselParametersGUI

namespace TesselPluginInterface
{
class IDataStore;
class IParameterRegistry;
class IPreferenceFolders;
} // namespace TesselPluginInterface

namespace RetargetSetup
{

/// The path of the panel's parameters in the host's store, and of their groups "Subject" and "Target" in the registry.
inline constexpr const char* c_ParameterPath = "RetargetSetup";

/// The settings of the panel: what they are called, where their values come from, and in which folders they look. They
/// are registered for the host's controls while this lives. User interface thread only.
class VPanelParameters
{
public:
	VPanelParameters(const std::shared_ptr<TesselPluginInterface::IDataStore>& i_rpStore,
	    TesselPluginInterface::IParameterRegistry& io_rRegistry,
	    const TesselPluginInterface::IPreferenceFolders& i_rFolders, const VProductFolders& i_rInstalled);
	~VPanelParameters();

	/// Looks in another folder from now on, if the preference of this key is one that a parameter follows.
	void OnFolderPreferenceChanged(
	    const std::string& i_rKey, const TesselPluginInterface::IPreferenceFolders& i_rFolders);

	/// A file from outside the folders is offered like those inside, with the others of its folder.
	static void OfferFile(
	    TesselParametersGUI::VParameterEnumFolderWatcher& io_rParameter, const boost::filesystem::path& i_rPath);

	/// What stands in the target's four parameters. Weight 0 and empty texts for what has no value.
	/// @param i_Index the target that they are of.
	VShownTarget ReadTarget(std::int32_t i_Index) const;
	void WriteTarget(const VShownTarget& i_rTarget);

	/// Replaces the choice of root bones.
	void SetBones(const std::vector<std::pair<std::string, std::uint32_t>>& i_rBones);

	std::shared_ptr<TesselParametersGUI::VParameterEnumFolderWatcher> m_pSourceSkeleton;
	std::shared_ptr<TesselParametersGUI::VParameterFBX> m_pSourceSkin;
	std::shared_ptr<TesselParametersGUI::VParameterFBX> m_pTargetFBX;
	std::shared_ptr<TesselParameters::VParameter> m_pTargetRoot;
	std::shared_ptr<TesselParameters::VParameter> m_pTargetScale;
	std::shared_ptr<TesselParameters::VParameter> m_pTargetWeight;
	std::array<std::shared_ptr<TesselParameters::VParameter>, 3> m_pTargetState;

private:
	const std::shared_ptr<TesselParameters::VParameterGroup> m_pSubjectGroup;
	const std::shared_ptr<TesselParameters::VParameterGroup> m_pTargetGroup;
};

} // namespace RetargetSetup
