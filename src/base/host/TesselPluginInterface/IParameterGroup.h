#pragma once

#include "NVX/Signal.h"

#include <memory>
#include <string>
#include <vector>

namespace TesselPluginInterface
{

class IParameter;

/// Parameters that are shown together. User interface thread only.
class IParameterGroup
{
public:
	virtual ~IParameterGroup() = default;

	/// Store path ("RetargetSetup") and name ("Subject") under which it is registered.
	virtual const std::string& GetPath() const = 0;
	virtual const std::string& GetName() const = 0;
	/// The label; the name if none was set.
	virtual std::string GetDisplay() const = 0;
	virtual std::string GetDescription() const = 0;

	/// In the order in which they were added.
	virtual const std::vector<std::shared_ptr<IParameter>>& GetParameters() const = 0;
	/// Null if there is none of that name.
	virtual std::shared_ptr<IParameter> Find(const std::string& i_rName) const = 0;
	virtual const std::vector<std::shared_ptr<IParameterGroup>>& GetChildren() const = 0;

	/// Fires after parameters or children were added, and when the group ends, before its parameters go.
	virtual NVX::VSignal<>& ChangedSignal() = 0;
	virtual NVX::VSignal<>& EndingSignal() = 0;
};

} // namespace TesselPluginInterface
