#pragma once

#include "TesselPluginInterface/IDispatcher.h"

#include <functional>
#include <memory>

namespace TesselPluginInterface
{

/// Runs jobs in the background.
class IJobRunner
{
public:
	virtual ~IJobRunner() = default;

	/// Returns at once; the job runs on some other thread. From any thread.
	/// @param i_Completion is posted to the dispatcher when the job has ended
	virtual void Run(std::function<void()> i_Job, std::function<void()> i_Completion,
	    std::shared_ptr<IDispatcher> i_pDispatcher) = 0;
};

} // namespace TesselPluginInterface
