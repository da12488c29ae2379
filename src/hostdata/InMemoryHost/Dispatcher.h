#pragma once

#include "TesselPluginInterface/IDispatcher.h"

#include <cstddef>
#include <deque>
#include <mutex>

namespace InMemoryHost
{

/// Always queues: nothing runs before the owner's thread calls RunPending.
class VDispatcher : public TesselPluginInterface::IDispatcher
{
public:
	void Post(std::function<void()> i_Callback) override;

	/// Runs what is queued, first in first out, and what is posted meanwhile, until nothing is left.
	/// A callback that throws ends the run; the ones behind it stay queued.
	/// @return how many ran to their end.
	std::size_t RunPending();

	std::size_t PendingCount() const;

private:
	mutable std::mutex m_Mutex;
	std::deque<std::function<void()>> m_Queue;
};

} // namespace InMemoryHost
