#include "TesselPluginRetargetSetup/PanelParameters.h"

#include "TesselParameters/ParameterGroup.h"
#include "TesselParametersGUI/ParameterFBX.h"
#include "TesselPluginInterface/IParameterRegistry.h"
#include "TesselPluginInterface/IPreferenceFolders.h"
#include "TesselPluginInterface/PathTypes.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>

using TesselDataStore::ToVariant;
using TesselParameters::CheckerOf;
using TesselParametersGUI::VParameterEnumFolderWatcher;
using TesselParametersGUI::VParameterFBX;
using TesselPluginInterface::c_FolderKeys;
using TesselPluginInterface::IParameter;
using TesselPluginInterface::VEnumEntry;

namespace RetargetSetup
{

namespace
{

/// A source skeleton that is taken if nothing has been chosen yet.
constexpr const char* c_DefaultSkeleton = "ClusterTemplate";

/// Among files of one name: what was opened from elsewhere, then the user's folders, then what products bring.
constexpr int c_OpenedPriority = 12;
constexpr int c_SubjectsPriority = 11;
constexpr int c_UserPriority = 10;
constexpr int c_InstalledPriority = 1;

constexpr const char* c_OpenedLabel = "Opened";

void AddInstalled(VParameterEnumFolderWatcher& io_rParameter, const std::vector<boost::filesystem::path>& i_rFolders)
{
	for (std::size_t i = 0; i < i_rFolders.size(); ++i)
		io_rParameter.AddFolder("Installed" + std::to_string(i), i_rFolders[i], c_InstalledPriority);
}

/// Reads the folders for the first time, when a value that is not in them would be cleared.
void Start(VParameterEnumFolderWatcher& io_rParameter)
{
	VPanelParameters::OfferFile(io_rParameter, UtilsFileSystem::PathFromUtf8(io_rParameter.GetValueText()));
	io_rParameter.Refresh();
}

} // namespace

VPanelParameters::VPanelParameters(const std::shared_ptr<TesselPluginInterface::IDataStore>& i_rpStore,
    TesselPluginInterface::IParameterRegistry& io_rRegistry,
    const TesselPluginInterface::IPreferenceFolders& i_rFolders, const VProductFolders& i_rInstalled)
    : m_pSubjectGroup(std::make_shared<TesselParameters::VParameterGroup>(i_rpStore, c_ParameterPath, "Subject")),
      m_pTargetGroup(std::make_shared<TesselParameters::VParameterGroup>(i_rpStore, c_ParameterPath, "Target"))
{
	m_pSourceSkeleton = m_pSubjectGroup->AddNew<VParameterEnumFolderWatcher>(
	    "Source Skeleton", "Orlex skeleton driving targets.", "SourceSkeleton", CheckerOf<std::string>(), ".qrs");
	m_pSourceSkin = m_pSubjectGroup->AddNew<VParameterFBX>("Source Skin", "Skin file for source skeleton.",
	    "SourceSkin", CheckerOf<boost::filesystem::path>(), "^Orlex.*");
	m_pTargetFBX = m_pSubjectGroup->AddNew<VParameterFBX>(
	    "Target FBX", "Skin file for target skeleton.", "TargetFBX", CheckerOf<std::string>());
	m_pTargetRoot = m_pSubjectGroup->Add<std::uint32_t>("TargetRoot", "Target Root", "Root bone for target skeleton");
	SetBones({});
	m_pTargetScale =
	    m_pSubjectGroup->Add<double>("TargetScale", "Target Scale", "Global scale to apply to target skeleton");
	m_pTargetScale->SetDefault(1.0);

	m_pTargetWeight = m_pTargetGroup->Add<double>("TargetWeight", "Weight", "Skin file for target skeleton.");
	m_pTargetWeight->SetLimits(1.0, 100.0);
	m_pTargetWeight->SetPresentationHint(TesselPluginInterface::EPresentationHint::ESlider);
	for (std::size_t i = 0; i < m_pTargetState.size(); ++i)
	{
		const std::string axis(1, char('X' + i));
		m_pTargetState[i] = m_pTargetGroup->Add<std::string>(
		    "TargetStateExpression" + axis, "State " + axis, "State expression for target " + axis);
	}

	m_pSourceSkeleton->AddFolder(
	    "Subjects", i_rFolders.Folder(c_FolderKeys[TesselPluginInterface::EPathSubjects]), c_SubjectsPriority);
	m_pSourceSkeleton->AddFolder(
	    "User", i_rFolders.Folder(c_FolderKeys[TesselPluginInterface::EPathSubjectCalTemplates]), c_UserPriority);
	AddInstalled(*m_pSourceSkeleton, i_rInstalled.m_Models);
	m_pTargetFBX->AddFolder("User", i_rFolders.Folder(c_FolderKeys[TesselPluginInterface::EPathSkins]), c_UserPriority);
	AddInstalled(*m_pTargetFBX, i_rInstalled.m_Skins);
	AddInstalled(*m_pSourceSkin, i_rInstalled.m_Skins);
	// A bare name was told by the target subject of an earlier run: nobody chose it, and nothing of it is lost.
	if (!UtilsFileSystem::PathFromUtf8(m_pSourceSkeleton->GetValueText()).is_absolute())
		m_pSourceSkeleton->ClearValue();
	Start(*m_pSourceSkeleton);
	Start(*m_pSourceSkin);
	Start(*m_pTargetFBX);

	if (!m_pSourceSkeleton->HasValue())
		for (const VEnumEntry& rEntry : m_pSourceSkeleton->GetEnumeration())
			if (rEntry.m_Name == c_DefaultSkeleton)
				m_pSourceSkeleton->SetValue(rEntry.m_Value);

	io_rRegistry.Register(c_ParameterPath, m_pSubjectGroup);
	io_rRegistry.Register(c_ParameterPath, m_pTargetGroup);
}

VPanelParameters::~VPanelParameters() = default;

void VPanelParameters::OnFolderPreferenceChanged(
    const std::string& i_rKey, const TesselPluginInterface::IPreferenceFolders& i_rFolders)
{
	if (i_rKey == c_FolderKeys[TesselPluginInterface::EPathSubjects])
		m_pSourceSkeleton->SetFolder("Subjects", i_rFolders.Folder(i_rKey));
	else if (i_rKey == c_FolderKeys[TesselPluginInterface::EPathSubjectCalTemplates])
		m_pSourceSkeleton->SetFolder("User", i_rFolders.Folder(i_rKey));
	else if (i_rKey == c_FolderKeys[TesselPluginInterface::EPathSkins])
		m_pTargetFBX->SetFolder("User", i_rFolders.Folder(i_rKey));
}

void VPanelParameters::OfferFile(VParameterEnumFolderWatcher& io_rParameter, const boost::filesystem::path& i_rPath)
{
	boost::system::error_code error;
	if (!i_rPath.is_absolute() || !boost::filesystem::is_regular_file(i_rPath, error))
		return;
	const std::vector<TesselParametersGUI::VWatchedFolder>& rFolders = io_rParameter.GetFolders();
	const boost::filesystem::path folder = i_rPath.parent_path();
	if (std::none_of(rFolders.begin(), rFolders.end(),
	        [&folder](const TesselParametersGUI::VWatchedFolder& i_rFolder) { return i_rFolder.m_Folder == folder; }))
		io_rParameter.AddFolder(c_OpenedLabel, folder, c_OpenedPriority);
}

VShownTarget VPanelParameters::ReadTarget(std::int32_t i_Index) const
{
	VShownTarget target;
	target.m_Index = i_Index;
	m_pTargetWeight->Get(target.m_Weight);
	for (std::size_t i = 0; i < m_pTargetState.size(); ++i)
		m_pTargetState[i]->Get(target.m_State[i]);
	return target;
}

void VPanelParameters::WriteTarget(const VShownTarget& i_rTarget)
{
	m_pTargetWeight->Set(i_rTarget.m_Weight);
	for (std::size_t i = 0; i < m_pTargetState.size(); ++i)
	{
		m_pTargetState[i]->SetFlag(IParameter::EHidden, i_rTarget.m_bStateHidden);
		m_pTargetState[i]->Set(i_rTarget.m_State[i]);
	}
}

void VPanelParameters::SetBones(const std::vector<std::pair<std::string, std::uint32_t>>& i_rBones)
{
	std::vector<VEnumEntry> entries;
	entries.reserve(i_rBones.size());
	for (const auto& [rName, index] : i_rBones)
		entries.push_back({rName, ToVariant(index)});
	m_pTargetRoot->SetEnumeration(entries);
}

} // namespace RetargetSetup
