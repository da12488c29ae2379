#pragma once

namespace TesselPluginInterface
{

/// The running application. A panel holds an owner of it and asks nothing.
class IApplicationObject
{
public:
	virtual ~IApplicationObject() = default;
};

} // namespace TesselPluginInterface
