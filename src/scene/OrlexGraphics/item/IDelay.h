#pragma once

#include <chrono>
#include <functional>

namespace OrlexGraphics
{

/// Calls back once, a while after it was started last. User interface thread only.
class IDelay
{
public:
	virtual ~IDelay() = default;

	/// What was started before never calls back.
	virtual void Start(std::chrono::milliseconds i_Time, std::function<void()> i_Callback) = 0;
	virtual void Stop() = 0;
};

} // namespace OrlexGraphics
