#pragma once

#include <array>

namespace TesselPluginInterface
{

/// The kinds of folders that a user sets in the host's preferences.
enum EPathTypes
{
	EPathSubjects,
	EPathSubjectCalTemplates,
	EPathSkins,
	EPathRetargets,
	EPathRemarkableActions,
	EPathProps,
	EPathClusters,
	EPathObjects,
	EPathSmartObjectTemplates,
	EPathPropMeshes,
	EPathCalibrationObjects,
	EPathTypeCount
};

/// The store key of each kind.
inline constexpr std::array<const char*, EPathTypeCount> c_FolderKeys = {"FolderSubjects", "FolderSubjectCalTemplates",
    "FolderSkins", "FolderRetargets", "FolderRemarkableActions", "FolderProps", "FolderClusters", "FolderObjects",
    "FolderSmartObjectTemplates", "FolderPropMeshes", "FolderCalibrationObjects"};

} // namespace TesselPluginInterface
