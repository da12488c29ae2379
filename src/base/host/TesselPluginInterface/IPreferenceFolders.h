#pragma once

#include "NVX/Signal.h"

#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <string>

namespace TesselPluginInterface
{

/// Key of the number that says which state of the Alt key makes the mouse select, the other one moves the camera: 1
/// held, 0 not held. 1 unless the user has chosen otherwise.
inline constexpr const char* c_NavigationAltKey = "NavigationAlt";

/// The folders that the user has set in the host, by store key (c_FolderKeys), and the few other preferences that
/// panels need.
class IPreferenceFolders
{
public:
	virtual ~IPreferenceFolders() = default;

	/// Empty for a key without a value.
	virtual boost::filesystem::path Folder(const std::string& i_rKey) const = 0;

	/// The default for a key without a number.
	virtual std::int32_t Number(const std::string& /*i_rKey*/, std::int32_t i_Default) const { return i_Default; }

	/// Fires with the key after its folder or number has changed.
	virtual NVX::VSignal<std::string>& ChangedSignal() = 0;
};

} // namespace TesselPluginInterface
