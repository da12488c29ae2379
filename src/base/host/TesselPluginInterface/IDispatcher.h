#pragma once

#include <functional>

namespace TesselPluginInterface
{

/// Runs callbacks on the user interface thread, in the order in which they were posted.
class IDispatcher
{
public:
	virtual ~IDispatcher() = default;

	/// Returns before the callback runs. From any thread.
	virtual void Post(std::function<void()> i_Callback) = 0;
};

} // namespace TesselPluginInterface
