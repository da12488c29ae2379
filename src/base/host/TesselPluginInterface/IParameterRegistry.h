#pragma once

#include "NVX/Signal.h"

#include <memory>
#include <string>

namespace TesselPluginInterface
{

class IParameterGroup;

/// The parameter groups that the host's generated controls can show, by store path and name ("RetargetSetup",
/// "Subject"). User interface thread only.
class IParameterRegistry
{
public:
	virtual ~IParameterRegistry() = default;

	/// A group of the same path and name is replaced. The registry owns no group: it forgets those that are gone.
	virtual void Register(const std::string& i_rPath, const std::shared_ptr<IParameterGroup>& i_rpGroup) = 0;

	/// Null if there is none.
	virtual std::shared_ptr<IParameterGroup> Find(const std::string& i_rPath, const std::string& i_rName) const = 0;

	/// Fires with path and name after a group was registered.
	virtual NVX::VSignal<std::string, std::string>& RegisteredSignal() = 0;
};

} // namespace TesselPluginInterface
