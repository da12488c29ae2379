#include "studio/host/JobRunner.h"

#include "DebugServices/GlobalLog.h"

#include <QRunnable>

namespace StudioHost
{
namespace
{

/// A source and a target skin at once; the rest of the machine is for drawing.
constexpr int c_Threads = 2;

} // namespace

VJobRunner::VJobRunner()
{
	m_Threads.setMaxThreadCount(c_Threads);
}

VJobRunner::~VJobRunner()
{
	m_Threads.clear();
	m_Threads.waitForDone();
}

void VJobRunner::Run(std::function<void()> i_Job, std::function<void()> i_Completion,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
{
	m_Threads.start(
	    [job = std::move(i_Job), completion = std::move(i_Completion), pDispatcher = std::move(i_pDispatcher)]
	    {
		    // Qt's threads do not let exceptions through.
		    try
		    {
			    job();
		    }
		    catch (const std::exception& rError)
		    {
			    NVX_LOG("System", NVX::ELogError, "A job in the background failed: %1%", rError.what());
		    }
		    pDispatcher->Post(completion);
	    });
}

} // namespace StudioHost
