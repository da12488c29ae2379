#pragma once

#include "NVX/Signal.h"

#include <boost/filesystem/path.hpp>

#include <string>

namespace TesselPluginInterface
{

/// The folders that the user has set in the host, by store key ("FolderSubjects", "FolderSkins", "FolderRetargets",
/// ...).
class IPreferenceFolders
{
public:
	virtual ~IPreferenceFolders() = default;

	/// Empty for a key without a value.
	virtual boost::filesystem::path Folder(const std::string& i_rKey) const = 0;

	/// Fires with the key after its folder has changed.
	virtual NVX::VSignal<std::string>& ChangedSignal() = 0;
};

} // namespace TesselPluginInterface
