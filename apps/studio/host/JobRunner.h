#pragma once

#include "TesselPluginInterface/IJobRunner.h"

#include <QThreadPool>

namespace StudioHost
{

/// Runs jobs on threads of its own. Its end waits for the jobs that have begun; the others never run.
class VJobRunner : public TesselPluginInterface::IJobRunner
{
public:
	VJobRunner();
	~VJobRunner() override;

	void Run(std::function<void()> i_Job, std::function<void()> i_Completion,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher) override;

private:
	QThreadPool m_Threads;
};

} // namespace StudioHost
