#pragma once

#include "TesselPluginInterface/IJobRunner.h"

#include <functional>
#include <memory>
#include <utility>
#include <vector>

/// A background whose jobs run when the test says so.
class VHeldJobs : public TesselPluginInterface::IJobRunner
{
public:
	void Run(std::function<void()> i_Job, std::function<void()> i_Completion,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher) override
	{
		m_Jobs.push_back(
		    [=]
		    {
			    i_Job();
			    i_pDispatcher->Post(i_Completion);
		    });
	}
	void RunAll()
	{
		for (const auto& rJob : std::exchange(m_Jobs, {}))
			rJob();
	}
	std::vector<std::function<void()>> m_Jobs;
};
